#pragma once

#include "host/domain/BaseObject.h"

#include <memory>
#include <vector>

namespace vemi {

class ColorValue;

// The colour values that describe one appearance of a standard.
class AppearanceValues : public BaseObject
{
public:
    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::vector<std::shared_ptr<ColorValue>> colorValues() const { return m_colorValues; }
    void setColorValues(const std::vector<std::shared_ptr<ColorValue>>& values);

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::vector<std::shared_ptr<ColorValue>> m_colorValues;
};

} // namespace vemi
