#include "host/domain/QCJobTemplate.h"

#include "host/domain/CheckListItem.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/CheckPointCouple.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/ObjectCodec.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Standard.h"
#include "host/domain/ToleranceSet.h"

#include <algorithm>
#include <utility>

namespace vemi {

QCJobTemplate::QCJobTemplate()
    : m_schematicImage(std::make_shared<SchematicImage>())
{
}

const std::string& QCJobTemplate::typeId()
{
    static const std::string id = "vemi.QCJobTemplate";
    return id;
}

std::string QCJobTemplate::objectTypeId() const
{
    return typeId();
}

void QCJobTemplate::setCheckListItems(const std::vector<std::shared_ptr<CheckListItem>>& items)
{
    m_checkListItems = items;
}

std::vector<std::shared_ptr<CheckPoint>> QCJobTemplate::checkPoints() const
{
    std::vector<std::shared_ptr<CheckPoint>> checkPoints;
    for (const auto& item : m_checkListItems) {
        if (const auto couple = std::dynamic_pointer_cast<CheckPointCouple>(item)) {
            for (const auto& member : couple->checkPoints()) {
                if (member)
                    checkPoints.push_back(member);
            }
        } else if (auto checkPoint = std::dynamic_pointer_cast<CheckPoint>(item)) {
            checkPoints.push_back(std::move(checkPoint));
        }
    }
    return checkPoints;
}

std::size_t QCJobTemplate::checkZoneIndex(const std::shared_ptr<CheckPoint>& checkPoint) const
{
    if (!checkPoint)
        return static_cast<std::size_t>(-1);
    const auto all = checkPoints();
    const auto found = std::find(all.begin(), all.end(), checkPoint);
    return found == all.end() ? static_cast<std::size_t>(-1) : std::size_t(found - all.begin());
}

void QCJobTemplate::setStandards(const std::vector<std::shared_ptr<Standard>>& standards)
{
    m_standards = standards;
}

void QCJobTemplate::setSharedToleranceSets(const std::vector<std::shared_ptr<ToleranceSet>>& sets)
{
    m_sharedToleranceSets = sets;
}

void QCJobTemplate::setPrivateToleranceSets(const std::vector<std::shared_ptr<ToleranceSet>>& sets)
{
    m_privateToleranceSets = sets;
}

void QCJobTemplate::setMeasurementConfiguration(const std::shared_ptr<MeasurementConfiguration>& configuration)
{
    m_measurementConfiguration = configuration;
}

void QCJobTemplate::setSchematicImage(const std::shared_ptr<SchematicImage>& image)
{
    m_schematicImage = image;
}

void QCJobTemplate::writeFields(QCborMap& map) const
{
    NamedObject::writeFields(map);
    map.insert(QStringLiteral("checkListItems"), ObjectCodec::encodeList(m_checkListItems));
    map.insert(QStringLiteral("standards"), ObjectCodec::encodeList(m_standards));
    map.insert(QStringLiteral("sharedToleranceSets"), ObjectCodec::encodeList(m_sharedToleranceSets));
    map.insert(QStringLiteral("privateToleranceSets"), ObjectCodec::encodeList(m_privateToleranceSets));
    map.insert(QStringLiteral("measurementConfiguration"), ObjectCodec::encode(m_measurementConfiguration));
    map.insert(QStringLiteral("enableRepeat"), m_enableRepeat);
    map.insert(QStringLiteral("schematicImage"), ObjectCodec::encode(m_schematicImage));
}

void QCJobTemplate::readFields(const QCborMap& map)
{
    NamedObject::readFields(map);
    m_checkListItems = ObjectCodec::decodeList<CheckListItem>(map.value(QStringLiteral("checkListItems")));
    m_standards = ObjectCodec::decodeList<Standard>(map.value(QStringLiteral("standards")));
    m_sharedToleranceSets = ObjectCodec::decodeList<ToleranceSet>(map.value(QStringLiteral("sharedToleranceSets")));
    m_privateToleranceSets = ObjectCodec::decodeList<ToleranceSet>(map.value(QStringLiteral("privateToleranceSets")));
    m_measurementConfiguration = ObjectCodec::decodeAs<MeasurementConfiguration>(
        map.value(QStringLiteral("measurementConfiguration")));
    m_enableRepeat = ObjectCodec::readBool(map, QStringLiteral("enableRepeat"));
    m_schematicImage = ObjectCodec::decodeAs<SchematicImage>(map.value(QStringLiteral("schematicImage")));
}

} // namespace vemi
