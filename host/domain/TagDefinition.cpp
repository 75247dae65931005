#include "host/domain/TagDefinition.h"

#include "host/domain/ObjectCodec.h"

namespace vemi {

const std::string& TagDefinition::typeId()
{
    static const std::string id = "vemi.TagDefinition";
    return id;
}

std::string TagDefinition::objectTypeId() const
{
    return typeId();
}

void TagDefinition::writeFields(QCborMap& map) const
{
    NamedObject::writeFields(map);
    map.insert(QStringLiteral("defaultValue"), ObjectCodec::text(m_defaultValue));
    map.insert(QStringLiteral("allowedValues"), ObjectCodec::textList(m_allowedValues));
    // Written only for numbers, so that text definitions stay as they were stored before.
    if (m_valueKind == ValueKind::Number)
        map.insert(QStringLiteral("valueKind"), QStringLiteral("number"));
}

void TagDefinition::readFields(const QCborMap& map)
{
    NamedObject::readFields(map);
    m_defaultValue = ObjectCodec::readText(map, QStringLiteral("defaultValue"));
    m_allowedValues = ObjectCodec::readTextList(map, QStringLiteral("allowedValues"));
    const std::string kind = ObjectCodec::readText(map, QStringLiteral("valueKind"));
    if (kind.empty() || kind == "text")
        m_valueKind = ValueKind::Text;
    else if (kind == "number")
        m_valueKind = ValueKind::Number;
    else
        throw DecodeError("unknown tag value kind " + kind);
}

} // namespace vemi
