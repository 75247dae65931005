#include "tests/common/TestMain.h"
#include "tests/common/RawConnection.h"
#include "tests/common/TempStore.h"

#include "host/domain/ColorStandardsLibrary.h"
#include "host/store/CommandDispatcher.h"
#include "host/store/CreateFolder.h"
#include "host/store/DeleteDirItems.h"
#include "host/domain/DirEntry.h"
#include "host/store/DirectoryTreeResponse.h"
#include "host/store/ErrorInfo.h"
#include "host/store/FolderResponse.h"
#include "host/store/GetDirectoryTree.h"
#include "host/store/GetMarloObject.h"
#include "host/store/GetMarloObjectResponse.h"
#include "host/store/GetMarloObjects.h"
#include "host/store/GetMarloObjectsResponse.h"
#include "host/domain/Header.h"
#include "host/store/MoveDirItem.h"
#include "host/domain/ObjectCodec.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/QCJobTemplate.h"
#include "host/store/QtCommand.h"
#include "host/store/RenameDirItem.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/store/StoreDatabase.h"
#include "host/store/UpdateObject.h"
#include "host/store/UpdateObjectResponse.h"

#include <QDateTime>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QScopeGuard>
#include <QThread>
#include <QtTest>

#include <unistd.h>

using namespace vemi;

namespace {

std::shared_ptr<QCJobTemplate> makeTemplate(const std::string& name, int imageBytes = 0)
{
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    jobTemplate->setName(name);
    auto image = std::make_shared<SchematicImage>();
    std::vector<unsigned char> bytes(static_cast<size_t>(imageBytes));
    for (size_t i = 0; i < bytes.size(); ++i)
        bytes[i] = static_cast<unsigned char>((i * 7919) >> 3);
    image->setImageData(bytes);
    image->setFormat("png");
    jobTemplate->setSchematicImage(image);
    return jobTemplate;
}

// Notes on which thread the store ran it.
class ThreadProbe : public Command
{
public:
    std::shared_ptr<Response> execute(StoreDatabase&) override
    {
        executedOn = QThread::currentThread();
        return std::make_shared<Response>();
    }
    std::string description() const override { return "probe"; }
    QThread* executedOn = nullptr;
};

std::string folderIdOf(const TempStore::Answer& answer)
{
    const auto folder = std::dynamic_pointer_cast<FolderResponse>(answer.response);
    return folder ? folder->folder().id : std::string();
}

std::string entryIdOf(const std::shared_ptr<Response>& saved)
{
    const auto update = std::dynamic_pointer_cast<UpdateObjectResponse>(saved);
    return update && update->entry() ? update->entry()->id() : std::string();
}

// Bytes that no decoder takes for an object.
const QByteArray kGarbage("\xa3\x01garbage", 9);

bool damage(const QString& storePath, const std::string& id)
{
    RawConnection raw(storePath);
    return raw.exec(QStringLiteral("UPDATE objects SET data = ? WHERE id = ?"), {kGarbage, QString::fromStdString(id)});
}

// A library of three members of its kind, as the store keeps it.
struct StoredLibrary
{
    std::shared_ptr<BaseObject> library;
    std::vector<std::shared_ptr<NamedObject>> members;
    std::function<std::vector<std::shared_ptr<NamedObject>>(const BaseObject&)> membersOf;
};

StoredLibrary makeLibrary(const QString& kind)
{
    StoredLibrary result;
    const char* const names[] = {"Signal Red", "Ocean Blue", "Sand Yellow"};
    if (kind == QLatin1String("standards")) {
        auto library = std::make_shared<ColorStandardsLibrary>();
        std::vector<std::shared_ptr<Standard>> standards;
        for (const char* name : names) {
            standards.push_back(std::make_shared<Standard>());
            standards.back()->setName(name);
        }
        library->setStandards(standards);
        result.library = library;
        result.members.assign(standards.begin(), standards.end());
        result.membersOf = [](const BaseObject& object) {
            const auto members = dynamic_cast<const ColorStandardsLibrary&>(object).standards();
            return std::vector<std::shared_ptr<NamedObject>>(members.begin(), members.end());
        };
    } else {
        auto library = std::make_shared<PropertyLibrary>();
        std::vector<std::shared_ptr<TagDefinition>> definitions;
        for (const char* name : names) {
            definitions.push_back(std::make_shared<TagDefinition>());
            definitions.back()->setName(name);
        }
        library->setProperties(definitions);
        result.library = library;
        result.members.assign(definitions.begin(), definitions.end());
        result.membersOf = [](const BaseObject& object) {
            const auto members = dynamic_cast<const PropertyLibrary&>(object).properties();
            return std::vector<std::shared_ptr<NamedObject>>(members.begin(), members.end());
        };
    }
    result.library->header()->setName("Interior");
    return result;
}

QStringList namesOf(const std::vector<std::shared_ptr<NamedObject>>& objects)
{
    QStringList names;
    for (const auto& object : objects)
        names << QString::fromStdString(object->name());
    return names;
}

QStringList namesOf(const std::vector<std::shared_ptr<BaseObject>>& objects)
{
    QStringList names;
    for (const auto& object : objects)
        names << QString::fromStdString(object->header()->name());
    return names;
}

} // namespace

