#include "host/store/StoredObjectReader.h"

#include "host/domain/BaseObject.h"
#include "host/domain/DecodeError.h"
#include "host/domain/ObjectCodec.h"
#include "host/store/StoreDatabase.h"
#include "host/store/StoreError.h"

namespace vemi {

std::shared_ptr<BaseObject> StoredObjectReader::read(const std::string& id, const std::string& expectedType, int depth)
{
    QSqlQuery query = m_database.run(QStringLiteral("SELECT type, data FROM objects WHERE id = ?"),
                                     {QString::fromStdString(id)});
    if (!query.next())
        throw StoreError("there is no stored object with the id " + id);
    const std::string type = query.value(0).toString().toStdString();
    if (!expectedType.empty() && type != expectedType)
        throw StoreError("the object " + id + " is a " + type + ", not a " + expectedType);
    return decode(id, query.value(1).toByteArray(), depth);
}

std::vector<std::shared_ptr<BaseObject>> StoredObjectReader::readAll(const std::string& type, int depth)
{
    QSqlQuery query = m_database.run(QStringLiteral("SELECT id, data FROM objects WHERE type = ? ORDER BY name, id"),
                                     {QString::fromStdString(type)});
    std::vector<std::shared_ptr<BaseObject>> objects;
    while (query.next())
        objects.push_back(decode(query.value(0).toString().toStdString(), query.value(1).toByteArray(), depth));
    return objects;
}

std::shared_ptr<BaseObject> StoredObjectReader::decode(const std::string& id, const QByteArray& data, int depth)
{
    std::shared_ptr<BaseObject> object;
    try {
        object = ObjectCodec::deserialize(data);
    } catch (const DecodeError& error) {
        throw DecodeError("object " + id + ": " + error.what());
    }
    if (depth >= 2 && !object->referencedIds().empty()) {
        std::vector<std::string> deleted;
        object->resolveReferences([&](const std::string& memberId) -> std::shared_ptr<BaseObject> {
            try {
                return read(memberId, std::string(), depth - 1);
            } catch (const StoreError&) {
                // Deleted since the library was stored: no longer a member.
                deleted.push_back(memberId);
                return {};
            }
        });
        if (!deleted.empty())
            object->dropReferences(deleted);
    }
    return object;
}

} // namespace vemi
