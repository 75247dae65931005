#pragma once

#include "host/store/DirFolder.h"
#include "host/store/Response.h"

namespace vemi {

class FolderResponse : public Response
{
public:
    explicit FolderResponse(DirFolder folder) : m_folder(std::move(folder)) {}
    const DirFolder& folder() const { return m_folder; }

private:
    DirFolder m_folder;
};

} // namespace vemi
