#include "host/store/StoreDatabase.h"

#include "host/store/StoreError.h"

#include <QFileInfo>
#include <QSqlDatabase>
#include <QSqlError>
#include <QStorageInfo>
#include <QStringList>
#include <QUrl>

#include <atomic>

namespace vemi {

namespace {

// Each entry upgrades the schema by one version; entry 0 creates version 1.
const std::vector<QStringList>& migrations()
{
    static const std::vector<QStringList> steps = {
        {
            QStringLiteral("CREATE TABLE folders("
                           " id TEXT PRIMARY KEY,"
                           " object_type TEXT NOT NULL,"
                           " parent_id TEXT REFERENCES folders(id) ON DELETE CASCADE,"
                           " name TEXT NOT NULL)"),
            QStringLiteral("CREATE INDEX folders_by_type ON folders(object_type)"),
            QStringLiteral("CREATE TABLE objects("
                           " id TEXT PRIMARY KEY,"
                           " type TEXT NOT NULL,"
                           " name TEXT NOT NULL,"
                           " data BLOB NOT NULL)"),
            QStringLiteral("CREATE INDEX objects_by_type ON objects(type, name)"),
            QStringLiteral("CREATE TABLE dir_entries("
                           " id TEXT PRIMARY KEY,"
                           " object_id TEXT NOT NULL UNIQUE REFERENCES objects(id) ON DELETE CASCADE,"
                           " folder_id TEXT REFERENCES folders(id) ON DELETE CASCADE)"),
            QStringLiteral("CREATE INDEX dir_entries_by_folder ON dir_entries(folder_id)"),
        },
        {
            // Each save counts up; a save that read an older revision is refused.
            QStringLiteral("ALTER TABLE objects ADD COLUMN revision INTEGER NOT NULL DEFAULT 1"),
        },
    };
    return steps;
}

QString uniqueConnectionName()
{
    static std::atomic<int> counter{0};
    return QStringLiteral("vemi-store-%1").arg(++counter);
}

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

} // namespace

StoreDatabase::StoreDatabase(QString path, StoreOptions options)
    : m_path(std::move(path)), m_options(options), m_connectionName(uniqueConnectionName())
{
}

StoreDatabase::~StoreDatabase()
{
    {
        QSqlDatabase database = QSqlDatabase::database(m_connectionName, false);
        if (database.isValid())
            database.close();
    }
    QSqlDatabase::removeDatabase(m_connectionName);
}

int StoreDatabase::schemaVersion()
{
    return int(migrations().size());
}

void StoreDatabase::open()
{
    try {
        if (m_options.readOnly)
            openReadOnly();
        else
            connect(Access::ReadWrite);
    } catch (const StoreError& error) {
        throw StoreError(std::string("Cannot open the store: ") + error.what(), error.sqliteCode());
    }
    m_open = true;
}

void StoreDatabase::connect(Access access)
{
    QSqlDatabase database = QSqlDatabase::database(m_connectionName, false);
    if (!database.isValid())
        database = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), m_connectionName);
    if (!database.isValid())
        throw StoreError("the SQLite driver for Qt is not installed (package libqt5sql5-sqlite)");
    database.close();
    QString connectOptions = QStringLiteral("QSQLITE_BUSY_TIMEOUT=%1").arg(m_options.busyTimeoutMs);
    if (access == Access::ReadWrite) {
        database.setDatabaseName(m_path);
    } else {
        connectOptions += QStringLiteral(";QSQLITE_OPEN_READONLY;QSQLITE_OPEN_URI");
        QUrl uri = QUrl::fromLocalFile(QFileInfo(m_path).absoluteFilePath());
        uri.setQuery(access == Access::Immutable ? QStringLiteral("immutable=1") : QStringLiteral("mode=ro"));
        database.setDatabaseName(uri.toString(QUrl::FullyEncoded));
    }
    database.setConnectOptions(connectOptions);
    if (!database.open()) {
        const QSqlError error = database.lastError();
        throw StoreError(describe(error).toStdString(), error.nativeErrorCode().toInt());
    }
    checkOwnership();
    applyPragmas();
}

// SQLite reads a WAL store through two side files, which even a reader
// creates; where they cannot be made (a read-only folder or mount, a full
// disk) the file is opened as immutable instead: read without locks or side
// files. That is safe only while nobody writes it: when no -wal file shows a
// writer or changes not yet merged into the file, and either nobody may write
// the folder or SQLite could not make its side files there either.
void StoreDatabase::openReadOnly()
{
    const std::string file = m_path.toStdString();
    const QFileInfo info(m_path);
    if (!info.exists())
        throw StoreError("there is no store file: " + file);
    const QFileInfo folder(info.absolutePath());
    const bool anyoneMayWrite =
        folder.permissions() & (QFileDevice::WriteOwner | QFileDevice::WriteGroup | QFileDevice::WriteOther);
    if (!anyoneMayWrite && !QFileInfo::exists(m_path + QStringLiteral("-wal"))) {
        connect(Access::Immutable);
        return;
    }
    try {
        connect(Access::ReadOnly);
    } catch (const StoreError& error) {
        if (!isSideFileFailure(error.sqliteCode()))
            throw;
        if (QFileInfo(m_path + QStringLiteral("-wal")).size() > 0)
            throw StoreError(std::string(error.what())
                             + " (the store holds changes not yet merged into the file, which cannot be read"
                               " without writing beside it: open it once with write access)");
        connect(Access::Immutable);
    }
}

