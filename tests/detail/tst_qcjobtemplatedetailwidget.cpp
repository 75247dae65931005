#include "tests/common/ModalAnswer.h"
#include "tests/common/ObjectBrowserAnswer.h"
#include "tests/common/RawConnection.h"
#include "tests/common/TempStore.h"
#include "tests/common/PropertyFixtures.h"
#include "tests/common/TestMain.h"

#include "detail/QCJobTemplateDetailWidget.h"
#include "host/client/GeneralSettings.h"
#include "host/domain/AppearanceValues.h"
#include "host/domain/ColorStandardsLibrary.h"
#include "host/domain/ColorimetricCondition.h"
#include "host/domain/LabToleranceBase.h"
#include "host/domain/LabValue.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/RGBValue.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/domain/ToleranceSet.h"
#include "host/store/CreateFolder.h"
#include "host/store/FolderResponse.h"
#include "host/store/GetMarloObjectResponse.h"
#include "host/store/HostMetaTypes.h"
#include "host/store/UpdateObject.h"
#include "host/widgets/ObjectBrowserDialog.h"
#include "host/widgets/SelectedPath.h"
#include "host/widgets/UIHelper.h"
#include "model/QCJobTemplateModel.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDialogButtonBox>
#include <QFile>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMetaMethod>
#include <QPushButton>
#include <QSplitter>
#include <QTabWidget>
#include <QTableWidget>
#include <QToolButton>
#include <QTreeView>

// Lets the spy keep the template that each modification names.
Q_DECLARE_METATYPE(std::shared_ptr<vemi::QCJobTemplate>)

using namespace vemi;
using namespace PropertyFixtures;
using ObjectBrowserAnswer::pickInNextDialog;

namespace {

const char* const kSecondStore = "Plant 2";

std::shared_ptr<Standard> standardUnder(const std::string& name, const std::string& condition)
{
    auto standard = named<Standard>(name);
    auto lab = std::make_shared<LabValue>(50, 10, -10);
    lab->setColorimetricCondition(condition);
    auto appearance = std::make_shared<AppearanceValues>();
    appearance->setColorValues({lab});
    standard->setAppearanceValuesList({appearance});
    return standard;
}

std::shared_ptr<ToleranceSet> labToleranceSet(const std::string& name, const std::string& illuminant)
{
    auto tolerance = named<LabToleranceBase>("dE2000");
    tolerance->setColorimetricCondition(std::make_shared<ColorimetricCondition>(illuminant, "10"));
    auto set = named<ToleranceSet>(name);
    set->setTolerances({tolerance});
    return set;
}

QStringList listTexts(const QListWidget* list)
{
    QStringList result;
    for (int row = 0; row < list->count(); ++row)
        result << list->item(row)->text();
    return result;
}

} // namespace

class tst_QCJobTemplateDetailWidget : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void init();
    void cleanup();

    void signalAndSlotsInOrder();
    void buttonsAtConstruction_data();
    void buttonsAtConstruction();
    void reloadLeavesNothingOfThePreviousTemplate();
    void editsAreAnnouncedOnce();
    void splitterStatesSurviveARestart();
    void longTemplateNameDoesNotWidenTheEditor();

    void standardsShowTheirDisplayColour();
    void toleranceButtonsFollowTheNumberOfSets_data();
    void toleranceButtonsFollowTheNumberOfSets();
    void removeAllStandardsAndTolerances();
    void removeProperties_data();
    void removeProperties();
    void editPropertyValue_data();
    void editPropertyValue();
    void colorimetricConditionCheck_data();
    void colorimetricConditionCheck();

    void pickersFetchAndRememberTheirPlace_data();
    void pickersFetchAndRememberTheirPlace();
    void propertyPositionIsSharedWithTheLibraryPicker();
    void severalChosenEntries_data();
    void severalChosenEntries();
    void fetchedObjectsMeetWhatIsThere_data();
    void fetchedObjectsMeetWhatIsThere();
    void unexpectedAnswersChangeNothing();
    void vanishedObjectIsReportedNotApplied();

private:
    void open(const std::shared_ptr<QCJobTemplate>& jobTemplate);
    template <class T>
    T* child(const char* name) const { return m_widget->findChild<T*>(QLatin1String(name)); }
    void invoke(const char* slot, std::shared_ptr<Response> response);
    // Stores object in the store named dispatcherId, in a new folder when folderName is given.
    std::string save(std::shared_ptr<NamedObject> object, const std::string& folderName = {},
                     const std::string& dispatcherId = {});

    std::unique_ptr<TempStore> m_store;
    std::shared_ptr<QCJobTemplateModel> m_model;
    std::unique_ptr<QCJobTemplateDetailWidget> m_widget;
    std::unique_ptr<QSignalSpy> m_modified;
};

void tst_QCJobTemplateDetailWidget::initTestCase()
{
    qRegisterMetaType<std::shared_ptr<QCJobTemplate>>("std::shared_ptr<vemi::QCJobTemplate>");
}

