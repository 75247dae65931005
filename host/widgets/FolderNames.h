#pragma once

#include <string>
#include <vector>

namespace vemi {

class DirEntryBrowserInterface;

// A folder browser as its client sees it when naming a new object: which
// names the folder that "new" files into holds already.
class FolderNames
{
public:
    // UTF-8 names of the entries and folders directly in that folder.
    virtual std::vector<std::string> namesInTargetFolder() const = 0;
    // client is being destroyed; the browser must not call it any more.
    virtual void clientDestroyed(DirEntryBrowserInterface* client) = 0;

protected:
    ~FolderNames() = default;
};

} // namespace vemi
