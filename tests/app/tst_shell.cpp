#include "tests/common/TestMain.h"
#include "tests/common/ModalAnswer.h"
#include "tests/common/ScriptedAsker.h"
#include "tests/common/TempStore.h"
#include "app/PluginCatalog.h"
#include "app/ShellOptions.h"
#include "app/ShellWindow.h"

#include "host/client/AppWidget.h"
#include "host/client/ClientInterface.h"
#include "host/client/CorvoTopBar.h"
#include "host/domain/QCJobTemplate.h"
#include "host/store/CreateFolder.h"
#include "host/store/FolderResponse.h"
#include "host/widgets/DirEntryBrowserWidget.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "host/widgets/FolderCommands.h"

#include <QAction>
#include <QFile>
#include <QLineEdit>
#include <QMenu>
#include <QPushButton>
#include <QProcess>
#include <QTabBar>
#include <QTabWidget>
#include <QTemporaryDir>
#include <QToolBar>
#include <QTreeView>
#include <QtTest>

using namespace vemi;
using Node = BaseObjectTreeModel::Node;

namespace {

// The real window with the real plug-in, loaded from the build's plug-in
// folder, shown and active, so that keys go where a user's keys go.
struct RunningShell
{
    explicit RunningShell(TempStore& store)
    {
        QSettings().clear();
        catalog.load(QFileInfo(QStringLiteral(CLIENT_PLUGIN)).absolutePath());
        window = std::make_unique<ShellWindow>(store.model(), catalog.clients());
        window->resize(1200, 800);
        window->show();
    }
    // The window active and the focus in the tree, as after a start.
    bool ready() const
    {
        return QTest::qWaitForWindowActive(window.get())
            && QTest::qWaitFor([this] { return QApplication::focusWidget() == browser()->treeView(); }, 5000);
    }
    DirEntryBrowserWidget* browser() const { return window->appWidget(0)->findChild<DirEntryBrowserWidget*>(); }
    Node* find(const QString& name) const
    {
        DirEntryTreeModel* model = browser()->treeModel();
        for (Node* node : model->descendants(model->root())) {
            if (node->displayName() == name)
                return node;
        }
        return nullptr;
    }
    void select(const QString& name) const
    {
        browser()->treeView()->selectionModel()->setCurrentIndex(browser()->treeModel()->indexFromNode(find(name)),
                                                                 QItemSelectionModel::ClearAndSelect);
    }
    // A key as the user presses it: to the widget that has the focus.
    static void press(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier)
    {
        QTest::keyClick(QApplication::focusWidget(), key, modifiers);
    }

    PluginCatalog catalog; // owns the plug-in the window's tab comes from
    std::unique_ptr<ShellWindow> window;
};

std::string storeFolder(TempStore& store, const std::string& name)
{
    const auto answer = store.run(std::make_shared<CreateFolder>(QCJobTemplate::typeId(), "", name));
    const auto folder = std::dynamic_pointer_cast<FolderResponse>(answer.response);
    return folder ? folder->folder().id : std::string();
}

void storeTemplate(TempStore& store, const std::string& name, const std::string& folderId = std::string())
{
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    jobTemplate->setName(name);
    store.save(jobTemplate, &folderId);
}

// Answers the next name dialog by typing text over its suggestion and pressing Enter.
void typeInNextNameDialog(const QString& text)
{
    ModalAnswer::actOnNextModal([text](QWidget* modal) {
        QVERIFY(QTest::qWaitForWindowActive(modal));
        QTest::keyClicks(modal->focusWidget(), text);
        QTest::keyClick(modal->focusWidget(), Qt::Key_Return);
    });
}

} // namespace

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
    void keysReachTheBrowserAfterStartAndNew();
    void browserKeysWorkFromAFieldOfTheTab();
    void deleteThenEnterKeepsTheFolder();
    void menuOpensFromTheKeyboard_data();
    void menuOpensFromTheKeyboard();
    void unsavedQuestionAnswersToAccessKeys();

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

