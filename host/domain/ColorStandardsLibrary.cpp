#include "host/domain/ColorStandardsLibrary.h"

#include "host/domain/ObjectCodec.h"
#include "host/domain/Standard.h"

#include <algorithm>

namespace vemi {

const std::string& ColorStandardsLibrary::typeId()
{
    static const std::string id = "vemi.ColorStandardsLibrary";
    return id;
}

std::string ColorStandardsLibrary::objectTypeId() const
{
    return typeId();
}

void ColorStandardsLibrary::setStandards(const std::vector<std::shared_ptr<Standard>>& standards)
{
    m_standards = standards;
}

void ColorStandardsLibrary::writeFields(QCborMap& map) const
{
    NamedObject::writeFields(map);
    map.insert(QStringLiteral("standardIds"), ObjectCodec::textList(referencedIds()));
}

void ColorStandardsLibrary::readFields(const QCborMap& map)
{
    NamedObject::readFields(map);
    m_standards.clear();
    for (const std::string& id : ObjectCodec::readTextList(map, QStringLiteral("standardIds"))) {
        auto standIn = std::make_shared<Standard>();
        standIn->setId(id);
        m_standards.push_back(standIn);
    }
}

std::vector<std::string> ColorStandardsLibrary::referencedIds() const
{
    std::vector<std::string> ids;
    ids.reserve(m_standards.size());
    for (const auto& standard : m_standards) {
        if (standard)
            ids.push_back(standard->id());
    }
    return ids;
}

std::string ColorStandardsLibrary::referencedTypeId() const
{
    return Standard::typeId();
}

void ColorStandardsLibrary::resolveReferences(const ObjectLookup& lookup)
{
    for (auto& standard : m_standards) {
        if (!standard)
            continue;
        if (auto found = std::dynamic_pointer_cast<Standard>(lookup(standard->id())))
            standard = found;
    }
}

void ColorStandardsLibrary::dropReferences(const std::vector<std::string>& ids)
{
    const auto dropped = [&ids](const std::shared_ptr<Standard>& member) {
        return member && std::find(ids.begin(), ids.end(), member->id()) != ids.end();
    };
    m_standards.erase(std::remove_if(m_standards.begin(), m_standards.end(), dropped), m_standards.end());
}

} // namespace vemi