void tst_QCJobTemplateDetailWidget::init()
{
    QSettings().clear();
    m_store = std::make_unique<TempStore>();
    m_store->model().addStore(kSecondStore, m_store->folder() + QStringLiteral("/plant2.sqlite"));
    m_model = std::make_shared<QCJobTemplateModel>(m_store->model());
    auto settings = std::make_shared<GeneralSettings>(std::vector<std::string>{"", kSecondStore}, "D65", "10");
    m_widget = std::make_unique<QCJobTemplateDetailWidget>(m_store->model(), nullptr, m_model, settings);
    m_modified = std::make_unique<QSignalSpy>(m_widget.get(), &QCJobTemplateDetailWidget::sgJobTemplateWasModified);
}

void tst_QCJobTemplateDetailWidget::cleanup()
{
    m_modified.reset();
    m_widget.reset();
    m_model.reset();
    m_store.reset();
}

// Callers connect by signature and the host lists the editor's methods in
// this order; a renamed or moved slot breaks them silently.
void tst_QCJobTemplateDetailWidget::signalAndSlotsInOrder()
{
    const QStringList expected = {
        "sgJobTemplateWasModified", "on_browseSchematicButton_clicked", "on_cropSchematicButton_clicked",
        "on_fitToWindowButton_clicked", "on_resetZoomButton_clicked", "on_clearSchematicButton_clicked",
        "onSavedMc", "onSaveError", "onSaveProgress", "onColorLibraryLoaded", "onPropertyLibraryLoaded",
        "onNewStandardLoaded", "onNewToleranceLoaded", "onGrabRubberBandedImageArea",
        "on_addMeasurementConfigurationButton_clicked", "on_zoomInButton_clicked", "on_zoomOutButton_clicked",
        "on_addProperty_clicked", "on_libraryLoadButton_clicked", "on_addStandardButton_clicked",
        "on_clearAllStandards_clicked", "on_removeTag_clicked", "on_insertToleranceButton_clicked",
        "on_removeToleranceButton_clicked", "on_enableRepeatCheckBox_clicked", "on_descriptionEdit_textEdited",
        "on_addPropertyLibrary_clicked", "onInstrumentConnected", "onInstrumentDisconnected", "tagEditSelected",
        "tagRowsSelected", "onPreferredInstrumentChanged", "onPropertyLoaded"};
    const QMetaObject& meta = QCJobTemplateDetailWidget::staticMetaObject;
    QStringList names;
    int protectedFrom = -1;
    for (int i = meta.methodOffset(); i < meta.methodCount(); ++i) {
        names << QString::fromLatin1(meta.method(i).name());
        if (protectedFrom < 0 && meta.method(i).access() == QMetaMethod::Protected)
            protectedFrom = i - meta.methodOffset();
    }
    QCOMPARE(names, expected);
    QCOMPARE(protectedFrom, expected.indexOf("onInstrumentConnected"));
    QCOMPARE(meta.method(meta.methodOffset()).methodType(), QMetaMethod::Signal);
}

void tst_QCJobTemplateDetailWidget::buttonsAtConstruction_data()
{
    QTest::addColumn<QString>("button");
    QTest::addColumn<QString>("icon");
    QTest::addColumn<QString>("toolTip");
    QTest::addColumn<bool>("enabled");
    QTest::newRow("addProperty") << "addProperty" << ":/Images/Images/Icon-Tag-BL.png" << "Add Properties" << false;
    QTest::newRow("addPropertyLibrary") << "addPropertyLibrary" << ":/Images/Images/Icon-Librar-BL.png"
                                        << "Add Properties from Library" << false;
    QTest::newRow("removeTag") << "removeTag" << ":/Images/Images/Icon-Trash-BL.png" << "Remove Selected Property"
                               << false;
    QTest::newRow("addStandardButton") << "addStandardButton" << ":/Images/Images/Icon-Standard-BL.png"
                                       << "Add Standard(s)" << false;
    QTest::newRow("libraryLoadButton") << "libraryLoadButton" << ":/Images/Images/Icon-Librar-BL.png"
                                       << "Insert Standards Library" << false;
    QTest::newRow("clearAllStandards") << "clearAllStandards" << ":/Images/Images/Icon-Trash-BL.png"
                                       << "Remove All Standards" << false;
    QTest::newRow("addMeasurementConfigurationButton")
        << "addMeasurementConfigurationButton" << ":/Images/Images/Icon-OptionsGear-BL.png"
        << "Set Measurement Configuration" << false;
    QTest::newRow("insertToleranceButton") << "insertToleranceButton" << ":/Images/Icon-Add-BL.png"
                                           << "Insert a default Tolerance" << true;
    QTest::newRow("removeToleranceButton") << "removeToleranceButton" << ":/Images/Images/Icon-Trash-BL.png"
                                           << "Remove all Tolerances" << true;
}

