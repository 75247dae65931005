#pragma once

#include "host/store/Response.h"

#include <QStringList>

#include <memory>
#include <vector>

namespace vemi {

class BaseObject;

class GetMarloObjectsResponse : public Response
{
public:
    explicit GetMarloObjectsResponse(std::vector<std::shared_ptr<BaseObject>> objects, QStringList problems = {})
        : m_objects(std::move(objects)), m_problems(std::move(problems)) {}
    // The objects that could be read; damaged ones are left out.
    std::vector<std::shared_ptr<BaseObject>> objects() const { return m_objects; }
    // One sentence for each object (or library member) that was left out
    // because it is damaged, naming it by name and folder; empty when all was read.
    QStringList problems() const { return m_problems; }

private:
    std::vector<std::shared_ptr<BaseObject>> m_objects;
    QStringList m_problems;
};

} // namespace vemi
