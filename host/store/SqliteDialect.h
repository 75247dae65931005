#pragma once

#include "host/store/StoreDialect.h"

namespace vemi {

// A store in an SQLite file. Its mark and schema version are the file's
// application_id and user_version; a writer takes the file's write lock
// (BEGIN IMMEDIATE). A read-only open never writes the file and works in a
// folder nobody may write and on a full disk, where SQLite cannot make its
// side files (-wal, -shm).
class SqliteDialect : public StoreDialect
{
public:
    explicit SqliteDialect(QString path) : m_path(std::move(path)) {}

    void connect(const QString& connectionName, const StoreOptions& options) override;
    void configure(StoreDatabase& database, const StoreOptions& options) override;
    Mark readMark(StoreDatabase& database) override;
    void writeMark(StoreDatabase& database, int applicationId, int schemaVersion) override;
    QString blobType() const override { return QStringLiteral("BLOB"); }
    QStringList beginWrite() const override { return {QStringLiteral("BEGIN IMMEDIATE")}; }
    QString describe(const QSqlError& error) const override;
    std::string noun() const override { return "file"; }

    // What a failed SQLite call means, in words a person can act on; empty
    // when SQLite's own text says it best. diskFull: the store's disk has no
    // room left, which turns SQLite's "disk I/O error" into plain words.
    static QString explain(int sqliteCode, bool diskFull);

private:
    enum class Access { ReadWrite, ReadOnly, Immutable };
    void connectAs(const QString& connectionName, Access access, const StoreOptions& options);
    void connectReadOnly(const QString& connectionName, const StoreOptions& options);
    bool diskFull() const;

    QString m_path;
};

} // namespace vemi
