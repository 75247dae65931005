#include "host/store/StoreDialect.h"

#include "host/store/PostgresDialect.h"
#include "host/store/SqliteDialect.h"

namespace vemi {

bool StoreDialect::isServerLocation(const QString& location)
{
    return location.startsWith(QLatin1String("postgresql://"), Qt::CaseInsensitive)
        || location.startsWith(QLatin1String("postgres://"), Qt::CaseInsensitive);
}

std::unique_ptr<StoreDialect> StoreDialect::forLocation(const QString& location)
{
    if (isServerLocation(location))
        return std::make_unique<PostgresDialect>(location);
    return std::make_unique<SqliteDialect>(location);
}

} // namespace vemi
