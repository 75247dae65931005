#pragma once

#include <QByteArray>
#include <QStringList>

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace vemi {

class BaseObject;
class DecodeError;
class StoreDatabase;

// Reads stored objects and decodes them; at depth 2 or more the objects that
// a library refers to are read too (one level less deep) and put in place.
// Members that no longer exist are left out; damaged members are left out and
// noted in problems(). A damaged object is one whose bytes cannot be decoded
// or whose decoded type is not the type its row is stored under.
class StoredObjectReader
{
public:
    explicit StoredObjectReader(StoreDatabase& database) : m_database(database) {}

    // Throws StoreError when there is no such object, it has another type (an
    // empty expectedType accepts any) or it is damaged; the message names the
    // object by its name and folder where the store knows them.
    std::shared_ptr<BaseObject> read(const std::string& id, const std::string& expectedType, int depth);
    // As read(), but a damaged object gives null and is noted in problems().
    std::shared_ptr<BaseObject> readIntact(const std::string& id, const std::string& expectedType, int depth);
    // Every intact object of the type, by name; the damaged ones are noted in problems().
    std::vector<std::shared_ptr<BaseObject>> readAll(const std::string& type, int depth);

    // One sentence per object that was left out because it is damaged.
    QStringList problems() const { return m_problems; }

    // How a person finds the object: "\"Door Panel\" in the folder
    // \"Samples/Doors\" (id …)"; the id alone when the store knows no more.
    QString describe(const std::string& id);

private:
    struct Row
    {
        std::string id;
        std::string type;
        QByteArray data;
        qint64 revision = 0;
    };

    // Nothing when there is no object of the id.
    std::optional<Row> findRow(const std::string& id);
    // Throws StoreError when there is no such object or it has another type.
    Row fetch(const std::string& id, const std::string& expectedType);
    void noteDamaged(const std::string& id, const DecodeError& error);
    // Throws DecodeError when the row is damaged.
    std::shared_ptr<BaseObject> decode(const Row& row, int depth);
    void resolveMembers(BaseObject& library, int depth);
    QString folderPath(const QString& folderId);

    StoreDatabase& m_database;
    QStringList m_problems;
};

} // namespace vemi
