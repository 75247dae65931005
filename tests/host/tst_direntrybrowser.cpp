#include "tests/common/TestMain.h"
#include "tests/common/ModalAnswer.h"
#include "tests/common/RawConnection.h"
#include "tests/common/ScriptedAsker.h"
#include "host/store/CommandSender.h"
#include "host/store/UpdateObject.h"
#include "host/domain/ObjectCodec.h"
#include "tests/common/TestPostgresServer.h"
#include "tests/common/TempStore.h"

#include "host/store/CreateFolder.h"
#include "host/store/DeleteDirItems.h"
#include "host/domain/DirEntry.h"
#include "host/widgets/DirEntryBrowserInterface.h"
#include "host/widgets/DirEntryBrowserWidget.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "host/widgets/FolderCommands.h"
#include "host/widgets/FolderNames.h"
#include "host/widgets/NameCheck.h"
#include "host/widgets/NameDialog.h"
#include "host/store/FolderResponse.h"
#include "host/domain/Header.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/QCJobTemplate.h"
#include "host/widgets/TreePickerDialog.h"

#include <QAction>
#include <QDialogButtonBox>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QPushButton>
#include <QScreen>
#include <QTreeView>
#include <QProcess>
#include <QScopeGuard>
#include <QSignalSpy>
#include <QtTest>

using namespace vemi;
using Node = BaseObjectTreeModel::Node;

namespace {

// The client side of a browser of job templates.
class TemplateCallbacks : public DirEntryBrowserInterface
{
public:
    std::shared_ptr<NamedObject> newNamedObject() override
    {
        auto jobTemplate = std::make_shared<QCJobTemplate>();
        jobTemplate->setName(defaultNamedObjectName(QStringLiteral("Job Template")));
        return jobTemplate;
    }
    std::string namedObjectTypeId() override { return QCJobTemplate::typeId(); }
};

// A client of any type, for naming only.
class TypedCallbacks : public DirEntryBrowserInterface
{
public:
    explicit TypedCallbacks(std::string typeId) : m_typeId(std::move(typeId)) {}
    std::shared_ptr<NamedObject> newNamedObject() override { return nullptr; }
    std::string namedObjectTypeId() override { return m_typeId; }

private:
    std::string m_typeId;
};

// A folder browser other than DirEntryBrowserWidget: a fixed list of names.
class FixedFolder : public FolderNames
{
public:
    std::vector<std::string> namesInTargetFolder() const override { return names; }
    void clientDestroyed(DirEntryBrowserInterface*) override {}
    std::vector<std::string> names;
};

// A browser over a real store, loaded and ready.
struct Browser
{
    explicit Browser(TempStore& store)
        : model(store.model()), widget()
    {
        widget.initialize(&model, &callbacks, QCJobTemplate::typeId(), QStringLiteral("Job Templates"),
                          QStringLiteral("New Job Template"), "Test", nullptr, false);
        QTest::qWait(0);
    }
    // The first node of name, anywhere or under folder.
    Node* find(const QString& name, Node* folder = nullptr) const
    {
        for (Node* node : model.descendants(folder ? folder : model.root())) {
            if (node->displayName() == name)
                return node;
        }
        return nullptr;
    }
    // Waits for the node of name, selects it and waits for its object.
    bool openLoaded(const QString& name)
    {
        if (!QTest::qWaitFor([&] { return find(name) != nullptr; }, 10000))
            return false;
        select(find(name));
        return QTest::qWaitFor([&] { return find(name)->object() != nullptr; }, 10000);
    }
    void select(Node* node)
    {
        widget.treeView()->selectionModel()->setCurrentIndex(model.indexFromNode(node),
                                                             QItemSelectionModel::ClearAndSelect);
    }
    void addToSelection(const QStringList& names)
    {
        for (const QString& name : names)
            widget.treeView()->selectionModel()->select(model.indexFromNode(find(name)), QItemSelectionModel::Select);
    }
    void modify(const QString& name) { widget.namedObjectWasModified(find(name)->object()); }
    // Waits for the message box the browser shows and gives its text.
    QString messageShown() const
    {
        if (!QTest::qWaitFor([this] { return widget.findChild<QMessageBox*>() != nullptr; }, 5000))
            return QStringLiteral("(no message)");
        return widget.findChild<QMessageBox*>()->text();
    }
    // The folder and entry commands as the menu offers them.
    QAction* action(const QString& text)
    {
        if (menu.isEmpty())
            widget.createCustomMenus(&menu, QStringLiteral("Job Template"), QStringLiteral("Job Templates"), true);
        for (QAction* candidate : menu.actions()) {
            if (candidate->text() == text)
                return candidate;
        }
        return nullptr;
    }
    QStringList namesIn(const Node* folder) const
    {
        QStringList names;
        for (const auto& child : (folder ? folder : model.root())->children())
            names << child->displayName();
        return names;
    }

    TemplateCallbacks callbacks;
    DirEntryTreeModel model;
    DirEntryBrowserWidget widget;
    QMenu menu;
};

std::string createFolder(TempStore& store, const std::string& name, const std::string& parentId = std::string())
{
    const auto answer = store.run(std::make_shared<CreateFolder>(QCJobTemplate::typeId(), parentId, name));
    const auto folder = std::dynamic_pointer_cast<FolderResponse>(answer.response);
    return folder ? folder->folder().id : std::string();
}

void storeTemplate(TempStore& store, const std::string& name, const std::string& folderId)
{
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    jobTemplate->setName(name);
    store.save(jobTemplate, &folderId);
}

} // namespace

class tst_DirEntryBrowser : public QObject
{
    Q_OBJECT

private slots:
    // Before the first sort: the browser's order is made once, in the default locale.
    void initTestCase() { QLocale::setDefault(QLocale(QLocale::German, QLocale::Germany)); }
    void init() { QSettings().clear(); }
    void newObjectAndSelectionSurviveRestart();
    void defaultNameIsFreeInTheFolder_data();
    void defaultNameIsFreeInTheFolder();
    void failedSaveKeepsObjectModified();
    void selectionCarriesLoadedObjects();
    void mayCloseAsksOnlyAboutUnsavedWork_data();
    void mayCloseAsksOnlyAboutUnsavedWork();
    void unsavedQuestionCountsTheObjects_data();
    void unsavedQuestionCountsTheObjects();
    void renameAndEditDuringSaveAreKept();
    void folderCommandsAskThenAct_data();
    void folderCommandsAskThenAct();
    void serverChangesRefreshTheBrowser();
    void refreshFindsChangesOfAnotherProgram_data();
    void refreshFindsChangesOfAnotherProgram();
    void saveConflictOffersCopyOrReload_data();
    void saveConflictOffersCopyOrReload();
    void editedObjectSurvivesDeletionElsewhere_data();
    void editedObjectSurvivesDeletionElsewhere();
    void deleteQuestionSaysWhatGoes_data();
    void deleteQuestionSaysWhatGoes();
    void mouseDragDoesNotSweepARange();
    void nameCheckRefusesBlankAndTakenNames_data();
    void nameCheckRefusesBlankAndTakenNames();
    void renameDialogKeepsOkDisabledForRefusedNames();
    void readOnlyStoreDisablesEditing_data();
    void readOnlyStoreDisablesEditing();
    void openPickerTellsPlacesApart_data();
    void openPickerTellsPlacesApart();
    void pickerWithLongNameFitsTheScreen();
    void movePickerOffersOnlyPlacesToGo_data();
    void movePickerOffersOnlyPlacesToGo();
    void entryDeletedElsewhereIsSaidAndRemoved_data();
    void entryDeletedElsewhereIsSaidAndRemoved();
    void refreshKeepsOpenFoldersAndSelection_data();
    void refreshKeepsOpenFoldersAndSelection();
    void namesSortAsPeopleRead();
};

