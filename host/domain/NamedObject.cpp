#include "host/domain/NamedObject.h"

#include "host/domain/Header.h"
#include "host/domain/ObjectCodec.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"

namespace vemi {

std::string NamedObject::name() const
{
    return header()->name();
}

void NamedObject::setName(const std::string& name)
{
    header()->setName(name);
}

std::string NamedObject::description() const
{
    return header()->description();
}

void NamedObject::setDescription(const std::string& description)
{
    header()->setDescription(description);
}

void NamedObject::setTagDefinitions(const std::vector<std::shared_ptr<TagDefinition>>& definitions)
{
    m_tagDefinitions = definitions;
}

void NamedObject::setTagValues(const std::vector<std::shared_ptr<TagValue>>& values)
{
    m_tagValues = values;
}

void NamedObject::writeFields(QCborMap& map) const
{
    map.insert(QStringLiteral("tagDefinitions"), ObjectCodec::encodeList(m_tagDefinitions));
    map.insert(QStringLiteral("tagValues"), ObjectCodec::encodeList(m_tagValues));
}

void NamedObject::readFields(const QCborMap& map)
{
    m_tagDefinitions = ObjectCodec::decodeList<TagDefinition>(map.value(QStringLiteral("tagDefinitions")));
    m_tagValues = ObjectCodec::decodeList<TagValue>(map.value(QStringLiteral("tagValues")));
}

} // namespace vemi
