#include "tests/common/TestMain.h"
#include "tests/common/ModalAnswer.h"
#include "tests/common/RawConnection.h"
#include "tests/common/ScriptedAsker.h"
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
        jobTemplate->setName(defaultNamedObjectName(base));
        return jobTemplate;
    }
    std::string namedObjectTypeId() override { return QCJobTemplate::typeId(); }

    QString base = QStringLiteral("Job Template");
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
    Node* find(const QString& name) const
    {
        for (Node* node : model.descendants(model.root())) {
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
    void newObjectGetsFirstFreeNameOfItsFolder_data();
    void newObjectGetsFirstFreeNameOfItsFolder();
    void defaultNameWithoutBaseIsTheTypesName_data();
    void defaultNameWithoutBaseIsTheTypesName();
    void savedNewObjectIsFoundAfterRestart();
    void modifiedObjectEnablesSave();
    void failedSaveKeepsObjectModified();
    void selectionCarriesLoadedObjects();
    void mayCloseAsksOnlyAboutUnsavedWork_data();
    void mayCloseAsksOnlyAboutUnsavedWork();
    void unsavedQuestionCountsTheObjects_data();
    void unsavedQuestionCountsTheObjects();
    void editDuringSaveStaysModified();
    void lastSelectionIsRestoredAtStart();
    void folderCommandsAskThenAct_data();
    void folderCommandsAskThenAct();
    void refusedRenameKeepsTheStoredName();
    void refreshWhileSavingKeepsOneNode();
    void editedObjectSurvivesDeletionElsewhere_data();
    void editedObjectSurvivesDeletionElsewhere();
    void renameThenSaveKeepsTheNewName();
    void damagedObjectIsLeftOutOfTheSelection();
    void deleteQuestionSaysWhatGoes_data();
    void deleteQuestionSaysWhatGoes();
    void mouseDragDoesNotSweepARange();
    void nameCheckRefusesBlankAndTakenNames_data();
    void nameCheckRefusesBlankAndTakenNames();
    void renameDialogKeepsOkDisabledForRefusedNames();
    void readOnlyStoreDisablesEditing_data();
    void readOnlyStoreDisablesEditing();
    void readOnlyStoreOffersNoSaveAtClose();
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

void tst_DirEntryBrowser::newObjectGetsFirstFreeNameOfItsFolder_data()
{
    QTest::addColumn<QString>("base");
    QTest::addColumn<QStringList>("inFolder");
    QTest::addColumn<QStringList>("elsewhere");
    QTest::addColumn<QString>("expected");
    const QString base = QStringLiteral("Job Template");
    QTest::newRow("empty folder") << base << QStringList{} << QStringList{} << "Job Template";
    QTest::newRow("base name taken") << base << QStringList{"Job Template"} << QStringList{} << "Job Template 2";
    QTest::newRow("gap is filled") << base << QStringList{"Job Template", "Job Template 3"} << QStringList{}
                                   << "Job Template 2";
    QTest::newRow("names of other folders do not count") << base << QStringList{} << QStringList{"Job Template"}
                                                         << "Job Template";
    QTest::newRow("no base text names it after its type, unique in its folder")
        << QString() << QStringList{"Job Template"} << QStringList{} << "Job Template 2";
}

void tst_DirEntryBrowser::newObjectGetsFirstFreeNameOfItsFolder()
{
    QFETCH(QString, base);
    QFETCH(QStringList, inFolder);
    QFETCH(QStringList, elsewhere);
    QFETCH(QString, expected);
    TempStore store;
    const std::string folder = createFolder(store, "Folder");
    createFolder(store, "Other");
    const std::string other = createFolder(store, "Other 2");
    for (const QString& name : inFolder)
        storeTemplate(store, name.toStdString(), folder);
    for (const QString& name : elsewhere)
        storeTemplate(store, name.toStdString(), other);

    Browser browser(store);
    browser.callbacks.base = base;
    QTRY_VERIFY(browser.find(QStringLiteral("Folder")));
    browser.select(browser.find(QStringLiteral("Folder")));
    browser.widget.actionNew()->trigger();

    Node* created = browser.find(expected);
    QVERIFY(created);
    QVERIFY(created->isModified());
    QCOMPARE(created->parent(), browser.find(QStringLiteral("Folder")));
}

void tst_DirEntryBrowser::defaultNameWithoutBaseIsTheTypesName_data()
{
    QTest::addColumn<QString>("typeId");
    QTest::addColumn<QString>("base");
    QTest::addColumn<bool>("withBrowser");
    QTest::addColumn<QStringList>("taken");
    QTest::addColumn<QString>("expected");
    const QString configuration = QString::fromStdString(MeasurementConfiguration::typeId());
    const QString jobTemplate = QString::fromStdString(QCJobTemplate::typeId());
    QTest::newRow("measurement configuration without a browser")
        << configuration << QString() << false << QStringList{} << "Measurement Configuration";
    QTest::newRow("measurement configuration whose name is taken in the folder")
        << configuration << QString() << true
        << QStringList{"Measurement Configuration", "Measurement Configuration 2"} << "Measurement Configuration 3";
    QTest::newRow("job template without a browser")
        << jobTemplate << QString() << false << QStringList{} << "Job Template";
    QTest::newRow("a base text is used as given")
        << configuration << "D65 Setup" << true << QStringList{"D65 Setup"} << "D65 Setup 2";
    QTest::newRow("a type without a name of its own")
        << "vemi.Unknown" << QString() << true << QStringList{"Object"} << "Object 2";
}

void tst_DirEntryBrowser::defaultNameWithoutBaseIsTheTypesName()
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

void tst_DirEntryBrowser::savedNewObjectIsFoundAfterRestart()
{
    TempStore store;
    const std::string folder = createFolder(store, "Samples");
    {
        Browser browser(store);
        QTRY_VERIFY(browser.find(QStringLiteral("Samples")));
        browser.select(browser.find(QStringLiteral("Samples")));
        browser.widget.actionNew()->trigger();
        QVERIFY(browser.widget.actionSave()->isEnabled());
        browser.widget.actionSave()->trigger();
        QTRY_VERIFY(browser.find(QStringLiteral("Job Template")));
        QVERIFY(!browser.widget.actionSave()->isEnabled());
    }
    store.reopen();
    Browser restarted(store);
    QTRY_VERIFY(restarted.find(QStringLiteral("Job Template")));
    Node* saved = restarted.find(QStringLiteral("Job Template"));
    QCOMPARE(static_cast<DirEntryTreeModel::DirEntryNode*>(saved)->dirEntry()->folderId(), folder);
}

void tst_DirEntryBrowser::modifiedObjectEnablesSave()
{
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    Browser browser(store);
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));
    QVERIFY(!browser.widget.actionSave()->isEnabled());

    auto object = browser.find(QStringLiteral("Door Panel"))->object();
    browser.widget.namedObjectWasModified(object);
    QVERIFY(browser.find(QStringLiteral("Door Panel"))->isModified());
    const QModelIndex index = browser.model.indexFromNode(browser.find(QStringLiteral("Door Panel")));
    QCOMPARE(index.data().toString(), QStringLiteral("Door Panel *"));
    QVERIFY(browser.widget.actionSave()->isEnabled());
}

