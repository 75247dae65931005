#include "host/domain/ToleranceSet.h"

#include "host/domain/ObjectCodec.h"
#include "host/domain/Tolerance.h"

namespace vemi {

const std::string& ToleranceSet::typeId()
{
    static const std::string id = "vemi.ToleranceSet";
    return id;
}

std::string ToleranceSet::objectTypeId() const
{
    return typeId();
}

void ToleranceSet::setTolerances(const std::vector<std::shared_ptr<Tolerance>>& tolerances)
{
    m_tolerances = tolerances;
}

void ToleranceSet::writeFields(QCborMap& map) const
{
    NamedObject::writeFields(map);
    map.insert(QStringLiteral("tolerances"), ObjectCodec::encodeList(m_tolerances));
}

void ToleranceSet::readFields(const QCborMap& map)
{
    NamedObject::readFields(map);
    m_tolerances = ObjectCodec::decodeList<Tolerance>(map.value(QStringLiteral("tolerances")));
}

} // namespace vemi
