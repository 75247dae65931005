#include "MoveDirItem.h"

#include "DirectoryQueries.h"
#include "Response.h"
#include "StoreDatabase.h"
#include "StoreError.h"

namespace vemi {

namespace {

QVariant nullable(const std::string& id)
{
    return id.empty() ? QVariant(QVariant::String) : QVariant(QString::fromStdString(id));
}

} // namespace

std::shared_ptr<Response> MoveDirItem::execute(StoreDatabase& database)
{
    database.writeTransaction([&] {
        DirectoryQueries(database).requireFolder(m_targetFolderId, "move the item");
        if (m_kind == DirItemKind::Folder) {
            moveFolder(database);
        } else {
            database.run(QStringLiteral("UPDATE dir_entries SET folder_id = ? WHERE id = ?"),
                         {nullable(m_targetFolderId), QString::fromStdString(m_id)}, "move the entry");
        }
    });
    return std::make_shared<Response>();
}

void MoveDirItem::moveFolder(StoreDatabase& database)
{
    DirectoryQueries queries(database);
    if (!m_targetFolderId.empty() && queries.isInSubtree(m_targetFolderId, m_id))
        throw StoreError("a folder cannot be moved into itself");
    QSqlQuery folder = database.run(QStringLiteral("SELECT object_type, name FROM folders WHERE id = ?"),
                                    {QString::fromStdString(m_id)}, "move the folder");
    if (!folder.next())
        throw StoreError("the folder no longer exists");
    queries.requireFreeFolderName(folder.value(0).toString().toStdString(), m_targetFolderId,
                                  folder.value(1).toString().toStdString(), m_id);
    database.run(QStringLiteral("UPDATE folders SET parent_id = ? WHERE id = ?"),
                 {nullable(m_targetFolderId), QString::fromStdString(m_id)}, "move the folder");
}

} // namespace vemi
