#include "tests/common/TestMain.h"
#include "tests/common/RawConnection.h"
#include "tests/common/TempStore.h"
#include "tests/common/TestLibrary.h"
#include "tests/common/TestPostgresServer.h"

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
#include "host/domain/QCJobTemplate.h"
#include "host/store/QtCommand.h"
#include "host/store/RenameDirItem.h"
#include "host/domain/SchematicImage.h"
#include "host/store/SqliteDialect.h"
#include "host/store/StoreDatabase.h"
#include "host/store/UpdateObject.h"
#include "host/store/UpdateObjectResponse.h"

#include <QDateTime>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QProcess>
#include <QScopeGuard>
#include <QSignalSpy>
#include <QThread>
#include <QUrl>
#include <QtTest>

#include <optional>
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

const std::string kTemplate = QCJobTemplate::typeId();

std::string createFolder(TempStore& store, const std::string& name, const std::string& parent = {},
                         const std::string& type = kTemplate)
{
    const auto answer = store.run(std::make_shared<CreateFolder>(type, parent, name));
    const auto folder = std::dynamic_pointer_cast<FolderResponse>(answer.response);
    return folder ? folder->folder().id : std::string();
}

std::string entryIdOf(const std::shared_ptr<Response>& saved)
{
    const auto update = std::dynamic_pointer_cast<UpdateObjectResponse>(saved);
    return update && update->entry() ? update->entry()->id() : std::string();
}

TempStore::Answer update(TempStore& store, const std::shared_ptr<BaseObject>& object)
{
    auto command = std::make_shared<UpdateObject>();
    command->setObject(object);
    return store.run(command);
}

TempStore::Answer getOne(TempStore& store, const std::string& type, const std::string& id, int depth = 1)
{
    auto get = std::make_shared<GetMarloObject>();
    get->setType(type);
    get->setId(id);
    get->setDepth(depth);
    return store.run(get);
}

std::shared_ptr<GetMarloObjectsResponse> getAll(TempStore& store, const std::string& type,
                                                const std::vector<std::string>& ids = {}, int depth = 1)
{
    auto get = std::make_shared<GetMarloObjects>();
    get->setType(type);
    get->setIds(ids);
    get->setDepth(depth);
    return std::dynamic_pointer_cast<GetMarloObjectsResponse>(store.run(get).response);
}

std::shared_ptr<DirectoryTreeResponse> treeOf(TempStore& store, const std::string& type = kTemplate)
{
    return std::dynamic_pointer_cast<DirectoryTreeResponse>(store.run(std::make_shared<GetDirectoryTree>(type)).response);
}

bool deleteItems(TempStore& store, const std::vector<std::string>& folders, const std::vector<std::string>& entries = {})
{
    const auto answer = store.run(std::make_shared<DeleteDirItems>(folders, entries));
    return !answer.error && !answer.timedOut;
}

// Bytes that no decoder takes for an object.
bool damage(const QString& storePath, const std::string& id)
{
    RawConnection raw(storePath);
    return raw.exec(QStringLiteral("UPDATE objects SET data = ? WHERE id = ?"),
                    {QByteArray("\xa3\x01garbage", 9), QString::fromStdString(id)});
}

template <class Object>
QStringList namesOf(const std::vector<std::shared_ptr<Object>>& objects)
{
    QStringList names;
    for (const auto& object : objects)
        names << QString::fromStdString(object->header()->name());
    return names;
}

bool onServer()
{
    return TempStore::backend() == TempStore::Backend::Postgres;
}

// What another program runs to hold the store's write lock.
QStringList writeLockStatements()
{
    if (onServer())
        return {QStringLiteral("BEGIN"),
                QStringLiteral("SELECT pg_advisory_xact_lock(%1)").arg(StoreDatabase::kApplicationId)};
    return {QStringLiteral("BEGIN EXCLUSIVE")};
}

} // namespace

#define SERVERS_ONLY()                                                                                         \
    if (!onServer())                                                                                           \
        QSKIP("about servers only");

#define SQLITE_FILES_ONLY()                                                                                    \
    if (onServer())                                                                                            \
        QSKIP("about SQLite files only");

class tst_Store : public QObject
{
    Q_OBJECT

    void refusesDatabasesThatAreNotStores(const QString& setup, const QString& expected);

private slots:
    // Every test runs on both kinds of store: an SQLite file, and a database
    // on a PostgreSQL server that the tests start.
    void initTestCase_data();
    void init();
    void templateSurvivesRestartByteForByte();
    void commandsRunInOrderOffTheCallersThread();
    void droppedWrapperAnswersAndDiesAtHome();
    void refusesFilesThatAreNotStores_data();
    void refusesFilesThatAreNotStores();
    void refusedWriteIsReportedAndChangesNothing_data();
    void refusedWriteIsReportedAndChangesNothing();
    void damagedObjectsAreLeftOutAndNamed();
    void lostLibraryMembersAreLeftOut_data();
    void lostLibraryMembersAreLeftOut();
    void contentOfAnotherTypeIsDamaged();
    void readOnlyOpenInFolderNobodyMayWrite();
    void readOnlyOpenSeesChangesNotYetMerged();
    void explainsSqliteFailures_data();
    void explainsSqliteFailures();
    void getObjectsListsAllOrTheIdsGiven();
    void folderTreeOperations();
    void deletingFolderDeletesItsObjects();
    void folderCycleDoesNotHangTheStore();
    void staleSaveIsRefusedAndWritesNothing();
    void renameCountsAsAChange();
    void twoProgramsSavingOneTemplateOneWins();
    void storeOfTheFirstSchemaIsUpgraded();
    void serverFailuresNameServerAndCause_data();
    void serverFailuresNameServerAndCause();
    void serverGoneDuringSaveLosesNothingAcknowledged();
    void serverAnnouncesWritesOfOthers();
};

