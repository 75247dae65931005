#include "host/store/SqliteDialect.h"

#include "host/store/StoreDatabase.h"
#include "host/store/StoreError.h"

#include <QFileInfo>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QStorageInfo>
#include <QUrl>

namespace vemi {

namespace {

// SQLite's primary result codes that this file tells apart.
enum SqliteCode {
    kBusy = 5,
    kLocked = 6,
    kReadOnly = 8,
    kIoError = 10,
    kCorrupt = 11,
    kFull = 13,
    kCantOpen = 14,
    kNotADatabase = 26,
};

int primaryCode(int code)
{
    return code & 0xFF;
}

// Failures of SQLite to make or grow its side files (-wal, -shm) beside the
// store: a read-only open can do without them.
bool isSideFileFailure(int code)
{
    switch (primaryCode(code)) {
    case kReadOnly:
    case kIoError:
    case kFull:
    case kCantOpen:
        return true;
    default:
        return false;
    }
}

// No disk has exactly nothing left when it is "full" for a program: the
// file system keeps a little back, so a few blocks count as full.
constexpr qint64 kFullDiskBytes = 64 * 1024;

int pragma(StoreDatabase& database, const char* name)
{
    return database.scalar(QStringLiteral("PRAGMA %1").arg(QLatin1String(name)), {}).toInt();
}

} // namespace

void SqliteDialect::connect(const QString& connectionName, const StoreOptions& options)
{
    if (options.readOnly)
        connectReadOnly(connectionName, options);
    else
        connectAs(connectionName, Access::ReadWrite, options);
}

void SqliteDialect::connectAs(const QString& connectionName, Access access, const StoreOptions& options)
{
    QSqlDatabase database = QSqlDatabase::database(connectionName, false);
    if (!database.isValid())
        database = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), connectionName);
    if (!database.isValid())
        throw StoreError("the SQLite driver for Qt is not installed (package libqt5sql5-sqlite)");
    database.close();
    QString connectOptions = QStringLiteral("QSQLITE_BUSY_TIMEOUT=%1").arg(options.busyTimeoutMs);
    if (access == Access::ReadWrite) {
        database.setDatabaseName(m_path);
    } else {
        connectOptions += QStringLiteral(";QSQLITE_OPEN_READONLY;QSQLITE_OPEN_URI");
        QUrl uri = QUrl::fromLocalFile(QFileInfo(m_path).absoluteFilePath());
        uri.setQuery(access == Access::Immutable ? QStringLiteral("immutable=1") : QStringLiteral("mode=ro"));
        database.setDatabaseName(uri.toString(QUrl::FullyEncoded));
    }
    database.setConnectOptions(connectOptions);
    const auto fail = [this](const QSqlError& error) {
        return StoreError(describe(error).toStdString(), error.nativeErrorCode().toInt());
    };
    if (!database.open())
        throw fail(database.lastError());
    // SQLite opens lazily: the first read shows whether the file can be used.
    QSqlQuery probe(database);
    if (!probe.exec(QStringLiteral("SELECT count(*) FROM sqlite_master")))
        throw fail(probe.lastError());
}

// SQLite reads a WAL store through two side files, which even a reader
// creates; where they cannot be made (a read-only folder or mount, a full
// disk) the file is opened as immutable instead: read without locks or side
// files. That is safe only while nobody writes it: when no -wal file shows a
// writer or changes not yet merged into the file, and either nobody may write
// the folder or SQLite could not make its side files there either.
void SqliteDialect::connectReadOnly(const QString& connectionName, const StoreOptions& options)
{
    const std::string file = m_path.toStdString();
    const QFileInfo info(m_path);
    if (!info.exists())
        throw StoreError("there is no store file: " + file);
    const QFileInfo folder(info.absolutePath());
    const bool anyoneMayWrite =
        folder.permissions() & (QFileDevice::WriteOwner | QFileDevice::WriteGroup | QFileDevice::WriteOther);
    if (!anyoneMayWrite && !QFileInfo::exists(m_path + QStringLiteral("-wal"))) {
        connectAs(connectionName, Access::Immutable, options);
        return;
    }
    try {
        connectAs(connectionName, Access::ReadOnly, options);
    } catch (const StoreError& error) {
        if (!isSideFileFailure(error.sqliteCode()))
            throw;
        if (QFileInfo(m_path + QStringLiteral("-wal")).size() > 0)
            throw StoreError(std::string(error.what())
                             + " (the store holds changes not yet merged into the file, which cannot be read"
                               " without writing beside it: open it once with write access)");
        connectAs(connectionName, Access::Immutable, options);
    }
}

void SqliteDialect::configure(StoreDatabase& database, const StoreOptions& options)
{
    database.run(QStringLiteral("PRAGMA foreign_keys = ON"), {});
    if (options.readOnly)
        return;
    database.run(QStringLiteral("PRAGMA journal_mode = WAL"), {});
    database.run(QStringLiteral("PRAGMA synchronous = NORMAL"), {});
}

StoreDialect::Mark SqliteDialect::readMark(StoreDatabase& database)
{
    Mark mark;
    mark.applicationId = pragma(database, "application_id");
    mark.schemaVersion = pragma(database, "user_version");
    mark.empty = database.scalar(QStringLiteral("SELECT count(*) FROM sqlite_master")).toInt() == 0;
    return mark;
}

void SqliteDialect::writeMark(StoreDatabase& database, int applicationId, int schemaVersion)
{
    database.run(QStringLiteral("PRAGMA application_id = %1").arg(applicationId), {});
    database.run(QStringLiteral("PRAGMA user_version = %1").arg(schemaVersion), {});
}

bool SqliteDialect::diskFull() const
{
    const QStorageInfo storage(QFileInfo(m_path).absolutePath());
    return storage.isValid() && storage.bytesAvailable() < kFullDiskBytes;
}

QString SqliteDialect::describe(const QSqlError& error) const
{
    const int code = error.nativeErrorCode().toInt();
    const int primary = primaryCode(code);
    const bool full = (primary == kIoError || primary == kFull || primary == kCantOpen) && diskFull();
    const QString cause = explain(code, full);
    const QString detail = error.databaseText().isEmpty() ? error.text() : error.databaseText();
    const QString message = cause.isEmpty() ? detail : cause + QStringLiteral(" (") + detail + QLatin1Char(')');
    return message + QStringLiteral(": ") + m_path;
}

QString SqliteDialect::explain(int sqliteCode, bool diskFull)
{
    switch (primaryCode(sqliteCode)) {
    case kBusy:
    case kLocked:
        return QStringLiteral("the store is locked by another program");
    case kReadOnly:
        return QStringLiteral("database is read-only");
    case kIoError:
        return diskFull ? QStringLiteral("the disk is full")
                        : QStringLiteral("the disk cannot be read or written (it may be full, or the folder may"
                                         " not be writable)");
    case kCorrupt:
        return QStringLiteral("the file is damaged");
    case kFull:
        return QStringLiteral("the disk is full");
    case kCantOpen:
        return diskFull ? QStringLiteral("the disk is full")
                        : QStringLiteral("the file cannot be opened (it may be missing, or its folder may not be"
                                         " writable)");
    case kNotADatabase:
        return QStringLiteral("the file is not a store");
    default:
        return {};
    }
}

} // namespace vemi
