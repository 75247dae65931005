#pragma once

#include "host/store/Response.h"

#include <memory>
#include <string>

namespace vemi {

class DirEntry;

class UpdateObjectResponse : public Response
{
public:
    UpdateObjectResponse(std::string objectId, std::shared_ptr<DirEntry> entry)
        : m_objectId(std::move(objectId)), m_entry(std::move(entry)) {}
    std::string objectId() const { return m_objectId; }
    // The folder entry of the object, when the command filed it in a folder.
    std::shared_ptr<DirEntry> entry() const { return m_entry; }

private:
    std::string m_objectId;
    std::shared_ptr<DirEntry> m_entry;
};

} // namespace vemi
