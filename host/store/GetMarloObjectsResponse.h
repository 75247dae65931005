#pragma once

#include "host/store/Response.h"

#include <memory>
#include <vector>

namespace vemi {

class BaseObject;

class GetMarloObjectsResponse : public Response
{
public:
    explicit GetMarloObjectsResponse(std::vector<std::shared_ptr<BaseObject>> objects)
        : m_objects(std::move(objects)) {}
    std::vector<std::shared_ptr<BaseObject>> objects() const { return m_objects; }

private:
    std::vector<std::shared_ptr<BaseObject>> m_objects;
};

} // namespace vemi
