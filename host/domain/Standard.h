#pragma once

#include "host/domain/NamedObject.h"

#include <cstddef>
#include <memory>
#include <vector>

namespace vemi {

class AppearanceValues;
class RGBValue;

// A colour standard: the target colour a measurement is compared with.
class Standard : public NamedObject
{
public:
    static const std::string& typeId();
    std::string objectTypeId() const override;

    // May be empty.
    std::shared_ptr<RGBValue> displayRGB() const { return m_displayRGB; }
    void setDisplayRGB(const std::shared_ptr<RGBValue>& rgb);

    // Empty when index is out of range.
    std::shared_ptr<AppearanceValues> appearanceValues(std::size_t index) const;
    std::vector<std::shared_ptr<AppearanceValues>> appearanceValuesList() const { return m_appearanceValues; }
    void setAppearanceValuesList(const std::vector<std::shared_ptr<AppearanceValues>>& list);

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::shared_ptr<RGBValue> m_displayRGB;
    std::vector<std::shared_ptr<AppearanceValues>> m_appearanceValues;
};

} // namespace vemi