// A new template takes the first free name of the selected folder (names in
// other folders do not count); once saved, it is there once, also after
// reloads and a restart, and the entry selected last is selected again, its
// folder opened.
void tst_DirEntryBrowser::newObjectAndSelectionSurviveRestart()
{
    TempStore store;
    const std::string folder = createFolder(store, "Folder");
    storeTemplate(store, "Job Template", folder);
    storeTemplate(store, "Job Template 3", folder);
    storeTemplate(store, "Job Template 2", createFolder(store, "Other"));
    {
        Browser browser(store);
        QTRY_VERIFY(browser.find("Folder") && browser.find("Job Template 3"));
        browser.select(browser.find("Folder"));
        QVERIFY(!browser.widget.actionSave()->isEnabled());
        browser.widget.actionNew()->trigger();
        const auto created = [&] { return browser.find("Job Template 2", browser.find("Folder")); };
        QVERIFY(created() && created()->isModified());
        QVERIFY(browser.widget.actionSave()->isEnabled());
        // The listing runs before the save in the store, so its answer does not
        // hold the new entry yet, while the save's answer comes after it.
        browser.widget.refresh();
        browser.widget.actionSave()->trigger();
        QTRY_VERIFY(created() && !created()->isModified());
        QVERIFY(!browser.widget.actionSave()->isEnabled());
        browser.widget.refresh();
        QTest::qWait(200);
        QCOMPARE(browser.namesIn(browser.find("Folder")), (QStringList{"Job Template", "Job Template 2", "Job Template 3"}));
        QVERIFY(browser.openLoaded("Job Template 3"));
    }
    store.reopen();
    Browser restarted(store);
    QTRY_VERIFY(restarted.widget.treeView()->selectionModel()->selectedRows().size() == 1);
    QVERIFY(restarted.find("Job Template 2", restarted.find("Folder")));
    Node* selected = restarted.model.nodeFromIndex(restarted.widget.treeView()->selectionModel()->selectedRows().first());
    QCOMPARE(selected->displayName(), QStringLiteral("Job Template 3"));
    QTRY_VERIFY(selected->object());
    QVERIFY(restarted.widget.treeView()->isExpanded(restarted.model.indexFromNode(selected->parent())));
}

void tst_DirEntryBrowser::defaultNameIsFreeInTheFolder_data()
{
    QTest::addColumn<QString>("typeId");
    QTest::addColumn<QString>("base");
    QTest::addColumn<bool>("withBrowser");
    QTest::addColumn<QStringList>("taken");
    QTest::addColumn<QString>("expected");
    const QString configuration = QString::fromStdString(MeasurementConfiguration::typeId());
    QTest::newRow("measurement configuration without a browser")
        << configuration << QString() << false << QStringList{} << "Measurement Configuration";
    QTest::newRow("measurement configuration whose name is taken in the folder")
        << configuration << QString() << true
        << QStringList{"Measurement Configuration", "Measurement Configuration 2"} << "Measurement Configuration 3";
    QTest::newRow("a base text is used as given, the gap filled")
        << configuration << "D65 Setup" << true << QStringList{"D65 Setup", "D65 Setup 3"} << "D65 Setup 2";
    QTest::newRow("a type without a name of its own")
        << "vemi.Unknown" << QString() << true << QStringList{"Object"} << "Object 2";
}

void tst_DirEntryBrowser::defaultNameIsFreeInTheFolder()
{
    QFETCH(QString, typeId);
    QFETCH(QString, base);
    QFETCH(bool, withBrowser);
    QFETCH(QStringList, taken);
    QFETCH(QString, expected);
    FixedFolder folder;
    for (const QString& name : taken)
        folder.names.push_back(name.toStdString());
    TypedCallbacks callbacks(typeId.toStdString());
    if (withBrowser)
        callbacks.setFolderBrowser(&folder);
    QCOMPARE(QString::fromStdString(callbacks.defaultNamedObjectName(base)), expected);
}

// An edit marks the template and enables Save; a save that fails says why and
// keeps both.
void tst_DirEntryBrowser::failedSaveKeepsObjectModified()
{
    StoreOptions impatient;
    impatient.busyTimeoutMs = 100;
    TempStore store(impatient);
    storeTemplate(store, "Door Panel", "");
    Browser browser(store);
    QVERIFY(browser.openLoaded("Door Panel"));
    QVERIFY(!browser.widget.actionSave()->isEnabled());
    browser.modify("Door Panel");
    QCOMPARE(browser.model.indexFromNode(browser.find("Door Panel")).data().toString(), QStringLiteral("Door Panel *"));
    QVERIFY(browser.widget.actionSave()->isEnabled());
    // Another program holds the write lock for as long as the save tries.
    RawConnection other(store.path());
    QVERIFY(other.exec(QStringLiteral("BEGIN EXCLUSIVE")));

    browser.widget.actionSave()->trigger();
    const QString message = browser.messageShown();
    QVERIFY2(message.contains(QStringLiteral("locked")), qPrintable(message));
    QVERIFY(browser.find("Door Panel")->isModified());
    QVERIFY(browser.widget.actionSave()->isEnabled());
    QVERIFY(other.exec(QStringLiteral("ROLLBACK")));
}

// Selected together, the loaded objects are announced once; a damaged one is
// said so and left out.
void tst_DirEntryBrowser::selectionCarriesLoadedObjects()
{
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    storeTemplate(store, "Dashboard", "");
    storeTemplate(store, "Bumper", "");
    QVERIFY(RawConnection(store.path()).exec(QStringLiteral("UPDATE objects SET data = ? WHERE name = 'Bumper'"),
                                             {QByteArray("\xa1\x01", 2)}));
    Browser browser(store);
    QTRY_VERIFY(browser.find("Dashboard") && browser.find("Bumper"));
    QSignalSpy selections(&browser.widget, &DirEntryBrowserWidget::sgSelectionChanged);

    browser.addToSelection({"Dashboard", "Bumper", "Door Panel"});
    // Each click replaces the one before while its objects load: one announcement.
    QTRY_COMPARE(selections.count(), 1);
    const auto nodes = selections.last().first().value<QVector<Node*>>();
    QStringList names;
    for (Node* node : nodes) {
        QVERIFY(node->object());
        names << QString::fromStdString(node->object()->name());
    }
    names.sort();
    QCOMPARE(names, (QStringList{"Dashboard", "Door Panel"}));
    QVERIFY(browser.messageShown().contains(QStringLiteral("damaged")));
}

