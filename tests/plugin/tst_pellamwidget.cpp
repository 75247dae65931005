#include "tests/common/TestMain.h"
#include "tests/common/TempStore.h"

#include "host/widgets/DirEntryBrowserWidget.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "plugin/PellamWidget.h"
#include "host/domain/QCJobTemplate.h"
#include "detail/QCJobTemplateDetailWidget.h"
#include "model/QCJobTemplateModel.h"
#include "host/domain/SchematicImage.h"
#include "host/client/SettingsManager.h"
#include "host/domain/Standard.h"

#include <QAction>
#include <QGroupBox>
#include <QLabel>
#include <QSplitter>
#include <QSplitterHandle>
#include <QStackedWidget>
#include <QTreeView>
#include <QtTest>

using namespace vemi;
using Node = BaseObjectTreeModel::Node;
using DirEntryNode = DirEntryTreeModel::DirEntryNode;

namespace {

std::unique_ptr<Node> entryNodeHolding(std::shared_ptr<NamedObject> object)
{
    auto node = std::make_unique<DirEntryNode>(nullptr, std::string());
    node->setObject(std::move(object));
    return node;
}

std::unique_ptr<Node> folderNode()
{
    return std::make_unique<DirEntryTreeModel::FolderNode>(DirFolder{"f", "", "Folder", QCJobTemplate::typeId()});
}

} // namespace

class tst_PellamWidget : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void firstStartShowsPlaceholderWithDefaultSizes();
    void splitterLayoutSurvivesRestart();
    void narrowWindowKeepsBrowserReadable_data();
    void narrowWindowKeepsBrowserReadable();
    void selectionDecidesPageAndTemplate_data();
    void selectionDecidesPageAndTemplate();
    void newTemplateIsNamedAndBecomesModelsTemplate();
    void longTemplateNameKeepsTheWindowNarrow();
    void editsAndRenamesReachTheOtherSide();

private:
    PellamWidget* createWidget();
    void select(const std::vector<Node*>& nodes);
    // Stores "Door Panel", starts the tab anew and opens it through its browser.
    Node* openStoredTemplate();
    QStackedWidget* pages() const { return m_widget->findChild<QStackedWidget*>(); }
    // The editor's group box whose title names the open template.
    QGroupBox* editorHeading() const
    {
        return m_widget->findChild<QCJobTemplateDetailWidget*>()->findChild<QGroupBox*>(
            QStringLiteral("checkZoneGroupBox"));
    }

    std::unique_ptr<TempStore> m_store;
    std::unique_ptr<QWidget> m_host;
    PellamWidget* m_widget = nullptr;
};

void tst_PellamWidget::init()
{
    QSettings().clear();
    m_store = std::make_unique<TempStore>();
    m_host = std::make_unique<QWidget>();
    m_widget = createWidget();
}

void tst_PellamWidget::cleanup()
{
    m_host.reset();
    m_store.reset();
}

PellamWidget* tst_PellamWidget::createWidget()
{
    auto* widget = new PellamWidget(nullptr, SettingsManager::instance().getGeneralSettings(), m_store->model(),
                                    m_host.get());
    widget->resize(1400 + widget->findChild<QSplitter*>()->handleWidth(), 600);
    return widget;
}

void tst_PellamWidget::select(const std::vector<Node*>& nodes)
{
    QMetaObject::invokeMethod(m_widget, "onSelectionChanged",
                              Q_ARG(QVector<vemi::BaseObjectTreeModel::Node*>,
                                    QVector<Node*>(nodes.begin(), nodes.end())));
}

void tst_PellamWidget::firstStartShowsPlaceholderWithDefaultSizes()
{
    m_host->resize(m_widget->size());
    m_host->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_host.get()));
    const QList<int> sizes = m_widget->findChild<QSplitter*>()->sizes();
    // Qt raises the browser's share to its minimum width, so the split is not
    // exactly 1 : 6; without default sizes the browser is squeezed to its minimum.
    const int browserMinimum = m_widget->findChild<DirEntryBrowserWidget*>()->minimumSizeHint().width();
    const QString actual = QStringLiteral("%1 %2 (browser minimum %3)").arg(sizes[0]).arg(sizes[1]).arg(browserMinimum);
    QVERIFY2(sizes[1] >= 2 * sizes[0], qPrintable(actual));
    QVERIFY2(sizes[0] > browserMinimum, qPrintable(actual));
    QCOMPARE(pages()->currentIndex(), 0);
    auto* placeholder = qobject_cast<QLabel*>(pages()->widget(0));
    QVERIFY(placeholder);
    QCOMPARE(placeholder->text(), QStringLiteral("Please create a new job template or open an existing one."));
}