void tst_DirEntryBrowser::failedSaveKeepsObjectModified()
{
    StoreOptions impatient;
    impatient.busyTimeoutMs = 100;
    TempStore store(impatient);
    storeTemplate(store, "Door Panel", "");
    Browser browser(store);
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));
    browser.widget.namedObjectWasModified(browser.find(QStringLiteral("Door Panel"))->object());
    // Another program holds the write lock for as long as the save tries.
    RawConnection other(store.path());
    QVERIFY(other.exec(QStringLiteral("BEGIN EXCLUSIVE")));

    browser.widget.actionSave()->trigger();
    QTRY_VERIFY(browser.widget.findChild<QMessageBox*>());
    const QString message = browser.widget.findChild<QMessageBox*>()->text();
    QVERIFY2(message.contains(QStringLiteral("locked")), qPrintable(message));
    QVERIFY(browser.find(QStringLiteral("Door Panel"))->isModified());
    QVERIFY(browser.widget.actionSave()->isEnabled());
    QVERIFY(other.exec(QStringLiteral("ROLLBACK")));
}

void tst_DirEntryBrowser::selectionCarriesLoadedObjects()
{
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    storeTemplate(store, "Dashboard", "");
    Browser browser(store);
    QTRY_VERIFY(browser.find(QStringLiteral("Dashboard")));
    QSignalSpy selections(&browser.widget, &DirEntryBrowserWidget::sgSelectionChanged);

    auto* selection = browser.widget.treeView()->selectionModel();
    selection->select(browser.model.indexFromNode(browser.find(QStringLiteral("Dashboard"))), QItemSelectionModel::Select);
    selection->select(browser.model.indexFromNode(browser.find(QStringLiteral("Door Panel"))), QItemSelectionModel::Select);
    // The second click replaces the first before its object is loaded: one announcement.
    QTRY_COMPARE(selections.count(), 1);
    const auto nodes = selections.last().first().value<QVector<Node*>>();
    QCOMPARE(nodes.size(), 2);
    for (Node* node : nodes) {
        QVERIFY(node->object());
        QCOMPARE(QString::fromStdString(node->object()->name()), node->displayName());
    }
}