class tst_Store : public QObject
{
    Q_OBJECT

private slots:
    void templateSurvivesRestartByteForByte();
    void commandsRunInDispatchOrder();
    void answersArriveOnCallersThread();
    void updateTakesSnapshotAtDispatch();
    void wrapperLivesUntilItDelivers();
    void wrapperIsReleasedOnItsOwnThread();
    void storeMarksAndConfiguresItsFile();
    void refusesFilesThatAreNotStores_data();
    void refusesFilesThatAreNotStores();
    void damagedObjectIsReportedByItsId();
    void missingObjectIsAnError();
    void readOnlyStoreRefusesWrites();
    void lockedStoreReportsAndRecovers();
    void libraryMembersResolveAtDepthTwo();
    void deletedLibraryMembersAreLeftOut_data();
    void deletedLibraryMembersAreLeftOut();
    void damagedObjectsAreLeftOutAndNamed();
    void damagedLibraryMemberIsLeftOutAndNamed_data();
    void damagedLibraryMemberIsLeftOutAndNamed();
    void contentOfAnotherTypeIsDamaged();
    void readOnlyOpenInFolderNobodyMayWrite();
    void readOnlyOpenSeesChangesNotYetMerged();
    void explainsSqliteFailures_data();
    void explainsSqliteFailures();
    void getObjectsListsAllOrTheIdsGiven();
    void folderTreeOperations();
    void folderCannotMoveIntoItself();
    void deletingFolderDeletesItsObjects();
    void folderCycleDoesNotHangTheStore();
};

void tst_Store::templateSurvivesRestartByteForByte()
{
    TempStore store;
    auto jobTemplate = makeTemplate("Door Panel", 1 << 20);
    const QByteArray before = ObjectCodec::serialize(*jobTemplate);
    QVERIFY(store.save(jobTemplate));

    store.reopen();
    const auto fetched = store.fetch(QCJobTemplate::typeId(), jobTemplate->id());
    QVERIFY(fetched);
    QCOMPARE(ObjectCodec::serialize(*fetched), before);
}

void tst_Store::commandsRunInDispatchOrder()
{
    TempStore store;
    auto jobTemplate = makeTemplate("v0");
    QStringList answered;
    QEventLoop loop;
    const int count = 20;
    for (int i = 1; i <= count; ++i) {
        jobTemplate->setName("v" + std::to_string(i));
        auto update = std::make_shared<UpdateObject>();
        update->setObject(jobTemplate);
        auto wrapper = std::make_shared<QtCommand>(update);
        connect(wrapper.get(), &QtCommand::responseReceived, &loop, [&, i]() {
            answered << QString::number(i);
            if (answered.size() == count)
                loop.quit();
        });
        store.model().commandDispatcher("")->dispatch(wrapper);
    }
    QTimer::singleShot(20000, &loop, &QEventLoop::quit);
    loop.exec();

    QStringList expected;
    for (int i = 1; i <= count; ++i)
        expected << QString::number(i);
    QCOMPARE(answered, expected);
    const auto stored = std::dynamic_pointer_cast<QCJobTemplate>(store.fetch(QCJobTemplate::typeId(), jobTemplate->id()));
    QVERIFY(stored);
    QCOMPARE(stored->name(), std::string("v20"));
}

void tst_Store::answersArriveOnCallersThread()
{
    TempStore store;
    auto probe = std::make_shared<ThreadProbe>();
    QThread* answeredOn = nullptr;
    QEventLoop loop;
    auto wrapper = std::make_shared<QtCommand>(probe);
    connect(wrapper.get(), &QtCommand::responseReceived, &loop, [&]() {
        answeredOn = QThread::currentThread();
        loop.quit();
    });
    store.model().commandDispatcher("")->dispatch(wrapper);
    QTimer::singleShot(20000, &loop, &QEventLoop::quit);
    loop.exec();

    QVERIFY(probe->executedOn);
    QVERIFY(probe->executedOn != QThread::currentThread());
    QCOMPARE(answeredOn, QThread::currentThread());
}

void tst_Store::updateTakesSnapshotAtDispatch()
{
    TempStore store;
    auto jobTemplate = makeTemplate("As dispatched");
    auto update = std::make_shared<UpdateObject>();
    update->setObject(jobTemplate);
    QEventLoop loop;
    auto wrapper = std::make_shared<QtCommand>(update);
    connect(wrapper.get(), &QtCommand::responseReceived, &loop, &QEventLoop::quit);
    store.model().commandDispatcher("")->dispatch(wrapper);
    jobTemplate->setName("Edited after dispatch");
    QTimer::singleShot(20000, &loop, &QEventLoop::quit);
    loop.exec();

    const auto stored = std::dynamic_pointer_cast<QCJobTemplate>(store.fetch(QCJobTemplate::typeId(), jobTemplate->id()));
    QVERIFY(stored);
    QCOMPARE(stored->name(), std::string("As dispatched"));
}