// Each button shows its picture (a missing resource leaves an empty button)
// and is usable only once a template is shown.
void tst_QCJobTemplateDetailWidget::buttonsAtConstruction()
{
    QFETCH(QString, button);
    QFETCH(QString, icon);
    QFETCH(QString, toolTip);
    QFETCH(bool, enabled);
    auto* widget = m_widget->findChild<QAbstractButton*>(button);
    QVERIFY(widget);
    QVERIFY(QFile::exists(icon));
    QVERIFY(!widget->icon().isNull());
    QCOMPARE(widget->icon().pixmap(24, 24).toImage(), QIcon(icon).pixmap(24, 24).toImage());
    QCOMPARE(widget->toolTip(), toolTip);
    QVERIFY(widget->text().isEmpty());
    QCOMPARE(widget->isEnabled(), enabled);
}

void tst_QCJobTemplateDetailWidget::open(const std::shared_ptr<QCJobTemplate>& jobTemplate)
{
    m_model->setJobTemplate(jobTemplate);
    m_widget->reloadFromModel();
}

void tst_QCJobTemplateDetailWidget::invoke(const char* slot, std::shared_ptr<Response> response)
{
    QVERIFY(QMetaObject::invokeMethod(m_widget.get(), slot, Q_ARG(std::shared_ptr<Response>, response)));
}

std::string tst_QCJobTemplateDetailWidget::save(std::shared_ptr<NamedObject> object, const std::string& folderName,
                                                const std::string& dispatcherId)
{
    std::string folderId;
    if (!folderName.empty()) {
        const auto created =
            m_store->run(std::make_shared<CreateFolder>(object->objectTypeId(), "", folderName), dispatcherId);
        if (const auto folder = std::dynamic_pointer_cast<FolderResponse>(created.response))
            folderId = folder->folder().id;
    }
    auto update = std::make_shared<UpdateObject>();
    update->setObject(object);
    update->setFolderId(folderId);
    if (!m_store->run(update, dispatcherId).response)
        qWarning("could not save %s", object->name().c_str());
    return object->id();
}

// --- Structure, load and refresh

void tst_QCJobTemplateDetailWidget::reloadLeavesNothingOfThePreviousTemplate()
{
    auto first = named<QCJobTemplate>("First");
    first->setDescription("first description");
    first->setEnableRepeat(true);
    first->setStandards({standardUnder("Red", "D65/10")});
    first->setSharedToleranceSets({labToleranceSet("dE2000 1.0", "D65")});
    first->setTagDefinitions({definition("Plant", "Nord")});
    first->setTagValues({TagValue::forDefinition(*first->tagDefinitions()[0], "Nord")});
    first->setMeasurementConfiguration(named<MeasurementConfiguration>("Spectro 45/0"));
    auto* tabs = child<QTabWidget>("tabWidget");
    // Before a template is open nothing can be edited.
    QVERIFY(!child<QLineEdit>("descriptionEdit")->isEnabled());
    QVERIFY(!child<QToolButton>("addStandardButton")->isEnabled());
    QVERIFY(child<QPushButton>("zoomInButton")->isHidden());
    open(first);
    QCOMPARE(tabs->currentIndex(), 0); // a template with a configuration keeps the tab shown
    QCOMPARE(child<QLabel>("MeasConfigurationNameLabel")->text(), QStringLiteral("Spectro 45/0"));
    QCOMPARE(child<QLineEdit>("descriptionEdit")->cursorPosition(), 0); // shows the description's beginning

    open(named<QCJobTemplate>("Second"));

    QCOMPARE(child<QListWidget>("standardsListWidget")->count(), 0);
    QCOMPARE(child<QListWidget>("defaultToleranceList")->count(), 0);
    QCOMPARE(child<QTableWidget>("tagTable")->rowCount(), 0);
    QCOMPARE(child<QLineEdit>("descriptionEdit")->text(), QString());
    QVERIFY(!child<QCheckBox>("enableRepeatCheckBox")->isChecked());
    QCOMPARE(child<QLabel>("MeasConfigurationNameLabel")->text(), QString());
    QVERIFY(!child<QLabel>("needMeasureConfigNotice")->isHidden());
    QCOMPARE(tabs->currentIndex(), 2);
    QCOMPARE(child<QGroupBox>("checkZoneGroupBox")->title(), QStringLiteral("Checkpoints for: Second"));
    QVERIFY(child<QLineEdit>("descriptionEdit")->isEnabled());
    QVERIFY(!child<QToolButton>("removeTag")->isEnabled());
    QCOMPARE(m_modified->count(), 0);
}