void tst_Store::initTestCase_data()
{
    QTest::addColumn<bool>("server");
    QTest::newRow("SQLite") << false;
    QTest::newRow("PostgreSQL") << true;
}

void tst_Store::init()
{
    QFETCH_GLOBAL(bool, server);
    TempStore::setBackend(server ? TempStore::Backend::Postgres : TempStore::Backend::Sqlite);
    if (server && !TestPostgresServer::shared())
        QSKIP(qPrintable(QStringLiteral("no PostgreSQL test server: ") + TestPostgresServer::skipReason()));
}

void tst_Store::templateSurvivesRestartByteForByte()
{
    TempStore store;
    auto jobTemplate = makeTemplate("Door Panel", 1 << 20);
    const QByteArray before = ObjectCodec::serialize(*jobTemplate);
    QVERIFY(store.save(jobTemplate));

    store.reopen();
    const auto fetched = store.fetch(kTemplate, jobTemplate->id());
    QVERIFY(fetched);
    QCOMPARE(ObjectCodec::serialize(*fetched), before);
}

// A probe, then twenty saves of one template, each dispatched under another
// name, and one more change after the last: the worker runs them in order,
// each answer comes on the caller's thread, and each save stores the object
// as it was when dispatched.
void tst_Store::commandsRunInOrderOffTheCallersThread()
{
    TempStore store;
    auto jobTemplate = makeTemplate("v0");
    auto probe = std::make_shared<ThreadProbe>();
    const int count = 20;
    QStringList answered;
    QStringList expected;
    int answeredElsewhere = 0;
    QEventLoop loop;
    for (int i = 0; i <= count; ++i) {
        std::shared_ptr<Command> command = probe;
        if (i > 0) {
            jobTemplate->setName("v" + std::to_string(i));
            auto update = std::make_shared<UpdateObject>();
            update->setObject(jobTemplate);
            command = update;
        }
        auto wrapper = std::make_shared<QtCommand>(command);
        connect(wrapper.get(), &QtCommand::responseReceived, &loop, [&, i] {
            answered << QString::number(i);
            answeredElsewhere += QThread::currentThread() != thread();
            if (answered.size() > count)
                loop.quit();
        }, Qt::DirectConnection);
        store.model().commandDispatcher("")->dispatch(wrapper);
        expected << QString::number(i);
    }
    jobTemplate->setName("Edited after dispatch");
    QTimer::singleShot(20000, &loop, &QEventLoop::quit);
    loop.exec();

    QCOMPARE(answered, expected);
    QCOMPARE(answeredElsewhere, 0);
    QVERIFY(probe->executedOn && probe->executedOn != thread());
    const auto stored = store.fetch(kTemplate, jobTemplate->id());
    QVERIFY(stored);
    QCOMPARE(stored->header()->name(), std::string("v20"));
}

// The requester drops its handle at once: the wrapper lives until it has
// answered, and dies on its own thread, as a QObject must. The race is
// narrow, hence many rounds.
void tst_Store::droppedWrapperAnswersAndDiesAtHome()
{
    TempStore store;
    const int rounds = 200;
    int delivered = 0;
    int released = 0;
    int releasedElsewhere = 0;
    QObject context;
    for (int i = 0; i < rounds; ++i) {
        auto get = std::make_shared<GetMarloObjects>();
        get->setType(kTemplate);
        auto wrapper = std::make_shared<QtCommand>(get);
        connect(wrapper.get(), &QtCommand::responseReceived, &context, [&] { ++delivered; });
        connect(wrapper.get(), &QObject::destroyed, this, [&] {
            ++released;
            releasedElsewhere += QThread::currentThread() != thread();
        }, Qt::DirectConnection);
        store.model().commandDispatcher("")->dispatch(wrapper);
    }
    QTRY_COMPARE_WITH_TIMEOUT(released, rounds, 20000);
    QCOMPARE(delivered, rounds);
    QCOMPARE(releasedElsewhere, 0);
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
    if (onServer()) {
        refusesDatabasesThatAreNotStores(setup, expected);
        return;
    }
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("file.sqlite"));
    if (setup == QLatin1String("text")) {
        QFile file(path);
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.write(QByteArray("These are the minutes of the last meeting, not a database.\n").repeated(100));
    } else if (setup == QLatin1String("unversioned")) {
        QVERIFY(MarloModel(path).open().isEmpty());
        QVERIFY(RawConnection(path).exec(QStringLiteral("PRAGMA user_version = 0")));
    } else if (setup == QLatin1String("foreign")) {
        QVERIFY(RawConnection(path).exec(QStringLiteral("CREATE TABLE people(name TEXT)")));
    } else {
        RawConnection raw(path);
        QVERIFY(raw.exec(QStringLiteral("PRAGMA application_id = %1").arg(StoreDatabase::kApplicationId)));
        QVERIFY(raw.exec(QStringLiteral("PRAGMA user_version = 99")));
    }
    QFile original(path);
    QVERIFY(original.open(QIODevice::ReadOnly));
    const QByteArray before = original.readAll();
    original.close();

    const QString error = MarloModel(path).open();
    QVERIFY2(error.contains(expected) && error.contains(path), qPrintable(error));
    QVERIFY(original.open(QIODevice::ReadOnly));
    QCOMPARE(original.readAll(), before);
}

