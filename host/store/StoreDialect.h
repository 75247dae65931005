#pragma once

#include "host/store/StoreOptions.h"

#include <QString>
#include <QStringList>

#include <memory>

class QSqlError;

namespace vemi {

class StoreDatabase;

// What one kind of database does its own way for the store: how a connection
// is opened, the column type for bytes, how a writer shuts out the others,
// where the store's mark and schema version live, and how failures are put
// into words. Everything else (the schema, every command's SQL) is shared.
class StoreDialect
{
public:
    // Which program's store it is and its schema version; 0 and 0 when unmarked.
    struct Mark
    {
        int applicationId = 0;
        int schemaVersion = 0;
        bool empty = true; // holds no tables at all
    };

    // A server store for a postgresql:// (or postgres://) address, else a file.
    static std::unique_ptr<StoreDialect> forLocation(const QString& location);
    static bool isServerLocation(const QString& location);

    virtual ~StoreDialect() = default;

    // Adds and opens the Qt connection of the name; throws StoreError.
    virtual void connect(const QString& connectionName, const StoreOptions& options) = 0;
    // Settings of the connection, run after the store passed its checks.
    virtual void configure(StoreDatabase& database, const StoreOptions& options) = 0;
    virtual Mark readMark(StoreDatabase& database) = 0;
    virtual void writeMark(StoreDatabase& database, int applicationId, int schemaVersion) = 0;
    // The column type of the schema's byte columns.
    virtual QString blobType() const = 0;
    // Opens a transaction that no other writer of the store runs beside.
    virtual QStringList beginWrite() const = 0;
    // The failure in words a person can act on, ending with the store's name.
    virtual QString describe(const QSqlError& error) const = 0;
    // The channel on which every write is announced to the store's other
    // users; empty where there is none (a file).
    virtual QString changeChannel() const { return {}; }
    // Whether the failure broke the connection (a server that went away), so
    // that the next command must connect anew.
    virtual bool isConnectionLost(const QSqlError&) const { return false; }
    // "file" or "database": what messages call the store.
    virtual std::string noun() const = 0;
};

} // namespace vemi
