#include "host/store/PostgresDialect.h"

#include "host/store/StoreDatabase.h"
#include "host/store/StoreError.h"

#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QUrl>
#include <QUrlQuery>

namespace vemi {

namespace {

// The parts of a postgresql:// address; a query parameter wins over the part.
struct Address
{
    QString host;
    int port = -1;
    QString user;
    QString database;
};

Address parse(const QString& text)
{
    const QUrl url(text, QUrl::TolerantMode);
    if (!url.isValid())
        throw StoreError("the server address is not valid (" + url.errorString().toStdString() + "): "
                         + text.toStdString());
    if (!url.password().isEmpty())
        throw StoreError("the server address holds a password, which is not used: put it in ~/.pgpass or "
                         "PGPASSWORD instead");
    const QUrlQuery query(url);
    Address address;
    address.host = url.host();
    address.port = url.port();
    address.user = url.userName(QUrl::FullyDecoded);
    address.database = url.path(QUrl::FullyDecoded).mid(1);
    if (query.hasQueryItem(QStringLiteral("host")))
        address.host = query.queryItemValue(QStringLiteral("host"), QUrl::FullyDecoded);
    if (query.hasQueryItem(QStringLiteral("port")))
        address.port = query.queryItemValue(QStringLiteral("port")).toInt();
    if (query.hasQueryItem(QStringLiteral("user")))
        address.user = query.queryItemValue(QStringLiteral("user"), QUrl::FullyDecoded);
    if (address.database.isEmpty())
        throw StoreError("the server address names no database: " + text.toStdString());
    return address;
}

// SQLSTATE classes and codes that this file tells apart.
bool isLoginRefused(const QString& state)
{
    return state.startsWith(QLatin1String("28")) || state == QLatin1String("3D000");
}

bool isLockTimeout(const QString& state)
{
    return state == QLatin1String("55P03");
}

} // namespace

void PostgresDialect::connect(const QString& connectionName, const StoreOptions& options)
{
    m_lockTimeoutMs = options.busyTimeoutMs;
    QSqlDatabase database = QSqlDatabase::database(connectionName, false);
    if (!database.isValid())
        database = QSqlDatabase::addDatabase(QStringLiteral("QPSQL"), connectionName);
    if (!database.isValid())
        throw StoreError("the PostgreSQL driver for Qt is not installed (package libqt5sql5-psql): "
                         + m_address.toStdString());
    database.close();
    applyAddress(database, m_address);
    const int timeoutSeconds = qMax(2, options.busyTimeoutMs / 1000);
    database.setConnectOptions(QStringLiteral("connect_timeout=%1;application_name=qchost").arg(timeoutSeconds));
    if (!database.open())
        throw StoreError(describeConnectFailure(database.lastError()).toStdString());
}

void PostgresDialect::applyAddress(QSqlDatabase& database, const QString& address)
{
    const Address parts = parse(address);
    // The driver quotes each part into libpq's connection string.
    database.setHostName(parts.host);
    if (parts.port > 0)
        database.setPort(parts.port);
    database.setUserName(parts.user);
    database.setDatabaseName(parts.database);
}

void PostgresDialect::configure(StoreDatabase& database, const StoreOptions& options)
{
    database.run(QStringLiteral("SET client_min_messages = warning"), {});
    if (options.readOnly)
        database.run(QStringLiteral("SET default_transaction_read_only = on"), {});
}

StoreDialect::Mark PostgresDialect::readMark(StoreDatabase& database)
{
    Mark mark;
    mark.empty = database.scalar(QStringLiteral("SELECT count(*) FROM information_schema.tables"
                                                " WHERE table_schema = current_schema()")).toInt() == 0;
    if (!database.scalar(QStringLiteral("SELECT to_regclass('store_mark') IS NOT NULL")).toBool())
        return mark;
    QSqlQuery query = database.run(QStringLiteral("SELECT application_id, schema_version FROM store_mark"), {});
    if (query.next()) {
        mark.applicationId = query.value(0).toInt();
        mark.schemaVersion = query.value(1).toInt();
    }
    return mark;
}

void PostgresDialect::writeMark(StoreDatabase& database, int applicationId, int schemaVersion)
{
    database.run(QStringLiteral("CREATE TABLE IF NOT EXISTS store_mark("
                                " application_id INTEGER NOT NULL, schema_version INTEGER NOT NULL)"), {});
    database.run(QStringLiteral("DELETE FROM store_mark"), {});
    database.run(QStringLiteral("INSERT INTO store_mark(application_id, schema_version) VALUES(?, ?)"),
                 {applicationId, schemaVersion});
}

// One writer at a time, as with SQLite's write lock: the checks of a save see
// every save committed before it. A writer that waits longer than the busy
// time fails as a locked store does.
QStringList PostgresDialect::beginWrite() const
{
    return {QStringLiteral("BEGIN"), QStringLiteral("SET LOCAL lock_timeout = %1").arg(m_lockTimeoutMs),
            QStringLiteral("SELECT pg_advisory_xact_lock(%1)").arg(StoreDatabase::kApplicationId)};
}

bool PostgresDialect::isConnectionLost(const QSqlError& error) const
{
    const QString state = error.nativeErrorCode();
    return error.type() == QSqlError::ConnectionError || state.startsWith(QLatin1String("08"))
        || state.startsWith(QLatin1String("57P")) || error.databaseText().contains(QLatin1String("server closed"))
        || error.databaseText().contains(QLatin1String("no connection to the server"));
}

QString PostgresDialect::describe(const QSqlError& error) const
{
    const QString state = error.nativeErrorCode();
    QString cause;
    if (isLockTimeout(state))
        cause = QStringLiteral("the store is locked by another program");
    else if (isConnectionLost(error))
        cause = QStringLiteral("the connection to the server was lost");
    return withCause(cause, error);
}

QString PostgresDialect::describeConnectFailure(const QSqlError& error) const
{
    const QString detail = error.databaseText() + error.driverText();
    const bool refused = isLoginRefused(error.nativeErrorCode())
        || detail.contains(QLatin1String("authentication failed")) || detail.contains(QLatin1String("no password"))
        || detail.contains(QLatin1String("does not exist"));
    return withCause(refused ? QStringLiteral("the server refused the login")
                             : QStringLiteral("the server cannot be reached"),
                     error);
}

QString PostgresDialect::withCause(const QString& cause, const QSqlError& error) const
{
    const QString detail = (error.databaseText().isEmpty() ? error.text() : error.databaseText()).simplified();
    const QString message = cause.isEmpty() ? detail : cause + QStringLiteral(" (") + detail + QLatin1Char(')');
    return message + QStringLiteral(": ") + m_address;
}

} // namespace vemi
