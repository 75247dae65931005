#include "host/domain/LabToleranceBase.h"

#include "host/domain/ColorimetricCondition.h"
#include "host/domain/ObjectCodec.h"

namespace vemi {

const std::string& LabToleranceBase::typeId()
{
    static const std::string id = "vemi.LabToleranceBase";
    return id;
}

std::string LabToleranceBase::objectTypeId() const
{
    return typeId();
}

void LabToleranceBase::setColorimetricCondition(const std::shared_ptr<ColorimetricCondition>& condition)
{
    m_condition = condition;
}

void LabToleranceBase::writeFields(QCborMap& map) const
{
    Tolerance::writeFields(map);
    map.insert(QStringLiteral("colorimetricCondition"), ObjectCodec::encode(m_condition));
}

void LabToleranceBase::readFields(const QCborMap& map)
{
    Tolerance::readFields(map);
    m_condition = ObjectCodec::decodeAs<ColorimetricCondition>(map.value(QStringLiteral("colorimetricCondition")));
}

} // namespace vemi
