#pragma once

#include "host/store/Response.h"

#include <QStringList>

#include <memory>

namespace vemi {

class BaseObject;

class GetMarloObjectResponse : public Response
{
public:
    explicit GetMarloObjectResponse(std::shared_ptr<BaseObject> object, QStringList problems = {})
        : m_object(std::move(object)), m_problems(std::move(problems)) {}
    std::shared_ptr<BaseObject> object() const { return m_object; }
    // One sentence for each member of a library that was left out because it
    // is damaged, naming it by name and folder; empty when all was read.
    QStringList problems() const { return m_problems; }

private:
    std::shared_ptr<BaseObject> m_object;
    QStringList m_problems;
};

} // namespace vemi
