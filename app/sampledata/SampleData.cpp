#include "app/sampledata/SampleData.h"

#include "app/sampledata/LabToScreen.h"
#include "app/sampledata/SampleCatalogue.h"
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
void addOne(FillEmptyStore& set, const char* folderName, const std::shared_ptr<Object>& object)
{
    addAll(set, Object::typeId(), folderName, std::vector<std::shared_ptr<Object>>{object});
}

} // namespace

std::shared_ptr<FillEmptyStore> SampleData::buildSet(QString* error)
{
    const auto toScreen = LabToScreen::create();
    if (!toScreen) {
        *error = QStringLiteral("Cannot compute the display colours of the sample standards: "
                                "Little CMS could not create the Lab to sRGB transform.");
        return nullptr;
    }
    const SampleCatalogue::Samples samples = SampleCatalogue::samples(*toScreen);

    auto set = std::make_shared<FillEmptyStore>("store the sample data");
    addAll(*set, Standard::typeId(), kSamplesFolder, samples.standards);
    addOne(*set, kSamplesFolder, SampleCatalogue::standardsLibrary(samples));
    addAll(*set, TagDefinition::typeId(), kSamplesFolder, samples.tagDefinitions);
    addOne(*set, kSamplesFolder, SampleCatalogue::propertyLibrary(samples));
    addOne(*set, kSamplesFolder, samples.toleranceSet);
    addOne(*set, kSamplesFolder, samples.configuration);
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