bool StoreDatabase::diskFull() const
{
    const QStorageInfo storage(QFileInfo(m_path).absolutePath());
    return storage.isValid() && storage.bytesAvailable() < kFullDiskBytes;
}

int StoreDatabase::readPragma(const char* name)
{
    return scalar(QStringLiteral("PRAGMA %1").arg(QLatin1String(name)), {}).toInt();
}

// Throws when the file is not a store of this program or one it cannot use;
// nothing is written before these checks pass.
void StoreDatabase::checkOwnership()
{
    const std::string file = m_path.toStdString();
    const int applicationId = readPragma("application_id");
    const int version = readPragma("user_version");
    const bool empty = scalar(QStringLiteral("SELECT count(*) FROM sqlite_master")).toInt() == 0;
    const bool fresh = applicationId == 0 && version == 0 && empty;
    if (!fresh && applicationId != kApplicationId)
        throw StoreError("the file is another program's SQLite database, not a store: " + file);
    // Creating the schema over tables that are there already would fail on
    // the first of them, with a message about SQL that helps nobody.
    if (version == 0 && !empty)
        throw StoreError("the file is damaged or not a store (it has tables but no schema version): " + file);
    if (version > schemaVersion())
        throw StoreError("it was written by a newer version (schema " + std::to_string(version)
                         + ", this program knows " + std::to_string(schemaVersion()) + "): " + file);
    if (version < schemaVersion()) {
        if (m_options.readOnly)
            throw StoreError("a read-only store must first be created or upgraded: " + file);
        migrate();
    }
}

void StoreDatabase::migrate()
{
    writeTransaction([&] {
        // Another program may have created or upgraded the schema since it was read.
        const int fromVersion = readPragma("user_version");
        for (int version = fromVersion; version < schemaVersion(); ++version) {
            for (const QString& statement : migrations()[size_t(version)])
                run(statement, {});
        }
        run(QStringLiteral("PRAGMA application_id = %1").arg(kApplicationId), {});
        run(QStringLiteral("PRAGMA user_version = %1").arg(schemaVersion()), {});
    });
}

void StoreDatabase::applyPragmas()
{
    run(QStringLiteral("PRAGMA foreign_keys = ON"), {});
    if (m_options.readOnly)
        return;
    run(QStringLiteral("PRAGMA journal_mode = WAL"), {});
    run(QStringLiteral("PRAGMA synchronous = NORMAL"), {});
}

QSqlQuery StoreDatabase::run(const QString& sql, const QVariantList& bindings)
{
    QSqlQuery query(QSqlDatabase::database(m_connectionName, false));
    query.setForwardOnly(true);
    const auto fail = [this](const QSqlError& error) {
        return StoreError(describe(error).toStdString(), error.nativeErrorCode().toInt());
    };
    if (!query.prepare(sql))
        throw fail(query.lastError());
    for (const QVariant& value : bindings)
        query.addBindValue(value);
    if (!query.exec())
        throw fail(query.lastError());
    return query;
}

QVariant StoreDatabase::scalar(const QString& sql, const QVariantList& bindings)
{
    QSqlQuery query = run(sql, bindings);
    return query.next() ? query.value(0) : QVariant();
}

void StoreDatabase::writeTransaction(const std::function<void()>& body)
{
    run(QStringLiteral("BEGIN IMMEDIATE"), {});
    try {
        body();
        run(QStringLiteral("COMMIT"), {});
    } catch (...) {
        QSqlQuery rollback(QSqlDatabase::database(m_connectionName, false));
        rollback.exec(QStringLiteral("ROLLBACK"));
        throw;
    }
}

QString StoreDatabase::describe(const QSqlError& error) const
{
    const int code = error.nativeErrorCode().toInt();
    const int primary = primaryCode(code);
    const bool full = (primary == kIoError || primary == kFull || primary == kCantOpen) && diskFull();
    const QString cause = explain(code, full);
    const QString detail = error.databaseText().isEmpty() ? error.text() : error.databaseText();
    const QString message = cause.isEmpty() ? detail : cause + QStringLiteral(" (") + detail + QLatin1Char(')');
    return message + QStringLiteral(": ") + m_path;
}

QString StoreDatabase::explain(int sqliteCode, bool diskFull)
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
