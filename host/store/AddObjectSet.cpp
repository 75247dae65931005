#include "host/store/AddObjectSet.h"

#include "host/domain/BaseObject.h"
#include "host/domain/Header.h"
#include "host/domain/ObjectCodec.h"
#include "host/store/AddObjectSetResponse.h"
#include "host/store/DirectoryQueries.h"
#include "host/store/StoreDatabase.h"
#include "host/store/StoreError.h"

#include <QUuid>

namespace vemi {

namespace {

QString newId()
{
    return QUuid::createUuid().toString(QUuid::WithoutBraces);
}

} // namespace

AddObjectSet::AddObjectSet(std::string description)
    : m_description(std::move(description))
{
}

AddObjectSet::FolderKey AddObjectSet::addFolder(const std::string& objectType, FolderKey parent,
                                                const std::string& name)
{
    m_folders.push_back({objectType, parent, name});
    return FolderKey(m_folders.size() - 1);
}

void AddObjectSet::addObject(const BaseObject& object, FolderKey folder)
{
    m_objects.push_back({ObjectCodec::snapshot(object), object.id(), object.objectTypeId(),
                         object.header() ? object.header()->name() : std::string(), folder});
}

std::shared_ptr<Response> AddObjectSet::execute(StoreDatabase& database)
{
    // Encoded before the write lock is taken, so that other programs wait less.
    std::vector<QByteArray> encoded;
    encoded.reserve(m_objects.size());
    for (const PlannedObject& object : m_objects)
        encoded.push_back(object.snapshot.toCbor());

    std::vector<std::string> folderIds;
    database.writeTransaction([&] {
        folderIds = resolveFolders(database);
        writeObjects(database, folderIds, encoded);
    });
    return std::make_shared<AddObjectSetResponse>(folderIds);
}

std::vector<std::string> AddObjectSet::resolveFolders(StoreDatabase& database) const
{
    std::vector<std::string> ids;
    DirectoryQueries queries(database);
    for (const PlannedFolder& folder : m_folders) {
        const std::string parentId = folder.parent == kTopLevel ? std::string() : ids.at(size_t(folder.parent));
        const QVariant existing = database.scalar(
            QStringLiteral("SELECT id FROM folders WHERE object_type = ? AND parent_id IS NOT DISTINCT FROM ? AND name = ?"),
            {QString::fromStdString(folder.objectType), DirectoryQueries::folderValue(parentId),
             QString::fromStdString(folder.name)});
        if (existing.isValid()) {
            ids.push_back(existing.toString().toStdString());
            continue;
        }
        const DirFolder created{newId().toStdString(), parentId, folder.name, folder.objectType};
        queries.insertFolder(created);
        ids.push_back(created.id);
    }
    return ids;
}

void AddObjectSet::writeObjects(StoreDatabase& database, const std::vector<std::string>& folderIds,
                                const std::vector<QByteArray>& encoded) const
{
    QSqlQuery insertObject =
        database.prepare(QStringLiteral("INSERT INTO objects(id, type, name, data) VALUES(?, ?, ?, ?)"));
    QSqlQuery insertEntry =
        database.prepare(QStringLiteral("INSERT INTO dir_entries(id, object_id, folder_id) VALUES(?, ?, ?)"));
    for (size_t i = 0; i < m_objects.size(); ++i) {
        const PlannedObject& object = m_objects[i];
        const QString id = QString::fromStdString(object.id);
        database.execute(insertObject,
                         {id, QString::fromStdString(object.type), QString::fromStdString(object.name), encoded[i]});
        if (object.folder == kTopLevel) {
            database.execute(insertEntry, {newId(), id, DirectoryQueries::folderValue(std::string())});
            continue;
        }
        const size_t folder = size_t(object.folder);
        if (m_folders.at(folder).objectType != object.type)
            throw StoreError("the folder \"" + m_folders[folder].name + "\" holds objects of another type");
        database.execute(insertEntry, {newId(), id, QString::fromStdString(folderIds[folder])});
    }
}

} // namespace vemi
