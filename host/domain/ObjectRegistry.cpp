#include "host/domain/ObjectRegistry.h"

#include "host/domain/AppearanceValues.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/CheckPointCouple.h"
#include "host/domain/ColorStandardsLibrary.h"
#include "host/domain/ColorimetricCondition.h"
#include "host/domain/DirEntry.h"
#include "host/domain/GlobalDirEntry.h"
#include "host/domain/LabToleranceBase.h"
#include "host/domain/LabValue.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/Position.h"
#include "host/domain/Property.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/RGBValue.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/domain/Tolerance.h"
#include "host/domain/ToleranceSet.h"

namespace vemi {

namespace {

template <class T>
void add(std::map<std::string, std::function<std::shared_ptr<BaseObject>()>>& creators)
{
    creators.emplace(T::typeId(), [] { return std::make_shared<T>(); });
}

} // namespace

std::shared_ptr<BaseObject> ObjectRegistry::create(const std::string& typeId)
{
    const auto& all = creators();
    const auto found = all.find(typeId);
    return found == all.end() ? nullptr : found->second();
}

bool ObjectRegistry::knows(const std::string& typeId)
{
    return creators().count(typeId) != 0;
}

std::vector<std::string> ObjectRegistry::typeIds()
{
    std::vector<std::string> ids;
    for (const auto& entry : creators())
        ids.push_back(entry.first);
    return ids;
}

const ObjectRegistry::Creators& ObjectRegistry::creators()
{
    static const Creators all = [] {
        Creators creators;
        add<AppearanceValues>(creators);
        add<CheckPoint>(creators);
        add<CheckPointCouple>(creators);
        add<ColorStandardsLibrary>(creators);
        add<ColorimetricCondition>(creators);
        add<DirEntry>(creators);
        add<GlobalDirEntry>(creators);
        add<LabToleranceBase>(creators);
        add<LabValue>(creators);
        add<MeasurementConfiguration>(creators);
        add<Position>(creators);
        add<Property>(creators);
        add<PropertyLibrary>(creators);
        add<QCJobTemplate>(creators);
        add<RGBValue>(creators);
        add<SchematicImage>(creators);
        add<Size>(creators);
        add<Standard>(creators);
        add<TagDefinition>(creators);
        add<TagValue>(creators);
        add<Tolerance>(creators);
        add<ToleranceSet>(creators);
        return creators;
    }();
    return all;
}

} // namespace vemi
