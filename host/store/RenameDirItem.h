#pragma once

#include "host/store/Command.h"
#include "host/store/DirFolder.h"

#include <QtGlobal>

#include <memory>

namespace vemi {

class BaseObject;

// Renames a folder, or the object of an entry (its stored name and header).
// Renaming an object stores a new revision of it, so that a save from an
// older one is refused instead of undoing the rename.
class RenameDirItem : public Command
{
public:
    RenameDirItem(DirItemKind kind, std::string id, std::string name)
        : m_kind(kind), m_id(std::move(id)), m_name(std::move(name)) {}
    // The open copy of the renamed object, which took the new name already:
    // unless it was stored elsewhere meanwhile, it carries the new revision
    // afterwards, so that its next save is not refused.
    void setOpenObject(std::shared_ptr<BaseObject> object) { m_openObject = std::move(object); }

    std::shared_ptr<Response> execute(StoreDatabase& database) override;
    std::string description() const override { return "rename to \"" + m_name + "\""; }

private:
    void renameFolder(StoreDatabase& database);
    void renameEntry(StoreDatabase& database);

    DirItemKind m_kind;
    std::string m_id;
    std::string m_name;
    std::shared_ptr<BaseObject> m_openObject;
    qint64 m_readRevision = 0;
};

} // namespace vemi
