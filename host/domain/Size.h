#pragma once

#include "host/domain/BaseObject.h"

namespace vemi {

// Width and height of an area on a schematic, in image pixels.
class Size : public BaseObject
{
public:
    explicit Size(int width = 0, int height = 0);

    static const std::string& typeId();
    std::string objectTypeId() const override;

    int width() const { return m_width; }
    void setWidth(int width) { m_width = width; }
    int height() const { return m_height; }
    void setHeight(int height) { m_height = height; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    int m_width;
    int m_height;
};

} // namespace vemi
