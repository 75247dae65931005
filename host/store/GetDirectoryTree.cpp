#include "host/store/GetDirectoryTree.h"

#include "host/domain/DirEntry.h"
#include "host/store/DirectoryTreeResponse.h"
#include "host/domain/Header.h"
#include "host/store/StoreDatabase.h"

namespace vemi {

std::shared_ptr<Response> GetDirectoryTree::execute(StoreDatabase& database)
{
    const QString type = QString::fromStdString(m_objectType);
    std::vector<DirFolder> folders;
    QSqlQuery folderRows = database.run(
        QStringLiteral("SELECT id, parent_id, name FROM folders WHERE object_type = ? ORDER BY name"),
        {type});
    while (folderRows.next()) {
        folders.push_back({folderRows.value(0).toString().toStdString(), folderRows.value(1).toString().toStdString(),
                           folderRows.value(2).toString().toStdString(), m_objectType});
    }

    std::vector<std::shared_ptr<DirEntry>> entries;
    QSqlQuery entryRows = database.run(
        QStringLiteral("SELECT e.id, e.object_id, e.folder_id, o.name, o.revision FROM dir_entries e"
                       " JOIN objects o ON o.id = e.object_id WHERE o.type = ? ORDER BY o.name"),
        {type});
    while (entryRows.next()) {
        auto entry = std::make_shared<DirEntry>();
        entry->setId(entryRows.value(0).toString().toStdString());
        entry->setEntryObjectId(entryRows.value(1).toString().toStdString());
        entry->setEntryObjectType(m_objectType);
        entry->setFolderId(entryRows.value(2).toString().toStdString());
        entry->header()->setName(entryRows.value(3).toString().toStdString());
        entry->setEntryObjectRevision(entryRows.value(4).toLongLong());
        entries.push_back(entry);
    }
    return std::make_shared<DirectoryTreeResponse>(std::move(folders), std::move(entries));
}

} // namespace vemi
