#pragma once

#include <QString>

#include <memory>
#include <string>

namespace vemi {

class DirEntryBrowserWidget;
class NamedObject;

// What a DirEntryBrowserWidget asks of the client that shows it.
class DirEntryBrowserInterface
{
public:
    virtual ~DirEntryBrowserInterface();
    // The object that "new" creates; the browser files it in the current folder.
    virtual std::shared_ptr<NamedObject> newNamedObject() = 0;
    // base, or base followed by " 2", " 3", … : the first name that no entry
    // of the folder that "new" files into has yet. UTF-8.
    virtual std::string defaultNamedObjectName(QString base);
    // The type of the objects the tree shows.
    virtual std::string namedObjectTypeId() = 0;

private:
    friend class DirEntryBrowserWidget;
    DirEntryBrowserWidget* m_browserWidget = nullptr; // set by the browser's initialize()
};

} // namespace vemi