void tst_Store::wrapperLivesUntilItDelivers()
{
    TempStore store;
    auto get = std::make_shared<GetMarloObjects>();
    get->setType(QCJobTemplate::typeId());
    bool delivered = false;
    QObject context;
    std::weak_ptr<QtCommand> watch;
    {
        auto wrapper = std::make_shared<QtCommand>(get);
        watch = wrapper;
        connect(wrapper.get(), &QtCommand::responseReceived, &context, [&]() { delivered = true; });
        store.model().commandDispatcher("")->dispatch(wrapper);
    }
    QTRY_VERIFY_WITH_TIMEOUT(delivered, 20000);
    QTRY_VERIFY(watch.expired());
}

void tst_Store::wrapperIsReleasedOnItsOwnThread()
{
    // The last handle must never be dropped on the worker: QObjects die on
    // their own thread. The race is narrow, hence many rounds.
    TempStore store;
    QThread* const home = QThread::currentThread();
    int released = 0;
    int releasedElsewhere = 0;
    const int rounds = 200;
    for (int i = 0; i < rounds; ++i) {
        auto get = std::make_shared<GetMarloObjects>();
        get->setType(QCJobTemplate::typeId());
        auto wrapper = std::make_shared<QtCommand>(get);
        connect(wrapper.get(), &QObject::destroyed, this, [&]() {
            ++released;
            if (QThread::currentThread() != home)
                ++releasedElsewhere;
        }, Qt::DirectConnection);
        store.model().commandDispatcher("")->dispatch(wrapper);
    }
    QTRY_COMPARE_WITH_TIMEOUT(released, rounds, 20000);
    QCOMPARE(releasedElsewhere, 0);
}

void tst_Store::storeMarksAndConfiguresItsFile()
{
    TempStore store;
    RawConnection raw(store.path());
    QCOMPARE(raw.scalar(QStringLiteral("PRAGMA application_id")).toInt(), StoreDatabase::kApplicationId);
    QCOMPARE(raw.scalar(QStringLiteral("PRAGMA user_version")).toInt(), StoreDatabase::schemaVersion());
    QCOMPARE(raw.scalar(QStringLiteral("PRAGMA journal_mode")).toString(), QStringLiteral("wal"));
}

void tst_Store::refusesFilesThatAreNotStores_data()
{
    QTest::addColumn<QString>("setup");
    QTest::addColumn<QString>("expected");
    QTest::newRow("a text file") << "text" << "not a store";
    QTest::newRow("another program's SQLite database") << "foreign" << "another program";
    QTest::newRow("a store from a newer version") << "newer" << "newer version";
    QTest::newRow("a store whose schema version was lost") << "unversioned" << "damaged or not a store";
}

void tst_Store::refusesFilesThatAreNotStores()
{
    QFETCH(QString, setup);
    QFETCH(QString, expected);
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("file.sqlite"));
    if (setup == QLatin1String("text")) {
        QFile file(path);
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.write(QByteArray("These are the minutes of the last meeting, not a database.\n").repeated(100));
    } else if (setup == QLatin1String("unversioned")) {
        QVERIFY(MarloModel(path).open().isEmpty());
        RawConnection raw(path);
        QVERIFY(raw.exec(QStringLiteral("PRAGMA user_version = 0")));
    } else {
        RawConnection raw(path);
        if (setup == QLatin1String("foreign")) {
            QVERIFY(raw.exec(QStringLiteral("CREATE TABLE people(name TEXT)")));
        } else {
            QVERIFY(raw.exec(QStringLiteral("PRAGMA application_id = %1").arg(StoreDatabase::kApplicationId)));
            QVERIFY(raw.exec(QStringLiteral("PRAGMA user_version = 99")));
        }
    }
    QFile original(path);
    QVERIFY(original.open(QIODevice::ReadOnly));
    const QByteArray before = original.readAll();
    original.close();

    const QString error = [&] { MarloModel model(path); return model.open(); }();
    QVERIFY2(error.contains(expected), qPrintable(error));
    QVERIFY2(error.contains(path), qPrintable(error));
    QVERIFY(original.open(QIODevice::ReadOnly));
    QCOMPARE(original.readAll(), before);
}

