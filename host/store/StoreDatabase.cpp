#include "host/store/StoreDatabase.h"

#include "host/store/StoreDialect.h"
#include "host/store/StoreError.h"

#include <QSqlDatabase>
#include <QSqlDriver>
#include <QSqlError>
#include <QStringList>

#include <atomic>

namespace vemi {

namespace {

// Each entry upgrades the schema by one version; entry 0 creates version 1.
// "%1" stands for the dialect's column type for bytes.
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
                           " data %1 NOT NULL)"),
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

} // namespace

StoreDatabase::StoreDatabase(QString location, StoreOptions options)
    : m_path(std::move(location))
    , m_options(options)
    , m_connectionName(uniqueConnectionName())
    , m_dialect(StoreDialect::forLocation(m_path))
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
        m_dialect->connect(m_connectionName, m_options);
        checkOwnership();
        m_dialect->configure(*this, m_options);
    } catch (const StoreError& error) {
        throw StoreError(std::string("Cannot open the store: ") + error.what(), error.sqliteCode());
    }
    m_open = true;
}

// Throws when the store is not one of this program or one it cannot use;
// nothing is written before these checks pass.
void StoreDatabase::checkOwnership()
{
    const std::string store = m_path.toStdString();
    const std::string noun = m_dialect->noun();
    const StoreDialect::Mark mark = m_dialect->readMark(*this);
    const bool fresh = mark.applicationId == 0 && mark.schemaVersion == 0 && mark.empty;
    if (!fresh && mark.applicationId != kApplicationId)
        throw StoreError("the " + noun + " is another program's database, not a store: " + store);
    // Creating the schema over tables that are there already would fail on
    // the first of them, with a message about SQL that helps nobody.
    if (mark.schemaVersion == 0 && !mark.empty)
        throw StoreError("the " + noun + " is damaged or not a store (it has tables but no schema version): " + store);
    if (mark.schemaVersion > schemaVersion())
        throw StoreError("it was written by a newer version (schema " + std::to_string(mark.schemaVersion)
                         + ", this program knows " + std::to_string(schemaVersion()) + "): " + store);
    if (mark.schemaVersion < schemaVersion()) {
        if (m_options.readOnly)
            throw StoreError("a read-only store must first be created or upgraded: " + store);
        migrate();
    }
}

void StoreDatabase::migrate()
{
    writeTransaction([&] {
        // Another program may have created or upgraded the schema since it was read.
        const int fromVersion = m_dialect->readMark(*this).schemaVersion;
        for (int version = fromVersion; version < schemaVersion(); ++version) {
            for (const QString& statement : migrations()[size_t(version)])
                run(statement.contains(QLatin1String("%1")) ? statement.arg(m_dialect->blobType()) : statement, {});
        }
        m_dialect->writeMark(*this, kApplicationId, schemaVersion());
    });
}

QSqlQuery StoreDatabase::run(const QString& sql, const QVariantList& bindings)
{
    // Statements without bindings run as they stand: a server cannot prepare
    // some of them (BEGIN, SET).
    if (bindings.isEmpty()) {
        QSqlQuery query(QSqlDatabase::database(m_connectionName, false));
        query.setForwardOnly(true);
        if (!query.exec(sql))
            throw failure(query.lastError());
        return query;
    }
    QSqlQuery query = prepare(sql);
    execute(query, bindings);
    return query;
}

QSqlQuery StoreDatabase::prepare(const QString& sql)
{
    QSqlQuery query(QSqlDatabase::database(m_connectionName, false));
    query.setForwardOnly(true);
    if (!query.prepare(sql))
        throw failure(query.lastError());
    return query;
}

void StoreDatabase::execute(QSqlQuery& query, const QVariantList& bindings)
{
    for (int i = 0; i < bindings.size(); ++i)
        query.bindValue(i, bindings[i]);
    if (!query.exec())
        throw failure(query.lastError());
}

StoreError StoreDatabase::failure(const QSqlError& error)
{
    m_connectionLost = m_connectionLost || m_dialect->isConnectionLost(error);
    return StoreError(describe(error).toStdString(), error.nativeErrorCode().toInt());
}

QVariant StoreDatabase::scalar(const QString& sql, const QVariantList& bindings)
{
    QSqlQuery query = run(sql, bindings);
    return query.next() ? query.value(0) : QVariant();
}

void StoreDatabase::writeTransaction(const std::function<void()>& body)
{
    const QStringList begin = m_dialect->beginWrite();
    try {
        for (const QString& statement : begin)
            run(statement, {});
        body();
        // Delivered to the listeners when, and only if, the write commits.
        if (!m_dialect->changeChannel().isEmpty())
            run(QStringLiteral("NOTIFY ") + m_dialect->changeChannel(), {});
        run(QStringLiteral("COMMIT"), {});
    } catch (...) {
        QSqlQuery rollback(QSqlDatabase::database(m_connectionName, false));
        rollback.exec(QStringLiteral("ROLLBACK"));
        throw;
    }
}

bool StoreDatabase::watchChanges(QObject* context, const std::function<void()>& onChange)
{
    const QString channel = m_dialect->changeChannel();
    QSqlDriver* driver = QSqlDatabase::database(m_connectionName, false).driver();
    if (channel.isEmpty() || !driver || !driver->subscribeToNotification(channel))
        return false;
    QObject::connect(driver, QOverload<const QString&, QSqlDriver::NotificationSource, const QVariant&>::of(
                                 &QSqlDriver::notification),
                     context, [onChange](const QString&, QSqlDriver::NotificationSource source, const QVariant&) {
                         if (source != QSqlDriver::SelfSource)
                             onChange();
                     });
    return true;
}

QString StoreDatabase::describe(const QSqlError& error) const
{
    return m_dialect->describe(error);
}

} // namespace vemi