// The description announces its change before the model takes it, the
// repeat box after: each edit is announced exactly once.
void tst_QCJobTemplateDetailWidget::editsAreAnnouncedOnce()
{
    auto jobTemplate = named<QCJobTemplate>("T");
    jobTemplate->setDescription("ab");
    open(jobTemplate);
    QStringList atSignal;
    connect(m_widget.get(), &QCJobTemplateDetailWidget::sgJobTemplateWasModified,
            [&atSignal](const std::shared_ptr<QCJobTemplate>& t) {
                atSignal << QString::fromStdString(t->description()) + (t->enableRepeat() ? "+repeat" : "");
            });
    auto* edit = child<QLineEdit>("descriptionEdit");
    edit->setFocus();
    edit->end(false);
    QTest::keyClick(edit, Qt::Key_C);
    QTest::mouseClick(child<QCheckBox>("enableRepeatCheckBox"), Qt::LeftButton);
    QCOMPARE(atSignal, QStringList({"ab", "abc+repeat"}));
    QCOMPARE(jobTemplate->description(), std::string("abc"));
    QVERIFY(jobTemplate->enableRepeat());
}

void tst_QCJobTemplateDetailWidget::splitterStatesSurviveARestart()
{
    m_widget->resize(1400, 800);
    m_widget->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_widget.get()));
    child<QSplitter>("qcJobTemplateSplitter")->setSizes({700, 680});
    child<QSplitter>("horizontalSplitter")->setSizes({250, 480});
    const QList<int> outer = child<QSplitter>("qcJobTemplateSplitter")->sizes();
    const QList<int> inner = child<QSplitter>("horizontalSplitter")->sizes();
    cleanup();
    QVERIFY(!QSettings().value("UI/Pellam/horizontalSplitterState").toByteArray().isEmpty());
    QVERIFY(!QSettings().value("UI/Pellam/qcJobTemplateSplitterState").toByteArray().isEmpty());

    m_store = std::make_unique<TempStore>();
    m_model = std::make_shared<QCJobTemplateModel>(m_store->model());
    m_widget = std::make_unique<QCJobTemplateDetailWidget>(m_store->model(), nullptr, m_model, nullptr);
    m_widget->resize(1400, 800);
    m_widget->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_widget.get()));
    QCOMPARE(child<QSplitter>("qcJobTemplateSplitter")->sizes(), outer);
    QCOMPARE(child<QSplitter>("horizontalSplitter")->sizes(), inner);
}

void tst_QCJobTemplateDetailWidget::longTemplateNameDoesNotWidenTheEditor()
{
    m_widget->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_widget.get()));
    open(named<QCJobTemplate>("Short"));
    QCoreApplication::sendPostedEvents(nullptr, QEvent::LayoutRequest);
    const int width = m_widget->minimumSizeHint().width();
    open(named<QCJobTemplate>(std::string(400, 'W')));
    QCoreApplication::sendPostedEvents(nullptr, QEvent::LayoutRequest);
    QCOMPARE(m_widget->minimumSizeHint().width(), width);
    QCOMPARE(child<QGroupBox>("checkZoneGroupBox")->toolTip(), QString(400, 'W'));
}

// --- Standards, tolerances and properties

void tst_QCJobTemplateDetailWidget::standardsShowTheirDisplayColour()
{
    auto coloured = standardUnder("Red", "D65/10");
    coloured->setDisplayRGB(std::make_shared<RGBValue>(200, 20, 30));
    auto jobTemplate = named<QCJobTemplate>("T");
    jobTemplate->setStandards({coloured, standardUnder("Plain", "D65/10")});
    open(jobTemplate);
    auto* list = child<QListWidget>("standardsListWidget");
    QCOMPARE(listTexts(list), QStringList({"Red", "Plain"}));
    const QImage swatch = list->item(0)->icon().pixmap(10, 10).toImage();
    QCOMPARE(swatch.pixelColor(5, 5), UIHelper::toColor(*coloured->displayRGB()));
    QVERIFY(!list->item(1)->icon().availableSizes().contains(QSize(10, 10)));
}

void tst_QCJobTemplateDetailWidget::toleranceButtonsFollowTheNumberOfSets_data()
{
    QTest::addColumn<int>("sets");
    QTest::addColumn<bool>("insertShown");
    QTest::addColumn<bool>("removeShown");
    QTest::newRow("no set: insert only") << 0 << true << false;
    QTest::newRow("one set: a second may be inserted") << 1 << true << true;
    QTest::newRow("two sets: no third") << 2 << false << true;
}

void tst_QCJobTemplateDetailWidget::toleranceButtonsFollowTheNumberOfSets()
{
    QFETCH(int, sets);
    QFETCH(bool, insertShown);
    QFETCH(bool, removeShown);
    open(named<QCJobTemplate>("T"));
    for (int i = 0; i < sets; ++i)
        invoke("onNewToleranceLoaded", answer(labToleranceSet("Set " + std::to_string(i), "D65")));
    QCOMPARE(m_modified->count(), sets);
    QCOMPARE(child<QListWidget>("defaultToleranceList")->count(), sets);
    QCOMPARE(!child<QToolButton>("insertToleranceButton")->isHidden(), insertShown);
    QCOMPARE(!child<QToolButton>("removeToleranceButton")->isHidden(), removeShown);
}

