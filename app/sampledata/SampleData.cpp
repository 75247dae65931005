#include "app/sampledata/SampleData.h"

#include "host/domain/ColorStandardsLibrary.h"
#include "host/store/CommandDispatcher.h"
#include "host/store/CreateFolder.h"
#include "host/store/DirectoryTreeResponse.h"
#include "host/store/ErrorInfo.h"
#include "host/store/FolderResponse.h"
#include "host/store/GetDirectoryTree.h"
#include "app/sampledata/LabToScreen.h"
#include "host/store/MarloModel.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/QCJobTemplate.h"
#include "host/store/QtCommand.h"
#include "app/sampledata/SampleCatalogue.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/ToleranceSet.h"
#include "host/store/UpdateObject.h"
#include "host/store/UpdateObjectResponse.h"

#include <QEventLoop>
#include <QTimer>

namespace vemi {

namespace {

// A command that gets no answer in this time means the store's worker is stuck.
constexpr int kAnswerTimeoutMs = 30000;

const char* const kSamplesFolder = "Samples";
const char* const kTemplatesFolder = "Sample Job Templates";

struct SeedFailure
{
    QString message;
};

struct Answer
{
    std::shared_ptr<Response> response;
    QString error;
};

Answer runAndWait(CommandDispatcher& dispatcher, std::shared_ptr<Command> command)
{
    auto wrapper = std::make_shared<QtCommand>(std::move(command));
    Answer answer;
    QEventLoop loop;
    QObject::connect(wrapper.get(), &QtCommand::responseReceived, &loop, [&](std::shared_ptr<Response> response) {
        answer.response = std::move(response);
        loop.quit();
    });
    QObject::connect(wrapper.get(), &QtCommand::errorReceived, &loop, [&](std::shared_ptr<ErrorInfo> error) {
        answer.error = error ? error->message() : QStringLiteral("The object store failed without saying why.");
        loop.quit();
    });
    QTimer::singleShot(kAnswerTimeoutMs, &loop, [&] {
        answer.error = QStringLiteral("The object store did not answer while the sample data was stored.");
        loop.quit();
    });
    dispatcher.dispatch(wrapper);
    loop.exec();
    return answer;
}

class Seeder
{
public:
    explicit Seeder(CommandDispatcher& dispatcher) : m_dispatcher(dispatcher) {}

    bool templateTreeIsEmpty()
    {
        auto tree = run<DirectoryTreeResponse>(std::make_shared<GetDirectoryTree>(QCJobTemplate::typeId()));
        return tree->folders().empty() && tree->entries().empty();
    }

    void seed()
    {
        const auto toScreen = LabToScreen::create();
        if (!toScreen)
            throw SeedFailure{QStringLiteral("Cannot compute the display colours of the sample standards: "
                                             "Little CMS could not create the Lab to sRGB transform.")};
        const SampleCatalogue::Samples samples = SampleCatalogue::samples(*toScreen);

        storeAll(samples.standards, topFolder(Standard::typeId(), kSamplesFolder));
        store(SampleCatalogue::standardsLibrary(samples), topFolder(ColorStandardsLibrary::typeId(), kSamplesFolder));
        storeAll(samples.tagDefinitions, topFolder(TagDefinition::typeId(), kSamplesFolder));
        store(SampleCatalogue::propertyLibrary(samples), topFolder(PropertyLibrary::typeId(), kSamplesFolder));
        store(samples.toleranceSet, topFolder(ToleranceSet::typeId(), kSamplesFolder));
        store(samples.configuration, topFolder(MeasurementConfiguration::typeId(), kSamplesFolder));

        // Templates last: a template tree that is not empty means seeding is done.
        storeAll(SampleCatalogue::jobTemplates(samples), topFolder(QCJobTemplate::typeId(), kTemplatesFolder));
    }

private:
    template <class R>
    std::shared_ptr<R> run(std::shared_ptr<Command> command)
    {
        const std::string description = command->description();
        Answer answer = runAndWait(m_dispatcher, std::move(command));
        if (!answer.error.isEmpty())
            throw SeedFailure{answer.error};
        auto response = std::dynamic_pointer_cast<R>(answer.response);
        if (!response)
            throw SeedFailure{QStringLiteral("Cannot %1: the object store gave an unexpected answer.")
                                  .arg(QString::fromStdString(description))};
        return response;
    }

    // The top-level folder of that name, created when it is missing: other
    // trees than the template tree may already hold a folder of it.
    std::string topFolder(const std::string& objectType, const std::string& name)
    {
        auto tree = run<DirectoryTreeResponse>(std::make_shared<GetDirectoryTree>(objectType));
        for (const DirFolder& folder : tree->folders()) {
            if (folder.parentId.empty() && folder.name == name)
                return folder.id;
        }
        return run<FolderResponse>(std::make_shared<CreateFolder>(objectType, std::string(), name))->folder().id;
    }

    void store(const std::shared_ptr<BaseObject>& object, const std::string& folderId)
    {
        auto command = std::make_shared<UpdateObject>();
        command->setObject(object);
        command->setFolderId(folderId);
        run<UpdateObjectResponse>(command);
    }

    template <class Objects>
    void storeAll(const Objects& objects, const std::string& folderId)
    {
        for (const auto& object : objects)
            store(object, folderId);
    }

    CommandDispatcher& m_dispatcher;
};

} // namespace

QString SampleData::seedIfEmpty(MarloModel& store)
{
    auto dispatcher = store.commandDispatcher("");
    if (!dispatcher)
        return QStringLiteral("Cannot store the sample data: there is no default object store.");
    try {
        Seeder seeder(*dispatcher);
        if (seeder.templateTreeIsEmpty())
            seeder.seed();
    } catch (const SeedFailure& failure) {
        return failure.message;
    }
    return {};
}

} // namespace vemi
