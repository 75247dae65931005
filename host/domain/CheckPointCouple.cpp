#include "host/domain/CheckPointCouple.h"

#include "host/domain/CheckPoint.h"
#include "host/domain/ObjectCodec.h"

namespace vemi {

const std::string& CheckPointCouple::typeId()
{
    static const std::string id = "vemi.CheckPointCouple";
    return id;
}

std::string CheckPointCouple::objectTypeId() const
{
    return typeId();
}

void CheckPointCouple::setCheckPoints(const std::vector<std::shared_ptr<CheckPoint>>& checkPoints)
{
    m_checkPoints = checkPoints;
}

void CheckPointCouple::writeFields(QCborMap& map) const
{
    CheckListItem::writeFields(map);
    map.insert(QStringLiteral("checkPoints"), ObjectCodec::encodeList(m_checkPoints));
}

void CheckPointCouple::readFields(const QCborMap& map)
{
    CheckListItem::readFields(map);
    m_checkPoints = ObjectCodec::decodeList<CheckPoint>(map.value(QStringLiteral("checkPoints")));
}

} // namespace vemi