void tst_DirEntryBrowser::mayCloseAsksOnlyAboutUnsavedWork_data()
{
    QTest::addColumn<bool>("readOnly");
    QTest::addColumn<bool>("modified");
    QTest::addColumn<int>("answer");
    QTest::addColumn<bool>("mayClose");
    QTest::addColumn<bool>("savedAfterwards");
    QTest::newRow("nothing unsaved closes without asking") << false << false << 0 << true << true;
    QTest::newRow("cancel keeps the tab open") << false << true << int(QMessageBox::Cancel) << false << false;
    QTest::newRow("discard closes without saving") << false << true << int(QMessageBox::Discard) << true << false;
    QTest::newRow("save stores the object and closes") << false << true << int(QMessageBox::Save) << true << true;
    QTest::newRow("a read-only store offers only to lose the edit or stay")
        << true << true << int(QMessageBox::Cancel) << false << false;
}

void tst_DirEntryBrowser::mayCloseAsksOnlyAboutUnsavedWork()
{
    QFETCH(bool, readOnly);
    QFETCH(bool, modified);
    QFETCH(int, answer);
    QFETCH(bool, mayClose);
    QFETCH(bool, savedAfterwards);
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    if (readOnly)
        store.reopenReadOnly();
    Browser browser(store);
    QVERIFY(browser.openLoaded("Door Panel"));
    auto jobTemplate = std::dynamic_pointer_cast<QCJobTemplate>(browser.find("Door Panel")->object());
    if (modified) {
        jobTemplate->setDescription("edited");
        browser.widget.namedObjectWasModified(jobTemplate);
        QCOMPARE(browser.widget.actionSave()->isEnabled(), !readOnly);
    }
    QString question;
    QStringList buttons;
    QString defaultButton;
    if (answer) {
        ModalAnswer::actOnNextModal([&](QWidget* dialog) {
            auto* box = qobject_cast<QMessageBox*>(dialog);
            QVERIFY(box && box->button(QMessageBox::StandardButton(answer)));
            question = box->text();
            for (QAbstractButton* button : box->buttons())
                buttons << button->text();
            defaultButton = box->defaultButton() ? box->defaultButton()->text() : QString();
            box->button(QMessageBox::StandardButton(answer))->click();
        });
    }

    QCOMPARE(browser.widget.mayClose(), mayClose);
    QCOMPARE(question.isEmpty(), !answer);
    if (answer) {
        QVERIFY2(question.contains("Door Panel") && question.contains("read-only") == readOnly, qPrintable(question));
        buttons.sort();
        QCOMPARE(buttons, readOnly ? QStringList({"&Cancel", "&Discard"}) : QStringList({"&Cancel", "&Discard", "&Save"}));
        QCOMPARE(defaultButton, readOnly ? QStringLiteral("&Cancel") : QStringLiteral("&Save"));
    }
    const auto stored = std::dynamic_pointer_cast<QCJobTemplate>(store.fetch(QCJobTemplate::typeId(), jobTemplate->id()));
    QVERIFY(stored);
    QCOMPARE(stored->description() == "edited", modified && savedAfterwards);
}

void tst_DirEntryBrowser::unsavedQuestionCountsTheObjects_data()
{
    QTest::addColumn<int>("count");
    QTest::addColumn<bool>("menusFirst");
    QTest::addColumn<QString>("expected");
    const QString one = QStringLiteral("This Job Template has unsaved changes. Save it before closing?");
    const QString three = QStringLiteral("These 3 Job Templates have unsaved changes. Save them before closing?");
    QTest::newRow("one object, no menus set up") << 1 << false << one;
    QTest::newRow("three objects, menus set up before") << 3 << true << three;
}

void tst_DirEntryBrowser::unsavedQuestionCountsTheObjects()
{
    QFETCH(int, count);
    QFETCH(bool, menusFirst);
    QFETCH(QString, expected);
    TempStore store;
    Browser browser(store);
    if (menusFirst)
        QVERIFY(browser.action("Delete"));
    for (int i = 0; i < count; ++i)
        browser.widget.actionNew()->trigger();
    QString question;
    ModalAnswer::clickInNextMessageBox(QMessageBox::Cancel, &question);

    QVERIFY(!browser.widget.mayClose());
    QVERIFY2(question.startsWith(expected), qPrintable(question));
    for (const QString& name : browser.namesIn(nullptr))
        QVERIFY2(question.contains(QStringLiteral("• ") + name), qPrintable(question));
}

// A rename whose answer has not come yet reaches the save sent after it. An
// edit that arrives while its object is being saved is not in the store: the
// object must stay marked, or closing would lose the edit without asking.
void tst_DirEntryBrowser::renameAndEditDuringSaveAreKept()
{
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    Browser browser(store);
    QVERIFY(browser.openLoaded("Door Panel"));
    Node* node = browser.find("Door Panel");
    auto jobTemplate = std::dynamic_pointer_cast<QCJobTemplate>(node->object());
    QSignalSpy saved(&browser.model, &DirEntryTreeModel::sgItemChanged);
    browser.modify("Door Panel");
    browser.model.renameNode(node, "Door Trim", {});
    browser.widget.actionSave()->trigger();
    // The store answers through the event loop, so this edit comes before the answer.
    jobTemplate->setDescription("edited while saving");
    browser.widget.namedObjectWasModified(jobTemplate);

    // The rename's answer, then the save's.
    QTRY_COMPARE(saved.count(), 2);
    const auto stored = store.fetch(QCJobTemplate::typeId(), jobTemplate->id());
    QVERIFY(stored);
    QCOMPARE(stored->header()->name(), std::string("Door Trim"));
    QVERIFY(node->isModified());
    QVERIFY(browser.widget.actionSave()->isEnabled());
    ModalAnswer::clickInNextMessageBox(QMessageBox::Cancel);
    QVERIFY(!browser.widget.mayClose());
}

void tst_DirEntryBrowser::folderCommandsAskThenAct_data()
{
    QTest::addColumn<QString>("command");
    QTest::addColumn<QStringList>("answers");
    QTest::addColumn<QStringList>("topLevel");
    QTest::addColumn<QString>("question");
    // The tree holds the folders "Interior" and "New Folder" and the template
    // "Door Panel", which is selected.
    const QStringList unchanged{"Interior", "New Folder", "Door Panel"};
    QTest::newRow("new folder suggests a free name")
        << "New Folder…" << QStringList{"Trim"} << QStringList{"Interior", "New Folder", "Trim", "Door Panel"}
        << "New Folder: Folder name: [New Folder 2]";
    QTest::newRow("cancelled new folder creates nothing")
        << "New Folder…" << QStringList{} << unchanged << "New Folder: Folder name: [New Folder 2]";
    QTest::newRow("rename changes the entry's name")
        << "Rename…" << QStringList{"Door Trim"} << QStringList{"Interior", "New Folder", "Door Trim"}
        << "Rename: New name: [Door Panel]";
    QTest::newRow("rename to the name of another entry of the folder is refused")
        << "Rename…" << QStringList{"New Folder"} << unchanged
        << "Rename: New name: [Door Panel] refused: \"New Folder\" is already used in this folder.";
    QTest::newRow("new folder with a name taken in its folder is refused")
        << "New Folder…" << QStringList{"Interior"} << unchanged
        << "New Folder: Folder name: [New Folder 2] refused: \"Interior\" is already used in this folder.";
    QTest::newRow("confirmed delete removes the entry")
        << "Delete" << QStringList{"yes"} << QStringList{"Interior", "New Folder"}
        << "Delete: Delete the Job Template \"Door Panel\"? This cannot be undone. [default No]";
}

