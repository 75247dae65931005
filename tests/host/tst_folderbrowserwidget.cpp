#include "tests/common/TestMain.h"
#include "tests/common/ScriptedAsker.h"
#include "tests/common/TempStore.h"

#include "host/domain/DirEntry.h"
#include "host/domain/Header.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/Property.h"
#include "host/store/CreateFolder.h"
#include "host/store/DirectoryTreeResponse.h"
#include "host/store/FolderResponse.h"
#include "host/store/GetDirectoryTree.h"
#include "host/widgets/DirEntryBrowserInterface.h"
#include "host/widgets/DirEntryBrowserWidget.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "host/widgets/FolderBrowserWidget.h"
#include "host/widgets/FolderCommands.h"

#include <QToolButton>
#include <QTreeView>

using namespace vemi;
using Node = BaseObjectTreeModel::Node;

namespace {

class ConfigurationClient : public DirEntryBrowserInterface
{
public:
    std::shared_ptr<NamedObject> newNamedObject() override { return std::make_shared<MeasurementConfiguration>(); }
    std::string namedObjectTypeId() override { return MeasurementConfiguration::typeId(); }
};

} // namespace

class tst_FolderBrowserWidget : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();

    void createNamesFreeInTheTargetFolder_data();
    void createNamesFreeInTheTargetFolder();
    void duplicateStoresACopyUnderANewId();
    void deleteRemovesFromTheStoreAfterAsking();
    void readOnlyStoreOffersNoChanges();

private:
    void openBrowser();
    void select(const QString& name);
    Node* node(const QString& name, const QString& folder = {}) const;
    // "folder/name" of every stored entry, sorted; top-level entries without "folder/".
    QStringList storedEntries();
    std::string store(const std::string& name, const std::string& folderId);

    std::unique_ptr<TempStore> m_store;
    std::unique_ptr<ConfigurationClient> m_client;
    std::unique_ptr<DirEntryTreeModel> m_model;
    std::unique_ptr<FolderBrowserWidget> m_browser;
    std::string m_plantFolder;
};

void tst_FolderBrowserWidget::init()
{
    qRegisterMetaType<QVector<Node*>>("QVector<vemi::BaseObjectTreeModel::Node*>");
    QSettings().clear();
    m_store = std::make_unique<TempStore>();
    const auto folder = std::dynamic_pointer_cast<FolderResponse>(
        m_store->run(std::make_shared<CreateFolder>(MeasurementConfiguration::typeId(), "", "Plant")).response);
    QVERIFY(folder);
    m_plantFolder = folder->folder().id;
    store("Alpha", "");
    store("Measurement Configuration", "");
    store("Bravo", m_plantFolder);
}

void tst_FolderBrowserWidget::cleanup()
{
    m_browser.reset();
    m_model.reset();
    m_client.reset();
    m_store.reset();
}

std::string tst_FolderBrowserWidget::store(const std::string& name, const std::string& folderId)
{
    auto configuration = std::make_shared<MeasurementConfiguration>();
    configuration->setName(name);
    configuration->setInstrumentModel("simcolor45");
    configuration->setProperties({std::make_shared<Property>("Aperture", "4 mm")});
    m_store->save(configuration, &folderId);
    return configuration->id();
}

void tst_FolderBrowserWidget::openBrowser()
{
    m_client = std::make_unique<ConfigurationClient>();
    m_model = std::make_unique<DirEntryTreeModel>(m_store->model());
    m_browser = std::make_unique<FolderBrowserWidget>();
    m_browser->initialize(m_model.get(), true, m_client.get(), "Test");
    m_browser->setToolTips("create", "duplicate", "delete");
    QTRY_VERIFY(node("Bravo", "Plant"));
}

Node* tst_FolderBrowserWidget::node(const QString& name, const QString& folder) const
{
    for (Node* candidate : m_model->descendants(m_model->root())) {
        const QString parent = candidate->parent() == m_model->root() ? QString() : candidate->parent()->displayName();
        if (candidate->displayName() == name && parent == folder)
            return candidate;
    }
    return nullptr;
}

void tst_FolderBrowserWidget::select(const QString& name)
{
    Node* target = node(name, "Plant") ? node(name, "Plant") : node(name);
    QVERIFY(target);
    QSignalSpy selected(m_browser.get(), &FolderBrowserWidget::sgSelectionChanged);
    m_browser->browser()->treeView()->setCurrentIndex(m_model->indexFromNode(target));
    QTRY_VERIFY(!selected.isEmpty());
}