// The same checks for a database on the server; nothing is created in it.
void tst_Store::refusesDatabasesThatAreNotStores(const QString& setup, const QString& expected)
{
    if (setup == QLatin1String("text"))
        QSKIP("a text file is about SQLite files only");
    const QString address = TestPostgresServer::shared()->createDatabase();
    if (setup == QLatin1String("unversioned")) {
        QVERIFY(MarloModel(address).open().isEmpty());
        QVERIFY(RawConnection(address).exec(QStringLiteral("UPDATE store_mark SET schema_version = 0")));
    } else if (setup == QLatin1String("foreign")) {
        QVERIFY(RawConnection(address).exec(QStringLiteral("CREATE TABLE people(name TEXT)")));
    } else {
        RawConnection raw(address);
        QVERIFY(raw.exec(QStringLiteral("CREATE TABLE store_mark(application_id INTEGER, schema_version INTEGER)")));
        QVERIFY(raw.exec(QStringLiteral("INSERT INTO store_mark VALUES(?, 99)"), {StoreDatabase::kApplicationId}));
    }
    const QString tables = QStringLiteral("SELECT string_agg(table_name, ',' ORDER BY table_name)"
                                          " FROM information_schema.tables WHERE table_schema = 'public'");
    const QString before = RawConnection(address).scalar(tables).toString();

    const QString error = MarloModel(address).open();
    QVERIFY2(error.contains(expected) && error.contains(address), qPrintable(error));
    QCOMPARE(RawConnection(address).scalar(tables).toString(), before);
}

void tst_Store::refusedWriteIsReportedAndChangesNothing_data()
{
    QTest::addColumn<bool>("readOnly");
    QTest::addColumn<QString>("reason");
    QTest::newRow("store opened read-only") << true << "read-only";
    QTest::newRow("store locked by another program") << false << "locked";
}

void tst_Store::refusedWriteIsReportedAndChangesNothing()
{
    QFETCH(bool, readOnly);
    QFETCH(QString, reason);
    StoreOptions impatient;
    impatient.busyTimeoutMs = 100;
    TempStore store(impatient);
    auto jobTemplate = makeTemplate("Kept");
    QVERIFY(store.save(jobTemplate));
    std::optional<RawConnection> other;
    if (readOnly) {
        store.reopenReadOnly();
    } else {
        other.emplace(store.path());
        for (const QString& statement : writeLockStatements())
            QVERIFY(other->exec(statement));
    }
    jobTemplate->setName("Changed");

    const auto answer = update(store, jobTemplate);
    QVERIFY(answer.error);
    QVERIFY2(answer.error->message().contains(reason) && answer.error->message().contains(store.path()),
             qPrintable(answer.error->message()));
    if (other)
        QVERIFY(other->exec(QStringLiteral("ROLLBACK")));
    const auto stored = store.fetch(kTemplate, jobTemplate->id());
    QVERIFY(stored);
    QCOMPARE(stored->header()->name(), std::string("Kept"));
    // Once the other program lets go, the store writes again.
    if (other)
        QVERIFY(store.save(jobTemplate));
}

void tst_Store::damagedObjectsAreLeftOutAndNamed()
{
    TempStore store;
    const std::string samples = createFolder(store, "Samples");
    const std::string doors = createFolder(store, "Doors", samples);
    auto first = makeTemplate("Bonnet");
    auto damaged = makeTemplate("Door Panel");
    auto last = makeTemplate("Tailgate");
    QVERIFY(store.save(first, &samples));
    QVERIFY(store.save(damaged, &doors));
    QVERIFY(store.save(last));
    QVERIFY(damage(store.path(), damaged->id()));

    using Ids = std::vector<std::string>;
    for (const Ids& ids : {Ids{}, Ids{first->id(), damaged->id(), last->id()}}) {
        const auto response = getAll(store, kTemplate, ids);
        QVERIFY(response);
        QCOMPARE(namesOf(response->objects()), QStringList({"Bonnet", "Tailgate"}));
        QCOMPARE(response->problems().size(), 1);
        const QString problem = response->problems().first();
        QVERIFY2(problem.contains(QStringLiteral("\"Door Panel\"")) && problem.contains(QStringLiteral("\"Samples/Doors\""))
                     && problem.contains(QStringLiteral("damaged")),
                 qPrintable(problem));
    }
    // Asked for alone, a damaged or missing object is an error that names it.
    const auto one = getOne(store, kTemplate, damaged->id());
    QVERIFY(one.error && !one.response);
    const QString message = one.error->message();
    QVERIFY2(message.contains(QString::fromStdString(damaged->id())) && message.contains(QStringLiteral("\"Door Panel\"")),
             qPrintable(message));
    const auto missing = getOne(store, kTemplate, "no-such-id");
    QVERIFY(missing.error && !missing.response);
    QVERIFY(missing.error->message().contains(QStringLiteral("no-such-id")));
}

