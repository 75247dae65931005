#pragma once

#include "host/store/Command.h"
#include "host/store/DirFolder.h"

namespace vemi {

// Renames a folder, or the object of an entry (its stored name and header).
class RenameDirItem : public Command
{
public:
    RenameDirItem(DirItemKind kind, std::string id, std::string name)
        : m_kind(kind), m_id(std::move(id)), m_name(std::move(name)) {}

    std::shared_ptr<Response> execute(StoreDatabase& database) override;
    std::string description() const override { return "rename to \"" + m_name + "\""; }

private:
    void renameFolder(StoreDatabase& database);
    void renameEntry(StoreDatabase& database);

    DirItemKind m_kind;
    std::string m_id;
    std::string m_name;
};

} // namespace vemi