void tst_DirEntryBrowser::mayCloseAsksOnlyAboutUnsavedWork_data()
{
    QTest::addColumn<bool>("modified");
    QTest::addColumn<int>("answer");
    QTest::addColumn<bool>("mayClose");
    QTest::addColumn<bool>("savedAfterwards");
    QTest::newRow("nothing unsaved closes without asking") << false << 0 << true << true;
    QTest::newRow("cancel keeps the tab open") << true << int(QMessageBox::Cancel) << false << false;
    QTest::newRow("discard closes without saving") << true << int(QMessageBox::Discard) << true << false;
    QTest::newRow("save stores the object and closes") << true << int(QMessageBox::Save) << true << true;
}

void tst_DirEntryBrowser::mayCloseAsksOnlyAboutUnsavedWork()
{
    QFETCH(bool, modified);
    QFETCH(int, answer);
    QFETCH(bool, mayClose);
    QFETCH(bool, savedAfterwards);
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    Browser browser(store);
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));
    auto jobTemplate = std::dynamic_pointer_cast<QCJobTemplate>(browser.find(QStringLiteral("Door Panel"))->object());
    if (modified) {
        jobTemplate->setDescription("edited");
        browser.widget.namedObjectWasModified(jobTemplate);
    }
    QString question;
    if (answer)
        ModalAnswer::clickInNextMessageBox(QMessageBox::StandardButton(answer), &question);

    QCOMPARE(browser.widget.mayClose(), mayClose);
    QCOMPARE(question.isEmpty(), !answer);
    if (answer)
        QVERIFY2(question.contains(QStringLiteral("Door Panel")), qPrintable(question));
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
    QTest::newRow("one object, menus set up before") << 1 << true << one;
    QTest::newRow("one object, no menus set up") << 1 << false << one;
    QTest::newRow("three objects, menus set up before") << 3 << true << three;
    QTest::newRow("three objects, no menus set up") << 3 << false << three;
}

void tst_DirEntryBrowser::unsavedQuestionCountsTheObjects()
{
    QFETCH(int, count);
    QFETCH(bool, menusFirst);
    QFETCH(QString, expected);
    TempStore store;
    Browser browser(store);
    if (menusFirst)
        QVERIFY(browser.action(QStringLiteral("Delete")));
    for (int i = 0; i < count; ++i)
        browser.widget.actionNew()->trigger();
    QString question;
    ModalAnswer::clickInNextMessageBox(QMessageBox::Cancel, &question);

    QVERIFY(!browser.widget.mayClose());
    QVERIFY2(question.startsWith(expected), qPrintable(question));
    for (const QString& name : browser.namesIn(nullptr))
        QVERIFY2(question.contains(QStringLiteral("• ") + name), qPrintable(question));
}

// An edit that arrives while its object is being saved is not in the store:
// the object must stay marked, or closing would lose the edit without asking.
void tst_DirEntryBrowser::editDuringSaveStaysModified()
{
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    Browser browser(store);
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));
    auto jobTemplate = std::dynamic_pointer_cast<QCJobTemplate>(browser.find(QStringLiteral("Door Panel"))->object());
    QSignalSpy saved(&browser.model, &DirEntryTreeModel::sgItemChanged);
    browser.widget.namedObjectWasModified(jobTemplate);
    browser.widget.actionSave()->trigger();
    // The store answers through the event loop, so this edit comes before the answer.
    jobTemplate->setDescription("edited while saving");
    browser.widget.namedObjectWasModified(jobTemplate);

    QTRY_COMPARE(saved.count(), 1);
    QVERIFY(browser.find(QStringLiteral("Door Panel"))->isModified());
    QVERIFY(browser.widget.actionSave()->isEnabled());
    ModalAnswer::clickInNextMessageBox(QMessageBox::Cancel);
    QVERIFY(!browser.widget.mayClose());
}