void tst_Store::lostLibraryMembersAreLeftOut_data()
{
    QTest::addColumn<QString>("kind");
    QTest::addColumn<bool>("damaged");
    for (const char* kind : {"standards", "properties"}) {
        QTest::addRow("%s library, a member deleted", kind) << kind << false;
        QTest::addRow("%s library, a member damaged", kind) << kind << true;
    }
}

void tst_Store::lostLibraryMembersAreLeftOut()
{
    QFETCH(QString, kind);
    QFETCH(bool, damaged);
    TempStore store;
    const TestLibrary stored = TestLibrary::make(kind);
    const std::string type = stored.library->objectTypeId();
    const std::string reds = createFolder(store, "Reds", "", stored.members[0]->objectTypeId());
    const std::string topLevel;
    std::vector<std::string> entries;
    for (const auto& member : stored.members)
        entries.push_back(entryIdOf(store.save(member, member == stored.members[0] ? &reds : &topLevel)));
    QVERIFY(store.save(stored.library));
    // Fetched shallow, the library keeps every member's id.
    const auto shallow = store.fetch(type, stored.library->id(), 1);
    QVERIFY(shallow);
    QCOMPARE(shallow->referencedIds(), stored.library->referencedIds());
    if (damaged)
        QVERIFY(damage(store.path(), stored.members[0]->id()));
    else
        QVERIFY(!entries[1].empty() && deleteItems(store, {}, {entries[1]}));

    const auto check = [&](const std::shared_ptr<BaseObject>& library, const QStringList& problems) {
        QVERIFY(library);
        QCOMPARE(namesOf(TestLibrary::membersOf(*library)),
                 damaged ? QStringList({"Ocean Blue", "Sand Yellow"}) : QStringList({"Signal Red", "Sand Yellow"}));
        // A deleted member is no fault of the store: nothing to report.
        QCOMPARE(problems.size(), damaged ? 1 : 0);
        if (damaged) {
            QVERIFY2(problems[0].contains(QStringLiteral("\"Signal Red\" in the folder \"Reds\""))
                         && problems[0].contains(QStringLiteral("\"Interior\"")),
                     qPrintable(problems[0]));
        }
    };
    const auto one = getOne(store, type, stored.library->id(), 2);
    const auto oneResponse = std::dynamic_pointer_cast<GetMarloObjectResponse>(one.response);
    QVERIFY2(oneResponse, one.error ? qPrintable(one.error->message()) : "");
    check(oneResponse->object(), oneResponse->problems());
    const auto all = getAll(store, type, {}, 2);
    QVERIFY(all && all->objects().size() == 1);
    check(all->objects()[0], all->problems());
}

void tst_Store::contentOfAnotherTypeIsDamaged()
{
    TempStore store;
    const std::string samples = createFolder(store, "Samples");
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
        QVERIFY(raw.exec(QStringLiteral("UPDATE objects SET data = ?, type = ? WHERE id = ?"),
                         {ObjectCodec::serialize(*jobTemplate), QString::fromStdString(kTemplate),
                          QString::fromStdString(standard->id())}));
    }

    const auto one = getOne(store, kTemplate, jobTemplate->id());
    QVERIFY(one.error && !one.response);
    QVERIFY2(one.error->message().contains(QStringLiteral("damaged"))
                 && one.error->message().contains(QStringLiteral("\"Door Panel\" in the folder \"Samples\"")),
             qPrintable(one.error->message()));
    const auto all = getAll(store, kTemplate);
    QVERIFY(all);
    // The standard now stored as a template holds a template: it reads as one.
    QCOMPARE(all->objects().size(), size_t(1));
    QCOMPARE(all->objects()[0]->objectTypeId(), kTemplate);
    QCOMPARE(all->problems().size(), 1);
    QVERIFY2(all->problems()[0].contains(QStringLiteral("\"Door Panel\"")), qPrintable(all->problems()[0]));
    const auto deep = std::dynamic_pointer_cast<ColorStandardsLibrary>(
        store.fetch(ColorStandardsLibrary::typeId(), library->id(), 2));
    QVERIFY(deep);
    QVERIFY(deep->standards().empty());
}

