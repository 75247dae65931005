#pragma once

#include "host/store/Command.h"

#include <vector>

namespace vemi {

// Deletes folders with everything in them, and entries with their objects.
class DeleteDirItems : public Command
{
public:
    DeleteDirItems(std::vector<std::string> folderIds, std::vector<std::string> entryIds)
        : m_folderIds(std::move(folderIds)), m_entryIds(std::move(entryIds)) {}

    std::shared_ptr<Response> execute(StoreDatabase& database) override;
    std::string description() const override { return "delete the selected items"; }

private:
    std::vector<std::string> m_folderIds;
    std::vector<std::string> m_entryIds;
};

} // namespace vemi
