#pragma once

#include "host/store/StoreError.h"
#include "host/store/StoreOptions.h"

#include <QSqlQuery>
#include <QString>
#include <QVariantList>

#include <functional>

class QSqlError;

namespace vemi {

// One SQLite connection to a store file. Created, used and destroyed on one
// thread (a dispatcher's worker). Every failure is thrown as a StoreError whose
// message names the operation, the file and the cause.
class StoreDatabase
{
public:
    // Marks the file as ours ("QCJT") so that a foreign SQLite file is refused.
    static constexpr int kApplicationId = 0x51434A54;

    StoreDatabase(QString path, StoreOptions options);
    StoreDatabase(const StoreDatabase&) = delete;
    StoreDatabase& operator=(const StoreDatabase&) = delete;
    ~StoreDatabase();

    QString path() const { return m_path; }
    bool isOpen() const { return m_open; }
    static int schemaVersion();

    // Opens the file, refuses one that is not a store, creates or migrates the
    // schema. Nothing is written to a file that fails the checks. A read-only
    // open never writes the file and works in a folder nobody may write and
    // on a full disk, where SQLite cannot make its side files (-wal, -shm).
    void open();

    // Runs one statement with positional bindings, positioned before its first
    // row; throws StoreError with the cause and the file (the dispatcher adds
    // what the command was doing).
    QSqlQuery run(const QString& sql, const QVariantList& bindings = {});
    // For one statement run many times, as in a batch write: prepare once,
    // then execute with each row's bindings. Both throw StoreError.
    QSqlQuery prepare(const QString& sql);
    void execute(QSqlQuery& query, const QVariantList& bindings);
    // The first column of the first row, or an invalid QVariant when there is none.
    QVariant scalar(const QString& sql, const QVariantList& bindings = {});
    // Runs body inside BEGIN IMMEDIATE … COMMIT; rolls back and rethrows on failure.
    void writeTransaction(const std::function<void()>& body);

    QString describe(const QSqlError& error) const;
    // What a failed SQLite call means, in words a person can act on; empty
    // when SQLite's own text says it best. diskFull: the store's disk has no
    // room left, which turns SQLite's "disk I/O error" into plain words.
    static QString explain(int sqliteCode, bool diskFull);

private:
    enum class Access { ReadWrite, ReadOnly, Immutable };
    // Opens the connection and runs the checks; throws StoreError.
    void connect(Access access);
    void openReadOnly();
    bool diskFull() const;
    StoreError failure(const QSqlError& error) const;
    void checkOwnership();
    void migrate();
    void applyPragmas();
    int readPragma(const char* name);

    QString m_path;
    StoreOptions m_options;
    QString m_connectionName;
    bool m_open = false;
};

} // namespace vemi
