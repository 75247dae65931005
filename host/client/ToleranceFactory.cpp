#include "host/client/ToleranceFactory.h"

#include "host/client/GeneralSettings.h"
#include "host/client/SettingsManager.h"
#include "host/domain/ColorimetricCondition.h"
#include "host/domain/LabToleranceBase.h"
#include "host/domain/ObjectCodec.h"
#include "host/domain/ToleranceSet.h"

namespace vemi {

ToleranceFactory* ToleranceFactory::toleranceFactory()
{
    static ToleranceFactory factory;
    return &factory;
}

std::shared_ptr<ToleranceSet> ToleranceFactory::buildToleranceSet(const std::shared_ptr<ToleranceSet>& set) const
{
    if (!set)
        return nullptr;
    auto built = ObjectCodec::clone(*set);
    std::shared_ptr<GeneralSettings> defaults;
    for (const auto& tolerance : built->tolerances()) {
        auto lab = std::dynamic_pointer_cast<LabToleranceBase>(tolerance);
        if (!lab || lab->colorimetricCondition())
            continue;
        if (!defaults)
            defaults = SettingsManager::instance().getGeneralSettings();
        lab->setColorimetricCondition(
            std::make_shared<ColorimetricCondition>(defaults->illuminant(), defaults->observer()));
    }
    return built;
}

} // namespace vemi
