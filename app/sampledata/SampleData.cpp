#include "app/sampledata/SampleData.h"

#include "colour/LabToScreen.h"
#include "app/sampledata/SampleCatalogue.h"
#include "host/domain/ColorimetricCondition.h"
#include "host/domain/ColorStandardsLibrary.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/ToleranceSet.h"
#include "host/store/CommandSender.h"
#include "host/store/DirectoryTreeResponse.h"
#include "host/store/ErrorInfo.h"
#include "host/store/FillEmptyStore.h"
#include "host/store/FillEmptyStoreResponse.h"
#include "host/store/GetDirectoryTree.h"

namespace vemi {

namespace {

// A command that gets no answer in this time means the store's worker is stuck.
constexpr int kAnswerTimeoutMs = 30000;

const char* const kSamplesFolder = "Samples";
const char* const kChartFolder = "Colour Chart";
const char* const kTemplatesFolder = "Sample Job Templates";

// Files objects of one type in a top-level folder of their own.
template <class Objects>
void addAll(FillEmptyStore& set, const std::string& objectType, const char* folderName, const Objects& objects)
{
    const std::string folderId = set.addFolder(objectType, std::string(), folderName);
    for (const auto& object : objects)
        set.addObject(object, folderId);
}

template <class Object>
void addAll(FillEmptyStore& set, const char* folderName, const std::vector<std::shared_ptr<Object>>& objects)
{
    addAll(set, Object::typeId(), folderName, objects);
}

} // namespace

std::shared_ptr<FillEmptyStore> SampleData::buildSet(QString* error)
{
    const auto d65ToScreen = LabToScreen::create(ColorimetricCondition("D65", "2"));
    const auto d50ToScreen = LabToScreen::create(ColorimetricCondition("D50", "2"));
    if (!d65ToScreen || !d50ToScreen) {
        *error = QStringLiteral("Cannot compute the display colours of the sample standards: "
                                "Little CMS could not create the Lab to sRGB transform.");
        return nullptr;
    }
    const SampleCatalogue::Samples samples = SampleCatalogue::samples(*d65ToScreen, *d50ToScreen);

    auto set = std::make_shared<FillEmptyStore>("store the sample data");
    addAll(*set, Standard::typeId(), kSamplesFolder, samples.standards);
    addAll(*set, Standard::typeId(), kChartFolder, samples.chartStandards);
    addAll(*set, kSamplesFolder, SampleCatalogue::standardsLibraries(samples));
    std::vector<std::shared_ptr<TagDefinition>> definitions = samples.tagDefinitions;
    definitions.insert(definitions.end(), samples.inspectionDefinitions.begin(), samples.inspectionDefinitions.end());
    addAll(*set, kSamplesFolder, definitions);
    addAll(*set, kSamplesFolder, SampleCatalogue::propertyLibraries(samples));
    addAll(*set, kSamplesFolder, SampleCatalogue::toleranceSets(samples));
    addAll(*set, kSamplesFolder, samples.configurations);
    addAll(*set, QCJobTemplate::typeId(), kTemplatesFolder, SampleCatalogue::jobTemplates(samples));
    return set;
}

QString SampleData::seedIfEmpty(MarloModel& store)
{
    // Building the set takes a while (pictures, colour transforms). A store
    // whose template tree holds anything is not empty, which one quick read
    // tells; any other store gets the set, and the store decides.
    const CommandSender::Answer tree = CommandSender::sendAndWait(
        store, std::string(), std::make_shared<GetDirectoryTree>(QCJobTemplate::typeId()), kAnswerTimeoutMs);
    if (tree.error)
        return tree.error->message();
    const auto templates = std::dynamic_pointer_cast<DirectoryTreeResponse>(tree.response);
    if (templates && !(templates->folders().empty() && templates->entries().empty()))
        return {};

    QString error;
    auto set = buildSet(&error);
    if (!set)
        return error;
    const CommandSender::Answer answer = CommandSender::sendAndWait(store, std::string(), set, kAnswerTimeoutMs);
    if (answer.error)
        return answer.error->message();
    if (!std::dynamic_pointer_cast<FillEmptyStoreResponse>(answer.response))
        return QStringLiteral("Cannot store the sample data: the object store gave an unexpected answer.");
    return {};
}

} // namespace vemi
