#pragma once

#include "host/store/StoreError.h"
#include "host/store/StoreOptions.h"

#include <QSqlQuery>
#include <QString>
#include <QVariantList>

#include <functional>
#include <memory>

class QSqlError;

namespace vemi {

class StoreDialect;

// One connection to a store: an SQLite file or a database on a PostgreSQL
// server, told apart by its location (see StoreDialect). Created, used and
// destroyed on one thread (a dispatcher's worker). Every failure is thrown as
// a StoreError whose message names the operation, the store and the cause.
class StoreDatabase
{
public:
    // Marks the store as ours ("QCJT") so that a foreign database is refused.
    static constexpr int kApplicationId = 0x51434A54;

    StoreDatabase(QString location, StoreOptions options);
    StoreDatabase(const StoreDatabase&) = delete;
    StoreDatabase& operator=(const StoreDatabase&) = delete;
    ~StoreDatabase();

    // The file path or server address that messages name the store by.
    QString path() const { return m_path; }
    bool isOpen() const { return m_open; }
    static int schemaVersion();

    // Opens the store, refuses one that is not a store, creates or migrates
    // the schema. Nothing is written to a store that fails the checks.
    void open();

    // Runs one statement with positional bindings, positioned before its first
    // row; throws StoreError with the cause and the store (the dispatcher adds
    // what the command was doing).
    QSqlQuery run(const QString& sql, const QVariantList& bindings = {});
    // For one statement run many times, as in a batch write: prepare once,
    // then execute with each row's bindings. Both throw StoreError.
    QSqlQuery prepare(const QString& sql);
    void execute(QSqlQuery& query, const QVariantList& bindings);
    // The first column of the first row, or an invalid QVariant when there is none.
    QVariant scalar(const QString& sql, const QVariantList& bindings = {});
    // Runs body in a transaction that no other writer runs beside; rolls back
    // and rethrows on failure.
    void writeTransaction(const std::function<void()>& body);

    QString describe(const QSqlError& error) const;
    // Calls onChange (on this thread) whenever another connection announces
    // a write; false where the store announces none.
    bool watchChanges(QObject* context, const std::function<void()>& onChange);
    // A statement failed because the connection broke (a server that went
    // away): the connection is of no further use.
    bool isConnectionLost() const { return m_connectionLost; }

private:
    // The error to throw for a failed statement; notes a broken connection.
    StoreError failure(const QSqlError& error);
    void checkOwnership();
    void migrate();

    QString m_path;
    StoreOptions m_options;
    QString m_connectionName;
    std::unique_ptr<StoreDialect> m_dialect;
    bool m_open = false;
    bool m_connectionLost = false;
};

} // namespace vemi
