#pragma once

#include <QByteArray>

#include <memory>
#include <string>
#include <vector>

namespace vemi {

class BaseObject;
class StoreDatabase;

// Reads stored objects and decodes them; at depth 2 or more the objects that
// a library refers to are read too (one level less deep) and put in place;
// members that no longer exist are left out.
class StoredObjectReader
{
public:
    explicit StoredObjectReader(StoreDatabase& database) : m_database(database) {}

    // Throws StoreError when there is no such object or it has another type
    // (an empty expectedType accepts any), DecodeError when it is damaged.
    std::shared_ptr<BaseObject> read(const std::string& id, const std::string& expectedType, int depth);
    // Every object of the type, by name.
    std::vector<std::shared_ptr<BaseObject>> readAll(const std::string& type, int depth);

private:
    std::shared_ptr<BaseObject> decode(const std::string& id, const QByteArray& data, int depth);

    StoreDatabase& m_database;
};

} // namespace vemi