void tst_DirEntryBrowser::folderCommandsAskThenAct()
{
    QFETCH(QString, command);
    QFETCH(QStringList, answers);
    QFETCH(QStringList, topLevel);
    QFETCH(QString, question);
    TempStore store;
    createFolder(store, "Interior");
    storeTemplate(store, "Door Panel", "");
    createFolder(store, "New Folder");
    Browser browser(store);
    QVERIFY(browser.openLoaded("Door Panel"));

    ScriptedAsker asker;
    for (const QString& answer : answers) {
        if (command == QStringLiteral("Delete"))
            asker.scriptConfirm(answer == QLatin1String("yes"));
        else
            asker.scriptText(answer);
    }
    browser.widget.folderCommands()->setAsker(&asker);
    QAction* action = browser.action(command);
    QVERIFY(action && action->isEnabled());
    action->trigger();

    QCOMPARE(asker.asked(), QStringList{question});
    QTRY_COMPARE(browser.namesIn(nullptr), topLevel);
    // What the tree shows is what the store holds.
    Browser restarted(store);
    QTRY_COMPARE(restarted.namesIn(nullptr), topLevel);
}

// On a server the browser hears of another program's saves by itself.
void tst_DirEntryBrowser::serverChangesRefreshTheBrowser()
{
    if (!TestPostgresServer::shared())
        QSKIP(qPrintable(QStringLiteral("no PostgreSQL test server: ") + TestPostgresServer::skipReason()));
    TempStore::setBackend(TempStore::Backend::Postgres);
    const auto sqliteAgain = qScopeGuard([] { TempStore::setBackend(TempStore::Backend::Sqlite); });
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    Browser browser(store);
    QVERIFY(browser.openLoaded("Door Panel"));
    const auto opened = browser.find("Door Panel")->object();
    MarloModel other(store.path());
    QCOMPARE(other.open(), QString());
    auto theirs = std::static_pointer_cast<NamedObject>(ObjectCodec::clone<BaseObject>(*opened));
    theirs->setStoredRevision(opened->storedRevision());
    theirs->setName("Door Panel, theirs");
    auto save = std::make_shared<UpdateObject>();
    save->setObject(theirs);
    QVERIFY(!CommandSender::sendAndWait(other, std::string(), save, 20000).error);

    QTRY_VERIFY_WITH_TIMEOUT(browser.find("Door Panel, theirs") && browser.find("Door Panel, theirs")->object(), 10000);
    QVERIFY(browser.find("Door Panel, theirs")->object() != opened);
}

void tst_DirEntryBrowser::refreshFindsChangesOfAnotherProgram_data()
{
    QTest::addColumn<bool>("changedHere");
    QTest::newRow("unchanged here: the stored version is read and handed on") << false;
    QTest::newRow("changed here: the edit is kept") << true;
}

void tst_DirEntryBrowser::refreshFindsChangesOfAnotherProgram()
{
    QFETCH(bool, changedHere);
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    Browser browser(store);
    QVERIFY(browser.openLoaded("Door Panel"));
    auto* node = static_cast<DirEntryTreeModel::DirEntryNode*>(browser.find("Door Panel"));
    const auto opened = node->object();
    if (changedHere)
        browser.modify("Door Panel");
    QProcess other;
    other.start(QCoreApplication::applicationDirPath() + QStringLiteral("/storesaver"),
                {store.path(), QString::fromStdString(QCJobTemplate::typeId()), QString::fromStdString(opened->id()),
                 QStringLiteral("Door Panel, theirs")});
    QVERIFY(other.waitForStarted(5000));
    other.write("go\n");
    QVERIFY(other.waitForFinished(20000));
    QCOMPARE(other.readAllStandardOutput(), QByteArray("read\nsaved\n"));
    QSignalSpy handedOn(&browser.widget, &DirEntryBrowserWidget::sgSelectionChanged);

    browser.widget.refresh();
    QTRY_COMPARE(node->dirEntry()->header()->name(), std::string("Door Panel, theirs"));
    if (changedHere) {
        QCOMPARE(node->object(), opened);
        QVERIFY(node->isModified());
        return;
    }
    QTRY_VERIFY(node->object() && node->object() != opened);
    QCOMPARE(node->object()->name(), std::string("Door Panel, theirs"));
    QTRY_VERIFY(!handedOn.isEmpty());
    QCOMPARE(handedOn.last().first().value<QVector<Node*>>(), QVector<Node*>{node});
}

void tst_DirEntryBrowser::saveConflictOffersCopyOrReload_data()
{
    QTest::addColumn<int>("choice"); // -1: cancel
    QTest::addColumn<QString>("edited");   // the description of the open object afterwards
    QTest::addColumn<bool>("modified");
    QTest::addColumn<bool>("copied");
    QTest::newRow("save as copy: the edit is a new entry, the original shows the stored version")
        << 0 << "theirs" << false << true;
    QTest::newRow("reload: the stored version replaces the edit") << 1 << "theirs" << false << false;
    QTest::newRow("cancel: the edit stays open, unsaved") << -1 << "mine" << true << false;
}

// The template is saved elsewhere while it is open here with changes: the
// save here is refused and the user chooses what becomes of the edit.
void tst_DirEntryBrowser::saveConflictOffersCopyOrReload()
{
    QFETCH(int, choice);
    QFETCH(QString, edited);
    QFETCH(bool, modified);
    QFETCH(bool, copied);
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    Browser browser(store);
    ScriptedAsker asker;
    asker.scriptChoice(choice < 0 ? std::nullopt : std::optional<int>(choice));
    browser.widget.folderCommands()->setAsker(&asker);
    QVERIFY(browser.openLoaded("Door Panel"));
    const auto id = browser.find("Door Panel")->object()->id();
    browser.find("Door Panel")->object()->setDescription("mine");
    browser.modify("Door Panel");
    const auto elsewhere = std::static_pointer_cast<NamedObject>(store.fetch(QCJobTemplate::typeId(), id));
    elsewhere->setDescription("theirs");
    QVERIFY(store.save(elsewhere));

    browser.widget.actionSave()->trigger();
    QTRY_COMPARE(asker.asked().size(), 1);
    QVERIFY2(asker.asked().first().contains(
                 QStringLiteral("\"Door Panel\" at the top level (id %1) was changed elsewhere since it was opened")
                     .arg(QString::fromStdString(id))),
             qPrintable(asker.asked().first()));
    Node* original = browser.find("Door Panel");
    QTRY_VERIFY(original->object() && original->object()->description() == edited.toStdString());
    QCOMPARE(original->isModified(), modified);
    QTRY_COMPARE(browser.find("Door Panel (copy)") != nullptr, copied);
    if (copied) {
        auto* copy = static_cast<DirEntryTreeModel::DirEntryNode*>(browser.find("Door Panel (copy)"));
        QTRY_VERIFY(copy->isSaved() && !copy->isModified());
        const auto stored = std::static_pointer_cast<NamedObject>(
            store.fetch(QCJobTemplate::typeId(), copy->object()->id()));
        QVERIFY(stored && stored->description() == "mine");
    }
    const auto stored = std::static_pointer_cast<NamedObject>(store.fetch(QCJobTemplate::typeId(), id));
    QCOMPARE(QString::fromStdString(stored->description()), QStringLiteral("theirs"));
}

