#pragma once

#include "host/store/Command.h"
#include "host/domain/ObjectSnapshot.h"

#include <vector>

namespace vemi {

class BaseObject;

// Adds a set of new objects, and the folders they are filed in, in one write
// transaction: all or nothing. A folder is looked up by its name under its
// parent and made only when it is missing, so that sets added one after the
// other share their folders. Answers an AddObjectSetResponse.
//
// Unlike UpdateObject, the objects' snapshots are taken when they are added,
// so a set can be built on any thread and dispatched from another without
// further work on the dispatching one.
class AddObjectSet : public Command
{
public:
    using FolderKey = int;
    static constexpr FolderKey kTopLevel = -1;

    // description: what the set is, for error messages ("import \"file.txt\"").
    explicit AddObjectSet(std::string description);

    // Add a parent before its children; objectType is that of the folder's tree.
    FolderKey addFolder(const std::string& objectType, FolderKey parent, const std::string& name);
    // The object must be new to the store and of the folder's type.
    void addObject(const BaseObject& object, FolderKey folder);
    std::size_t objectCount() const { return m_objects.size(); }

    std::shared_ptr<Response> execute(StoreDatabase& database) override;
    std::string description() const override { return m_description; }

private:
    struct PlannedFolder
    {
        std::string objectType;
        FolderKey parent;
        std::string name;
    };
    struct PlannedObject
    {
        ObjectSnapshot snapshot;
        std::string id;
        std::string type;
        std::string name;
        FolderKey folder;
    };

    std::vector<std::string> resolveFolders(StoreDatabase& database) const;
    void writeObjects(StoreDatabase& database, const std::vector<std::string>& folderIds,
                      const std::vector<QByteArray>& encoded) const;

    std::string m_description;
    std::vector<PlannedFolder> m_folders;
    std::vector<PlannedObject> m_objects;
};

} // namespace vemi
