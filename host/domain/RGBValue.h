#pragma once

#include "host/domain/BaseObject.h"

namespace vemi {

// A colour as shown on screen; each channel 0–255.
class RGBValue : public BaseObject
{
public:
    explicit RGBValue(int red = 0, int green = 0, int blue = 0);

    static const std::string& typeId();
    std::string objectTypeId() const override;

    int red() const { return m_red; }
    void setRed(int red) { m_red = red; }
    int green() const { return m_green; }
    void setGreen(int green) { m_green = green; }
    int blue() const { return m_blue; }
    void setBlue(int blue) { m_blue = blue; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    int m_red;
    int m_green;
    int m_blue;
};

} // namespace vemi
