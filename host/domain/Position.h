#pragma once

#include "host/domain/BaseObject.h"

namespace vemi {

// Top-left corner of an area on a schematic, in image pixels.
class Position : public BaseObject
{
public:
    explicit Position(int x = 0, int y = 0);

    static const std::string& typeId();
    std::string objectTypeId() const override;

    int x() const { return m_x; }
    void setX(int x) { m_x = x; }
    int y() const { return m_y; }
    void setY(int y) { m_y = y; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    int m_x;
    int m_y;
};

} // namespace vemi
