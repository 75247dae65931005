#include "host/store/MoveDirItem.h"

#include "host/store/DirectoryQueries.h"
#include "host/store/Response.h"
#include "host/store/StoreDatabase.h"
#include "host/store/StoreError.h"

namespace vemi {

std::shared_ptr<Response> MoveDirItem::execute(StoreDatabase& database)
{
    database.writeTransaction([&] {
        if (m_kind == DirItemKind::Folder)
            moveFolder(database);
        else
            moveEntry(database);
    });
    return std::make_shared<Response>();
}

void MoveDirItem::moveEntry(StoreDatabase& database)
{
    const QVariant type = database.scalar(QStringLiteral("SELECT o.type FROM dir_entries e"
                                                         " JOIN objects o ON o.id = e.object_id WHERE e.id = ?"),
                                          {QString::fromStdString(m_id)});
    if (!type.isValid())
        throw StoreError("the entry no longer exists");
    DirectoryQueries(database).requireFolder(m_targetFolderId, type.toString().toStdString());
    database.run(QStringLiteral("UPDATE dir_entries SET folder_id = ? WHERE id = ?"),
                 {DirectoryQueries::folderValue(m_targetFolderId), QString::fromStdString(m_id)});
}

void MoveDirItem::moveFolder(StoreDatabase& database)
{
    DirectoryQueries queries(database);
    if (!m_targetFolderId.empty() && queries.isInSubtree(m_targetFolderId, m_id))
        throw StoreError("a folder cannot be moved into itself");
    QSqlQuery folder = database.run(QStringLiteral("SELECT object_type, name FROM folders WHERE id = ?"),
                                    {QString::fromStdString(m_id)});
    if (!folder.next())
        throw StoreError("the folder no longer exists");
    queries.requireFolder(m_targetFolderId, folder.value(0).toString().toStdString());
    queries.requireFreeFolderName(folder.value(0).toString().toStdString(), m_targetFolderId,
                                  folder.value(1).toString().toStdString(), m_id);
    database.run(QStringLiteral("UPDATE folders SET parent_id = ? WHERE id = ?"),
                 {DirectoryQueries::folderValue(m_targetFolderId), QString::fromStdString(m_id)});
}

} // namespace vemi
