#include "ObjectRegistry.h"

#include "AppearanceValues.h"
#include "CheckPoint.h"
#include "CheckPointCouple.h"
#include "ColorStandardsLibrary.h"
#include "ColorimetricCondition.h"
#include "DirEntry.h"
#include "GlobalDirEntry.h"
#include "LabToleranceBase.h"
#include "LabValue.h"
#include "MeasurementConfiguration.h"
#include "Position.h"
#include "Property.h"
#include "PropertyLibrary.h"
#include "QCJobTemplate.h"
#include "RGBValue.h"
#include "SchematicImage.h"
#include "Size.h"
#include "Standard.h"
#include "TagDefinition.h"
#include "TagValue.h"
#include "Tolerance.h"
#include "ToleranceSet.h"

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
