#pragma once

#include <QString>

#include <memory>
#include <string>

namespace vemi {

class FolderNames;
class NamedObject;

// What a folder browser (a DirEntryBrowserWidget or any other FolderNames)
// asks of the client that shows it.
class DirEntryBrowserInterface
{
public:
    virtual ~DirEntryBrowserInterface();
    // The object that "new" creates; the browser files it in the current folder.
    virtual std::shared_ptr<NamedObject> newNamedObject() = 0;
    // base, or base followed by " 2", " 3", … : the first name that no entry
    // of the folder that "new" files into has yet. An empty base stands for
    // the readable name of namedObjectTypeId() ("Measurement Configuration").
    // UTF-8.
    virtual std::string defaultNamedObjectName(QString base);
    // The type of the objects the tree shows.
    virtual std::string namedObjectTypeId() = 0;

    // The browser in whose target folder new names must be unique; null for
    // none. Not owned: a browser sets itself when it takes this client and
    // clears itself when it dies; this client tells it when it dies first.
    void setFolderBrowser(FolderNames* browser) { m_folderBrowser = browser; }
    FolderNames* folderBrowser() const { return m_folderBrowser; }

private:
    FolderNames* m_folderBrowser = nullptr;
};

} // namespace vemi
