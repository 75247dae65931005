#include "tests/common/TestMain.h"
#include "tests/common/ModalAnswer.h"
#include "tests/common/RecordingDispatcher.h"
#include "tests/common/TempStore.h"

#include "host/client/AppWidget.h"
#include "host/client/ClientInterface.h"
#include "host/client/CommonSettings.h"
#include "host/client/CorvoTopBar.h"
#include "host/store/GetDirectoryTree.h"
#include "host/widgets/ImageRepository.h"
#include "host/client/Version.h"

#include <QAction>
#include <QMenu>
#include <QPluginLoader>
#include <QToolBar>
#include <QtTest>

using namespace vemi;

// Loads the built plug-in file the way the shell does.
class tst_PluginEntry : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void metadataNamesClientWithoutJson();
    void clientAnswersTheHostsQuestions();
    void entryPointsBeforeContentDoNothing_data();
    void entryPointsBeforeContentDoNothing();
    void fileMenuHoldsBrowserEntriesThenRefresh();
    void refreshReachesTheBrowserOnce();
    void toolBarGetsNewOpenSaveWithIcons();
    void mayCloseIsTheBrowsersAnswer();

private:
    AppWidget* createTab(TempStore& store, QWidget* parent);

    QString m_pluginPath;
    std::unique_ptr<QPluginLoader> m_loader;
    ClientInterface* m_client = nullptr;
};

void tst_PluginEntry::initTestCase()
{
    QSettings().clear();
    const QDir folder(QStringLiteral(PLUGIN_DIR));
    const QStringList files = folder.entryList({QStringLiteral("*pellam*")}, QDir::Files);
    QCOMPARE(files.size(), 1);
    m_pluginPath = folder.filePath(files.first());
    m_loader = std::make_unique<QPluginLoader>(m_pluginPath);
    QVERIFY2(m_loader->load(), qPrintable(m_loader->errorString()));
    m_client = qobject_cast<ClientInterface*>(m_loader->instance());
    QVERIFY(m_client);
}

void tst_PluginEntry::metadataNamesClientWithoutJson()
{
    // Read through a loader of its own, as a host does before instantiating.
    QPluginLoader reader(m_pluginPath);
    const QJsonObject metaData = reader.metaData();
    QCOMPARE(metaData.value(QStringLiteral("IID")).toString(), QStringLiteral("ClientInterface"));
    QCOMPARE(metaData.value(QStringLiteral("className")).toString(), QStringLiteral("PellamApp"));
    QVERIFY(metaData.value(QStringLiteral("MetaData")).toObject().isEmpty());
}

void tst_PluginEntry::clientAnswersTheHostsQuestions()
{
    QCOMPARE(m_client->clientTitle(), QStringLiteral("QC Job Template Editor"));
    QCOMPARE(m_client->clientGroup(), 2);
    QCOMPARE(m_client->clientPosition(), 3);
    QCOMPARE(m_client->styleSheetName(), QStringLiteral("Pellam.stylesheet"));
    QCOMPARE(m_client->clientIdentifiers(), std::vector<QString>{QStringLiteral("Pellam")});
    const Version& version = m_client->version();
    QCOMPARE(&m_client->version(), &version);
    QCOMPARE(version.toString(), QStringLiteral("1.3.0"));
    QCOMPARE(int(version.type()), 4);
    QVERIFY(!ImageRepository::instance().appIcon("QC Job Template Editor").isNull());
    QVERIFY(QFile::exists(QStringLiteral(":/StyleSheets/Pellam.stylesheet")));
}

void tst_PluginEntry::entryPointsBeforeContentDoNothing_data()
{
    QTest::addColumn<QString>("entryPoint");
    QTest::newRow("mayClose answers true") << "mayClose";
    QTest::newRow("refresh") << "refresh";
    QTest::newRow("addMenus adds no menu") << "addMenus";
    QTest::newRow("addToolBarActions adds no action") << "addToolBarActions";
}