void tst_QCJobTemplateDetailWidget::removeAllStandardsAndTolerances()
{
    auto jobTemplate = named<QCJobTemplate>("T");
    jobTemplate->setStandards({standardUnder("Red", "D65/10"), standardUnder("Blue", "D65/10")});
    jobTemplate->setSharedToleranceSets({labToleranceSet("A", "D65"), labToleranceSet("B", "D65")});
    jobTemplate->setPrivateToleranceSets({labToleranceSet("P", "D65")});
    open(jobTemplate);
    QTest::mouseClick(child<QToolButton>("clearAllStandards"), Qt::LeftButton);
    QVERIFY(jobTemplate->standards().empty());
    QCOMPARE(child<QListWidget>("standardsListWidget")->count(), 0);
    QTest::mouseClick(child<QToolButton>("removeToleranceButton"), Qt::LeftButton);
    QVERIFY(jobTemplate->sharedToleranceSets().empty());
    QVERIFY(jobTemplate->privateToleranceSets().empty());
    QCOMPARE(child<QListWidget>("defaultToleranceList")->count(), 0);
    QVERIFY(child<QToolButton>("removeToleranceButton")->isHidden());
    QVERIFY(!child<QToolButton>("insertToleranceButton")->isHidden());
    QCOMPARE(m_modified->count(), 2);
}

void tst_QCJobTemplateDetailWidget::removeProperties_data()
{
    addRemovalRows();
}

void tst_QCJobTemplateDetailWidget::removeProperties()
{
    QFETCH(QList<int>, clickedRows);
    QFETCH(QStringList, values);
    QFETCH(QStringList, remainingDefinitions);
    QFETCH(QStringList, remainingValues);
    std::vector<std::shared_ptr<TagDefinition>> definitions;
    std::vector<std::shared_ptr<TagValue>> tagValues;
    numberedProperties(values, &definitions, &tagValues);
    auto jobTemplate = named<QCJobTemplate>("T");
    jobTemplate->setTagDefinitions(definitions);
    jobTemplate->setTagValues(tagValues);
    open(jobTemplate);
    m_widget->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_widget.get()));
    child<QTabWidget>("tabWidget")->setCurrentIndex(0);

    auto* table = child<QTableWidget>("tagTable");
    for (int row : clickedRows) {
        const QRect cell = table->visualRect(table->model()->index(row, 0));
        QTest::mouseClick(table->viewport(), Qt::LeftButton, Qt::ControlModifier, cell.center());
    }
    auto* removeTag = child<QToolButton>("removeTag");
    QVERIFY(removeTag->isEnabled());
    QTest::mouseClick(removeTag, Qt::LeftButton);

    QCOMPARE(names(jobTemplate->tagDefinitions()), remainingDefinitions);
    QCOMPARE(valueTexts(definitions, jobTemplate->tagValues()), remainingValues);
    QCOMPARE(jobTemplate->tagValues().size(), std::size_t(remainingValues.size())); // no orphan values
    QCOMPARE(table->rowCount(), remainingDefinitions.size());
    QCOMPARE(m_modified->count(), 1);
    QVERIFY(!removeTag->isEnabled());
}

void tst_QCJobTemplateDetailWidget::editPropertyValue_data()
{
    QTest::addColumn<bool>("accept");
    QTest::newRow("accepted value is stored") << true;
    QTest::newRow("cancelled dialog changes nothing") << false;
}

void tst_QCJobTemplateDetailWidget::editPropertyValue()
{
    QFETCH(bool, accept);
    auto jobTemplate = named<QCJobTemplate>("T");
    jobTemplate->setTagDefinitions({definition("Plant"), definition("Line", "7")});
    jobTemplate->setTagValues({TagValue::forDefinition(*jobTemplate->tagDefinitions()[1], "7")});
    open(jobTemplate);
    ModalAnswer::actOnNextModal([accept](QWidget* modal) {
        auto* dialog = qobject_cast<QDialog*>(modal);
        QVERIFY(dialog);
        auto* edit = dialog->findChild<QLineEdit*>(QStringLiteral("valueEdit"));
        edit->setText(QStringLiteral("Süd"));
        if (accept)
            dialog->accept();
        else
            dialog->reject();
    });
    auto* table = child<QTableWidget>("tagTable");
    emit table->cellDoubleClicked(0, 0);

    QCOMPARE(m_modified->count(), accept ? 1 : 0);
    const QStringList expected = accept ? QStringList{"Line=7", "Plant=Süd"} : QStringList{"Line=7"};
    QStringList stored = valueTexts(jobTemplate->tagDefinitions(), jobTemplate->tagValues());
    stored.sort();
    QCOMPARE(stored, expected);
    QCOMPARE(table->item(0, 1)->text(), accept ? QStringLiteral("Süd") : QString());
    QVERIFY(!child<QToolButton>("removeTag")->isEnabled());
}

