#include "host/domain/AppearanceValues.h"

#include "host/domain/ColorValue.h"
#include "host/domain/ObjectCodec.h"

namespace vemi {

const std::string& AppearanceValues::typeId()
{
    static const std::string id = "vemi.AppearanceValues";
    return id;
}

std::string AppearanceValues::objectTypeId() const
{
    return typeId();
}

void AppearanceValues::setColorValues(const std::vector<std::shared_ptr<ColorValue>>& values)
{
    m_colorValues = values;
}

void AppearanceValues::writeFields(QCborMap& map) const
{
    BaseObject::writeFields(map);
    map.insert(QStringLiteral("colorValues"), ObjectCodec::encodeList(m_colorValues));
}

void AppearanceValues::readFields(const QCborMap& map)
{
    BaseObject::readFields(map);
    m_colorValues = ObjectCodec::decodeList<ColorValue>(map.value(QStringLiteral("colorValues")));
}

} // namespace vemi
