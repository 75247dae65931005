#include "tests/common/RawConnection.h"

#include <QSqlDatabase>
#include <QSqlQuery>

namespace {
int s_connections = 0;
} // namespace

RawConnection::RawConnection(const QString& path)
    : m_name(QStringLiteral("raw-%1").arg(++s_connections))
{
    QSqlDatabase database = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), m_name);
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