void tst_QCJobTemplateDetailWidget::colorimetricConditionCheck_data()
{
    QTest::addColumn<QStringList>("standardConditions"); // one standard per entry, named S1, S2, …
    QTest::addColumn<bool>("labTolerance");
    QTest::addColumn<QString>("message"); // empty: the set is accepted
    QTest::newRow("same condition on every standard") << QStringList{"D65/10", "D65/10"} << true << QString();
    QTest::newRow("second standard differs by letter case")
        << QStringList{"D65/10", "d65/10", "A/2"} << true
        << QStringLiteral("Your standard \"S2\" uses d65/10, while the tolerance you want to add uses D65/10");
    QTest::newRow("template without standards") << QStringList{} << true << QString();
    QTest::newRow("set without a Lab tolerance") << QStringList{"A/2"} << false << QString();
}

void tst_QCJobTemplateDetailWidget::colorimetricConditionCheck()
{
    QFETCH(QStringList, standardConditions);
    QFETCH(bool, labTolerance);
    QFETCH(QString, message);
    std::vector<std::shared_ptr<Standard>> standards;
    for (int i = 0; i < standardConditions.size(); ++i)
        standards.push_back(standardUnder("S" + std::to_string(i + 1), standardConditions[i].toStdString()));
    auto jobTemplate = named<QCJobTemplate>("T");
    jobTemplate->setStandards(standards);
    open(jobTemplate);
    auto set = labTolerance ? labToleranceSet("dE2000", "D65") : named<ToleranceSet>("Plain");
    if (!labTolerance)
        set->setTolerances({named<Tolerance>("dE")});

    QString shown;
    if (!message.isEmpty())
        ModalAnswer::clickInNextMessageBox(QMessageBox::Ok, &shown);
    invoke("onNewToleranceLoaded", answer(set));

    QCOMPARE(shown, message);
    const bool accepted = message.isEmpty();
    QCOMPARE(jobTemplate->sharedToleranceSets().size(), std::size_t(accepted ? 1 : 0));
    QCOMPARE(child<QListWidget>("defaultToleranceList")->count(), accepted ? 1 : 0);
    QCOMPARE(m_modified->count(), accepted ? 1 : 0);
}

// --- Pickers

void tst_QCJobTemplateDetailWidget::pickersFetchAndRememberTheirPlace_data()
{
    QTest::addColumn<QString>("button");
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("group");
    QTest::addColumn<QString>("added"); // what the list shows afterwards
    QTest::newRow("standard") << "addStandardButton" << "Add selected standard(s)" << "Opal QC/StandardPath"
                              << "standards: Picked";
    QTest::newRow("standards library") << "libraryLoadButton" << "Add standards in selected library"
                                       << "Opal QC/PropertyPath" << "standards: In Library";
    QTest::newRow("property") << "addProperty" << "Select properties to insert" << "Opal QC/PropertyPath"
                              << "properties: Picked";
    QTest::newRow("property library") << "addPropertyLibrary" << "Add properties in selected library"
                                      << "Opal QC/PropertyPath" << "properties: Shift, Picked";
    QTest::newRow("default tolerance") << "insertToleranceButton" << "Select a default tolerance"
                                       << "Opal QC/TolerancePath" << "tolerances: Picked";
}

void tst_QCJobTemplateDetailWidget::pickersFetchAndRememberTheirPlace()
{
    QFETCH(QString, button);
    QFETCH(QString, title);
    QFETCH(QString, group);
    QFETCH(QString, added);
    // Each kind of object is stored in a folder "Shelf" of its own tree in the
    // second store, so that a fetch from the default store would find nothing.
    save(standardUnder("Picked", "D65/10"), "Shelf", kSecondStore);
    auto library = named<ColorStandardsLibrary>("Picked");
    library->setStandards({standardUnder("In Library", "D65/10")});
    save(library->standards()[0], {}, kSecondStore);
    save(library, "Shelf", kSecondStore);
    save(definition("Picked", "x"), "Shelf", kSecondStore);
    auto properties = named<PropertyLibrary>("Picked");
    properties->setProperties({definition("Shift"), definition("Picked", "y")});
    save(properties->properties()[0], {}, kSecondStore);
    save(properties->properties()[1], {}, kSecondStore);
    save(properties, "Shelf", kSecondStore);
    save(labToleranceSet("Picked", "D65"), "Shelf", kSecondStore);
    auto jobTemplate = named<QCJobTemplate>("T");
    open(jobTemplate);

    QString shownTitle;
    pickInNextDialog(kSecondStore, {"Shelf"}, {"Picked"}, &shownTitle);
    QTest::mouseClick(m_widget->findChild<QToolButton*>(button), Qt::LeftButton);
    QCOMPARE(shownTitle, title);
    QTRY_COMPARE_WITH_TIMEOUT(m_modified->count(), 1, 5000);

    const QString list = added.section(':', 0, 0);
    const QStringList expected = added.section(": ", 1).split(", ");
    if (list == "standards")
        QCOMPARE(listTexts(child<QListWidget>("standardsListWidget")), expected);
    else if (list == "tolerances")
        QCOMPARE(listTexts(child<QListWidget>("defaultToleranceList")), expected);
    else
        QCOMPARE(names(jobTemplate->tagDefinitions()), expected);

    QSettings settings;
    for (const char* const g : {"Opal QC/LibraryPath", "Opal QC/StandardPath", "Opal QC/TolerancePath",
                             "Opal QC/PropertyPath"}) {
        QVERIFY2(settings.contains(g + QStringLiteral("/LastSelectedPath")), g); // all four are written
        QCOMPARE(settings.value(g + QStringLiteral("/LastSelectedPath")).toString(), QLatin1String(g) == group ? "/Shelf" : QString());
        QCOMPARE(settings.value(g + QStringLiteral("/DispatcherId")).toString(), QLatin1String(g) == group ? kSecondStore : "");
    }

    // After a restart the same picker opens where it was left.
    m_modified.reset();
    m_widget = std::make_unique<QCJobTemplateDetailWidget>(
        m_store->model(), nullptr, m_model,
        std::make_shared<GeneralSettings>(std::vector<std::string>{"", kSecondStore}, "D65", "10"));
    m_widget->reloadFromModel();
    std::shared_ptr<SelectedPath> openedAt;
    pickInNextDialog({}, {}, {}, nullptr, &openedAt);
    QTest::mouseClick(m_widget->findChild<QToolButton*>(button), Qt::LeftButton);
    QVERIFY(openedAt);
    QCOMPARE(openedAt->dispatcherId(), std::string(kSecondStore));
    QCOMPARE(openedAt->path(), std::vector<std::string>{"Shelf"});
}

