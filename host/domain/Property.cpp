#include "host/domain/Property.h"

#include "host/domain/ObjectCodec.h"

#include <utility>

namespace vemi {

Property::Property(std::string key, std::string value)
    : m_key(std::move(key)), m_value(std::move(value))
{
}

const std::string& Property::typeId()
{
    static const std::string id = "vemi.Property";
    return id;
}

std::string Property::objectTypeId() const
{
    return typeId();
}

void Property::writeFields(QCborMap& map) const
{
    BaseObject::writeFields(map);
    map.insert(QStringLiteral("key"), ObjectCodec::text(m_key));
    map.insert(QStringLiteral("value"), ObjectCodec::text(m_value));
}

void Property::readFields(const QCborMap& map)
{
    BaseObject::readFields(map);
    m_key = ObjectCodec::readText(map, QStringLiteral("key"));
    m_value = ObjectCodec::readText(map, QStringLiteral("value"));
}

} // namespace vemi