void tst_DirEntryBrowser::lastSelectionIsRestoredAtStart()
{
    TempStore store;
    const std::string folder = createFolder(store, "Interior");
    storeTemplate(store, "Door Panel", "");
    storeTemplate(store, "Dashboard", folder);
    {
        Browser browser(store);
        QSignalSpy selections(&browser.widget, &DirEntryBrowserWidget::sgSelectionChanged);
        QVERIFY(browser.openLoaded(QStringLiteral("Dashboard")));
        QTRY_VERIFY(!selections.isEmpty());
    }
    Browser restarted(store);
    // The remembered entry sits in a collapsed folder: it is opened and selected.
    QTRY_VERIFY(restarted.widget.treeView()->selectionModel()->selectedRows().size() == 1);
    Node* selected = restarted.model.nodeFromIndex(restarted.widget.treeView()->selectionModel()->selectedRows().first());
    QCOMPARE(selected->displayName(), QStringLiteral("Dashboard"));
    QTRY_VERIFY(selected->object());
    QVERIFY(restarted.widget.treeView()->isExpanded(restarted.model.indexFromNode(selected->parent())));
}

void tst_DirEntryBrowser::folderCommandsAskThenAct_data()
{
    QTest::addColumn<QString>("command");
    QTest::addColumn<QStringList>("answers");
    QTest::addColumn<QStringList>("topLevel");
    QTest::addColumn<QStringList>("inFolder");
    QTest::addColumn<QString>("question");
    // The tree holds the folders "Interior" and "New Folder" and the template
    // "Door Panel", which is selected.
    const QStringList unchanged{"Interior", "New Folder", "Door Panel"};
    QTest::newRow("new folder suggests a free name")
        << "New Folder…" << QStringList{"Trim"} << QStringList{"Interior", "New Folder", "Trim", "Door Panel"}
        << QStringList{} << "New Folder: Folder name: [New Folder 2]";
    QTest::newRow("cancelled new folder creates nothing")
        << "New Folder…" << QStringList{} << unchanged << QStringList{} << "New Folder: Folder name: [New Folder 2]";
    QTest::newRow("rename changes the entry's name")
        << "Rename…" << QStringList{"Door Trim"} << QStringList{"Interior", "New Folder", "Door Trim"}
        << QStringList{} << "Rename: New name: [Door Panel]";
    QTest::newRow("rename to the name of another entry of the folder is refused")
        << "Rename…" << QStringList{"New Folder"} << unchanged << QStringList{}
        << "Rename: New name: [Door Panel] refused: \"New Folder\" is already used in this folder.";
    QTest::newRow("rename to blanks is refused")
        << "Rename…" << QStringList{"   "} << unchanged << QStringList{}
        << "Rename: New name: [Door Panel] refused: A name cannot be empty.";
    QTest::newRow("new folder with a name taken in its folder is refused")
        << "New Folder…" << QStringList{"Interior"} << unchanged << QStringList{}
        << "New Folder: Folder name: [New Folder 2] refused: \"Interior\" is already used in this folder.";
    QTest::newRow("confirmed delete removes the entry")
        << "Delete" << QStringList{"yes"} << QStringList{"Interior", "New Folder"} << QStringList{}
        << "Delete: Delete the Job Template \"Door Panel\"? This cannot be undone. [default No]";
    QTest::newRow("declined delete keeps the entry")
        << "Delete" << QStringList{"no"} << unchanged << QStringList{}
        << "Delete: Delete the Job Template \"Door Panel\"? This cannot be undone. [default No]";
}

