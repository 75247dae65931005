#include "host/domain/Size.h"

#include "host/domain/ObjectCodec.h"

namespace vemi {

Size::Size(int width, int height)
    : m_width(width), m_height(height)
{
}

const std::string& Size::typeId()
{
    static const std::string id = "vemi.Size";
    return id;
}

std::string Size::objectTypeId() const
{
    return typeId();
}

void Size::writeFields(QCborMap& map) const
{
    BaseObject::writeFields(map);
    map.insert(QStringLiteral("width"), m_width);
    map.insert(QStringLiteral("height"), m_height);
}

void Size::readFields(const QCborMap& map)
{
    BaseObject::readFields(map);
    m_width = int(ObjectCodec::readInteger(map, QStringLiteral("width")));
    m_height = int(ObjectCodec::readInteger(map, QStringLiteral("height")));
}

} // namespace vemi
