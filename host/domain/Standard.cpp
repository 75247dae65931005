#include "host/domain/Standard.h"

#include "host/domain/AppearanceValues.h"
#include "host/domain/ObjectCodec.h"
#include "host/domain/RGBValue.h"

namespace vemi {

const std::string& Standard::typeId()
{
    static const std::string id = "vemi.Standard";
    return id;
}

std::string Standard::objectTypeId() const
{
    return typeId();
}

void Standard::setDisplayRGB(const std::shared_ptr<RGBValue>& rgb)
{
    m_displayRGB = rgb;
}

std::shared_ptr<AppearanceValues> Standard::appearanceValues(std::size_t index) const
{
    if (index >= m_appearanceValues.size())
        return {};
    return m_appearanceValues[index];
}

void Standard::setAppearanceValuesList(const std::vector<std::shared_ptr<AppearanceValues>>& list)
{
    m_appearanceValues = list;
}

void Standard::writeFields(QCborMap& map) const
{
    NamedObject::writeFields(map);
    map.insert(QStringLiteral("displayRGB"), ObjectCodec::encode(m_displayRGB));
    map.insert(QStringLiteral("appearanceValues"), ObjectCodec::encodeList(m_appearanceValues));
}

void Standard::readFields(const QCborMap& map)
{
    NamedObject::readFields(map);
    m_displayRGB = ObjectCodec::decodeAs<RGBValue>(map.value(QStringLiteral("displayRGB")));
    m_appearanceValues = ObjectCodec::decodeList<AppearanceValues>(map.value(QStringLiteral("appearanceValues")));
}

} // namespace vemi
