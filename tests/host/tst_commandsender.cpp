#include "tests/common/TestMain.h"
#include "tests/common/RecordingDispatcher.h"
#include "tests/common/TempStore.h"

#include "host/domain/DirEntry.h"
#include "host/domain/GlobalDirEntry.h"
#include "host/domain/Standard.h"
#include "host/store/CommandSender.h"
#include "host/store/EntryObjectFetch.h"
#include "host/store/ErrorInfo.h"
#include "host/store/GetMarloObject.h"
#include "host/store/GetMarloObjectResponse.h"
#include "host/store/UpdateObject.h"
#include "host/widgets/DirEntryTreeModel.h"

#include <QPointer>
#include <QSignalSpy>
#include <QtTest>

using namespace vemi;

namespace {

const char* const kSecondStore = "Plant 2";

std::shared_ptr<Standard> standardNamed(const std::string& name)
{
    auto standard = std::make_shared<Standard>();
    standard->setName(name);
    return standard;
}

std::shared_ptr<GetMarloObject> getStandard(const std::string& id)
{
    auto get = std::make_shared<GetMarloObject>();
    get->setType(Standard::typeId());
    get->setId(id);
    return get;
}

// What reached the callbacks of one send().
struct Heard
{
    int responses = 0;
    int errors = 0;
    QString message;
    std::string objectName;
    QThread* thread = nullptr;
};

} // namespace

class tst_CommandSender : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void answerReachesLivingContext_data();
    void answerReachesLivingContext();
    void destroyedContextHearsNothing_data();
    void destroyedContextHearsNothing();
    void waitGivesUpAtDeadline();
    void entryFetchAsksTheStoreItNames_data();
    void entryFetchAsksTheStoreItNames();
    void treeModelAsksTheStoreItNames();

private:
    std::unique_ptr<TempStore> m_store;
    std::shared_ptr<Standard> m_local;  // in the default store
    std::shared_ptr<Standard> m_remote; // in the second store only
};

// Two real store files in one MarloModel, each with one standard.
void tst_CommandSender::init()
{
    m_store = std::make_unique<TempStore>();
    m_store->model().addStore(kSecondStore, m_store->folder() + QStringLiteral("/plant2.sqlite"));
    m_local = standardNamed("Local Beige");
    m_remote = standardNamed("Remote Red");
    QVERIFY(m_store->save(m_local));
    auto update = std::make_shared<UpdateObject>();
    update->setObject(m_remote);
    QVERIFY(m_store->run(update, kSecondStore).response);
}

void tst_CommandSender::cleanup()
{
    m_store.reset();
}

void tst_CommandSender::answerReachesLivingContext_data()
{
    QTest::addColumn<QString>("dispatcherId");
    QTest::addColumn<bool>("stored");
    QTest::addColumn<QString>("errorPart");
    QTest::newRow("stored object answers with the response") << "" << true << "";
    QTest::newRow("missing object answers with the store's error") << "" << false << "no stored object";
    QTest::newRow("unknown store answers with an error naming it")
        << "Plant 9" << true << "there is no store named \"Plant 9\"";
}

void tst_CommandSender::answerReachesLivingContext()
{
    QFETCH(QString, dispatcherId);
    QFETCH(bool, stored);
    QFETCH(QString, errorPart);

    QObject context;
    Heard heard;
    CommandSender::send(
        m_store->model(), dispatcherId.toStdString(), getStandard(stored ? m_local->id() : "no-such-id"), &context,
        [&](const std::shared_ptr<Response>&) {
            ++heard.responses;
            heard.thread = QThread::currentThread();
        },
        [&](const std::shared_ptr<ErrorInfo>& error) {
            ++heard.errors;
            heard.message = error->message();
            heard.thread = QThread::currentThread();
        });
    // Never inside send(): callers rely on their state being set up afterwards.
    QCOMPARE(heard.responses + heard.errors, 0);
    QTRY_COMPARE_WITH_TIMEOUT(heard.responses + heard.errors, 1, 10000);
    QCOMPARE(heard.thread, QThread::currentThread());
    QCOMPARE(heard.errors, errorPart.isEmpty() ? 0 : 1);
    QVERIFY2(heard.message.contains(errorPart), qPrintable(heard.message));
    // Exactly one answer: nothing else is still on its way.
    QTest::qWait(50);
    QCOMPARE(heard.responses + heard.errors, 1);
}

void tst_CommandSender::destroyedContextHearsNothing_data()
{
    QTest::addColumn<QString>("dispatcherId");
    QTest::newRow("answer from the store") << "";
    QTest::newRow("answer about an unknown store") << "Plant 9";
}

void tst_CommandSender::destroyedContextHearsNothing()
{
    QFETCH(QString, dispatcherId);

    int calls = 0;
    auto context = std::make_unique<QObject>();
    CommandSender::send(m_store->model(), dispatcherId.toStdString(), getStandard(m_local->id()), context.get(),
                        [&](const std::shared_ptr<Response>&) { ++calls; },
                        [&](const std::shared_ptr<ErrorInfo>&) { ++calls; });
    context.reset();
    // Answers come in order: once a later command has its answer, the first one's was delivered too.
    QVERIFY(m_store->run(getStandard(m_local->id())).response);
    QCOMPARE(calls, 0);
}