// SQLite makes -wal and -shm files beside a WAL store even to read it; a
// read-only open must do without them where the folder cannot be written.
void tst_Store::readOnlyOpenInFolderNobodyMayWrite()
{
    SQLITE_FILES_ONLY();
    QTemporaryDir folder;
    const QString path = folder.filePath(QStringLiteral("store.sqlite"));
    {
        TempStore writer;
        QVERIFY(writer.save(makeTemplate("Kept")));
        // Closed cleanly, the file alone holds everything.
        writer.reopen(StoreOptions{true});
        QVERIFY(QFile::copy(writer.path(), path));
    }
    QVERIFY(QFile::setPermissions(path, QFileDevice::ReadOwner | QFileDevice::ReadGroup | QFileDevice::ReadOther));
    const QFileDevice::Permissions readAndList = QFileDevice::ReadOwner | QFileDevice::ExeOwner | QFileDevice::ReadGroup
        | QFileDevice::ExeGroup | QFileDevice::ReadOther | QFileDevice::ExeOther;
    QVERIFY(QFile::setPermissions(folder.path(), readAndList));
    const auto restore = qScopeGuard([&] { QFile::setPermissions(folder.path(), readAndList | QFileDevice::WriteOwner); });
    // Root may write the folder all the same; there the proof is that the
    // file and the folder stay as they were.
    if (::geteuid() != 0)
        QVERIFY(!QFileInfo(folder.path()).isWritable());
    QFile file(path);
    QVERIFY(file.open(QIODevice::ReadOnly));
    const QByteArray bytes = file.readAll();
    file.close();
    const QDateTime modified = QFileInfo(path).lastModified();
    const auto listing = [&] { return QDir(folder.path()).entryList(QDir::Files | QDir::Hidden); };

    {
        MarloModel model(path, StoreOptions{true});
        const QString error = model.open();
        QVERIFY2(error.isEmpty(), qPrintable(error));
        QCOMPARE(listing(), QStringList({"store.sqlite"}));
    }
    QCOMPARE(listing(), QStringList({"store.sqlite"}));
    QVERIFY(file.open(QIODevice::ReadOnly));
    QCOMPARE(file.readAll(), bytes);
    QCOMPARE(QFileInfo(path).lastModified(), modified);
}

// Another program holds the store open with a change in its -wal file; a
// read-only open that skipped the -wal file would still see the object.
void tst_Store::readOnlyOpenSeesChangesNotYetMerged()
{
    SQLITE_FILES_ONLY();
    TempStore store;
    auto removed = makeTemplate("Removed");
    QVERIFY(store.save(makeTemplate("Kept")));
    QVERIFY(store.save(removed));
    RawConnection other(store.path());
    QVERIFY(other.exec(QStringLiteral("DELETE FROM objects WHERE id = ?"), {QString::fromStdString(removed->id())}));
    store.reopen(StoreOptions{true});
    QVERIFY(QFileInfo(store.path() + QStringLiteral("-wal")).size() > 0);

    const auto response = getAll(store, kTemplate);
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
    SQLITE_FILES_ONLY();
    QFETCH(int, code);
    QFETCH(bool, diskFull);
    QFETCH(QString, expected);
    const QString explained = SqliteDialect::explain(code, diskFull);
    QVERIFY2(expected.isEmpty() ? explained.isEmpty() : explained.contains(expected), qPrintable(explained));
}

void tst_Store::getObjectsListsAllOrTheIdsGiven()
{
    TempStore store;
    auto a = makeTemplate("A");
    auto c = makeTemplate("C");
    for (const auto& jobTemplate : {makeTemplate("B"), a, c})
        QVERIFY(store.save(jobTemplate));
    QVERIFY(store.save(std::make_shared<Standard>()));

    QCOMPARE(namesOf(getAll(store, kTemplate)->objects()), QStringList({"A", "B", "C"}));
    QCOMPARE(namesOf(getAll(store, kTemplate, {c->id(), a->id()})->objects()), QStringList({"C", "A"}));
}

void tst_Store::folderTreeOperations()
{
    TempStore store;
    const std::string samples = createFolder(store, "Samples");
    QVERIFY(!samples.empty());
    const auto duplicate = store.run(std::make_shared<CreateFolder>(kTemplate, "", "Samples"));
    QVERIFY(duplicate.error && duplicate.error->message().contains(QStringLiteral("already exists")));
    // The same name is free in the tree of another type, but the trees do not mix.
    const std::string standards = createFolder(store, "Samples", "", Standard::typeId());
    QVERIFY(!standards.empty());
    QVERIFY(store.run(std::make_shared<CreateFolder>(kTemplate, standards, "Inside")).error);
    QVERIFY(store.run(std::make_shared<MoveDirItem>(DirItemKind::Folder, samples, standards)).error);
    // A folder cannot go into its own sub-folder, but may go up.
    const std::string inner = createFolder(store, "Inner", samples);
    QVERIFY(store.run(std::make_shared<MoveDirItem>(DirItemKind::Folder, samples, inner)).error);
    QVERIFY(!store.run(std::make_shared<MoveDirItem>(DirItemKind::Folder, inner, "")).error);

    auto jobTemplate = makeTemplate("Door Panel");
    const auto saved = std::dynamic_pointer_cast<UpdateObjectResponse>(store.save(jobTemplate, &samples));
    QVERIFY(saved && saved->entry());
    QCOMPARE(saved->entry()->folderId(), samples);
    QVERIFY(!store.run(std::make_shared<RenameDirItem>(DirItemKind::Entry, saved->entry()->id(), "Door Trim")).error);
    const auto tree = treeOf(store);
    QVERIFY(tree);
    QCOMPARE(tree->folders().size(), size_t(2));
    QCOMPARE(tree->entries().size(), size_t(1));
    QCOMPARE(tree->entries()[0]->header()->name(), std::string("Door Trim"));
    QCOMPARE(tree->entries()[0]->entryObjectId(), jobTemplate->id());
    const auto renamed = store.fetch(kTemplate, jobTemplate->id());
    QVERIFY(renamed);
    QCOMPARE(renamed->header()->name(), std::string("Door Trim"));
}

