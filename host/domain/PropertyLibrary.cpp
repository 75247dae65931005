#include "host/domain/PropertyLibrary.h"

#include "host/domain/ObjectCodec.h"
#include "host/domain/TagDefinition.h"

#include <algorithm>

namespace vemi {

const std::string& PropertyLibrary::typeId()
{
    static const std::string id = "vemi.PropertyLibrary";
    return id;
}

std::string PropertyLibrary::objectTypeId() const
{
    return typeId();
}

void PropertyLibrary::setProperties(const std::vector<std::shared_ptr<TagDefinition>>& properties)
{
    m_properties = properties;
}

void PropertyLibrary::writeFields(QCborMap& map) const
{
    NamedObject::writeFields(map);
    map.insert(QStringLiteral("propertyIds"), ObjectCodec::textList(referencedIds()));
}

void PropertyLibrary::readFields(const QCborMap& map)
{
    NamedObject::readFields(map);
    m_properties.clear();
    for (const std::string& id : ObjectCodec::readTextList(map, QStringLiteral("propertyIds"))) {
        auto standIn = std::make_shared<TagDefinition>();
        standIn->setId(id);
        m_properties.push_back(standIn);
    }
}

std::vector<std::string> PropertyLibrary::referencedIds() const
{
    std::vector<std::string> ids;
    ids.reserve(m_properties.size());
    for (const auto& property : m_properties) {
        if (property)
            ids.push_back(property->id());
    }
    return ids;
}

std::string PropertyLibrary::referencedTypeId() const
{
    return TagDefinition::typeId();
}

void PropertyLibrary::resolveReferences(const ObjectLookup& lookup)
{
    for (auto& property : m_properties) {
        if (!property)
            continue;
        if (auto found = std::dynamic_pointer_cast<TagDefinition>(lookup(property->id())))
            property = found;
    }
}

void PropertyLibrary::dropReferences(const std::vector<std::string>& ids)
{
    const auto dropped = [&ids](const std::shared_ptr<TagDefinition>& member) {
        return member && std::find(ids.begin(), ids.end(), member->id()) != ids.end();
    };
    m_properties.erase(std::remove_if(m_properties.begin(), m_properties.end(), dropped), m_properties.end());
}

} // namespace vemi
