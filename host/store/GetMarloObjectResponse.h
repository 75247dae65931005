#pragma once

#include "host/store/Response.h"

#include <memory>

namespace vemi {

class BaseObject;

class GetMarloObjectResponse : public Response
{
public:
    explicit GetMarloObjectResponse(std::shared_ptr<BaseObject> object) : m_object(std::move(object)) {}
    std::shared_ptr<BaseObject> object() const { return m_object; }

private:
    std::shared_ptr<BaseObject> m_object;
};

} // namespace vemi