void tst_Store::damagedObjectIsReportedByItsId()
{
    TempStore store;
    auto damaged = makeTemplate("Damaged");
    auto intact = makeTemplate("Intact");
    QVERIFY(store.save(damaged));
    QVERIFY(store.save(intact));
    {
        RawConnection raw(store.path());
        QVERIFY(raw.exec(QStringLiteral("UPDATE objects SET data = ? WHERE id = ?"),
                         {QByteArray("\xa3\x01garbage", 9), QString::fromStdString(damaged->id())}));
    }
    auto get = std::make_shared<GetMarloObject>();
    get->setType(QCJobTemplate::typeId());
    get->setId(damaged->id());
    const auto answer = store.run(get);
    QVERIFY(answer.error);
    QVERIFY2(answer.error->message().contains(QString::fromStdString(damaged->id())), qPrintable(answer.error->message()));
    QVERIFY2(answer.error->message().contains(QStringLiteral("\"Damaged\"")), qPrintable(answer.error->message()));
    QVERIFY(store.fetch(QCJobTemplate::typeId(), intact->id()));
}

void tst_Store::missingObjectIsAnError()
{
    TempStore store;
    auto get = std::make_shared<GetMarloObject>();
    get->setType(QCJobTemplate::typeId());
    get->setId("no-such-id");
    const auto answer = store.run(get);
    QVERIFY(!answer.response);
    QVERIFY(answer.error);
    QVERIFY(answer.error->message().contains(QStringLiteral("no-such-id")));
}

void tst_Store::readOnlyStoreRefusesWrites()
{
    TempStore store;
    auto jobTemplate = makeTemplate("Kept");
    QVERIFY(store.save(jobTemplate));
    store.reopenReadOnly();

    jobTemplate->setName("Changed");
    auto update = std::make_shared<UpdateObject>();
    update->setObject(jobTemplate);
    const auto answer = store.run(update);
    QVERIFY(answer.error);
    QVERIFY2(answer.error->message().contains(QStringLiteral("read-only")), qPrintable(answer.error->message()));
    QVERIFY(answer.error->message().contains(store.path()));
    const auto stored = std::dynamic_pointer_cast<QCJobTemplate>(store.fetch(QCJobTemplate::typeId(), jobTemplate->id()));
    QVERIFY(stored);
    QCOMPARE(stored->name(), std::string("Kept"));
}

void tst_Store::lockedStoreReportsAndRecovers()
{
    StoreOptions impatient;
    impatient.busyTimeoutMs = 100;
    TempStore store(impatient);
    auto jobTemplate = makeTemplate("Waits");
    {
        RawConnection other(store.path());
        QVERIFY(other.exec(QStringLiteral("BEGIN EXCLUSIVE")));
        auto update = std::make_shared<UpdateObject>();
        update->setObject(jobTemplate);
        const auto answer = store.run(update);
        QVERIFY(answer.error);
        QVERIFY2(answer.error->message().contains(QStringLiteral("locked")), qPrintable(answer.error->message()));
        QVERIFY(other.exec(QStringLiteral("ROLLBACK")));
    }
    QVERIFY(store.save(jobTemplate));
}

void tst_Store::libraryMembersResolveAtDepthTwo()
{
    TempStore store;
    auto red = std::make_shared<Standard>();
    red->setName("Signal Red");
    auto blue = std::make_shared<Standard>();
    blue->setName("Ocean Blue");
    auto library = std::make_shared<ColorStandardsLibrary>();
    library->setName("Interior");
    library->setStandards({red, blue});
    QVERIFY(store.save(red));
    QVERIFY(store.save(blue));
    QVERIFY(store.save(library));

    const auto shallow = std::dynamic_pointer_cast<ColorStandardsLibrary>(
        store.fetch(ColorStandardsLibrary::typeId(), library->id(), 1));
    QVERIFY(shallow);
    QCOMPARE(shallow->standards().size(), size_t(2));
    QCOMPARE(shallow->standards()[0]->id(), red->id());
    QCOMPARE(shallow->standards()[0]->name(), std::string());

    const auto deep = std::dynamic_pointer_cast<ColorStandardsLibrary>(
        store.fetch(ColorStandardsLibrary::typeId(), library->id(), 2));
    QVERIFY(deep);
    QCOMPARE(deep->standards()[0]->name(), std::string("Signal Red"));
    QCOMPARE(deep->standards()[1]->name(), std::string("Ocean Blue"));
}

void tst_Store::deletedLibraryMembersAreLeftOut_data()
{
    QTest::addColumn<QString>("kind");
    QTest::newRow("colour standards library") << "standards";
    QTest::newRow("property library") << "properties";
}