void tst_Store::deletingFolderDeletesItsObjects()
{
    TempStore store;
    const std::string outer = createFolder(store, "Outer");
    const std::string inner = createFolder(store, "Inner", outer);
    auto nested = makeTemplate("Nested");
    auto kept = makeTemplate("Kept");
    const std::string topLevel;
    QVERIFY(store.save(nested, &inner));
    QVERIFY(store.save(kept, &topLevel));

    QVERIFY(deleteItems(store, {outer}));
    QVERIFY(getOne(store, kTemplate, nested->id()).error);
    QVERIFY(store.fetch(kTemplate, kept->id()));
    const auto tree = treeOf(store);
    QVERIFY(tree && tree->folders().empty());
    QCOMPARE(tree->entries().size(), size_t(1));
}

void tst_Store::folderCycleDoesNotHangTheStore()
{
    TempStore store;
    const std::string first = createFolder(store, "First");
    const std::string second = createFolder(store, "Second", first);
    auto nested = makeTemplate("Nested");
    QVERIFY(store.save(nested, &second));
    // A damaged file: each folder is the other's parent.
    QVERIFY(RawConnection(store.path()).exec(QStringLiteral("UPDATE folders SET parent_id = ? WHERE id = ?"),
                                             {QString::fromStdString(second), QString::fromStdString(first)}));

    const auto tree = store.run(std::make_shared<GetDirectoryTree>(kTemplate));
    QVERIFY(!tree.timedOut && tree.response);
    QVERIFY(deleteItems(store, {first}));
    QVERIFY(getOne(store, kTemplate, nested->id()).error);
}


// Two editors read the same template; the first saves (twice), the second
// is refused and nothing of its edit is written; once it has read the
// stored version again it saves.
void tst_Store::staleSaveIsRefusedAndWritesNothing()
{
    TempStore store;
    auto original = makeTemplate("Door Panel");
    QVERIFY(store.save(original));
    auto first = std::static_pointer_cast<QCJobTemplate>(store.fetch(kTemplate, original->id()));
    auto second = std::static_pointer_cast<QCJobTemplate>(store.fetch(kTemplate, original->id()));
    QVERIFY(first && second);

    first->setName("Door Panel A");
    QVERIFY(!update(store, first).error);
    first->setName("Door Panel A2");
    QVERIFY2(!update(store, first).error, "a second save from the same editor states the revision it wrote");

    second->setName("Door Panel B");
    const auto refused = update(store, second);
    QVERIFY(refused.error);
    QVERIFY(refused.error->isConflict());
    const QString message = refused.error->message();
    QVERIFY2(message.contains(QStringLiteral("\"Door Panel A2\" (id "))
                 && message.contains(QStringLiteral("was changed elsewhere since it was opened")),
             qPrintable(message));
    QCOMPARE(store.fetch(kTemplate, original->id())->header()->name(), std::string("Door Panel A2"));

    auto reread = std::static_pointer_cast<QCJobTemplate>(store.fetch(kTemplate, original->id()));
    reread->setName("Door Panel B");
    QVERIFY(!update(store, reread).error);
    QCOMPARE(store.fetch(kTemplate, original->id())->header()->name(), std::string("Door Panel B"));
}

// A rename elsewhere refuses a save from before it; the renaming editor's
// own copy saves on.
void tst_Store::renameCountsAsAChange()
{
    TempStore store;
    auto jobTemplate = makeTemplate("Door Panel");
    const std::string topLevel;
    const std::string entryId = entryIdOf(store.save(jobTemplate, &topLevel));
    QVERIFY(!entryId.empty());
    auto elsewhere = std::static_pointer_cast<QCJobTemplate>(store.fetch(kTemplate, jobTemplate->id()));
    auto renaming = std::static_pointer_cast<QCJobTemplate>(store.fetch(kTemplate, jobTemplate->id()));

    renaming->setName("Door Trim");
    auto rename = std::make_shared<RenameDirItem>(DirItemKind::Entry, entryId, "Door Trim");
    rename->setOpenObject(renaming);
    QVERIFY(!store.run(rename).error);

    elsewhere->setDescription("changed elsewhere");
    const auto refused = update(store, elsewhere);
    QVERIFY(refused.error && refused.error->isConflict());
    renaming->setDescription("changed by the renaming editor");
    QVERIFY(!update(store, renaming).error);
    const auto stored = std::static_pointer_cast<QCJobTemplate>(store.fetch(kTemplate, jobTemplate->id()));
    QCOMPARE(stored->name(), std::string("Door Trim"));
    QCOMPARE(stored->description(), std::string("changed by the renaming editor"));
}

