#pragma once

#include "host/store/StoreDialect.h"

class QSqlDatabase;

namespace vemi {

// A store in a database on a PostgreSQL server, named by an address such as
// postgresql://user@host:port/dbname (query parameters host, port and user
// override the parts; a host that is a folder names the server's Unix socket
// folder). Passwords come from ~/.pgpass or PGPASSWORD, as for every libpq
// program, never from the address. Every part goes to the driver as a
// connection option. The store's mark lives in a table of its own; a writer
// holds a transaction-scoped advisory lock.
class PostgresDialect : public StoreDialect
{
public:
    explicit PostgresDialect(QString address) : m_address(std::move(address)) {}

    // Sets the connection's host, port, user and database from the address;
    // throws StoreError for an address that is not valid or holds a password.
    static void applyAddress(QSqlDatabase& database, const QString& address);

    void connect(const QString& connectionName, const StoreOptions& options) override;
    void configure(StoreDatabase& database, const StoreOptions& options) override;
    Mark readMark(StoreDatabase& database) override;
    void writeMark(StoreDatabase& database, int applicationId, int schemaVersion) override;
    QString blobType() const override { return QStringLiteral("BYTEA"); }
    QStringList beginWrite() const override;
    QString describe(const QSqlError& error) const override;
    bool isConnectionLost(const QSqlError& error) const override;
    QString changeChannel() const override { return QStringLiteral("qcjt_store_changed"); }
    std::string noun() const override { return "database"; }

private:
    QString describeConnectFailure(const QSqlError& error) const;
    QString withCause(const QString& cause, const QSqlError& error) const;

    QString m_address;
    int m_lockTimeoutMs = 5000;
};

} // namespace vemi
