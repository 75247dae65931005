#include "host/domain/LabValue.h"

#include "host/domain/ObjectCodec.h"

namespace vemi {

LabValue::LabValue(double L, double a, double b)
    : m_L(L), m_a(a), m_b(b)
{
}

const std::string& LabValue::typeId()
{
    static const std::string id = "vemi.LabValue";
    return id;
}

std::string LabValue::objectTypeId() const
{
    return typeId();
}

void LabValue::writeFields(QCborMap& map) const
{
    ColorValue::writeFields(map);
    map.insert(QStringLiteral("L"), m_L);
    map.insert(QStringLiteral("a"), m_a);
    map.insert(QStringLiteral("b"), m_b);
    map.insert(QStringLiteral("colorimetricCondition"), ObjectCodec::text(m_condition));
}

void LabValue::readFields(const QCborMap& map)
{
    ColorValue::readFields(map);
    m_L = ObjectCodec::readDouble(map, QStringLiteral("L"));
    m_a = ObjectCodec::readDouble(map, QStringLiteral("a"));
    m_b = ObjectCodec::readDouble(map, QStringLiteral("b"));
    m_condition = ObjectCodec::readText(map, QStringLiteral("colorimetricCondition"));
}

} // namespace vemi