void tst_DirEntryBrowser::folderCommandsAskThenAct()
{
    QFETCH(QString, command);
    QFETCH(QStringList, answers);
    QFETCH(QStringList, topLevel);
    QFETCH(QStringList, inFolder);
    QFETCH(QString, question);
    TempStore store;
    createFolder(store, "Interior");
    storeTemplate(store, "Door Panel", "");
    createFolder(store, "New Folder");
    Browser browser(store);
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));

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
    QTRY_COMPARE(browser.namesIn(browser.find(QStringLiteral("Interior"))), inFolder);
    // What the tree shows is what the store holds.
    Browser restarted(store);
    QTRY_COMPARE(restarted.namesIn(nullptr), topLevel);
}

// A rename the store refuses must not leave the open object with a name the
// store does not have: a later save would store it under a name never confirmed.
void tst_DirEntryBrowser::refusedRenameKeepsTheStoredName()
{
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    store.reopenReadOnly();
    Browser browser(store);
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));
    Node* node = browser.find(QStringLiteral("Door Panel"));
    ScriptedAsker asker;
    asker.scriptText(QStringLiteral("Door Trim"));
    browser.widget.folderCommands()->setAsker(&asker);

    // The browser disables Rename on a read-only store; the command is sent
    // anyway, as if the store had become read-only since.
    browser.widget.folderCommands()->rename(node);
    QTRY_VERIFY(browser.widget.findChild<QMessageBox*>());
    QVERIFY(browser.widget.findChild<QMessageBox*>()->text().contains(QStringLiteral("read-only")));
    QCOMPARE(node->displayName(), QStringLiteral("Door Panel"));
    QCOMPARE(node->object()->name(), std::string("Door Panel"));
}

void tst_DirEntryBrowser::refreshWhileSavingKeepsOneNode()
{
    TempStore store;
    Browser browser(store);
    browser.widget.actionNew()->trigger();
    // The listing runs before the save in the store, so its answer does not
    // hold the new entry yet, while the save's answer comes after it.
    browser.widget.refresh();
    browser.widget.actionSave()->trigger();
    QTRY_VERIFY(!browser.find(QStringLiteral("Job Template"))->isModified());
    browser.widget.refresh();
    QTest::qWait(200);

    std::vector<Node*> entries;
    for (Node* node : browser.model.descendants(browser.model.root()))
        entries.push_back(node);
    QCOMPARE(entries.size(), size_t(1));
    QVERIFY(static_cast<DirEntryTreeModel::DirEntryNode*>(entries.front())->isSaved());
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
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));
    auto* node = static_cast<DirEntryTreeModel::DirEntryNode*>(browser.find(QStringLiteral("Door Panel")));
    const auto object = node->object();
    browser.widget.namedObjectWasModified(object);
    const std::vector<std::string> folders = inFolder ? std::vector<std::string>{folder} : std::vector<std::string>{};
    const std::vector<std::string> entries =
        inFolder ? std::vector<std::string>{} : std::vector<std::string>{node->dirEntry()->id()};
    QVERIFY(!store.run(std::make_shared<DeleteDirItems>(folders, entries)).error);

    browser.widget.refresh();
    QTRY_VERIFY(!static_cast<DirEntryTreeModel::DirEntryNode*>(browser.find(QStringLiteral("Door Panel")))->isSaved());
    node = static_cast<DirEntryTreeModel::DirEntryNode*>(browser.find(QStringLiteral("Door Panel")));
    QCOMPARE(node->object(), object);
    QVERIFY(node->isModified());
    QCOMPARE(node->parent(), browser.model.root());

    browser.select(node);
    browser.widget.actionSave()->trigger();
    QTRY_VERIFY(node->isSaved() && !node->isModified());
    QVERIFY(store.fetch(QCJobTemplate::typeId(), object->id()));
}

void tst_DirEntryBrowser::renameThenSaveKeepsTheNewName()
{
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    Browser browser(store);
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));
    Node* node = browser.find(QStringLiteral("Door Panel"));
    browser.widget.namedObjectWasModified(node->object());
    // The save is sent before the rename's answer arrives.
    browser.model.renameNode(node, "Door Trim", {});
    browser.widget.actionSave()->trigger();
    QTRY_VERIFY(!node->isModified());

    const auto stored = store.fetch(QCJobTemplate::typeId(), node->object()->id());
    QVERIFY(stored);
    QCOMPARE(stored->header()->name(), std::string("Door Trim"));
}