void tst_Store::deletedLibraryMembersAreLeftOut()
{
    QFETCH(QString, kind);
    TempStore store;
    const StoredLibrary stored = makeLibrary(kind);
    const std::string topLevel;
    std::vector<std::string> entries;
    for (const auto& member : stored.members)
        entries.push_back(entryIdOf(store.save(member, &topLevel)));
    QVERIFY(store.save(stored.library));
    QVERIFY(!entries[1].empty());
    QVERIFY(!store.run(std::make_shared<DeleteDirItems>(std::vector<std::string>{},
                                                        std::vector<std::string>{entries[1]})).error);

    auto get = std::make_shared<GetMarloObject>();
    get->setType(stored.library->objectTypeId());
    get->setId(stored.library->id());
    get->setDepth(2);
    const auto answer = store.run(get);
    QVERIFY(!answer.error);
    const auto response = std::dynamic_pointer_cast<GetMarloObjectResponse>(answer.response);
    QVERIFY(response && response->object());
    QCOMPARE(namesOf(stored.membersOf(*response->object())), QStringList({"Signal Red", "Sand Yellow"}));
    // A deleted member is no fault of the store: nothing to report.
    QCOMPARE(response->problems(), QStringList());
}

void tst_Store::damagedObjectsAreLeftOutAndNamed()
{
    TempStore store;
    const std::string type = QCJobTemplate::typeId();
    const std::string samples = folderIdOf(store.run(std::make_shared<CreateFolder>(type, "", "Samples")));
    const std::string doors = folderIdOf(store.run(std::make_shared<CreateFolder>(type, samples, "Doors")));
    auto first = makeTemplate("Bonnet");
    auto damaged = makeTemplate("Door Panel");
    auto last = makeTemplate("Tailgate");
    QVERIFY(store.save(first, &samples));
    QVERIFY(store.save(damaged, &doors));
    QVERIFY(store.save(last));
    QVERIFY(damage(store.path(), damaged->id()));

    const auto check = [&](const std::vector<std::string>& ids) {
        auto get = std::make_shared<GetMarloObjects>();
        get->setType(type);
        get->setIds(ids);
        const auto answer = store.run(get);
        QVERIFY2(!answer.error, answer.error ? qPrintable(answer.error->message()) : "");
        const auto response = std::dynamic_pointer_cast<GetMarloObjectsResponse>(answer.response);
        QVERIFY(response);
        QCOMPARE(namesOf(response->objects()), QStringList({"Bonnet", "Tailgate"}));
        QCOMPARE(response->problems().size(), 1);
        const QString problem = response->problems().first();
        QVERIFY2(problem.contains(QStringLiteral("\"Door Panel\"")), qPrintable(problem));
        QVERIFY2(problem.contains(QStringLiteral("\"Samples/Doors\"")), qPrintable(problem));
        QVERIFY2(problem.contains(QStringLiteral("damaged")), qPrintable(problem));
    };
    check({});
    check({first->id(), damaged->id(), last->id()});
}

void tst_Store::damagedLibraryMemberIsLeftOutAndNamed_data()
{
    deletedLibraryMembersAreLeftOut_data();
}

void tst_Store::damagedLibraryMemberIsLeftOutAndNamed()
{
    QFETCH(QString, kind);
    TempStore store;
    const StoredLibrary stored = makeLibrary(kind);
    const std::string memberType = stored.members[0]->objectTypeId();
    const std::string reds = folderIdOf(store.run(std::make_shared<CreateFolder>(memberType, "", "Reds")));
    QVERIFY(!reds.empty());
    const std::string topLevel;
    QVERIFY(store.save(stored.members[0], &reds));
    QVERIFY(store.save(stored.members[1], &topLevel));
    QVERIFY(store.save(stored.members[2], &topLevel));
    QVERIFY(store.save(stored.library));
    QVERIFY(damage(store.path(), stored.members[0]->id()));

    const auto check = [&](const std::shared_ptr<BaseObject>& library, const QStringList& problems) {
        QVERIFY(library);
        QCOMPARE(namesOf(stored.membersOf(*library)), QStringList({"Ocean Blue", "Sand Yellow"}));
        QCOMPARE(problems.size(), 1);
        QVERIFY2(problems[0].contains(QStringLiteral("\"Signal Red\" in the folder \"Reds\"")), qPrintable(problems[0]));
        QVERIFY2(problems[0].contains(QStringLiteral("\"Interior\"")), qPrintable(problems[0]));
    };
    auto getOne = std::make_shared<GetMarloObject>();
    getOne->setType(stored.library->objectTypeId());
    getOne->setId(stored.library->id());
    getOne->setDepth(2);
    const auto one = store.run(getOne);
    QVERIFY2(!one.error, one.error ? qPrintable(one.error->message()) : "");
    const auto oneResponse = std::dynamic_pointer_cast<GetMarloObjectResponse>(one.response);
    QVERIFY(oneResponse);
    check(oneResponse->object(), oneResponse->problems());

    auto getAll = std::make_shared<GetMarloObjects>();
    getAll->setType(stored.library->objectTypeId());
    getAll->setDepth(2);
    const auto all = store.run(getAll);
    QVERIFY(!all.error);
    const auto allResponse = std::dynamic_pointer_cast<GetMarloObjectsResponse>(all.response);
    QVERIFY(allResponse && allResponse->objects().size() == 1);
    check(allResponse->objects()[0], allResponse->problems());
}

