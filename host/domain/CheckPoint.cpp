#include "host/domain/CheckPoint.h"

#include "host/domain/ObjectCodec.h"
#include "host/domain/Position.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"
#include "host/domain/Standard.h"

namespace vemi {

CheckPoint::CheckPoint()
    : m_position(std::make_shared<Position>())
    , m_size(std::make_shared<Size>())
    , m_schematicImage(std::make_shared<SchematicImage>())
{
}

const std::string& CheckPoint::typeId()
{
    static const std::string id = "vemi.CheckPoint";
    return id;
}

std::string CheckPoint::objectTypeId() const
{
    return typeId();
}

void CheckPoint::setPosition(const std::shared_ptr<Position>& position)
{
    m_position = position;
}

void CheckPoint::setSize(const std::shared_ptr<Size>& size)
{
    m_size = size;
}

void CheckPoint::setSchematicImage(const std::shared_ptr<SchematicImage>& image)
{
    m_schematicImage = image;
}

void CheckPoint::setStandard(const std::shared_ptr<Standard>& standard)
{
    m_standard = standard;
}

void CheckPoint::writeFields(QCborMap& map) const
{
    CheckListItem::writeFields(map);
    map.insert(QStringLiteral("position"), ObjectCodec::encode(m_position));
    map.insert(QStringLiteral("size"), ObjectCodec::encode(m_size));
    map.insert(QStringLiteral("schematicImage"), ObjectCodec::encode(m_schematicImage));
    map.insert(QStringLiteral("standard"), ObjectCodec::encode(m_standard));
    map.insert(QStringLiteral("autoStandard"), m_autoStandard);
    map.insert(QStringLiteral("skippable"), m_skippable);
    map.insert(QStringLiteral("matchPoint"), ObjectCodec::text(m_matchPoint));
}

void CheckPoint::readFields(const QCborMap& map)
{
    CheckListItem::readFields(map);
    m_position = ObjectCodec::decodeAs<Position>(map.value(QStringLiteral("position")));
    m_size = ObjectCodec::decodeAs<Size>(map.value(QStringLiteral("size")));
    m_schematicImage = ObjectCodec::decodeAs<SchematicImage>(map.value(QStringLiteral("schematicImage")));
    m_standard = ObjectCodec::decodeAs<Standard>(map.value(QStringLiteral("standard")));
    m_autoStandard = ObjectCodec::readBool(map, QStringLiteral("autoStandard"), true);
    m_skippable = ObjectCodec::readBool(map, QStringLiteral("skippable"));
    m_matchPoint = ObjectCodec::readText(map, QStringLiteral("matchPoint"));
}

} // namespace vemi
