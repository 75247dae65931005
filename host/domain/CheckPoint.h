#pragma once

#include "host/domain/CheckListItem.h"

#include <memory>

namespace vemi {

class Position;
class SchematicImage;
class Size;
class Standard;

// A named area of the template's schematic to be measured, with its own
// cut-out image. A new checkpoint starts with an empty image, position and size.
class CheckPoint : public CheckListItem
{
public:
    CheckPoint();

    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::shared_ptr<Position> position() const { return m_position; }
    void setPosition(const std::shared_ptr<Position>& position);
    std::shared_ptr<Size> size() const { return m_size; }
    void setSize(const std::shared_ptr<Size>& size);
    std::shared_ptr<SchematicImage> schematicImage() const { return m_schematicImage; }
    void setSchematicImage(const std::shared_ptr<SchematicImage>& image);
    // May be empty.
    std::shared_ptr<Standard> standard() const { return m_standard; }
    void setStandard(const std::shared_ptr<Standard>& standard);
    // True when the standard is picked at measuring time rather than fixed here.
    bool autoStandard() const { return m_autoStandard; }
    void setAutoStandard(bool autoStandard) { m_autoStandard = autoStandard; }
    bool skippable() const { return m_skippable; }
    void setSkippable(bool skippable) { m_skippable = skippable; }
    // "<CP1>" or "<CP2>" for a member of a couple.
    std::string matchPoint() const { return m_matchPoint; }
    void setMatchPoint(const std::string& matchPoint) { m_matchPoint = matchPoint; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::shared_ptr<Position> m_position;
    std::shared_ptr<Size> m_size;
    std::shared_ptr<SchematicImage> m_schematicImage;
    std::shared_ptr<Standard> m_standard;
    bool m_autoStandard = true;
    bool m_skippable = false;
    std::string m_matchPoint;
};

} // namespace vemi
