#pragma once

#include "host/store/DirFolder.h"
#include "host/store/Response.h"

#include <memory>
#include <vector>

namespace vemi {

class DirEntry;

// The whole folder tree of one object type: its folders and its entries.
class DirectoryTreeResponse : public Response
{
public:
    DirectoryTreeResponse(std::vector<DirFolder> folders, std::vector<std::shared_ptr<DirEntry>> entries)
        : m_folders(std::move(folders)), m_entries(std::move(entries)) {}
    const std::vector<DirFolder>& folders() const { return m_folders; }
    const std::vector<std::shared_ptr<DirEntry>>& entries() const { return m_entries; }

private:
    std::vector<DirFolder> m_folders;
    std::vector<std::shared_ptr<DirEntry>> m_entries;
};

} // namespace vemi