// A host may call the entry points before createContent(), when the tab has
// no browser yet.
void tst_PluginEntry::entryPointsBeforeContentDoNothing()
{
    QFETCH(QString, entryPoint);
    TempStore store;
    QWidget host;
    AppWidget* tab = m_client->createAppWidget(store.model(), &host);
    CorvoTopBar topBar;
    QToolBar bar;
    if (entryPoint == QLatin1String("mayClose"))
        QVERIFY(tab->mayClose());
    else if (entryPoint == QLatin1String("refresh"))
        tab->refresh();
    else if (entryPoint == QLatin1String("addMenus"))
        tab->addMenus(&topBar);
    else
        tab->addToolBarActions(&bar);
    QVERIFY(topBar.actions().isEmpty());
    QVERIFY(bar.actions().isEmpty());

    // The content made afterwards serves the same calls as usual.
    tab->createContent();
    tab->addMenus(&topBar);
    tab->addToolBarActions(&bar);
    QCOMPARE(topBar.actions().size(), 1);
    QCOMPARE(bar.actions().size(), 3);
    QVERIFY(tab->mayClose());
}

AppWidget* tst_PluginEntry::createTab(TempStore& store, QWidget* parent)
{
    AppWidget* widget = m_client->createAppWidget(store.model(), parent);
    widget->createContent();
    return widget;
}

void tst_PluginEntry::fileMenuHoldsBrowserEntriesThenRefresh()
{
    TempStore store;
    QWidget host;
    AppWidget* tab = createTab(store, &host);
    CorvoTopBar topBar;
    tab->addMenus(&topBar);

    QCOMPARE(topBar.actions().size(), 1);
    QMenu* menu = topBar.actions().first()->menu();
    QCOMPARE(menu->title(), QStringLiteral("&File"));
    const QList<QAction*> entries = menu->actions();
    QVERIFY(entries.size() >= 5);
    QCOMPARE(entries.at(0)->text(), QStringLiteral("New Job Template"));
    QVERIFY(entries.at(1)->text().contains(QStringLiteral("Open")));
    QVERIFY(entries.at(2)->text().contains(QStringLiteral("Save")));
    QVERIFY(entries.at(entries.size() - 2)->isSeparator());
    QCOMPARE(entries.last()->text(), QStringLiteral("&Refresh"));
    QCOMPARE(entries.last()->shortcut(), QKeySequence(QKeySequence::Refresh));
}

void tst_PluginEntry::refreshReachesTheBrowserOnce()
{
    TempStore store;
    auto recorder = std::make_shared<RecordingDispatcher>();
    store.model().setCommandDispatcher("", recorder);
    QWidget host;
    AppWidget* tab = createTab(store, &host);
    CorvoTopBar topBar;
    tab->addMenus(&topBar);
    const auto treeReads = [&] { return recorder->commandsOf<GetDirectoryTree>().size(); };
    const size_t before = treeReads();

    topBar.actions().first()->menu()->actions().last()->trigger();
    QCOMPARE(treeReads(), before + 1);
}

void tst_PluginEntry::toolBarGetsNewOpenSaveWithIcons()
{
    TempStore store;
    QWidget host;
    AppWidget* tab = createTab(store, &host);
    QToolBar bar;
    tab->addToolBarActions(&bar);
    const QList<QAction*> actions = bar.actions();
    QCOMPARE(actions.size(), 3);
    QCOMPARE(actions.at(0)->text(), QStringLiteral("New Job Template"));
    QVERIFY(actions.at(1)->text().contains(QStringLiteral("Open")));
    QVERIFY(actions.at(2)->text().contains(QStringLiteral("Save")));
    for (QAction* action : actions)
        QVERIFY2(!action->icon().pixmap(24).isNull(), qPrintable(action->text()));
}

void tst_PluginEntry::mayCloseIsTheBrowsersAnswer()
{
    TempStore store;
    QWidget host;
    AppWidget* tab = createTab(store, &host);
    QToolBar bar;
    tab->addToolBarActions(&bar);
    QVERIFY(tab->mayClose());

    bar.actions().at(0)->trigger(); // a new template is unsaved work
    ModalAnswer::clickInNextMessageBox(QMessageBox::Cancel);
    QVERIFY(!tab->mayClose());
    ModalAnswer::clickInNextMessageBox(QMessageBox::Discard);
    QVERIFY(tab->mayClose());
}

QC_TEST_MAIN(tst_PluginEntry)
#include "tst_pluginentry.moc"
