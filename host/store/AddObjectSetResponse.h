#pragma once

#include "host/store/Response.h"

#include <string>
#include <vector>

namespace vemi {

class AddObjectSetResponse : public Response
{
public:
    explicit AddObjectSetResponse(std::vector<std::string> folderIds) : m_folderIds(std::move(folderIds)) {}
    // The store's id of each folder of the set, in the order they were added.
    const std::vector<std::string>& folderIds() const { return m_folderIds; }

private:
    std::vector<std::string> m_folderIds;
};

} // namespace vemi