void tst_Shell::windowShowsTheEditorTabWithItsBars()
{
    TempStore store;
    RunningShell shell(store);
    QVERIFY(shell.ready());
    ShellWindow& window = *shell.window;
    QCOMPARE(window.tabs()->count(), 1);
    QCOMPARE(window.tabs()->tabText(0), QStringLiteral("QC Job Template Editor"));
    QVERIFY(!window.tabs()->tabIcon(0).isNull());
    QVERIFY(shell.browser()->isVisible());
    QVERIFY(window.toolBar(0)->isVisible());
    QCOMPARE(window.toolBar(0)->actions().size(), 3);
    QCOMPARE(window.toolBar(0)->actions().first(), shell.browser()->actionNew());
    QCOMPARE(window.topBar(0)->actions().first()->menu()->title(), QStringLiteral("&File"));
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
    QTest::newRow("a server address names its database")
        << "postgresql://qc@db.plant2:5432/templates" << "postgresql://qc@db.plant2:5432/templates";
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

// Before, the tree had no focus after start or New: F2 went nowhere and the
// name typed for the rename was lost.
void tst_Shell::keysReachTheBrowserAfterStartAndNew()
{
    TempStore store;
    storeTemplate(store, "Dashboard");
    storeTemplate(store, "Door Panel");
    RunningShell shell(store);
    QVERIFY(shell.ready());
    QTRY_VERIFY(shell.find(QStringLiteral("Door Panel")));

    // The focused tree shows "Dashboard" as current, unselected: Down selects the next.
    RunningShell::press(Qt::Key_Down);
    typeInNextNameDialog(QStringLiteral("Door Trim"));
    RunningShell::press(Qt::Key_F2);
    QTRY_VERIFY(shell.find(QStringLiteral("Door Trim")));
    // The focus comes back to the tree when the window is active again (a
    // window manager does this when the dialog closes; offscreen does not).
    shell.window->activateWindow();
    QVERIFY(QTest::qWaitForWindowActive(shell.window.get()));
    QTRY_COMPARE(QApplication::focusWidget(), static_cast<QWidget*>(shell.browser()->treeView()));

    // New from elsewhere in the window still hands the focus to the tree.
    shell.window->tabs()->tabBar()->setFocus();
    QTRY_COMPARE(QApplication::focusWidget(), static_cast<QWidget*>(shell.window->tabs()->tabBar()));
    RunningShell::press(Qt::Key_N, Qt::ControlModifier);
    QTRY_VERIFY(shell.find(QStringLiteral("Job Template")));
    QCOMPARE(QApplication::focusWidget(), static_cast<QWidget*>(shell.browser()->treeView()));
    // The new entry becomes current once the store has answered; F2 acts on the current entry.
    QTRY_VERIFY(shell.browser()->treeView()->currentIndex().data().toString().startsWith(QStringLiteral("Job Template")));
    typeInNextNameDialog(QStringLiteral("Bumper Left"));
    RunningShell::press(Qt::Key_F2);
    QTRY_VERIFY(shell.find(QStringLiteral("Bumper Left")));
    QVERIFY(!shell.find(QStringLiteral("Job Template")));
}

// The editor's fields sit in the tab beside the tree: F2 still renames the
// selected entry from there, while Del stays the field's own key.
void tst_Shell::browserKeysWorkFromAFieldOfTheTab()
{
    TempStore store;
    storeTemplate(store, "Door Panel");
    RunningShell shell(store);
    QVERIFY(shell.ready());
    QTRY_VERIFY(shell.find(QStringLiteral("Door Panel")));
    shell.select(QStringLiteral("Door Panel"));
    ScriptedAsker asker;
    shell.browser()->folderCommands()->setAsker(&asker);
    auto* field = new QLineEdit(QStringLiteral("abc"), shell.window->appWidget(0));
    field->show();
    field->setFocus();
    field->setCursorPosition(0);
    QTRY_COMPARE(QApplication::focusWidget(), field);

    RunningShell::press(Qt::Key_Delete);
    QCOMPARE(field->text(), QStringLiteral("bc"));
    QVERIFY(asker.asked().isEmpty());
    RunningShell::press(Qt::Key_F2);
    QCOMPARE(asker.asked(), QStringList{"Rename: New name: [Door Panel]"});
}

// The worst of it: Del and Enter on a folder deleted it with everything in it,
// unsaved work included. Now Enter answers No, and the question says what would go.
void tst_Shell::deleteThenEnterKeepsTheFolder()
{
    TempStore store;
    const std::string bumpers = storeFolder(store, "Bumpers");
    for (const char* name : {"Bumper Left", "Bumper Right", "Bumper Rear"})
        storeTemplate(store, name, bumpers);
    RunningShell shell(store);
    QVERIFY(shell.ready());
    QTRY_VERIFY(shell.find(QStringLiteral("Bumper Left")));
    shell.select(QStringLiteral("Bumper Left"));
    QTRY_VERIFY(shell.find(QStringLiteral("Bumper Left"))->object());
    shell.browser()->namedObjectWasModified(shell.find(QStringLiteral("Bumper Left"))->object());
    shell.select(QStringLiteral("Bumpers"));
    shell.browser()->treeView()->setFocus();

    QString question;
    bool noIsDefault = false;
    ModalAnswer::actOnNextModal([&](QWidget* modal) {
        auto* box = qobject_cast<QMessageBox*>(modal);
        QVERIFY(box);
        question = box->text();
        noIsDefault = box->defaultButton() == box->button(QMessageBox::No);
        QTest::keyClick(box, Qt::Key_Return);
    });
    RunningShell::press(Qt::Key_Delete);

    QVERIFY(noIsDefault);
    QVERIFY2(question.contains(QStringLiteral("\"Bumpers\" with everything in it: 3 Job Templates?")),
             qPrintable(question));
    QVERIFY2(question.contains(QStringLiteral("lost in:\n  • Bumper Left")), qPrintable(question));
    QTest::qWait(200);
    for (const char* name : {"Bumpers", "Bumper Left", "Bumper Right", "Bumper Rear"})
        QVERIFY2(shell.find(QString::fromUtf8(name)), name);
}

void tst_Shell::menuOpensFromTheKeyboard_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("modifiers");
    QTest::newRow("F10") << int(Qt::Key_F10) << int(Qt::NoModifier);
    QTest::newRow("Alt+F") << int(Qt::Key_F) << int(Qt::AltModifier);
}