void tst_DirEntryBrowser::editedObjectSurvivesDeletionElsewhere_data()
{
    QTest::addColumn<bool>("inFolder");
    QTest::newRow("entry at the top level deleted") << false;
    QTest::newRow("entry's folder deleted with it") << true;
}

void tst_DirEntryBrowser::editedObjectSurvivesDeletionElsewhere()
{
    QFETCH(bool, inFolder);
    TempStore store;
    const std::string folder = inFolder ? createFolder(store, "Interior") : std::string();
    storeTemplate(store, "Door Panel", folder);
    Browser browser(store);
    QVERIFY(browser.openLoaded("Door Panel"));
    auto* node = static_cast<DirEntryTreeModel::DirEntryNode*>(browser.find("Door Panel"));
    const auto object = node->object();
    browser.modify("Door Panel");
    using Ids = std::vector<std::string>;
    QVERIFY(!store.run(std::make_shared<DeleteDirItems>(inFolder ? Ids{folder} : Ids{},
                                                        inFolder ? Ids{} : Ids{node->dirEntry()->id()})).error);

    browser.widget.refresh();
    QTRY_VERIFY(!static_cast<DirEntryTreeModel::DirEntryNode*>(browser.find("Door Panel"))->isSaved());
    node = static_cast<DirEntryTreeModel::DirEntryNode*>(browser.find("Door Panel"));
    QCOMPARE(node->object(), object);
    QVERIFY(node->isModified());
    QCOMPARE(node->parent(), browser.model.root());

    browser.select(node);
    browser.widget.actionSave()->trigger();
    QTRY_VERIFY(node->isSaved() && !node->isModified());
    QVERIFY(store.fetch(QCJobTemplate::typeId(), object->id()));
}

void tst_DirEntryBrowser::deleteQuestionSaysWhatGoes_data()
{
    QTest::addColumn<QStringList>("selected");
    QTest::addColumn<QString>("question");
    // "Bumpers" holds "Bumper Left" (changed, not saved), "Bumper Right",
    // "Bumper Rear" and the folder "Clips" with "Clip A"; "Spare" is empty.
    const QString undone = QStringLiteral(" This cannot be undone.");
    const QString lost = QStringLiteral("\n\nUnsaved changes will be lost in:\n  • Bumper Left");
    const QString defaultNo = QStringLiteral(" [default No]");
    QTest::newRow("one template is named alone, not with everything in it")
        << QStringList{"Door Panel"} << "Delete: Delete the Job Template \"Door Panel\"?" + undone + defaultNo;
    QTest::newRow("one unsaved template says its changes go too")
        << QStringList{"Bumper Left"} << "Delete: Delete the Job Template \"Bumper Left\"?" + undone + lost + defaultNo;
    QTest::newRow("a folder counts what is in it and names the unsaved template")
        << QStringList{"Bumpers"}
        << "Delete: Delete the folder \"Bumpers\" with everything in it: 4 Job Templates and 1 folder?" + undone
               + lost + defaultNo;
    QTest::newRow("an empty folder says so")
        << QStringList{"Spare"} << "Delete: Delete the empty folder \"Spare\"?" + undone + defaultNo;
    QTest::newRow("several templates are counted")
        << QStringList{"Door Panel", "Bumper Rear"} << "Delete: Delete these 2 Job Templates?" + undone + defaultNo;
    QTest::newRow("a template inside a selected folder is counted once")
        << QStringList{"Bumpers", "Bumper Right", "Door Panel"}
        << "Delete: Delete these 2 items with everything in them: 5 Job Templates and 2 folders in all?" + undone
               + lost + defaultNo;
}

void tst_DirEntryBrowser::deleteQuestionSaysWhatGoes()
{
    QFETCH(QStringList, selected);
    QFETCH(QString, question);
    TempStore store;
    const std::string bumpers = createFolder(store, "Bumpers");
    for (const char* name : {"Bumper Left", "Bumper Right", "Bumper Rear"})
        storeTemplate(store, name, bumpers);
    storeTemplate(store, "Clip A", createFolder(store, "Clips", bumpers));
    storeTemplate(store, "Door Panel", "");
    createFolder(store, "Spare");
    Browser browser(store);
    QVERIFY(browser.openLoaded("Bumper Left"));
    browser.modify("Bumper Left");
    browser.widget.treeView()->selectionModel()->clearSelection();
    browser.addToSelection(selected);
    ScriptedAsker asker;
    browser.widget.folderCommands()->setAsker(&asker);

    browser.action("Delete")->trigger();
    QCOMPARE(asker.asked(), QStringList{question});
    // Declined: everything stays.
    QTest::qWait(50);
    for (const QString& name : selected)
        QVERIFY2(browser.find(name), qPrintable(name));
}