void tst_Store::contentOfAnotherTypeIsDamaged()
{
    TempStore store;
    const std::string type = QCJobTemplate::typeId();
    const std::string samples = folderIdOf(store.run(std::make_shared<CreateFolder>(type, "", "Samples")));
    auto jobTemplate = makeTemplate("Door Panel");
    QVERIFY(store.save(jobTemplate, &samples));
    auto standard = std::make_shared<Standard>();
    standard->setName("Signal Red");
    auto library = std::make_shared<ColorStandardsLibrary>();
    library->setName("Interior");
    library->setStandards({standard});
    QVERIFY(store.save(standard));
    QVERIFY(store.save(library));
    {
        // A standard's bytes under the template's row, and a library whose
        // member's row says template.
        RawConnection raw(store.path());
        QVERIFY(raw.exec(QStringLiteral("UPDATE objects SET data = (SELECT data FROM objects WHERE id = ?) WHERE id = ?"),
                         {QString::fromStdString(standard->id()), QString::fromStdString(jobTemplate->id())}));
        QVERIFY(raw.exec(QStringLiteral("UPDATE objects SET data = ? WHERE id = ?"),
                         {ObjectCodec::serialize(*jobTemplate), QString::fromStdString(standard->id())}));
        QVERIFY(raw.exec(QStringLiteral("UPDATE objects SET type = ? WHERE id = ?"),
                         {QString::fromStdString(type), QString::fromStdString(standard->id())}));
    }

    auto getOne = std::make_shared<GetMarloObject>();
    getOne->setType(type);
    getOne->setId(jobTemplate->id());
    const auto one = store.run(getOne);
    QVERIFY(!one.response);
    QVERIFY(one.error);
    QVERIFY2(one.error->message().contains(QStringLiteral("damaged")), qPrintable(one.error->message()));
    QVERIFY2(one.error->message().contains(QStringLiteral("\"Door Panel\" in the folder \"Samples\"")),
             qPrintable(one.error->message()));

    auto getAll = std::make_shared<GetMarloObjects>();
    getAll->setType(type);
    const auto all = store.run(getAll);
    const auto allResponse = std::dynamic_pointer_cast<GetMarloObjectsResponse>(all.response);
    QVERIFY(allResponse);
    // The standard now stored as a template holds a template: it reads as one.
    QCOMPARE(allResponse->objects().size(), size_t(1));
    QCOMPARE(allResponse->objects()[0]->objectTypeId(), type);
    QCOMPARE(allResponse->problems().size(), 1);
    QVERIFY2(allResponse->problems()[0].contains(QStringLiteral("\"Door Panel\"")), qPrintable(allResponse->problems()[0]));

    const auto deep = std::dynamic_pointer_cast<ColorStandardsLibrary>(
        store.fetch(ColorStandardsLibrary::typeId(), library->id(), 2));
    QVERIFY(deep);
    QVERIFY(deep->standards().empty());
}

void tst_Store::readOnlyOpenInFolderNobodyMayWrite()
{
    // SQLite makes -wal and -shm files beside a WAL store even to read it; a
    // read-only open must do without them where the folder cannot be written.
    QTemporaryDir sourceFolder;
    const QString source = sourceFolder.filePath(QStringLiteral("store.sqlite"));
    auto kept = makeTemplate("Kept");
    {
        TempStore writer;
        QVERIFY(writer.save(kept));
        writer.reopen(StoreOptions{true});
        // The writer closed cleanly, so the file alone holds everything.
        QVERIFY(QFile::copy(writer.path(), source));
    }
    QTemporaryDir folder;
    const QString path = folder.filePath(QStringLiteral("store.sqlite"));
    QVERIFY(QFile::copy(source, path));
    QVERIFY(QFile::setPermissions(path, QFileDevice::ReadOwner | QFileDevice::ReadGroup | QFileDevice::ReadOther));
    const QFileDevice::Permissions readAndList = QFileDevice::ReadOwner | QFileDevice::ExeOwner
                                                 | QFileDevice::ReadGroup | QFileDevice::ExeGroup
                                                 | QFileDevice::ReadOther | QFileDevice::ExeOther;
    QVERIFY(QFile::setPermissions(folder.path(), readAndList));
    const auto restore = qScopeGuard([&] {
        QFile::setPermissions(folder.path(), readAndList | QFileDevice::WriteOwner);
    });
    // Root may write the folder all the same (chmod does not stop it), so
    // there the proof is that the file and the folder stay as they were,
    // which the checks below hold in either case.
    if (::geteuid() != 0)
        QVERIFY(!QFileInfo(folder.path()).isWritable());
    QFile file(path);
    QVERIFY(file.open(QIODevice::ReadOnly));
    const QByteArray bytes = file.readAll();
    file.close();
    const QDateTime modified = QFileInfo(path).lastModified();
    const QStringList listing = QDir(folder.path()).entryList(QDir::Files | QDir::Hidden);
    QCOMPARE(listing, QStringList({"store.sqlite"}));

    {
        MarloModel model(path, StoreOptions{true});
        const QString error = model.open();
        QVERIFY2(error.isEmpty(), qPrintable(error));
        QCOMPARE(QDir(folder.path()).entryList(QDir::Files | QDir::Hidden), listing);
    }
    QCOMPARE(QDir(folder.path()).entryList(QDir::Files | QDir::Hidden), listing);
    QVERIFY(file.open(QIODevice::ReadOnly));
    QCOMPARE(file.readAll(), bytes);
    QCOMPARE(QFileInfo(path).lastModified(), modified);
}

