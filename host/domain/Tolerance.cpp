#include "host/domain/Tolerance.h"

#include "host/domain/ObjectCodec.h"

namespace vemi {

const std::string& Tolerance::typeId()
{
    static const std::string id = "vemi.Tolerance";
    return id;
}

std::string Tolerance::objectTypeId() const
{
    return typeId();
}

void Tolerance::writeFields(QCborMap& map) const
{
    NamedObject::writeFields(map);
    map.insert(QStringLiteral("method"), ObjectCodec::text(m_method));
    map.insert(QStringLiteral("limit"), m_limit);
}

void Tolerance::readFields(const QCborMap& map)
{
    NamedObject::readFields(map);
    m_method = ObjectCodec::readText(map, QStringLiteral("method"));
    m_limit = ObjectCodec::readDouble(map, QStringLiteral("limit"));
}

} // namespace vemi