void tst_QCJobTemplateDetailWidget::propertyPositionIsSharedWithTheLibraryPicker()
{
    save(definition("Picked"), "Shelf");
    open(named<QCJobTemplate>("T"));
    pickInNextDialog({}, {"Shelf"}, {"Picked"});
    QTest::mouseClick(child<QToolButton>("addProperty"), Qt::LeftButton);
    QTRY_COMPARE_WITH_TIMEOUT(m_modified->count(), 1, 5000);

    std::shared_ptr<SelectedPath> openedAt;
    pickInNextDialog({}, {}, {}, nullptr, &openedAt);
    QTest::mouseClick(child<QToolButton>("libraryLoadButton"), Qt::LeftButton);
    QVERIFY(openedAt);
    QCOMPARE(openedAt->path(), std::vector<std::string>{"Shelf"});
    // A cancelled picker keeps the positions as they were.
    QCOMPARE(QSettings().value("Opal QC/PropertyPath/LastSelectedPath").toString(), QStringLiteral("/Shelf"));
}

void tst_QCJobTemplateDetailWidget::severalChosenEntries_data()
{
    QTest::addColumn<QString>("button");
    QTest::addColumn<QStringList>("chosen");
    QTest::addColumn<QStringList>("standards");
    QTest::newRow("three standards are fetched and added each")
        << "addStandardButton" << QStringList{"Red", "Green", "Blue"} << QStringList{"Blue", "Green", "Red"};
    QTest::newRow("of two libraries only the first chosen is loaded")
        << "libraryLoadButton" << QStringList{"Library A", "Library B"} << QStringList{"In A"};
}

void tst_QCJobTemplateDetailWidget::severalChosenEntries()
{
    QFETCH(QString, button);
    QFETCH(QStringList, chosen);
    QFETCH(QStringList, standards);
    for (const char* name : {"Red", "Green", "Blue"})
        save(standardUnder(name, "D65/10"), {});
    for (const char* name : {"A", "B"}) {
        auto library = named<ColorStandardsLibrary>(std::string("Library ") + name);
        library->setStandards({standardUnder(std::string("In ") + name, "D65/10")});
        save(library->standards()[0], {});
        save(library, {});
    }
    open(named<QCJobTemplate>("T"));

    pickInNextDialog({}, {}, chosen);
    QTest::mouseClick(m_widget->findChild<QToolButton*>(button), Qt::LeftButton);
    QTRY_COMPARE_WITH_TIMEOUT(m_modified->count(), standards.size() > 1 ? standards.size() : 1, 5000);
    QTest::qWait(100); // a fetch for a second library would have answered by now
    QStringList shown = listTexts(child<QListWidget>("standardsListWidget"));
    shown.sort();
    QCOMPARE(shown, standards);
}

// The template holds the standard "Red" and the property "Plant"; each row
// brings one fetched object in through its picker's answer slot.
void tst_QCJobTemplateDetailWidget::fetchedObjectsMeetWhatIsThere_data()
{
    QTest::addColumn<QString>("fetched");
    QTest::addColumn<QStringList>("standards");
    QTest::addColumn<QStringList>("properties");
    QTest::addColumn<int>("announced");
    QTest::newRow("a standard of a name already there is not added, yet announced")
        << "standard Red" << QStringList{"Red"} << QStringList{"Plant"} << 1;
    QTest::newRow("a library without standards keeps the template's")
        << "empty library" << QStringList{"Red"} << QStringList{"Plant"} << 1;
    QTest::newRow("a library with standards replaces them all")
        << "library Blue" << QStringList{"Blue"} << QStringList{"Plant"} << 1;
    QTest::newRow("a property of a name already there changes nothing and says nothing")
        << "property Plant" << QStringList{"Red"} << QStringList{"Plant"} << 0;
    QTest::newRow("a property library whose properties are all there is announced once")
        << "property library Plant" << QStringList{"Red"} << QStringList{"Plant"} << 1;
    QTest::newRow("a name twice in a property library is added once")
        << "property library Shift Shift" << QStringList{"Red"} << QStringList{"Plant", "Shift"} << 1;
}