// Two other programs read the template, then save it at the same moment.
void tst_Store::twoProgramsSavingOneTemplateOneWins()
{
    TempStore store;
    auto jobTemplate = makeTemplate("Door Panel");
    QVERIFY(store.save(jobTemplate));
    const QString saver = QCoreApplication::applicationDirPath() + QStringLiteral("/storesaver");
    QProcess programs[2];
    const QStringList names{QStringLiteral("Saved by one"), QStringLiteral("Saved by two")};
    for (int i = 0; i < 2; ++i) {
        programs[i].start(saver, {store.path(), QString::fromStdString(kTemplate), QString::fromStdString(jobTemplate->id()),
                                  names[i]});
        QVERIFY(programs[i].waitForStarted(5000));
    }
    const auto stopAll = qScopeGuard([&programs] {
        for (QProcess& program : programs) {
            program.kill();
            program.waitForFinished(5000);
        }
    });
    for (QProcess& program : programs) {
        QVERIFY(program.waitForReadyRead(20000));
        QCOMPARE(program.readLine().trimmed(), QByteArray("read"));
    }
    for (QProcess& program : programs)
        program.write("go\n");
    QStringList outcomes;
    for (QProcess& program : programs) {
        QVERIFY(program.waitForFinished(20000));
        outcomes << QString::fromUtf8(program.readAllStandardOutput().trimmed());
    }
    QCOMPARE(outcomes.count(QStringLiteral("saved")), 1);
    const int winner = outcomes.indexOf(QStringLiteral("saved"));
    const QString refusal = outcomes[1 - winner];
    QVERIFY2(refusal.startsWith(QStringLiteral("refused: Cannot save \"Saved by "))
                 && refusal.contains(QStringLiteral("was changed elsewhere since it was opened")),
             qPrintable(refusal));
    QCOMPARE(QString::fromStdString(store.fetch(kTemplate, jobTemplate->id())->header()->name()), names[winner]);
}

// A store written before objects had revisions: its objects read and save as before.
void tst_Store::storeOfTheFirstSchemaIsUpgraded()
{
    SQLITE_FILES_ONLY();
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("old.sqlite"));
    auto jobTemplate = makeTemplate("Door Panel");
    {
        RawConnection raw(path);
        for (const char* statement :
             {"CREATE TABLE folders(id TEXT PRIMARY KEY, object_type TEXT NOT NULL,"
              " parent_id TEXT REFERENCES folders(id) ON DELETE CASCADE, name TEXT NOT NULL)",
              "CREATE TABLE objects(id TEXT PRIMARY KEY, type TEXT NOT NULL, name TEXT NOT NULL, data BLOB NOT NULL)",
              "CREATE TABLE dir_entries(id TEXT PRIMARY KEY,"
              " object_id TEXT NOT NULL UNIQUE REFERENCES objects(id) ON DELETE CASCADE,"
              " folder_id TEXT REFERENCES folders(id) ON DELETE CASCADE)",
              "PRAGMA user_version = 1"})
            QVERIFY(raw.exec(QString::fromLatin1(statement)));
        QVERIFY(raw.exec(QStringLiteral("PRAGMA application_id = %1").arg(StoreDatabase::kApplicationId)));
        QVERIFY(raw.exec(QStringLiteral("INSERT INTO objects VALUES(?, ?, ?, ?)"),
                         {QString::fromStdString(jobTemplate->id()), QString::fromStdString(kTemplate),
                          QStringLiteral("Door Panel"), ObjectCodec::serialize(*jobTemplate)}));
    }
    MarloModel model(path);
    QCOMPARE(model.open(), QString());
    auto get = std::make_shared<GetMarloObject>();
    get->setType(kTemplate);
    get->setId(jobTemplate->id());
    const auto fetched = std::dynamic_pointer_cast<GetMarloObjectResponse>(
        CommandSender::sendAndWait(model, std::string(), get, 20000).response);
    QVERIFY(fetched && fetched->object());
    QCOMPARE(fetched->object()->storedRevision(), std::int64_t(1));
    auto save = std::make_shared<UpdateObject>();
    save->setObject(fetched->object());
    QVERIFY(!CommandSender::sendAndWait(model, std::string(), save, 20000).error);
    QCOMPARE(RawConnection(path).scalar(QStringLiteral("PRAGMA user_version")).toInt(), StoreDatabase::schemaVersion());
}