QStringList tst_FolderBrowserWidget::storedEntries()
{
    const auto tree = std::dynamic_pointer_cast<DirectoryTreeResponse>(
        m_store->run(std::make_shared<GetDirectoryTree>(MeasurementConfiguration::typeId())).response);
    QStringList names;
    for (const auto& entry : tree->entries())
        names << QString::fromStdString((entry->folderId().empty() ? "" : "Plant/") + entry->header()->name());
    names.sort();
    return names;
}

void tst_FolderBrowserWidget::createNamesFreeInTheTargetFolder_data()
{
    QTest::addColumn<QString>("selected"); // empty: nothing
    QTest::addColumn<QStringList>("created");

    QTest::newRow("top level, where the plain name is taken")
        << "" << QStringList{"Measurement Configuration 2", "Measurement Configuration 3"};
    QTest::newRow("beside an entry of a folder, where it is free")
        << "Bravo" << QStringList{"Plant/Measurement Configuration", "Plant/Measurement Configuration 2"};
    QTest::newRow("a folder itself") << "Plant"
                                     << QStringList{"Plant/Measurement Configuration", "Plant/Measurement Configuration 2"};
}

void tst_FolderBrowserWidget::createNamesFreeInTheTargetFolder()
{
    QFETCH(QString, selected);
    QFETCH(QStringList, created);
    openBrowser();
    if (!selected.isEmpty())
        select(selected);
    QSignalSpy selections(m_browser.get(), &FolderBrowserWidget::sgSelectionChanged);

    QStringList expected = storedEntries() + created;
    expected.sort();
    for (int round = 0; round < created.size(); ++round) {
        m_browser->createButton()->click();
        // The new object is stored and becomes the selection.
        QTRY_VERIFY(selections.count() > round);
        const auto nodes = selections.last().first().value<QVector<Node*>>();
        QCOMPARE(nodes.size(), 1);
        QCOMPARE(nodes.first()->displayName(), created.at(round).section('/', -1));
        QVERIFY(!nodes.first()->isModified());
    }
    QCOMPARE(storedEntries(), expected);
    QCOMPARE(m_browser->createButton()->toolTip(), QStringLiteral("create"));
}

void tst_FolderBrowserWidget::duplicateStoresACopyUnderANewId()
{
    openBrowser();
    QVERIFY(!m_browser->duplicateButton()->isEnabled());
    select("Bravo");
    QTRY_VERIFY(m_browser->duplicateButton()->isEnabled());
    m_browser->duplicateButton()->click();

    QTRY_VERIFY(node("Bravo Copy", "Plant") && !node("Bravo Copy", "Plant")->isModified());
    const auto copy = std::dynamic_pointer_cast<MeasurementConfiguration>(node("Bravo Copy", "Plant")->object());
    const auto original = std::dynamic_pointer_cast<MeasurementConfiguration>(node("Bravo", "Plant")->object());
    QVERIFY(copy->id() != original->id());
    QCOMPARE(copy->instrumentModel(), original->instrumentModel());
    QCOMPARE(copy->properties().size(), original->properties().size());
    QVERIFY(storedEntries().contains("Plant/Bravo Copy"));
}

void tst_FolderBrowserWidget::deleteRemovesFromTheStoreAfterAsking()
{
    openBrowser();
    ScriptedAsker asker;
    m_browser->browser()->folderCommands()->setAsker(&asker);
    select("Alpha");
    QTRY_VERIFY(m_browser->deleteButton()->isEnabled());

    asker.scriptConfirm(false);
    m_browser->deleteButton()->click();
    asker.scriptConfirm(true);
    m_browser->deleteButton()->click();
    QTRY_VERIFY(!node("Alpha"));
    QCOMPARE(asker.asked().size(), 2);
    QVERIFY(!storedEntries().contains("Alpha"));
    m_browser->browser()->folderCommands()->setAsker(nullptr);
}

void tst_FolderBrowserWidget::readOnlyStoreOffersNoChanges()
{
    m_store->reopenReadOnly();
    openBrowser();
    select("Alpha");
    QTRY_VERIFY(node("Alpha")->object());
    for (QToolButton* button : {m_browser->createButton(), m_browser->duplicateButton(), m_browser->deleteButton()})
        QVERIFY2(!button->isEnabled(), qPrintable(button->text()));
}

QC_TEST_MAIN(tst_FolderBrowserWidget)
#include "tst_folderbrowserwidget.moc"