// A press on one entry, a move over others with the button held and a
// release must leave one entry selected: a sweep made "Delete 8 items" out
// of what the user meant as a click.
void tst_DirEntryBrowser::mouseDragDoesNotSweepARange()
{
    TempStore store;
    for (const char* name : {"Part 1", "Part 2", "Part 3", "Part 4"})
        storeTemplate(store, name, "");
    Browser browser(store);
    QTRY_VERIFY(browser.find("Part 4"));
    browser.widget.resize(300, 400);
    browser.widget.show();
    QVERIFY(QTest::qWaitForWindowExposed(&browser.widget));
    QTreeView* tree = browser.widget.treeView();
    const auto centreOf = [&](const QString& name) {
        return tree->visualRect(browser.model.indexFromNode(browser.find(name))).center();
    };
    const QPoint from = centreOf(QStringLiteral("Part 1"));
    const QPoint to = centreOf(QStringLiteral("Part 4"));
    // Sent by hand: QTest::mouseMove carries no held button.
    QTest::mousePress(tree->viewport(), Qt::LeftButton, Qt::NoModifier, from);
    for (int y = from.y(); y <= to.y(); y += 4) {
        QMouseEvent move(QEvent::MouseMove, QPoint(from.x(), y), tree->viewport()->mapToGlobal(QPoint(from.x(), y)),
                         Qt::NoButton, Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(tree->viewport(), &move);
    }
    QTest::mouseRelease(tree->viewport(), Qt::LeftButton, Qt::NoModifier, to);
    QCOMPARE(tree->selectionModel()->selectedRows().size(), 1);

    // Ctrl+click still adds to the selection.
    QTest::mouseClick(tree->viewport(), Qt::LeftButton, Qt::ControlModifier, centreOf(QStringLiteral("Part 3")));
    QCOMPARE(tree->selectionModel()->selectedRows().size(), 2);
}

void tst_DirEntryBrowser::nameCheckRefusesBlankAndTakenNames_data()
{
    QTest::addColumn<QString>("name");
    QTest::addColumn<QString>("problem");
    QTest::newRow("a free name is fine") << "Bumper Rear" << "";
    QTest::newRow("an empty name is refused") << "" << "A name cannot be empty.";
    QTest::newRow("blanks only are refused") << " \t " << "A name cannot be empty.";
    QTest::newRow("a name taken in the folder is refused")
        << "Bumper Left" << "\"Bumper Left\" is already used in this folder.";
    QTest::newRow("blanks around a taken name do not make it free")
        << "  Bumper Left " << "\"Bumper Left\" is already used in this folder.";
    QTest::newRow("a name that only begins like a taken one is fine") << "Bumper Left 2" << "";
}

void tst_DirEntryBrowser::nameCheckRefusesBlankAndTakenNames()
{
    QFETCH(QString, name);
    QFETCH(QString, problem);
    QCOMPARE(NameCheck::problem(name, {"Bumper Left", "Clips"}), problem);
}

// The real dialog of the browser's Rename, driven by keys.
void tst_DirEntryBrowser::renameDialogKeepsOkDisabledForRefusedNames()
{
    TempStore store;
    storeTemplate(store, "Bumper Left", "");
    storeTemplate(store, "Bumper Right", "");
    Browser browser(store);
    QVERIFY(browser.openLoaded("Bumper Right"));
    // What the dialog shows at each step: whether OK is enabled, and the problem.
    QStringList seen;
    ModalAnswer::actOnNextModal([&seen](QWidget* modal) {
        auto* dialog = qobject_cast<NameDialog*>(modal);
        if (!dialog) {
            modal->close();
            QFAIL("expected the name dialog");
        }
        auto* edit = dialog->findChild<QLineEdit*>();
        QPushButton* ok = dialog->findChild<QDialogButtonBox*>()->button(QDialogButtonBox::Ok);
        auto* problem = dialog->findChild<QLabel*>(QStringLiteral("problem"));
        const auto note = [&](const QString& step) {
            seen << step + (ok->isEnabled() ? ": OK" : ": no OK") + (problem->isVisible() ? ", " + problem->text() : QString());
        };
        note(QStringLiteral("suggestion"));
        // The suggestion is selected: typing replaces it.
        QTest::keyClicks(edit, QStringLiteral("Bumper Left"));
        note(QStringLiteral("taken"));
        edit->selectAll();
        QTest::keyClick(edit, Qt::Key_Space);
        QTest::keyClick(edit, Qt::Key_Return);
        note(dialog->isVisible() ? QStringLiteral("blank, Enter, still open") : QStringLiteral("blank, Enter, closed"));
        edit->selectAll();
        QTest::keyClicks(edit, QStringLiteral("Bumper Rear"));
        QTest::keyClick(edit, Qt::Key_Return);
    });
    browser.action("Rename…")->trigger();

    QCOMPARE(seen, (QStringList{"suggestion: OK", "taken: no OK, \"Bumper Left\" is already used in this folder.",
                                "blank, Enter, still open: no OK, A name cannot be empty."}));
    QTRY_VERIFY(browser.find("Bumper Rear"));
    QCOMPARE(browser.namesIn(nullptr), (QStringList{"Bumper Left", "Bumper Rear"}));
}

void tst_DirEntryBrowser::readOnlyStoreDisablesEditing_data()
{
    QTest::addColumn<QString>("how");
    QTest::addColumn<bool>("writable");
    QTest::newRow("a writable store offers every action") << "writable" << true;
    QTest::newRow("a store opened read-only") << "read-only option" << false;
    QTest::newRow("a store whose folder the user may not write") << "folder not writable" << false;
}

void tst_DirEntryBrowser::readOnlyStoreDisablesEditing()
{
    QFETCH(QString, how);
    QFETCH(bool, writable);
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    QFile::Permissions permissions = QFile::permissions(store.folder());
    if (how == QLatin1String("read-only option")) {
        store.reopenReadOnly();
    } else if (how == QLatin1String("folder not writable")) {
        QVERIFY(QFile::setPermissions(store.folder(), QFile::ReadOwner | QFile::ExeOwner));
        if (QFileInfo(store.folder()).isWritable()) {
            QFile::setPermissions(store.folder(), permissions);
            QSKIP("this user may write any folder (root)");
        }
    }
    Browser browser(store);
    QVERIFY(browser.openLoaded("Door Panel"));
    ScriptedAsker asker;
    browser.widget.folderCommands()->setAsker(&asker);
    browser.widget.show();
    QVERIFY(QTest::qWaitForWindowActive(&browser.widget));
    browser.widget.treeView()->setFocus();

    QCOMPARE(browser.widget.isWritable(), writable);
    for (const char* text : {"New Job Template", "New Folder…", "Rename…", "Move To…", "Delete"}) {
        QAction* action = text == QLatin1String("New Job Template") ? browser.widget.actionNew() : browser.action(text);
        QVERIFY2(action && action->isEnabled() == writable, qPrintable(text));
    }
    QVERIFY(browser.action("Open Job Template…")->isEnabled());
    QCOMPARE(browser.widget.findChild<QLabel*>()->text().contains(QStringLiteral("(read-only)")), !writable);
    // Del asks only where deleting can succeed.
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Delete);
    QCOMPARE(asker.asked().size(), writable ? 1 : 0);
    QFile::setPermissions(store.folder(), permissions);
    if (how != QLatin1String("read-only option"))
        return;
    // A rename sent all the same, as if the store had become read-only since, is
    // refused, and the open object keeps its stored name: a later save would
    // otherwise store a name never confirmed.
    asker.scriptText(QStringLiteral("Door Trim"));
    Node* node = browser.find("Door Panel");
    browser.widget.folderCommands()->rename(node);
    QVERIFY(browser.messageShown().contains(QStringLiteral("read-only")));
    QCOMPARE(node->displayName(), QStringLiteral("Door Panel"));
    QCOMPARE(node->object()->name(), std::string("Door Panel"));
}

namespace {

// The picker's rows as "name[child, child]", top-level rows joined by ", ".
QString pickerRows(const QAbstractItemModel* model, const QModelIndex& parent = {})
{
    QStringList rows;
    for (int row = 0; row < model->rowCount(parent); ++row) {
        const QModelIndex index = model->index(row, 0, parent);
        const QString children = pickerRows(model, index);
        rows << index.data().toString() + (children.isEmpty() ? QString() : QLatin1Char('[') + children + QLatin1Char(']'));
    }
    return rows.join(QStringLiteral(", "));
}

// The row reached through the names of path, from the top.
QModelIndex pickerRow(const QAbstractItemModel* model, const QStringList& path)
{
    QModelIndex current;
    for (const QString& name : path) {
        const QModelIndexList found =
            model->match(model->index(0, 0, current), Qt::DisplayRole, name, 1, Qt::MatchExactly);
        if (found.isEmpty())
            return {};
        current = found.first();
    }
    return current;
}

QStringList pathOf(const QModelIndex& index)
{
    QStringList path;
    for (QModelIndex at = index; at.isValid(); at = at.parent())
        path.prepend(at.data().toString());
    return path;
}

// What a test saw of the picker that it answered.
struct PickerSeen
{
    bool appeared = false;
    QString rows;
    QStringList preselected;
    bool okEnabled = false;
    bool stayedOpen = false;
};

// Answers the next modal dialog, which must be a TreePickerDialog: chooses the
// row at path with Enter or a double-click, or cancels when path is empty.
void answerNextPicker(PickerSeen* seen, const QStringList& path, bool doubleClick = false)
{
    ModalAnswer::actOnNextModal([seen, path, doubleClick](QWidget* modal) {
        auto* picker = qobject_cast<TreePickerDialog*>(modal);
        if (!picker) {
            modal->close();
            return;
        }
        QTreeView* view = picker->view();
        seen->appeared = true;
        seen->rows = pickerRows(view->model());
        seen->preselected = pathOf(view->currentIndex());
        const QModelIndex row = pickerRow(view->model(), path);
        if (!row.isValid()) {
            picker->reject();
            return;
        }
        view->scrollTo(row);
        view->setCurrentIndex(row);
        seen->okEnabled = picker->findChild<QDialogButtonBox*>()->button(QDialogButtonBox::Ok)->isEnabled();
        if (doubleClick) {
            // As a mouse sends it: a click, then the second press as a double-click.
            const QPoint at = view->visualRect(row).center();
            QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, at);
            QTest::mouseDClick(view->viewport(), Qt::LeftButton, {}, at);
        } else
            QTest::keyClick(view, Qt::Key_Return);
        seen->stayedOpen = picker->isVisible();
        if (seen->stayedOpen)
            picker->reject();
    });
}

