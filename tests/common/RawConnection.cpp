#include "tests/common/RawConnection.h"

#include "host/store/PostgresDialect.h"
#include "host/store/StoreDialect.h"

#include <QSqlDatabase>
#include <QSqlQuery>

namespace {
int s_connections = 0;
} // namespace

RawConnection::RawConnection(const QString& path)
    : m_name(QStringLiteral("raw-%1").arg(++s_connections))
{
    const bool server = vemi::StoreDialect::isServerLocation(path);
    QSqlDatabase database = QSqlDatabase::addDatabase(server ? QStringLiteral("QPSQL") : QStringLiteral("QSQLITE"), m_name);
    if (server)
        vemi::PostgresDialect::applyAddress(database, path);
    else
        database.setDatabaseName(path);
    database.open();
}

RawConnection::~RawConnection()
{
    QSqlDatabase::database(m_name).close();
    QSqlDatabase::removeDatabase(m_name);
}

bool RawConnection::exec(const QString& sql, const QVariantList& bindings)
{
    QSqlQuery query(QSqlDatabase::database(m_name));
    // A server prepares only queries, not statements such as CREATE or BEGIN.
    if (bindings.isEmpty())
        return query.exec(sql);
    query.prepare(sql);
    for (const QVariant& value : bindings)
        query.addBindValue(value);
    return query.exec();
}

QVariant RawConnection::scalar(const QString& sql)
{
    QSqlQuery query(QSqlDatabase::database(m_name));
    query.exec(sql);
    return query.next() ? query.value(0) : QVariant();
}
