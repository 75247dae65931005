#include "host/domain/TagValue.h"

#include "host/domain/ObjectCodec.h"
#include "host/domain/TagDefinition.h"

#include <utility>

namespace vemi {

TagValue::TagValue() = default;

const std::string& TagValue::typeId()
{
    static const std::string id = "vemi.TagValue";
    return id;
}

std::string TagValue::objectTypeId() const
{
    return typeId();
}

std::shared_ptr<TagValue> TagValue::forDefinition(const TagDefinition& definition, std::string value)
{
    auto tagValue = std::make_shared<TagValue>();
    tagValue->m_definitionId = definition.id();
    tagValue->m_value = std::move(value);
    return tagValue;
}

void TagValue::writeFields(QCborMap& map) const
{
    BaseObject::writeFields(map);
    map.insert(QStringLiteral("definitionId"), ObjectCodec::text(m_definitionId));
    map.insert(QStringLiteral("value"), ObjectCodec::text(m_value));
}

void TagValue::readFields(const QCborMap& map)
{
    BaseObject::readFields(map);
    m_definitionId = ObjectCodec::readText(map, QStringLiteral("definitionId"));
    m_value = ObjectCodec::readText(map, QStringLiteral("value"));
}

} // namespace vemi