void tst_Shell::menuOpensFromTheKeyboard()
{
    QFETCH(int, key);
    QFETCH(int, modifiers);
    TempStore store;
    RunningShell shell(store);
    QVERIFY(shell.ready());

    RunningShell::press(Qt::Key(key), Qt::KeyboardModifiers(modifiers));
    QTRY_VERIFY(qobject_cast<QMenu*>(QApplication::activePopupWidget()));
    auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
    QCOMPARE(menu->title(), QStringLiteral("&File"));
    QTest::keyClick(menu, Qt::Key_Escape);
    QTRY_VERIFY(!QApplication::activePopupWidget());
}

void tst_Shell::unsavedQuestionAnswersToAccessKeys()
{
    TempStore store;
    RunningShell shell(store);
    QVERIFY(shell.ready());
    RunningShell::press(Qt::Key_N, Qt::ControlModifier);
    QTRY_VERIFY(shell.find(QStringLiteral("Job Template")));

    QStringList buttons;
    bool closedByKey = false;
    ModalAnswer::actOnNextModal([&](QWidget* modal) {
        auto* box = qobject_cast<QMessageBox*>(modal);
        if (!box) {
            modal->close();
            return;
        }
        for (QMessageBox::StandardButton button : {QMessageBox::Save, QMessageBox::Discard, QMessageBox::Cancel})
            buttons << (box->button(button) ? box->button(button)->text() : QString());
        // Access keys reach only the active window; a window manager activates
        // a new dialog, offscreen does not. The button clicks after a moment.
        box->activateWindow();
        if (QTest::qWaitFor([box] { return QApplication::activeWindow() == box; }, 5000))
            QTest::keyClick(box, Qt::Key_D, Qt::AltModifier);
        closedByKey = QTest::qWaitFor([box] { return !box->isVisible(); }, 5000);
        if (!closedByKey)
            box->button(QMessageBox::Discard)->click();
    });
    QVERIFY(shell.window->close());
    QCOMPARE(buttons, (QStringList{"&Save", "&Discard", "&Cancel"}));
    QVERIFY(closedByKey);
    QVERIFY(!shell.window->isVisible());
}

QC_TEST_MAIN(tst_Shell)
#include "tst_shell.moc"
