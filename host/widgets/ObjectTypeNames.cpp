#include "host/widgets/ObjectTypeNames.h"

#include "host/domain/ColorStandardsLibrary.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/ToleranceSet.h"

#include <QCoreApplication>

#include <map>
#include <utility>

namespace vemi {

namespace {

using Names = std::pair<const char*, const char*>;

// Plurals are listed, not derived: "Library" becomes "Libraries".
const std::map<std::string, Names>& names()
{
    static const std::map<std::string, Names> table = {
        {QCJobTemplate::typeId(), {QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Job Template"),
                                   QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Job Templates")}},
        {MeasurementConfiguration::typeId(),
         {QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Measurement Configuration"),
          QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Measurement Configurations")}},
        {Standard::typeId(), {QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Standard"),
                              QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Standards")}},
        {ColorStandardsLibrary::typeId(),
         {QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Color Standards Library"),
          QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Color Standards Libraries")}},
        {ToleranceSet::typeId(), {QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Tolerance Set"),
                                  QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Tolerance Sets")}},
        {TagDefinition::typeId(), {QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Property"),
                                   QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Properties")}},
        {PropertyLibrary::typeId(), {QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Property Library"),
                                     QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Property Libraries")}},
    };
    return table;
}

QString translated(const char* text)
{
    return QCoreApplication::translate("vemi::ObjectTypeNames", text);
}

} // namespace

QString ObjectTypeNames::singular(const std::string& typeId)
{
    const auto found = names().find(typeId);
    return translated(found == names().end() ? QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Object")
                                             : found->second.first);
}

QString ObjectTypeNames::plural(const std::string& typeId)
{
    const auto found = names().find(typeId);
    return translated(found == names().end() ? QT_TRANSLATE_NOOP("vemi::ObjectTypeNames", "Objects")
                                             : found->second.second);
}

} // namespace vemi
