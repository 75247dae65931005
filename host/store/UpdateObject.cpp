#include "host/store/UpdateObject.h"

#include "host/domain/BaseObject.h"
#include "host/domain/DirEntry.h"
#include "host/store/DirectoryQueries.h"
#include "host/domain/Header.h"
#include "host/domain/ObjectCodec.h"
#include "host/store/StoreDatabase.h"
#include "host/store/StoreError.h"
#include "host/store/StoredObjectReader.h"
#include "host/store/UpdateObjectResponse.h"

#include <QUuid>

namespace vemi {

void UpdateObject::prepare()
{
    if (!m_object)
        return;
    m_snapshot = ObjectCodec::snapshot(*m_object);
    m_id = m_object->id();
    m_type = m_object->objectTypeId();
    m_name = m_object->header() ? m_object->header()->name() : std::string();
}

std::shared_ptr<Response> UpdateObject::execute(StoreDatabase& database)
{
    const QByteArray data = encode();
    std::shared_ptr<DirEntry> entry;
    database.writeTransaction([&] { entry = write(database, data); });
    commitRevision();
    return std::make_shared<UpdateObjectResponse>(m_id, entry);
}

QByteArray UpdateObject::encode() const
{
    if (!m_snapshot)
        throw StoreError("there is no object to save");
    return m_snapshot->toCbor();
}

std::shared_ptr<DirEntry> UpdateObject::write(StoreDatabase& database, const QByteArray& data)
{
    const qint64 revision = nextRevision(database);
    database.run(QStringLiteral("INSERT INTO objects(id, type, name, data, revision) VALUES(?, ?, ?, ?, ?)"
                                " ON CONFLICT(id) DO UPDATE SET type = excluded.type,"
                                " name = excluded.name, data = excluded.data, revision = excluded.revision"),
                 {QString::fromStdString(m_id), QString::fromStdString(m_type), QString::fromStdString(m_name), data,
                  revision});
    m_writtenRevision = revision;
    return m_folderId ? fileInFolder(database) : nullptr;
}

// Read inside the write transaction, so that no other save can come between
// the check and the write. The revision the save states is read from the
// object now, not when the command was sent: an earlier save of the same
// object, queued before this one, has given it the revision it wrote.
qint64 UpdateObject::nextRevision(StoreDatabase& database)
{
    const QVariant stored =
        database.scalar(QStringLiteral("SELECT revision FROM objects WHERE id = ?"), {QString::fromStdString(m_id)});
    if (!stored.isValid())
        return 1; // a new object, or one deleted elsewhere: stored anew
    const qint64 read = m_object->storedRevision();
    if (stored.toLongLong() != read)
        throw StoreError::conflict(StoredObjectReader(database).describe(m_id).toStdString()
                                   + " was changed elsewhere since it was opened");
    return stored.toLongLong() + 1;
}

void UpdateObject::commitRevision()
{
    if (m_writtenRevision > 0)
        m_object->setStoredRevision(m_writtenRevision);
}

std::shared_ptr<DirEntry> UpdateObject::fileInFolder(StoreDatabase& database)
{
    QVariant entryId = database.scalar(QStringLiteral("SELECT id FROM dir_entries WHERE object_id = ?"),
                                       {QString::fromStdString(m_id)});
    std::string folderId = *m_folderId;
    if (entryId.isValid()) {
        folderId = database.scalar(QStringLiteral("SELECT folder_id FROM dir_entries WHERE id = ?"),
                                   {entryId}).toString().toStdString();
    } else {
        DirectoryQueries(database).requireFolder(folderId, m_type);
        entryId = QUuid::createUuid().toString(QUuid::WithoutBraces);
        database.run(QStringLiteral("INSERT INTO dir_entries(id, object_id, folder_id) VALUES(?, ?, ?)"),
                     {entryId, QString::fromStdString(m_id), DirectoryQueries::folderValue(folderId)});
    }
    auto entry = std::make_shared<DirEntry>();
    entry->setId(entryId.toString().toStdString());
    entry->setEntryObjectId(m_id);
    entry->setEntryObjectType(m_type);
    entry->setFolderId(folderId);
    entry->header()->setName(m_name);
    return entry;
}

std::string UpdateObject::description() const
{
    return m_name.empty() ? "save the object " + m_id : "save \"" + m_name + "\"";
}

} // namespace vemi