// The folders that hold node, from the top.
QStringList folderPath(const Browser& browser, const Node* node)
{
    QStringList path;
    for (const std::string& folder : browser.model.pathOf(node->parent()))
        path << QString::fromStdString(folder);
    return path;
}

QStringList selectedNames(const Browser& browser)
{
    QStringList names;
    for (const QModelIndex& index : browser.widget.treeView()->selectionModel()->selectedRows())
        names << browser.model.nodeFromIndex(index)->displayName();
    return names;
}

} // namespace

void tst_DirEntryBrowser::openPickerTellsPlacesApart_data()
{
    QTest::addColumn<QStringList>("path");
    QTest::addColumn<bool>("doubleClick");
    QTest::addColumn<QString>("openedIn");
    QTest::newRow("the template in the folder, chosen with Enter")
        << QStringList{"Door A", "B 3/4"} << false << "Door A";
    QTest::newRow("the template whose name looks like that path, chosen with a double-click")
        << QStringList{"Door A/B 3/4"} << true << QString();
    QTest::newRow("a folder is no choice: Enter leaves the picker open") << QStringList{"Door A"} << false << "-";
}

void tst_DirEntryBrowser::openPickerTellsPlacesApart()
{
    QFETCH(QStringList, path);
    QFETCH(bool, doubleClick);
    QFETCH(QString, openedIn);
    TempStore store;
    storeTemplate(store, "B 3/4", createFolder(store, "Door A"));
    storeTemplate(store, "Door A/B 3/4", "");
    Browser browser(store);
    QTRY_VERIFY(browser.find("B 3/4"));

    PickerSeen seen;
    answerNextPicker(&seen, path, doubleClick);
    browser.widget.actionOpen()->trigger();

    QVERIFY(seen.appeared);
    QCOMPARE(seen.rows, QStringLiteral("Door A[B 3/4], Door A/B 3/4"));
    const bool choosable = openedIn != QLatin1String("-");
    QCOMPARE(seen.okEnabled, choosable);
    QCOMPARE(seen.stayedOpen, !choosable);
    if (!choosable) {
        QVERIFY(selectedNames(browser).isEmpty());
        return;
    }
    QCOMPARE(selectedNames(browser), QStringList{path.last()});
    Node* opened = browser.model.nodeFromIndex(browser.widget.treeView()->currentIndex());
    QCOMPARE(opened->parent()->displayName(), openedIn);
    QTRY_VERIFY(opened->object());
}

// A name far wider than the screen must neither widen the dialog past the
// screen nor push its buttons out of reach.
void tst_DirEntryBrowser::pickerWithLongNameFitsTheScreen()
{
    const QString longName = QStringLiteral("Door Panel Left ").repeated(20) + QStringLiteral("End of a long name");
    TempStore store;
    storeTemplate(store, longName.toStdString(), createFolder(store, "Interior"));
    Browser browser(store);
    QTRY_VERIFY(browser.find(longName));

    QRect frame;
    QRect available;
    bool buttonsInside = false;
    QString tooltip;
    bool nameElided = false;
    ModalAnswer::actOnNextModal([&](QWidget* modal) {
        auto* picker = qobject_cast<TreePickerDialog*>(modal);
        if (!picker) {
            modal->close();
            return;
        }
        frame = picker->frameGeometry();
        available = picker->screen()->availableGeometry();
        auto* buttons = picker->findChild<QDialogButtonBox*>();
        buttonsInside = picker->rect().contains(QRect(buttons->mapTo(picker, QPoint()), buttons->size()));
        QTreeView* view = picker->view();
        const QModelIndex row = pickerRow(view->model(), {"Interior", longName});
        view->scrollTo(row);
        tooltip = row.data(Qt::ToolTipRole).toString();
        const QRect cell = view->visualRect(row);
        nameElided = cell.right() <= view->viewport()->width()
            && view->fontMetrics().horizontalAdvance(longName) > cell.width();
        picker->reject();
    });
    browser.widget.actionOpen()->trigger();

    QVERIFY(!frame.isEmpty());
    QVERIFY2(available.contains(frame), qPrintable(QStringLiteral("dialog %1 px wide at %2, screen %3 px")
                                                       .arg(frame.width()).arg(frame.x()).arg(available.width())));
    QVERIFY(buttonsInside);
    QCOMPARE(tooltip, longName);
    QVERIFY(nameElided);
}

void tst_DirEntryBrowser::movePickerOffersOnlyPlacesToGo_data()
{
    QTest::addColumn<QStringList>("moving");
    QTest::addColumn<QString>("offered");
    QTest::addColumn<QStringList>("preselected");
    QTest::addColumn<QStringList>("target");
    QTest::addColumn<QStringList>("movedTo");
    // The store holds Interior (with Doors and the template Door Panel), Trim
    // and the template Dashboard at the top level.
    const QString everyFolder = QStringLiteral("(top level)[Interior[Doors], Trim]");
    QTest::newRow("a template starts at its folder and goes to another")
        << QStringList{"Door Panel"} << everyFolder << QStringList{"(top level)", "Interior"}
        << QStringList{"(top level)", "Trim"} << QStringList{"Trim"};
    QTest::newRow("a template at the top level goes into a sub-folder")
        << QStringList{"Dashboard"} << everyFolder << QStringList{"(top level)"}
        << QStringList{"(top level)", "Interior", "Doors"} << QStringList{"Interior", "Doors"};
    QTest::newRow("a folder is not offered, nor anything inside it")
        << QStringList{"Interior"} << QStringLiteral("(top level)[Trim]") << QStringList{"(top level)"}
        << QStringList{"(top level)", "Trim"} << QStringList{"Trim"};
    QTest::newRow("a template and a folder go together to the top level")
        << QStringList{"Door Panel", "Doors"} << QStringLiteral("(top level)[Interior, Trim]")
        << QStringList{"(top level)", "Interior"} << QStringList{"(top level)"} << QStringList{};
}

