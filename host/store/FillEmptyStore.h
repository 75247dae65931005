#pragma once

#include "host/store/Command.h"
#include "host/store/DirFolder.h"

#include <vector>

namespace vemi {

class BaseObject;
class UpdateObject;

// Writes a whole set of folders and objects, all or nothing, and only into a
// store that holds no folder and no object yet. The check and the writes share
// one write transaction, so two programs that fill the same new store at once
// end with one set, and a failure half-way leaves the store empty. Answers a
// FillEmptyStoreResponse, which says whether the set was written.
class FillEmptyStore : public Command
{
public:
    // description: what the set is, for error messages ("store the sample data").
    explicit FillEmptyStore(std::string description);
    ~FillEmptyStore() override;

    // Returns the id of the new folder. Folders are written in the order
    // added, so add a parent before its children.
    std::string addFolder(const std::string& objectType, const std::string& parentId, const std::string& name);
    // Files the object in folderId ("" = top level). Its snapshot is taken when
    // the command is dispatched, as UpdateObject does.
    void addObject(std::shared_ptr<BaseObject> object, const std::string& folderId);

    void prepare() override;
    std::shared_ptr<Response> execute(StoreDatabase& database) override;
    std::string description() const override { return m_description; }

private:
    static bool holdsAnything(StoreDatabase& database);

    std::string m_description;
    std::vector<DirFolder> m_folders;
    std::vector<std::shared_ptr<UpdateObject>> m_objects;
};

} // namespace vemi