void tst_Store::readOnlyOpenSeesChangesNotYetMerged()
{
    // Another program holds the store open with a change in its -wal file; a
    // read-only open that skipped the -wal file would still see the object.
    TempStore store;
    auto kept = makeTemplate("Kept");
    auto removed = makeTemplate("Removed");
    QVERIFY(store.save(kept));
    QVERIFY(store.save(removed));
    RawConnection other(store.path());
    QVERIFY(other.exec(QStringLiteral("DELETE FROM objects WHERE id = ?"), {QString::fromStdString(removed->id())}));
    store.reopen(StoreOptions{true});
    QVERIFY(QFileInfo(store.path() + QStringLiteral("-wal")).size() > 0);

    auto get = std::make_shared<GetMarloObjects>();
    get->setType(QCJobTemplate::typeId());
    const auto response = std::dynamic_pointer_cast<GetMarloObjectsResponse>(store.run(get).response);
    QVERIFY(response);
    QCOMPARE(namesOf(response->objects()), QStringList({"Kept"}));
}

void tst_Store::explainsSqliteFailures_data()
{
    QTest::addColumn<int>("code");
    QTest::addColumn<bool>("diskFull");
    QTest::addColumn<QString>("expected");
    // Extended codes: SQLITE_IOERR_SHMSIZE is what a WAL store gives at open
    // when there is no room for its -shm file.
    const int ioErrShmSize = 10 | (19 << 8);
    QTest::newRow("disk I/O error on a full disk") << ioErrShmSize << true << "the disk is full";
    QTest::newRow("disk I/O error with room left") << ioErrShmSize << false << "folder may not be writable";
    QTest::newRow("disk full while writing") << 13 << false << "the disk is full";
    QTest::newRow("file that cannot be opened") << 14 << false << "cannot be opened";
    QTest::newRow("file that cannot be opened on a full disk") << 14 << true << "the disk is full";
    QTest::newRow("read-only file") << (8 | (3 << 8)) << false << "read-only";
    QTest::newRow("store locked by another program") << 5 << false << "locked";
    QTest::newRow("file that is not a database") << 26 << false << "not a store";
    QTest::newRow("damaged file") << 11 << false << "damaged";
    QTest::newRow("any other failure keeps SQLite's words") << 1 << false << "";
}

void tst_Store::explainsSqliteFailures()
{
    QFETCH(int, code);
    QFETCH(bool, diskFull);
    QFETCH(QString, expected);
    const QString explained = StoreDatabase::explain(code, diskFull);
    if (expected.isEmpty())
        QCOMPARE(explained, QString());
    else
        QVERIFY2(explained.contains(expected), qPrintable(explained));
}

void tst_Store::getObjectsListsAllOrTheIdsGiven()
{
    TempStore store;
    auto b = makeTemplate("B");
    auto a = makeTemplate("A");
    auto c = makeTemplate("C");
    for (const auto& jobTemplate : {b, a, c})
        QVERIFY(store.save(jobTemplate));
    QVERIFY(store.save(std::make_shared<Standard>()));

    const auto namesOf = [&](std::vector<std::string> ids) {
        auto get = std::make_shared<GetMarloObjects>();
        get->setType(QCJobTemplate::typeId());
        get->setIds(ids);
        const auto response = std::dynamic_pointer_cast<GetMarloObjectsResponse>(store.run(get).response);
        QStringList names;
        for (const auto& object : response ? response->objects() : std::vector<std::shared_ptr<BaseObject>>())
            names << QString::fromStdString(object->header()->name());
        return names;
    };
    QCOMPARE(namesOf({}), QStringList({"A", "B", "C"}));
    QCOMPARE(namesOf({c->id(), a->id()}), QStringList({"C", "A"}));
}

