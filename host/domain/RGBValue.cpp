#include "host/domain/RGBValue.h"

#include "host/domain/ObjectCodec.h"

namespace vemi {

RGBValue::RGBValue(int red, int green, int blue)
    : m_red(red), m_green(green), m_blue(blue)
{
}

const std::string& RGBValue::typeId()
{
    static const std::string id = "vemi.RGBValue";
    return id;
}

std::string RGBValue::objectTypeId() const
{
    return typeId();
}

void RGBValue::writeFields(QCborMap& map) const
{
    BaseObject::writeFields(map);
    map.insert(QStringLiteral("red"), m_red);
    map.insert(QStringLiteral("green"), m_green);
    map.insert(QStringLiteral("blue"), m_blue);
}

void RGBValue::readFields(const QCborMap& map)
{
    BaseObject::readFields(map);
    m_red = int(ObjectCodec::readInteger(map, QStringLiteral("red")));
    m_green = int(ObjectCodec::readInteger(map, QStringLiteral("green")));
    m_blue = int(ObjectCodec::readInteger(map, QStringLiteral("blue")));
}

} // namespace vemi
