#include "host/store/StoredObjectReader.h"

#include "host/domain/BaseObject.h"
#include "host/domain/DecodeError.h"
#include "host/domain/Header.h"
#include "host/domain/ObjectCodec.h"
#include "host/store/StoreDatabase.h"
#include "host/store/StoreError.h"

namespace vemi {

namespace {

// Deeper folder chains than this are taken to be cycles in a damaged file.
constexpr int kMaxFolderDepth = 64;

} // namespace

std::shared_ptr<BaseObject> StoredObjectReader::read(const std::string& id, const std::string& expectedType, int depth)
{
    const Row row = fetch(id, expectedType);
    try {
        return decode(row, depth);
    } catch (const DecodeError& error) {
        throw StoreError("the stored object " + describe(id).toStdString() + " is damaged ("
                         + error.what() + "): " + m_database.path().toStdString());
    }
}

std::shared_ptr<BaseObject> StoredObjectReader::readIntact(const std::string& id, const std::string& expectedType,
                                                           int depth)
{
    const Row row = fetch(id, expectedType);
    try {
        return decode(row, depth);
    } catch (const DecodeError& error) {
        noteDamaged(id, error);
        return {};
    }
}

std::vector<std::shared_ptr<BaseObject>> StoredObjectReader::readAll(const std::string& type, int depth)
{
    // All rows first: reading a library's members runs queries of its own.
    std::vector<Row> rows;
    QSqlQuery query = m_database.run(QStringLiteral("SELECT id, data, revision FROM objects WHERE type = ? ORDER BY name, id"),
                                     {QString::fromStdString(type)});
    while (query.next())
        rows.push_back({query.value(0).toString().toStdString(), type, query.value(1).toByteArray(),
                        query.value(2).toLongLong()});
    query.finish();

    std::vector<std::shared_ptr<BaseObject>> objects;
    objects.reserve(rows.size());
    for (const Row& row : rows) {
        try {
            objects.push_back(decode(row, depth));
        } catch (const DecodeError& error) {
            noteDamaged(row.id, error);
        }
    }
    return objects;
}

void StoredObjectReader::noteDamaged(const std::string& id, const DecodeError& error)
{
    m_problems << QStringLiteral("%1 is damaged and was left out: %2")
                      .arg(describe(id), QString::fromStdString(error.what()));
}

std::optional<StoredObjectReader::Row> StoredObjectReader::findRow(const std::string& id)
{
    QSqlQuery query = m_database.run(QStringLiteral("SELECT type, data, revision FROM objects WHERE id = ?"),
                                     {QString::fromStdString(id)});
    if (!query.next())
        return std::nullopt;
    return Row{id, query.value(0).toString().toStdString(), query.value(1).toByteArray(), query.value(2).toLongLong()};
}

StoredObjectReader::Row StoredObjectReader::fetch(const std::string& id, const std::string& expectedType)
{
    const std::optional<Row> found = findRow(id);
    if (!found)
        throw StoreError("there is no stored object with the id " + id);
    const Row& row = *found;
    if (!expectedType.empty() && row.type != expectedType)
        throw StoreError("the object " + id + " is a " + row.type + ", not a " + expectedType);
    return row;
}

std::shared_ptr<BaseObject> StoredObjectReader::decode(const Row& row, int depth)
{
    std::shared_ptr<BaseObject> object;
    try {
        object = ObjectCodec::deserialize(row.data);
    } catch (const DecodeError& error) {
        throw DecodeError("object " + row.id + ": " + error.what());
    }
    // The row's type is what every query selects by; content of another type
    // would reach callers that cast to the row's type.
    if (object->objectTypeId() != row.type)
        throw DecodeError("object " + row.id + " is stored as a " + row.type + " but holds a "
                          + object->objectTypeId());
    object->setStoredRevision(row.revision);
    if (depth >= 2 && !object->referencedIds().empty())
        resolveMembers(*object, depth);
    return object;
}

void StoredObjectReader::resolveMembers(BaseObject& library, int depth)
{
    const std::string memberType = library.referencedTypeId();
    std::vector<std::string> leftOut;
    library.resolveReferences([&](const std::string& memberId) -> std::shared_ptr<BaseObject> {
        const std::optional<Row> found = findRow(memberId);
        if (!found) {
            // Deleted since the library was stored: no longer a member.
            leftOut.push_back(memberId);
            return {};
        }
        const Row& row = *found;
        try {
            if (!memberType.empty() && row.type != memberType)
                throw DecodeError("object " + memberId + " is a " + row.type + ", not a " + memberType);
            return decode(row, depth - 1);
        } catch (const DecodeError& error) {
            m_problems << QStringLiteral("%1, a member of %2, is damaged and was left out: %3")
                              .arg(describe(memberId), describe(library.id()), QString::fromStdString(error.what()));
            leftOut.push_back(memberId);
            return {};
        }
    });
    if (!leftOut.empty())
        library.dropReferences(leftOut);
}

QString StoredObjectReader::describe(const std::string& id)
{
    const QString idText = QString::fromStdString(id);
    try {
        QSqlQuery query = m_database.run(QStringLiteral("SELECT o.name, e.id IS NOT NULL, e.folder_id FROM objects o"
                                                        " LEFT JOIN dir_entries e ON e.object_id = o.id WHERE o.id = ?"),
                                         {idText});
        if (!query.next())
            return QStringLiteral("the object %1").arg(idText);
        const QString name = query.value(0).toString();
        const bool filed = query.value(1).toBool();
        const QString folderId = query.value(2).toString();
        query.finish();
        const QString named = name.isEmpty() ? QStringLiteral("an unnamed object") : QLatin1Char('"') + name + QLatin1Char('"');
        if (!filed)
            return QStringLiteral("%1 (id %2)").arg(named, idText);
        if (folderId.isEmpty())
            return QStringLiteral("%1 at the top level (id %2)").arg(named, idText);
        return QStringLiteral("%1 in the folder \"%2\" (id %3)").arg(named, folderPath(folderId), idText);
    } catch (const StoreError&) {
        // Describing must not hide the fault being reported.
        return QStringLiteral("the object %1").arg(idText);
    }
}

QString StoredObjectReader::folderPath(const QString& folderId)
{
    QSqlQuery query = m_database.run(
        QStringLiteral("WITH RECURSIVE chain(id, parent_id, name, depth) AS ("
                       " SELECT id, parent_id, name, 0 FROM folders WHERE id = ?"
                       " UNION ALL SELECT f.id, f.parent_id, f.name, chain.depth + 1"
                       " FROM folders f JOIN chain ON f.id = chain.parent_id WHERE chain.depth < ?)"
                       " SELECT name FROM chain ORDER BY depth DESC"),
        {folderId, kMaxFolderDepth});
    QStringList names;
    while (query.next())
        names << query.value(0).toString();
    return names.join(QLatin1Char('/'));
}

} // namespace vemi
