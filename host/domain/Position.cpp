#include "host/domain/Position.h"

#include "host/domain/ObjectCodec.h"

namespace vemi {

Position::Position(int x, int y)
    : m_x(x), m_y(y)
{
}

const std::string& Position::typeId()
{
    static const std::string id = "vemi.Position";
    return id;
}

std::string Position::objectTypeId() const
{
    return typeId();
}

void Position::writeFields(QCborMap& map) const
{
    BaseObject::writeFields(map);
    map.insert(QStringLiteral("x"), m_x);
    map.insert(QStringLiteral("y"), m_y);
}

void Position::readFields(const QCborMap& map)
{
    BaseObject::readFields(map);
    m_x = int(ObjectCodec::readInteger(map, QStringLiteral("x")));
    m_y = int(ObjectCodec::readInteger(map, QStringLiteral("y")));
}

} // namespace vemi
