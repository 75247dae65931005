#include "host/domain/MeasurementConfiguration.h"

#include "host/domain/ObjectCodec.h"
#include "host/domain/Property.h"

namespace vemi {

const std::string& MeasurementConfiguration::typeId()
{
    static const std::string id = "vemi.MeasurementConfiguration";
    return id;
}

std::string MeasurementConfiguration::objectTypeId() const
{
    return typeId();
}

void MeasurementConfiguration::setProperties(const std::vector<std::shared_ptr<Property>>& properties)
{
    m_properties = properties;
}

void MeasurementConfiguration::writeFields(QCborMap& map) const
{
    NamedObject::writeFields(map);
    map.insert(QStringLiteral("instrumentModel"), ObjectCodec::text(m_instrumentModel));
    map.insert(QStringLiteral("properties"), ObjectCodec::encodeList(m_properties));
}

void MeasurementConfiguration::readFields(const QCborMap& map)
{
    NamedObject::readFields(map);
    m_instrumentModel = ObjectCodec::readText(map, QStringLiteral("instrumentModel"));
    m_properties = ObjectCodec::decodeList<Property>(map.value(QStringLiteral("properties")));
}

} // namespace vemi