void tst_PellamWidget::splitterLayoutSurvivesRestart()
{
    m_widget->findChild<QSplitter*>()->setSizes({300, 400});
    const QByteArray state = m_widget->findChild<QSplitter*>()->saveState();
    delete m_widget;
    m_widget = createWidget();
    QCOMPARE(m_widget->findChild<QSplitter*>()->saveState(), state);
}

void tst_PellamWidget::narrowWindowKeepsBrowserReadable_data()
{
    QTest::addColumn<int>("startWidth");
    QTest::addColumn<int>("width");
    QTest::addColumn<bool>("dragToLeftEdge");
    QTest::newRow("started 780 px wide") << 780 << 780 << false;
    QTest::newRow("narrowed from 1400 to 780 px") << 1400 << 780 << false;
    QTest::newRow("narrowed to 500 px") << 1400 << 500 << false;
    QTest::newRow("splitter handle dragged to the left edge") << 1400 << 1400 << true;
}

void tst_PellamWidget::narrowWindowKeepsBrowserReadable()
{
    QFETCH(int, startWidth);
    QFETCH(int, width);
    QFETCH(bool, dragToLeftEdge);
    m_widget->resize(startWidth, 600);
    m_host->resize(m_widget->size());
    m_host->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_host.get()));
    m_widget->resize(width, 600);
    m_host->resize(m_widget->size());
    auto* splitter = m_widget->findChild<QSplitter*>();
    if (dragToLeftEdge) {
        // QTest moves the mouse without buttons, which a splitter handle ignores.
        QSplitterHandle* handle = splitter->handle(1);
        const QPoint grip = handle->rect().center();
        const QPoint edge = handle->mapFrom(m_widget, QPoint(0, grip.y()));
        QTest::mousePress(handle, Qt::LeftButton, {}, grip);
        QMouseEvent drag(QEvent::MouseMove, edge, handle->mapToGlobal(edge), Qt::NoButton, Qt::LeftButton, {});
        QApplication::sendEvent(handle, &drag);
        QTest::mouseRelease(handle, Qt::LeftButton, {}, edge);
    }
    QApplication::processEvents();

    // A name of twenty characters, beside its icon, in a top-level row.
    auto* browser = m_widget->findChild<DirEntryBrowserWidget*>();
    QTreeView* tree = browser->treeView();
    const int rowWidth = tree->indentation() + tree->style()->pixelMetric(QStyle::PM_SmallIconSize)
        + tree->fontMetrics().horizontalAdvance(QStringLiteral("Door Panel Left 1234"));
    // A collapsed browser keeps its size but lies outside the splitter: its share tells.
    const int shown = std::min(splitter->sizes().first(), tree->viewport()->width());
    const QString actual = QStringLiteral("tree shows %1 px, the row needs %2 px").arg(shown).arg(rowWidth);
    QVERIFY2(browser->isVisible() && shown >= rowWidth, qPrintable(actual));
}

void tst_PellamWidget::selectionDecidesPageAndTemplate_data()
{
    QTest::addColumn<QString>("selection");
    QTest::addColumn<int>("page");
    QTest::addColumn<bool>("templateLoaded");
    QTest::newRow("nothing shows the placeholder") << "none" << 0 << false;
    QTest::newRow("two templates show the placeholder") << "two" << 0 << false;
    QTest::newRow("a folder shows the placeholder") << "folder" << 0 << false;
    QTest::newRow("one template opens it in the editor") << "one" << 1 << true;
    QTest::newRow("an entry of another type keeps the editor as it was") << "standard" << 1 << false;
}

void tst_PellamWidget::selectionDecidesPageAndTemplate()
{
    QFETCH(QString, selection);
    QFETCH(int, page);
    QFETCH(bool, templateLoaded);
    auto previous = std::make_shared<QCJobTemplate>();
    m_widget->model()->setJobTemplate(previous);
    QSignalSpy loaded(m_widget->model().get(), &QCJobTemplateModel::sgMeasurementConfigLoaded);

    auto opened = std::make_shared<QCJobTemplate>();
    opened->setName("Door Panel");
    auto one = entryNodeHolding(opened);
    auto two = entryNodeHolding(std::make_shared<QCJobTemplate>());
    auto folder = folderNode();
    auto standard = entryNodeHolding(std::make_shared<Standard>());
    const std::map<QString, std::vector<Node*>> selections = {
        {"none", {}}, {"two", {one.get(), two.get()}}, {"folder", {folder.get()}},
        {"one", {one.get()}}, {"standard", {standard.get()}}};
    select(selections.at(selection));

    QCOMPARE(pages()->currentIndex(), page);
    QCOMPARE(m_widget->model()->jobTemplate(), templateLoaded ? opened : previous);
    QCOMPARE(loaded.count(), templateLoaded ? 1 : 0);
    QCOMPARE(editorHeading()->title() == QStringLiteral("Checkpoints for: Door Panel"), templateLoaded);
}

