#pragma once

#include "host/store/Command.h"
#include "host/store/DirFolder.h"

namespace vemi {

// Moves a folder or an entry into another folder ("" = top level).
class MoveDirItem : public Command
{
public:
    MoveDirItem(DirItemKind kind, std::string id, std::string targetFolderId)
        : m_kind(kind), m_id(std::move(id)), m_targetFolderId(std::move(targetFolderId)) {}

    std::shared_ptr<Response> execute(StoreDatabase& database) override;
    std::string description() const override { return "move the item"; }

private:
    void moveFolder(StoreDatabase& database);
    void moveEntry(StoreDatabase& database);

    DirItemKind m_kind;
    std::string m_id;
    std::string m_targetFolderId;
};

} // namespace vemi
