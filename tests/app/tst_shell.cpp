#include "tests/common/TestMain.h"
#include "tests/common/TempStore.h"
#include "app/PluginCatalog.h"
#include "app/ShellOptions.h"
#include "app/ShellWindow.h"

#include "host/client/AppWidget.h"
#include "host/client/ClientInterface.h"
#include "host/client/CorvoTopBar.h"
#include "host/widgets/DirEntryBrowserWidget.h"

#include <QAction>
#include <QFile>
#include <QMenu>
#include <QProcess>
#include <QTabWidget>
#include <QTemporaryDir>
#include <QToolBar>
#include <QtTest>

using namespace vemi;

class tst_Shell : public QObject
{
    Q_OBJECT

private slots:
    void catalogTakesOnlyClientPlugins();
    void windowShowsTheEditorTabWithItsBars();
    void badStoreFileStopsTheShell_data();
    void badStoreFileStopsTheShell();
    void shellStartsWithTheEditorTab();
    void otherStoresLiveBesideTheDefault_data();
    void otherStoresLiveBesideTheDefault();

private:
    static QProcess* runShell(const QStringList& arguments, const QString& home);
};

void tst_Shell::catalogTakesOnlyClientPlugins()
{
    QTemporaryDir folder;
    QVERIFY(QFile::copy(QStringLiteral(CLIENT_PLUGIN), folder.filePath(QStringLiteral("libpellam.so"))));
    QVERIFY(QFile::copy(QStringLiteral(FOREIGN_PLUGIN), folder.filePath(QStringLiteral("libforeign.so"))));
    QFile fake(folder.filePath(QStringLiteral("libnotaplugin.so")));
    QVERIFY(fake.open(QIODevice::WriteOnly));
    fake.write("not a shared library");
    fake.close();

    PluginCatalog catalog;
    catalog.load(folder.path());
    QCOMPARE(catalog.clients().size(), size_t(1));
    QCOMPARE(catalog.clients().front().client->clientTitle(), QStringLiteral("QC Job Template Editor"));
    QCOMPARE(catalog.messages().size(), 2);
    QVERIFY(catalog.messages().filter(QStringLiteral("libforeign.so")).first().contains(QStringLiteral("org.example.SomethingElse")));
    QVERIFY(!catalog.messages().filter(QStringLiteral("libnotaplugin.so")).isEmpty());
}

// The real window with the real plug-in, loaded from the build's plug-in folder.
void tst_Shell::windowShowsTheEditorTabWithItsBars()
{
    QSettings().clear();
    TempStore store;
    PluginCatalog catalog;
    catalog.load(QFileInfo(QStringLiteral(CLIENT_PLUGIN)).absolutePath());
    QCOMPARE(catalog.clients().size(), size_t(1));
    ShellWindow window(store.model(), catalog.clients());
    window.resize(1200, 800);
    window.show();
    QVERIFY(QTest::qWaitForWindowExposed(&window));

    QCOMPARE(window.tabs()->count(), 1);
    QCOMPARE(window.tabs()->tabText(0), QStringLiteral("QC Job Template Editor"));
    QVERIFY(!window.tabs()->tabIcon(0).isNull());
    QCOMPARE(window.tabs()->currentWidget(), window.appWidget(0));
    auto* browser = window.appWidget(0)->findChild<DirEntryBrowserWidget*>();
    QVERIFY(browser);
    QVERIFY(browser->isVisible());
    QVERIFY(window.toolBar(0)->isVisible());
    QCOMPARE(window.toolBar(0)->actions().size(), 3);
    QCOMPARE(window.toolBar(0)->actions().first(), browser->actionNew());
    QCOMPARE(window.topBar(0)->actions().size(), 1);
    QCOMPARE(window.topBar(0)->actions().first()->menu()->title(), QStringLiteral("File"));
}

QProcess* tst_Shell::runShell(const QStringList& arguments, const QString& home)
{
    auto* process = new QProcess;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.insert(QStringLiteral("QT_QPA_PLATFORM"), QStringLiteral("offscreen"));
    environment.insert(QStringLiteral("HOME"), home);
    environment.insert(QStringLiteral("XDG_CONFIG_HOME"), home + QStringLiteral("/config"));
    environment.insert(QStringLiteral("XDG_DATA_HOME"), home + QStringLiteral("/data"));
    process->setProcessEnvironment(environment);
    process->start(QStringLiteral(QCHOST), arguments);
    return process;
}

void tst_Shell::badStoreFileStopsTheShell_data()
{
    QTest::addColumn<QByteArray>("content");
    QTest::newRow("a text file") << QByteArray("shopping list: milk, eggs\n").repeated(50);
    QTest::newRow("an image") << QByteArray("\x89PNG\r\n\x1a\n", 8) + QByteArray(300, '\x07');
}

void tst_Shell::badStoreFileStopsTheShell()
{
    QFETCH(QByteArray, content);
    QTemporaryDir home;
    const QString path = home.filePath(QStringLiteral("not-a-store.sqlite"));
    QFile file(path);
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write(content);
    file.close();

    std::unique_ptr<QProcess> shell(runShell({QStringLiteral("--store"), path}, home.path()));
    QVERIFY(shell->waitForFinished(30000));
    QCOMPARE(shell->exitStatus(), QProcess::NormalExit);
    QVERIFY(shell->exitCode() != 0);
    const QString errors = QString::fromLocal8Bit(shell->readAllStandardError());
    QVERIFY2(errors.contains(path), qPrintable(errors));
    QVERIFY2(errors.contains(QStringLiteral("not a store")), qPrintable(errors));
    QVERIFY(file.open(QIODevice::ReadOnly));
    QCOMPARE(file.readAll(), content);
}

void tst_Shell::shellStartsWithTheEditorTab()
{
    QTemporaryDir home;
    const QString shot = home.filePath(QStringLiteral("shell.png"));
    std::unique_ptr<QProcess> shell(runShell({QStringLiteral("--store"), home.filePath(QStringLiteral("store.sqlite")),
                                              QStringLiteral("--screenshot"), shot},
                                             home.path()));
    QVERIFY(shell->waitForFinished(60000));
    QCOMPARE(shell->exitCode(), 0);
    const QImage picture(shot);
    QVERIFY(!picture.isNull());
    QVERIFY(picture.width() >= 800);
}

void tst_Shell::otherStoresLiveBesideTheDefault_data()
{
    QTest::addColumn<QString>("id");
    QTest::addColumn<QString>("file");
    QTest::newRow("a plain name") << "Plant 2" << "/data/Plant 2.sqlite";
    QTest::newRow("the default store is not added twice") << "Local" << "";
    QTest::newRow("a path that climbs out is refused") << "../secrets" << "";
    QTest::newRow("an absolute path is refused") << "/etc/passwd" << "";
}

void tst_Shell::otherStoresLiveBesideTheDefault()
{
    QFETCH(QString, id);
    QFETCH(QString, file);
    ShellOptions options;
    options.storePath = QStringLiteral("/data/store.sqlite");
    QStringList refused;
    const auto files = options.otherStoreFiles({id.toStdString()}, &refused);
    const auto found = files.find(id.toStdString());
    QCOMPARE(found == files.end() ? QString() : found->second, file);
    QCOMPARE(refused.contains(id), file.isEmpty() && id != QLatin1String("Local"));
}

QC_TEST_MAIN(tst_Shell)
#include "tst_shell.moc"