void tst_PellamWidget::newTemplateIsNamedAndBecomesModelsTemplate()
{
    auto* browser = m_widget->findChild<DirEntryBrowserWidget*>();
    QTRY_VERIFY(browser->treeModel()->rowCount() == 0);
    browser->actionNew()->trigger();

    QTRY_COMPARE(browser->treeModel()->rowCount(), 1);
    Node* node = browser->treeModel()->root()->children().front().get();
    QCOMPARE(node->displayName(), QStringLiteral("Job Template"));
    QVERIFY(node->isModified());
    const auto created = m_widget->model()->jobTemplate();
    QCOMPARE(created, node->object());
    QVERIFY(created->schematicImage() && created->schematicImage()->imageData().empty());
    QCOMPARE(editorHeading()->title(), QStringLiteral("Checkpoints for: Job Template"));
}

void tst_PellamWidget::longTemplateNameKeepsTheWindowNarrow()
{
    auto opened = std::make_shared<QCJobTemplate>();
    opened->setName(QString(QStringLiteral("Left Inner Trim Gloss Check ")).repeated(12).toStdString());
    auto node = entryNodeHolding(opened);
    auto shortName = std::make_shared<QCJobTemplate>();
    shortName->setName("Door");
    auto shortNode = entryNodeHolding(shortName);
    m_host->show();
    // Measured with the editor shown once, since its style applies only then.
    select({shortNode.get()});
    QCoreApplication::sendPostedEvents(nullptr, QEvent::LayoutRequest);
    const int before = m_widget->minimumSizeHint().width();
    select({node.get()});

    QCOMPARE(pages()->currentIndex(), 1);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::LayoutRequest);
    // The name is cut at the pane's edge rather than widening the tab.
    QCOMPARE(m_widget->minimumSizeHint().width(), before);
    QCOMPARE(editorHeading()->toolTip(),
             QString::fromStdString(opened->name()));
}

Node* tst_PellamWidget::openStoredTemplate()
{
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    jobTemplate->setName("Door Panel");
    const std::string topLevel;
    if (!m_store->save(jobTemplate, &topLevel))
        return nullptr;
    delete m_widget;
    m_widget = createWidget();
    auto* browser = m_widget->findChild<DirEntryBrowserWidget*>();
    if (!QTest::qWaitFor([browser] { return browser->treeModel()->rowCount() == 1; }, 5000))
        return nullptr;
    Node* node = browser->treeModel()->root()->children().front().get();
    browser->treeView()->selectionModel()->setCurrentIndex(browser->treeModel()->indexFromNode(node),
                                                           QItemSelectionModel::ClearAndSelect);
    if (!QTest::qWaitFor([this] { return pages()->currentIndex() == 1; }, 5000))
        return nullptr;
    return node;
}

// An edit in the editor marks the template in the browser; a rename in the
// browser retitles the editor.
void tst_PellamWidget::editsAndRenamesReachTheOtherSide()
{
    Node* node = openStoredTemplate();
    QVERIFY(node);
    auto* browser = m_widget->findChild<DirEntryBrowserWidget*>();
    QVERIFY(!node->isModified());
    QTRY_COMPARE(editorHeading()->title(), QStringLiteral("Checkpoints for: Door Panel"));

    emit m_widget->findChild<QCJobTemplateDetailWidget*>()->sgJobTemplateWasModified(
        std::dynamic_pointer_cast<QCJobTemplate>(node->object()));
    QVERIFY(node->isModified());
    QVERIFY(browser->actionSave()->isEnabled());
    browser->treeModel()->renameNode(node, "Door Trim", {});
    QTRY_COMPARE(editorHeading()->title(), QStringLiteral("Checkpoints for: Door Trim"));
}

QC_TEST_MAIN(tst_PellamWidget)
#include "tst_pellamwidget.moc"