void tst_DirEntryBrowser::damagedObjectIsLeftOutOfTheSelection()
{
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    {
        RawConnection raw(store.path());
        QVERIFY(raw.exec(QStringLiteral("UPDATE objects SET data = ?"), {QByteArray("\xa1\x01", 2)}));
    }
    Browser browser(store);
    QTRY_VERIFY(browser.find(QStringLiteral("Door Panel")));
    QSignalSpy selections(&browser.widget, &DirEntryBrowserWidget::sgSelectionChanged);
    browser.select(browser.find(QStringLiteral("Door Panel")));

    QTRY_COMPARE(selections.count(), 1);
    QVERIFY(selections.first().first().value<QVector<Node*>>().isEmpty());
    QTRY_VERIFY(browser.widget.findChild<QMessageBox*>());
    QVERIFY(browser.widget.findChild<QMessageBox*>()->text().contains(QStringLiteral("damaged")));
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
    QVERIFY(browser.openLoaded(QStringLiteral("Bumper Left")));
    browser.widget.namedObjectWasModified(browser.find(QStringLiteral("Bumper Left"))->object());
    auto* selection = browser.widget.treeView()->selectionModel();
    selection->clearSelection();
    for (const QString& name : selected)
        selection->select(browser.model.indexFromNode(browser.find(name)), QItemSelectionModel::Select);
    ScriptedAsker asker;
    browser.widget.folderCommands()->setAsker(&asker);

    browser.action(QStringLiteral("Delete"))->trigger();
    QCOMPARE(asker.asked(), QStringList{question});
    // Declined: everything stays, in the tree and in the store.
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
    QTRY_VERIFY(browser.find(QStringLiteral("Part 4")));
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
    QVERIFY(browser.openLoaded(QStringLiteral("Bumper Right")));
    struct Seen
    {
        bool okAtFirst = false;
        bool okForTaken = true;
        QString problemForTaken;
        bool okForBlank = true;
        bool openAfterEnterOnBlank = false;
    } seen;
    ModalAnswer::actOnNextModal([&seen](QWidget* modal) {
        auto* dialog = qobject_cast<NameDialog*>(modal);
        if (!dialog) {
            modal->close();
            QFAIL("expected the name dialog");
        }
        auto* edit = dialog->findChild<QLineEdit*>();
        QPushButton* ok = dialog->findChild<QDialogButtonBox*>()->button(QDialogButtonBox::Ok);
        auto* problem = dialog->findChild<QLabel*>(QStringLiteral("problem"));
        seen.okAtFirst = ok->isEnabled();
        // The suggestion is selected: typing replaces it.
        QTest::keyClicks(edit, QStringLiteral("Bumper Left"));
        seen.okForTaken = ok->isEnabled();
        seen.problemForTaken = problem->isVisible() ? problem->text() : QString();
        edit->selectAll();
        QTest::keyClick(edit, Qt::Key_Space);
        seen.okForBlank = ok->isEnabled();
        QTest::keyClick(edit, Qt::Key_Return);
        seen.openAfterEnterOnBlank = dialog->isVisible();
        edit->selectAll();
        QTest::keyClicks(edit, QStringLiteral("Bumper Rear"));
        QTest::keyClick(edit, Qt::Key_Return);
    });
    browser.action(QStringLiteral("Rename…"))->trigger();

    QVERIFY(seen.okAtFirst);
    QVERIFY(!seen.okForTaken);
    QCOMPARE(seen.problemForTaken, QStringLiteral("\"Bumper Left\" is already used in this folder."));
    QVERIFY(!seen.okForBlank);
    QVERIFY(seen.openAfterEnterOnBlank);
    QTRY_VERIFY(browser.find(QStringLiteral("Bumper Rear")));
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
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));
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
    QVERIFY(browser.action(QStringLiteral("Open Job Template…"))->isEnabled());
    QCOMPARE(browser.widget.findChild<QLabel*>()->text().contains(QStringLiteral("(read-only)")), !writable);
    // Del asks only where deleting can succeed.
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Delete);
    QCOMPARE(asker.asked().size(), writable ? 1 : 0);
    QFile::setPermissions(store.folder(), permissions);
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
    QString title;
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
        seen->title = picker->windowTitle();
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