void tst_Store::folderTreeOperations()
{
    TempStore store;
    const std::string type = QCJobTemplate::typeId();
    const std::string samples = folderIdOf(store.run(std::make_shared<CreateFolder>(type, "", "Samples")));
    QVERIFY(!samples.empty());
    const auto duplicate = store.run(std::make_shared<CreateFolder>(type, "", "Samples"));
    QVERIFY(duplicate.error);
    QVERIFY(duplicate.error->message().contains(QStringLiteral("already exists")));
    // The same name is free in the tree of another type, but the trees do not mix.
    const std::string standards = folderIdOf(store.run(std::make_shared<CreateFolder>(Standard::typeId(), "", "Samples")));
    QVERIFY(!standards.empty());
    QVERIFY(store.run(std::make_shared<CreateFolder>(type, standards, "Inside")).error);
    QVERIFY(store.run(std::make_shared<MoveDirItem>(DirItemKind::Folder, samples, standards)).error);

    auto jobTemplate = makeTemplate("Door Panel");
    const auto saved = std::dynamic_pointer_cast<UpdateObjectResponse>(store.save(jobTemplate, &samples));
    QVERIFY(saved && saved->entry());
    QCOMPARE(saved->entry()->folderId(), samples);

    QVERIFY(!store.run(std::make_shared<RenameDirItem>(DirItemKind::Entry, saved->entry()->id(), "Door Trim")).error);
    const auto tree = std::dynamic_pointer_cast<DirectoryTreeResponse>(
        store.run(std::make_shared<GetDirectoryTree>(type)).response);
    QVERIFY(tree);
    QCOMPARE(tree->folders().size(), size_t(1));
    QCOMPARE(tree->entries().size(), size_t(1));
    QCOMPARE(tree->entries()[0]->header()->name(), std::string("Door Trim"));
    QCOMPARE(tree->entries()[0]->entryObjectId(), jobTemplate->id());
    const auto renamed = std::dynamic_pointer_cast<QCJobTemplate>(store.fetch(type, jobTemplate->id()));
    QVERIFY(renamed);
    QCOMPARE(renamed->name(), std::string("Door Trim"));
}

void tst_Store::folderCannotMoveIntoItself()
{
    TempStore store;
    const std::string type = QCJobTemplate::typeId();
    const std::string outer = folderIdOf(store.run(std::make_shared<CreateFolder>(type, "", "Outer")));
    const std::string inner = folderIdOf(store.run(std::make_shared<CreateFolder>(type, outer, "Inner")));
    const auto answer = store.run(std::make_shared<MoveDirItem>(DirItemKind::Folder, outer, inner));
    QVERIFY(answer.error);
    QVERIFY(!store.run(std::make_shared<MoveDirItem>(DirItemKind::Folder, inner, "")).error);
}

void tst_Store::deletingFolderDeletesItsObjects()
{
    TempStore store;
    const std::string type = QCJobTemplate::typeId();
    const std::string outer = folderIdOf(store.run(std::make_shared<CreateFolder>(type, "", "Outer")));
    const std::string inner = folderIdOf(store.run(std::make_shared<CreateFolder>(type, outer, "Inner")));
    auto nested = makeTemplate("Nested");
    auto kept = makeTemplate("Kept");
    QVERIFY(store.save(nested, &inner));
    const std::string topLevel;
    QVERIFY(store.save(kept, &topLevel));

    QVERIFY(!store.run(std::make_shared<DeleteDirItems>(std::vector<std::string>{outer}, std::vector<std::string>{})).error);
    auto get = std::make_shared<GetMarloObject>();
    get->setType(type);
    get->setId(nested->id());
    QVERIFY(store.run(get).error);
    QVERIFY(store.fetch(type, kept->id()));
    const auto tree = std::dynamic_pointer_cast<DirectoryTreeResponse>(
        store.run(std::make_shared<GetDirectoryTree>(type)).response);
    QVERIFY(tree);
    QVERIFY(tree->folders().empty());
    QCOMPARE(tree->entries().size(), size_t(1));
}

void tst_Store::folderCycleDoesNotHangTheStore()
{
    TempStore store;
    const std::string type = QCJobTemplate::typeId();
    const std::string first = folderIdOf(store.run(std::make_shared<CreateFolder>(type, "", "First")));
    const std::string second = folderIdOf(store.run(std::make_shared<CreateFolder>(type, first, "Second")));
    auto nested = makeTemplate("Nested");
    QVERIFY(store.save(nested, &second));
    {
        // A damaged file: each folder is the other's parent.
        RawConnection raw(store.path());
        QVERIFY(raw.exec(QStringLiteral("UPDATE folders SET parent_id = ? WHERE id = ?"),
                         {QString::fromStdString(second), QString::fromStdString(first)}));
    }
    const auto tree = store.run(std::make_shared<GetDirectoryTree>(type));
    QVERIFY(!tree.timedOut && tree.response);
    const auto deleted = store.run(std::make_shared<DeleteDirItems>(std::vector<std::string>{first},
                                                                    std::vector<std::string>{}));
    QVERIFY(!deleted.timedOut);
    QVERIFY(!deleted.error);
    auto get = std::make_shared<GetMarloObject>();
    get->setType(type);
    get->setId(nested->id());
    QVERIFY(store.run(get).error);
}

QC_TEST_GUILESS_MAIN(tst_Store)
#include "tst_store.moc"