void tst_QCJobTemplateDetailWidget::fetchedObjectsMeetWhatIsThere()
{
    QFETCH(QString, fetched);
    QFETCH(QStringList, standards);
    QFETCH(QStringList, properties);
    QFETCH(int, announced);
    auto jobTemplate = named<QCJobTemplate>("T");
    jobTemplate->setStandards({standardUnder("Red", "D65/10")});
    jobTemplate->setTagDefinitions({definition("Plant")});
    open(jobTemplate);

    if (fetched == "standard Red") {
        invoke("onNewStandardLoaded", answer(standardUnder("Red", "D50/2")));
    } else if (fetched == "empty library" || fetched == "library Blue") {
        auto library = named<ColorStandardsLibrary>("Library");
        if (fetched == "library Blue")
            library->setStandards({standardUnder("Blue", "D65/10")});
        invoke("onColorLibraryLoaded", answer(library));
    } else if (fetched == "property Plant") {
        invoke("onPropertyLoaded", answer(definition("Plant", "Nord")));
    } else {
        auto library = named<PropertyLibrary>("Properties");
        std::vector<std::shared_ptr<TagDefinition>> members;
        for (const QString& name : fetched.section(' ', 2).split(' '))
            members.push_back(definition(name.toStdString()));
        library->setProperties(members);
        invoke("onPropertyLibraryLoaded", answer(library));
    }

    QStringList shown = listTexts(child<QListWidget>("standardsListWidget"));
    shown.sort();
    QCOMPARE(shown, standards);
    QCOMPARE(names(jobTemplate->tagDefinitions()), properties);
    QCOMPARE(m_modified->count(), announced);
}

void tst_QCJobTemplateDetailWidget::unexpectedAnswersChangeNothing()
{
    auto jobTemplate = named<QCJobTemplate>("T");
    jobTemplate->setStandards({standardUnder("Red", "D65/10")});
    jobTemplate->setTagDefinitions({definition("Plant")});
    open(jobTemplate);
    auto wrongStandard = named<TagDefinition>("Blue"); // a standard slot given a property
    invoke("onNewStandardLoaded", answer(wrongStandard));
    invoke("onColorLibraryLoaded", answer(named<Standard>("Green")));
    invoke("onPropertyLoaded", answer(named<Standard>("Plant 2")));
    invoke("onPropertyLibraryLoaded", answer(named<ColorStandardsLibrary>("Lib")));
    invoke("onNewToleranceLoaded", answer(named<Standard>("Set")));
    invoke("onNewStandardLoaded", std::make_shared<Response>());
    QCOMPARE(jobTemplate->standards().size(), std::size_t(1));
    QCOMPARE(names(jobTemplate->tagDefinitions()), QStringList{"Plant"});
    QVERIFY(jobTemplate->sharedToleranceSets().empty());
    QCOMPARE(m_modified->count(), 0);
}

void tst_QCJobTemplateDetailWidget::vanishedObjectIsReportedNotApplied()
{
    const std::string id = save(standardUnder("Fleeting", "D65/10"));
    auto jobTemplate = named<QCJobTemplate>("T");
    open(jobTemplate);
    static QStringList warnings;
    warnings.clear();
    const QtMessageHandler previous =
        qInstallMessageHandler([](QtMsgType type, const QMessageLogContext&, const QString& text) {
            if (type == QtWarningMsg && text.startsWith("Cannot"))
                warnings.append(text);
        });
    // The entry is listed, then another program deletes its object before OK.
    const QString path = m_store->path();
    pickInNextDialog({}, {}, {"Fleeting"}, nullptr, nullptr, [path, id] {
        RawConnection raw(path);
        raw.exec(QStringLiteral("PRAGMA foreign_keys = OFF"));
        raw.exec(QStringLiteral("DELETE FROM objects WHERE id = ?"), {QString::fromStdString(id)});
    });
    QTest::mouseClick(child<QToolButton>("addStandardButton"), Qt::LeftButton);
    (void)QTest::qWaitFor([] { return !warnings.isEmpty(); }, 5000);
    qInstallMessageHandler(previous); // before any check, so that the test log is not swallowed
    QCOMPARE(warnings.size(), 1);
    QVERIFY2(warnings.first().contains(QString::fromStdString(id)), qPrintable(warnings.first()));
    QVERIFY(jobTemplate->standards().empty());
    QCOMPARE(m_modified->count(), 0);
}

QC_TEST_MAIN(tst_QCJobTemplateDetailWidget)
#include "tst_qcjobtemplatedetailwidget.moc"
