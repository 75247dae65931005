#include "host/domain/ColorimetricCondition.h"

#include "host/domain/ObjectCodec.h"

#include <utility>

namespace vemi {

ColorimetricCondition::ColorimetricCondition(std::string illuminant, std::string observer)
    : m_illuminant(std::move(illuminant)), m_observer(std::move(observer))
{
}

const std::string& ColorimetricCondition::typeId()
{
    static const std::string id = "vemi.ColorimetricCondition";
    return id;
}

std::string ColorimetricCondition::objectTypeId() const
{
    return typeId();
}

std::string ColorimetricCondition::toString() const
{
    return m_illuminant + '/' + m_observer;
}

bool ColorimetricCondition::operator==(const ColorimetricCondition& other) const
{
    return m_illuminant == other.m_illuminant && m_observer == other.m_observer;
}

void ColorimetricCondition::writeFields(QCborMap& map) const
{
    BaseObject::writeFields(map);
    map.insert(QStringLiteral("illuminant"), ObjectCodec::text(m_illuminant));
    map.insert(QStringLiteral("observer"), ObjectCodec::text(m_observer));
}

void ColorimetricCondition::readFields(const QCborMap& map)
{
    BaseObject::readFields(map);
    m_illuminant = ObjectCodec::readText(map, QStringLiteral("illuminant"));
    m_observer = ObjectCodec::readText(map, QStringLiteral("observer"));
}

} // namespace vemi