void tst_DirEntryBrowser::movePickerOffersOnlyPlacesToGo()
{
    QFETCH(QStringList, moving);
    QFETCH(QString, offered);
    QFETCH(QStringList, preselected);
    QFETCH(QStringList, target);
    QFETCH(QStringList, movedTo);
    TempStore store;
    const std::string interior = createFolder(store, "Interior");
    createFolder(store, "Doors", interior);
    createFolder(store, "Trim");
    storeTemplate(store, "Door Panel", interior);
    storeTemplate(store, "Dashboard", "");
    Browser browser(store);
    QTRY_VERIFY(browser.find("Door Panel") && browser.find("Doors"));
    QTreeView* tree = browser.widget.treeView();
    tree->collapseAll();
    browser.addToSelection(moving);

    PickerSeen seen;
    answerNextPicker(&seen, target);
    browser.action("Move To…")->trigger();

    QVERIFY(seen.appeared);
    QCOMPARE(seen.rows, offered);
    QCOMPARE(seen.preselected, preselected);
    QVERIFY(!seen.stayedOpen);
    // Each moved node lands in the folder chosen and is selected, its folder open.
    for (const QString& name : moving)
        QTRY_COMPARE(folderPath(browser, browser.find(name)), movedTo);
    QStringList nowSelected = selectedNames(browser);
    nowSelected.sort();
    moving.sort();
    QCOMPARE(nowSelected, moving);
    for (const QString& name : moving) {
        const QModelIndex folder = browser.model.indexFromNode(browser.find(name)->parent());
        QVERIFY(!folder.isValid() || tree->isExpanded(folder));
    }
    Browser restarted(store);
    for (const QString& name : moving) {
        QTRY_VERIFY(restarted.find(name));
        QCOMPARE(folderPath(restarted, restarted.find(name)), movedTo);
    }
}

void tst_DirEntryBrowser::entryDeletedElsewhereIsSaidAndRemoved_data()
{
    QTest::addColumn<QString>("deletedBy");
    QTest::newRow("another browser on the same store") << "browser";
    QTest::newRow("another program writing the store file") << "program";
}

void tst_DirEntryBrowser::entryDeletedElsewhereIsSaidAndRemoved()
{
    QFETCH(QString, deletedBy);
    TempStore store;
    const std::string interior = createFolder(store, "Interior");
    storeTemplate(store, "Door Panel", interior);
    storeTemplate(store, "Dashboard", interior);
    Browser browser(store);
    QTRY_VERIFY(browser.find("Door Panel"));
    QVERIFY(browser.openLoaded("Dashboard"));
    if (deletedBy == QLatin1String("browser")) {
        Browser other(store);
        QTRY_VERIFY(other.find("Door Panel"));
        bool deleted = false;
        other.model.deleteNodes({other.find("Door Panel")}, [&deleted](bool ok) { deleted = ok; });
        QTRY_VERIFY(deleted);
    } else {
        RawConnection raw(store.path());
        QVERIFY(raw.exec(QStringLiteral("DELETE FROM dir_entries WHERE object_id IN "
                                        "(SELECT id FROM objects WHERE name = 'Door Panel')")));
        QVERIFY(raw.exec(QStringLiteral("DELETE FROM objects WHERE name = 'Door Panel'")));
    }
    QSignalSpy selections(&browser.widget, &DirEntryBrowserWidget::sgSelectionChanged);

    browser.select(browser.find("Door Panel"));

    const QString message = browser.messageShown();
    QVERIFY2(message.contains(QStringLiteral("\"Door Panel\"")) && message.contains(QStringLiteral("deleted elsewhere")),
             qPrintable(message));
    QVERIFY2(!message.contains(QStringLiteral("no stored object")), qPrintable(message));
    QTRY_VERIFY(!browser.find("Door Panel"));
    QVERIFY(browser.find("Dashboard"));
    QVERIFY(browser.widget.treeView()->isExpanded(browser.model.indexFromNode(browser.find("Interior"))));
    QTRY_VERIFY(!selections.isEmpty());
    QVERIFY(selections.last().first().value<QVector<Node*>>().isEmpty());
}

void tst_DirEntryBrowser::refreshKeepsOpenFoldersAndSelection_data()
{
    QTest::addColumn<QStringList>("selected");
    QTest::addColumn<QStringList>("expanded");
    // The store holds Interior with Doors (holding Door Panel), Trim (holding
    // Moulding) and the template Dashboard at the top level.
    QTest::newRow("a template deep in open folders")
        << QStringList{"Door Panel"} << QStringList{"Interior", "Doors"};
    QTest::newRow("a folder, its parent closed")
        << QStringList{"Trim"} << QStringList{};
    QTest::newRow("two templates in different folders")
        << QStringList{"Dashboard", "Moulding"} << QStringList{"Trim"};
    QTest::newRow("a sub-folder open inside a closed folder")
        << QStringList{} << QStringList{"Doors"};
}

void tst_DirEntryBrowser::refreshKeepsOpenFoldersAndSelection()
{
    QFETCH(QStringList, selected);
    QFETCH(QStringList, expanded);
    TempStore store;
    const std::string interior = createFolder(store, "Interior");
    const std::string doors = createFolder(store, "Doors", interior);
    const std::string trim = createFolder(store, "Trim");
    storeTemplate(store, "Door Panel", doors);
    storeTemplate(store, "Moulding", trim);
    storeTemplate(store, "Dashboard", "");
    Browser browser(store);
    QTRY_VERIFY(browser.find("Door Panel") && browser.find("Moulding"));
    QTreeView* tree = browser.widget.treeView();
    tree->collapseAll();
    for (const QString& name : expanded)
        tree->expand(browser.model.indexFromNode(browser.find(name)));
    browser.addToSelection(selected);
    QTRY_COMPARE(selectedNames(browser).size(), selected.size());
    // Something new in the store shows that the tree was read again.
    storeTemplate(store, "Bumper", "");

    browser.widget.refresh();

    QTRY_VERIFY(browser.find("Bumper"));
    QStringList nowExpanded;
    for (Node* node : browser.model.descendants(browser.model.root())) {
        if (node->isFolder() && tree->isExpanded(browser.model.indexFromNode(node)))
            nowExpanded << node->displayName();
    }
    QStringList expectedExpanded = expanded;
    // Selecting a node opens the folders above it.
    for (const QString& name : selected) {
        for (Node* parent = browser.find(name)->parent(); parent != browser.model.root(); parent = parent->parent()) {
            if (!expectedExpanded.contains(parent->displayName()))
                expectedExpanded << parent->displayName();
        }
    }
    nowExpanded.sort();
    expectedExpanded.sort();
    QCOMPARE(nowExpanded, expectedExpanded);
    QStringList nowSelected = selectedNames(browser);
    nowSelected.sort();
    selected.sort();
    QCOMPARE(nowSelected, selected);
}

void tst_DirEntryBrowser::namesSortAsPeopleRead()
{
    TempStore store;
    for (const char* name : {"Part 10", "part 2", "Ärmel", "Zierleiste", "Öse"})
        storeTemplate(store, name, "");
    createFolder(store, "Zubehör");
    Browser browser(store);

    QTRY_COMPARE(browser.namesIn(nullptr),
                 (QStringList{"Zubehör", "Ärmel", "Öse", "part 2", "Part 10", "Zierleiste"}));
}

QC_TEST_MAIN(tst_DirEntryBrowser)
#include "tst_direntrybrowser.moc"
