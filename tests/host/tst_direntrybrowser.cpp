#include "tests/common/TestMain.h"
#include "tests/common/ModalAnswer.h"
#include "tests/common/RawConnection.h"
#include "tests/common/TempStore.h"

#include "host/store/CreateFolder.h"
#include "host/store/DeleteDirItems.h"
#include "host/domain/DirEntry.h"
#include "host/widgets/DirEntryBrowserInterface.h"
#include "host/widgets/DirEntryBrowserWidget.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "host/store/FolderResponse.h"
#include "host/domain/Header.h"
#include "host/domain/QCJobTemplate.h"

#include <QAction>
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
        jobTemplate->setName(defaultNamedObjectName(QStringLiteral("Job Template")));
        return jobTemplate;
    }
    std::string namedObjectTypeId() override { return QCJobTemplate::typeId(); }
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

    TemplateCallbacks callbacks;
    DirEntryTreeModel model;
    DirEntryBrowserWidget widget;
};

std::string createFolder(TempStore& store, const std::string& name)
{
    const auto answer = store.run(std::make_shared<CreateFolder>(QCJobTemplate::typeId(), "", name));
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
    void init() { QSettings().clear(); }
    void newObjectGetsFirstFreeNameOfItsFolder_data();
    void newObjectGetsFirstFreeNameOfItsFolder();
    void savedNewObjectIsFoundAfterRestart();
    void modifiedObjectEnablesSave();
    void failedSaveKeepsObjectModified();
    void selectionCarriesLoadedObjects();
    void mayCloseAsksOnlyAboutUnsavedWork_data();
    void mayCloseAsksOnlyAboutUnsavedWork();
    void refreshWhileSavingKeepsOneNode();
    void editedObjectSurvivesDeletionElsewhere();
    void renameThenSaveKeepsTheNewName();
    void damagedObjectIsLeftOutOfTheSelection();
};

void tst_DirEntryBrowser::newObjectGetsFirstFreeNameOfItsFolder_data()
{
    QTest::addColumn<QStringList>("inFolder");
    QTest::addColumn<QStringList>("elsewhere");
    QTest::addColumn<QString>("expected");
    QTest::newRow("empty folder") << QStringList{} << QStringList{} << "Job Template";
    QTest::newRow("base name taken") << QStringList{"Job Template"} << QStringList{} << "Job Template 2";
    QTest::newRow("gap is filled") << QStringList{"Job Template", "Job Template 3"} << QStringList{} << "Job Template 2";
    QTest::newRow("names of other folders do not count") << QStringList{} << QStringList{"Job Template"}
                                                         << "Job Template";
}

void tst_DirEntryBrowser::newObjectGetsFirstFreeNameOfItsFolder()
{
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
    QTRY_VERIFY(browser.find(QStringLiteral("Folder")));
    browser.select(browser.find(QStringLiteral("Folder")));
    browser.widget.actionNew()->trigger();

    Node* created = browser.find(expected);
    QVERIFY(created);
    QVERIFY(created->isModified());
    QCOMPARE(created->parent(), browser.find(QStringLiteral("Folder")));
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
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    StoreOptions readOnly;
    readOnly.readOnly = true;
    store.reopen(readOnly);
    Browser browser(store);
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));
    browser.widget.namedObjectWasModified(browser.find(QStringLiteral("Door Panel"))->object());

    browser.widget.actionSave()->trigger();
    QTRY_VERIFY(browser.widget.findChild<QMessageBox*>());
    const QString message = browser.widget.findChild<QMessageBox*>()->text();
    QVERIFY2(message.contains(QStringLiteral("read-only")), qPrintable(message));
    QVERIFY(browser.find(QStringLiteral("Door Panel"))->isModified());
    QVERIFY(browser.widget.actionSave()->isEnabled());
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

void tst_DirEntryBrowser::editedObjectSurvivesDeletionElsewhere()
{
    TempStore store;
    storeTemplate(store, "Door Panel", "");
    Browser browser(store);
    QVERIFY(browser.openLoaded(QStringLiteral("Door Panel")));
    auto* node = static_cast<DirEntryTreeModel::DirEntryNode*>(browser.find(QStringLiteral("Door Panel")));
    const auto object = node->object();
    browser.widget.namedObjectWasModified(object);
    QVERIFY(!store.run(std::make_shared<DeleteDirItems>(std::vector<std::string>{},
                                                        std::vector<std::string>{node->dirEntry()->id()})).error);

    browser.widget.refresh();
    QTRY_VERIFY(!static_cast<DirEntryTreeModel::DirEntryNode*>(browser.find(QStringLiteral("Door Panel")))->isSaved());
    node = static_cast<DirEntryTreeModel::DirEntryNode*>(browser.find(QStringLiteral("Door Panel")));
    QCOMPARE(node->object(), object);
    QVERIFY(node->isModified());

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

QC_TEST_MAIN(tst_DirEntryBrowser)
#include "tst_direntrybrowser.moc"
