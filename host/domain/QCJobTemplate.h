#pragma once

#include "host/domain/NamedObject.h"

#include <cstddef>
#include <memory>
#include <vector>

namespace vemi {

class CheckListItem;
class CheckPoint;
class MeasurementConfiguration;
class SchematicImage;
class Standard;
class ToleranceSet;

// A reusable QC job: the check list on a schematic of the part, the standards,
// tolerances and measurement configuration to measure with. A template is
// stored self-contained: everything it holds is encoded inside it, so it keeps
// working when a library changes. A new template starts with an empty
// schematic image.
class QCJobTemplate : public NamedObject
{
public:
    QCJobTemplate();

    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::vector<std::shared_ptr<CheckListItem>> checkListItems() const { return m_checkListItems; }
    void setCheckListItems(const std::vector<std::shared_ptr<CheckListItem>>& items);
    // Every checkpoint of the check list in item order; a couple contributes
    // its members in member order.
    std::vector<std::shared_ptr<CheckPoint>> checkPoints() const;
    // Position of checkPoint (the same object) in checkPoints(), or
    // static_cast<std::size_t>(-1) when the check list does not hold it.
    std::size_t checkZoneIndex(const std::shared_ptr<CheckPoint>& checkPoint) const;

    std::vector<std::shared_ptr<Standard>> standards() const { return m_standards; }
    void setStandards(const std::vector<std::shared_ptr<Standard>>& standards);
    std::vector<std::shared_ptr<ToleranceSet>> sharedToleranceSets() const { return m_sharedToleranceSets; }
    void setSharedToleranceSets(const std::vector<std::shared_ptr<ToleranceSet>>& sets);
    std::vector<std::shared_ptr<ToleranceSet>> privateToleranceSets() const { return m_privateToleranceSets; }
    void setPrivateToleranceSets(const std::vector<std::shared_ptr<ToleranceSet>>& sets);
    // May be empty.
    std::shared_ptr<MeasurementConfiguration> measurementConfiguration() const { return m_measurementConfiguration; }
    void setMeasurementConfiguration(const std::shared_ptr<MeasurementConfiguration>& configuration);
    // Lets the operator keep adding measurements until the job is finished.
    bool enableRepeat() const { return m_enableRepeat; }
    void setEnableRepeat(bool enable) { m_enableRepeat = enable; }
    // May be empty.
    std::shared_ptr<SchematicImage> schematicImage() const { return m_schematicImage; }
    void setSchematicImage(const std::shared_ptr<SchematicImage>& image);

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::vector<std::shared_ptr<CheckListItem>> m_checkListItems;
    std::vector<std::shared_ptr<Standard>> m_standards;
    std::vector<std::shared_ptr<ToleranceSet>> m_sharedToleranceSets;
    std::vector<std::shared_ptr<ToleranceSet>> m_privateToleranceSets;
    std::shared_ptr<MeasurementConfiguration> m_measurementConfiguration;
    bool m_enableRepeat = false;
    std::shared_ptr<SchematicImage> m_schematicImage;
};

} // namespace vemi