void tst_CommandSender::waitGivesUpAtDeadline()
{
    // A dispatcher that never answers stands for a stuck worker.
    m_store->model().setCommandDispatcher("Silent", std::make_shared<RecordingDispatcher>());
    const CommandSender::Answer answer =
        CommandSender::sendAndWait(m_store->model(), "Silent", getStandard(m_local->id()), 200);
    QVERIFY(answer.timedOut);
    QVERIFY(!answer.response);
    QVERIFY(answer.error);
    QVERIFY2(answer.error->message().contains("did not answer"), qPrintable(answer.error->message()));
}

void tst_CommandSender::entryFetchAsksTheStoreItNames_data()
{
    QTest::addColumn<bool>("global");
    QTest::addColumn<QString>("entryStore");
    QTest::addColumn<QString>("listedFrom");
    QTest::addColumn<bool>("remoteObject");
    QTest::addColumn<QString>("expected"); // the object's name, or a part of the error
    QTest::newRow("global entry naming the second store, listed from the default")
        << true << kSecondStore << "" << true << "Remote Red";
    QTest::newRow("global entry with no store name means the default store")
        << true << "" << kSecondStore << false << "Local Beige";
    QTest::newRow("plain entry is fetched from the store it was listed from")
        << false << "" << kSecondStore << true << "Remote Red";
    QTest::newRow("global entry naming an unknown store")
        << true << "Plant 9" << "" << true << "there is no store named \"Plant 9\"";
    QTest::newRow("global entry naming the default store for an object of the second finds none")
        << true << "" << "" << true << "no stored object";
}

void tst_CommandSender::entryFetchAsksTheStoreItNames()
{
    QFETCH(bool, global);
    QFETCH(QString, entryStore);
    QFETCH(QString, listedFrom);
    QFETCH(bool, remoteObject);
    QFETCH(QString, expected);

    std::shared_ptr<DirEntry> entry;
    if (global) {
        auto globalEntry = std::make_shared<GlobalDirEntry>();
        globalEntry->setDispatcherId(entryStore.toStdString());
        entry = globalEntry;
    } else {
        entry = std::make_shared<DirEntry>();
    }
    entry->setEntryObjectType(Standard::typeId());
    entry->setEntryObjectId((remoteObject ? m_remote : m_local)->id());

    QObject context;
    Heard heard;
    EntryObjectFetch::fetch(
        m_store->model(), *entry, listedFrom.toStdString(), &context,
        [&](const std::shared_ptr<BaseObject>& object) {
            ++heard.responses;
            const auto named = std::dynamic_pointer_cast<Standard>(object);
            heard.objectName = named ? named->name() : std::string();
        },
        [&](const std::shared_ptr<ErrorInfo>& error) {
            ++heard.errors;
            heard.message = error->message();
        });
    QTRY_COMPARE_WITH_TIMEOUT(heard.responses + heard.errors, 1, 10000);
    const QString outcome = heard.responses ? QString::fromStdString(heard.objectName) : heard.message;
    QVERIFY2(outcome.contains(expected), qPrintable(outcome));
}

// A global entry is loaded from its own store; an unknown store is reported by name.
void tst_CommandSender::treeModelAsksTheStoreItNames()
{
    DirEntryTreeModel model(m_store->model());
    model.setObjectType(Standard::typeId());
    auto entry = std::make_shared<GlobalDirEntry>();
    entry->setDispatcherId(kSecondStore);
    entry->setEntryObjectType(Standard::typeId());
    entry->setEntryObjectId(m_remote->id());
    auto* node = static_cast<DirEntryTreeModel::DirEntryNode*>(
        model.insertNode(model.root(), std::make_unique<DirEntryTreeModel::DirEntryNode>(entry, std::string())));

    QSignalSpy errors(&model, &DirEntryTreeModel::sgErrorOccurred);
    int done = -1;
    model.loadObject(node, [&](bool ok) { done = ok; });
    QTRY_VERIFY_WITH_TIMEOUT(done != -1, 10000);
    QVERIFY2(errors.isEmpty(), errors.isEmpty() ? "" : qPrintable(errors.first().first().toString()));
    QCOMPARE(done, 1);
    QVERIFY(node->object());
    QCOMPARE(node->object()->name(), std::string("Remote Red"));

    model.setDispatcherId("Plant 9");
    done = -1;
    model.load([&](bool ok) { done = ok; });
    QTRY_VERIFY_WITH_TIMEOUT(done != -1, 10000);
    QCOMPARE(done, 0);
    QCOMPARE(errors.count(), 1);
    const QString message = errors.first().first().toString();
    QVERIFY2(message.contains("there is no store named \"Plant 9\""), qPrintable(message));
}

QC_TEST_MAIN(tst_CommandSender)

#include "tst_commandsender.moc"