void tst_Store::serverFailuresNameServerAndCause_data()
{
    QTest::addColumn<QString>("user");
    QTest::addColumn<QString>("socketFolder"); // empty: the test server's
    QTest::addColumn<QString>("cause");
    QTest::newRow("no server at the address") << "postgres" << "/nonexistent-socket-folder" << "cannot be reached";
    QTest::newRow("a user the server does not know") << "nobody here" << "" << "refused the login";
    QTest::newRow("quotes and semicolons stay in the user name")
        << "x'; DROP TABLE objects; --" << "" << "refused the login";
    QTest::newRow("a password in the address is refused, not sent") << "postgres:secret" << "" << "~/.pgpass";
}

void tst_Store::serverFailuresNameServerAndCause()
{
    SERVERS_ONLY();
    QFETCH(QString, user);
    QFETCH(QString, socketFolder);
    QFETCH(QString, cause);
    TempStore store;
    const auto kept = makeTemplate("Kept");
    QVERIFY(store.save(kept));
    QUrl address(TestPostgresServer::shared()->addressAs(user.section(QLatin1Char(':'), 0, 0),
                                                         QUrl(store.path()).path().mid(1)));
    address.setPassword(user.section(QLatin1Char(':'), 1));
    if (!socketFolder.isEmpty())
        address.setQuery(QStringLiteral("host=") + socketFolder);
    const QString text = address.toString(QUrl::FullyEncoded);

    const QString error = MarloModel(text).open();
    const bool named = address.password().isEmpty() ? error.contains(text) : !error.contains(QLatin1String("secret"));
    QVERIFY2(error.contains(cause) && named, qPrintable(error));
    QVERIFY(store.fetch(kTemplate, kept->id()));
}

// The server stops while a save of a large template is under way: either the
// save was acknowledged and is there once the server is back, or it failed,
// saying why, and saving again then succeeds.
void tst_Store::serverGoneDuringSaveLosesNothingAcknowledged()
{
    SERVERS_ONLY();
    TestPostgresServer* server = TestPostgresServer::shared();
    const auto restart = qScopeGuard([server] { server->start(); });
    TempStore store;
    auto jobTemplate = makeTemplate("Door Panel", 10 << 20);
    QVERIFY(store.save(jobTemplate));
    jobTemplate->setName("Door Panel, changed");
    std::optional<TempStore::Answer> answer;
    auto save = std::make_shared<UpdateObject>();
    save->setObject(jobTemplate);
    QObject context;
    CommandSender::send(store.model(), std::string(), save, &context,
                        [&answer](const std::shared_ptr<Response>& response) { answer = TempStore::Answer{response, nullptr}; },
                        [&answer](const std::shared_ptr<ErrorInfo>& error) { answer = TempStore::Answer{{}, error}; });
    QVERIFY(server->kill());
    QTRY_VERIFY_WITH_TIMEOUT(answer.has_value(), 20000);
    const auto namesServerAndCause = [&store](const QString& message) {
        return message.contains(store.path())
            && (message.contains(QStringLiteral("cannot be reached"))
                || message.contains(QStringLiteral("connection to the server was lost")));
    };
    if (answer->error) {
        QVERIFY2(namesServerAndCause(answer->error->message()), qPrintable(answer->error->message()));
        const auto whileDown = update(store, jobTemplate);
        QVERIFY(whileDown.error);
        QVERIFY2(namesServerAndCause(whileDown.error->message()), qPrintable(whileDown.error->message()));
    }
    QVERIFY(server->start());
    if (answer->error)
        QVERIFY(store.save(jobTemplate));
    const auto stored = store.fetch(kTemplate, jobTemplate->id());
    QVERIFY(stored);
    QCOMPARE(ObjectCodec::serialize(*stored), ObjectCodec::serialize(*jobTemplate));
}

// Each write of another program is announced; the store's own are not.
void tst_Store::serverAnnouncesWritesOfOthers()
{
    SERVERS_ONLY();
    TempStore store;
    auto jobTemplate = makeTemplate("Door Panel");
    QVERIFY(store.save(jobTemplate));
    QSignalSpy announced(store.model().commandDispatcher(std::string()).get(), &CommandDispatcher::sgStoreChanged);
    MarloModel other(store.path());
    QCOMPARE(other.open(), QString());
    const auto saveElsewhere = [&other](const std::shared_ptr<BaseObject>& object) {
        auto save = std::make_shared<UpdateObject>();
        save->setObject(object);
        return !CommandSender::sendAndWait(other, std::string(), save, 20000).error;
    };

    QVERIFY(saveElsewhere(makeTemplate("Bonnet")));
    QTRY_COMPARE_WITH_TIMEOUT(announced.count(), 1, 10000);
    jobTemplate->setName("Door Panel, changed here");
    QVERIFY(store.save(jobTemplate));
    QVERIFY(saveElsewhere(makeTemplate("Bumper")));
    // Announcements come in the order of the writes: the own one came first.
    QTRY_VERIFY_WITH_TIMEOUT(announced.count() >= 2, 10000);
    QCOMPARE(announced.count(), 2);
}

QC_TEST_GUILESS_MAIN(tst_Store)
#include "tst_store.moc"