// Edits on a read-only store cannot be stored: Save stays disabled, and the
// close question offers only to lose them or to stay.
void tst_DirEntryBrowser::readOnlyStoreOffersNoSaveAtClose()
{
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    store.reopenReadOnly();
    Browser browser(store);
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));
    browser.widget.namedObjectWasModified(browser.find(QStringLiteral("Door Panel"))->object());
    QVERIFY(browser.find(QStringLiteral("Door Panel"))->isModified());
    QVERIFY(!browser.widget.actionSave()->isEnabled());

    QStringList buttons;
    QString question;
    ModalAnswer::actOnNextModal([&](QWidget* dialog) {
        auto* box = qobject_cast<QMessageBox*>(dialog);
        QVERIFY(box);
        question = box->text();
        for (QAbstractButton* button : box->buttons())
            buttons << button->text();
        QCOMPARE(box->defaultButton(), box->button(QMessageBox::Cancel));
        box->button(QMessageBox::Cancel)->click();
    });
    QVERIFY(!browser.widget.mayClose());
    buttons.sort();
    QCOMPARE(buttons, (QStringList{"&Cancel", "&Discard"}));
    QVERIFY2(question.contains(QStringLiteral("read-only")) && question.contains(QStringLiteral("Door Panel")),
             qPrintable(question));
}

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
    QTRY_VERIFY(browser.find(QStringLiteral("B 3/4")));

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
    QCOMPARE(longName.size(), 338);
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
    QTRY_VERIFY(browser.find(QStringLiteral("Door Panel")) && browser.find(QStringLiteral("Doors")));
    QTreeView* tree = browser.widget.treeView();
    tree->collapseAll();
    for (const QString& name : moving)
        tree->selectionModel()->select(browser.model.indexFromNode(browser.find(name)), QItemSelectionModel::Select);

    PickerSeen seen;
    answerNextPicker(&seen, target);
    browser.action(QStringLiteral("Move To…"))->trigger();

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
    QTRY_VERIFY(browser.find(QStringLiteral("Door Panel")));
    QVERIFY(browser.openLoaded(QStringLiteral("Dashboard")));
    if (deletedBy == QLatin1String("browser")) {
        Browser other(store);
        QTRY_VERIFY(other.find(QStringLiteral("Door Panel")));
        bool deleted = false;
        other.model.deleteNodes({other.find(QStringLiteral("Door Panel"))}, [&deleted](bool ok) { deleted = ok; });
        QTRY_VERIFY(deleted);
    } else {
        RawConnection raw(store.path());
        QVERIFY(raw.exec(QStringLiteral("DELETE FROM dir_entries WHERE object_id IN "
                                        "(SELECT id FROM objects WHERE name = 'Door Panel')")));
        QVERIFY(raw.exec(QStringLiteral("DELETE FROM objects WHERE name = 'Door Panel'")));
    }
    QSignalSpy selections(&browser.widget, &DirEntryBrowserWidget::sgSelectionChanged);

    browser.select(browser.find(QStringLiteral("Door Panel")));

    QTRY_VERIFY(browser.widget.findChild<QMessageBox*>());
    const QString message = browser.widget.findChild<QMessageBox*>()->text();
    QVERIFY2(message.contains(QStringLiteral("\"Door Panel\"")) && message.contains(QStringLiteral("deleted elsewhere")),
             qPrintable(message));
    QVERIFY2(!message.contains(QStringLiteral("no stored object")), qPrintable(message));
    QTRY_VERIFY(!browser.find(QStringLiteral("Door Panel")));
    QVERIFY(browser.find(QStringLiteral("Dashboard")));
    QVERIFY(browser.widget.treeView()->isExpanded(browser.model.indexFromNode(browser.find(QStringLiteral("Interior")))));
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
    QTRY_VERIFY(browser.find(QStringLiteral("Door Panel")) && browser.find(QStringLiteral("Moulding")));
    QTreeView* tree = browser.widget.treeView();
    tree->collapseAll();
    for (const QString& name : expanded)
        tree->expand(browser.model.indexFromNode(browser.find(name)));
    for (const QString& name : selected)
        tree->selectionModel()->select(browser.model.indexFromNode(browser.find(name)), QItemSelectionModel::Select);
    QTRY_COMPARE(selectedNames(browser).size(), selected.size());
    // Something new in the store shows that the tree was read again.
    storeTemplate(store, "Bumper", "");

    browser.widget.refresh();

    QTRY_VERIFY(browser.find(QStringLiteral("Bumper")));
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
