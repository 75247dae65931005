#include "host/store/RenameDirItem.h"

#include "host/domain/BaseObject.h"
#include "host/store/DirectoryQueries.h"
#include "host/domain/Header.h"
#include "host/domain/ObjectCodec.h"
#include "host/store/Response.h"
#include "host/store/StoreDatabase.h"
#include "host/store/StoreError.h"

namespace vemi {

std::shared_ptr<Response> RenameDirItem::execute(StoreDatabase& database)
{
    if (m_name.empty())
        throw StoreError("the name is empty");
    database.writeTransaction([&] {
        if (m_kind == DirItemKind::Folder)
            renameFolder(database);
        else
            renameEntry(database);
    });
    if (m_openObject && m_readRevision > 0 && m_openObject->storedRevision() == m_readRevision)
        m_openObject->setStoredRevision(m_readRevision + 1);
    return std::make_shared<Response>();
}

void RenameDirItem::renameFolder(StoreDatabase& database)
{
    QSqlQuery folder = database.run(QStringLiteral("SELECT object_type, parent_id FROM folders WHERE id = ?"),
                                    {QString::fromStdString(m_id)});
    if (!folder.next())
        throw StoreError("the folder no longer exists");
    DirectoryQueries(database).requireFreeFolderName(folder.value(0).toString().toStdString(),
                                                     folder.value(1).toString().toStdString(), m_name, m_id);
    database.run(QStringLiteral("UPDATE folders SET name = ? WHERE id = ?"),
                 {QString::fromStdString(m_name), QString::fromStdString(m_id)});
}

void RenameDirItem::renameEntry(StoreDatabase& database)
{
    QSqlQuery stored = database.run(QStringLiteral("SELECT o.id, o.data, o.revision FROM dir_entries e"
                                                   " JOIN objects o ON o.id = e.object_id WHERE e.id = ?"),
                                    {QString::fromStdString(m_id)});
    if (!stored.next())
        throw StoreError("the entry no longer exists");
    const QString objectId = stored.value(0).toString();
    m_readRevision = stored.value(2).toLongLong();
    auto object = ObjectCodec::deserialize(stored.value(1).toByteArray());
    object->header()->setName(m_name);
    database.run(QStringLiteral("UPDATE objects SET name = ?, data = ?, revision = revision + 1 WHERE id = ?"),
                 {QString::fromStdString(m_name), ObjectCodec::serialize(*object), objectId});
}

} // namespace vemi
