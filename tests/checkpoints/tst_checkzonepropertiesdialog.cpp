#include "tests/common/ModalAnswer.h"
#include "tests/common/ObjectBrowserAnswer.h"
#include "tests/common/TempStore.h"
#include "tests/common/PropertyFixtures.h"
#include "tests/common/TestMain.h"

#include "checkpoints/CheckZonePropertiesDialog.h"
#include "detail/QCJobTemplateDetailWidget.h"
#include "host/client/GeneralSettings.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/RGBValue.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/store/CreateFolder.h"
#include "host/store/FolderResponse.h"
#include "host/store/GetMarloObjectResponse.h"
#include "host/store/HostMetaTypes.h"
#include "host/store/UpdateObject.h"
#include "host/widgets/SelectedPath.h"
#include "host/widgets/UIHelper.h"
#include "model/QCJobTemplateModel.h"

#include <QAbstractButton>
#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QTableWidget>

using namespace vemi;
using ObjectBrowserAnswer::pickInNextDialog;
using namespace PropertyFixtures;

namespace {

QStringList comboTexts(const QComboBox* combo)
{
    QStringList result;
    for (int i = 0; i < combo->count(); ++i)
        result << combo->itemText(i);
    return result;
}

} // namespace

class tst_CheckZonePropertiesDialog : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();

    void standardSelection_data();
    void standardSelection();
    void standardsShowTheirSwatch();
    void placeholderNameIsSelected_data();
    void placeholderNameIsSelected();
    void removeProperties_data();
    void removeProperties();
    void editPropertyValue_data();
    void editPropertyValue();
    void pickersFetchIntoTheDialog_data();
    void pickersFetchIntoTheDialog();
    void pickerPlaceIsSharedWithTheEditor();
    void fetchedPropertiesMeetWhatIsThere_data();
    void fetchedPropertiesMeetWhatIsThere();
    void checkPointAndTemplateStayUntouched_data();
    void checkPointAndTemplateStayUntouched();

private:
    std::unique_ptr<CheckZonePropertiesDialog> makeDialog();
    template <class T>
    T* child(const char* name) const { return m_dialog->findChild<T*>(QLatin1String(name)); }
    void invoke(const char* slot, std::shared_ptr<Response> response);
    // Stores object, in a new folder when folderName is given.
    void save(std::shared_ptr<NamedObject> object, const std::string& folderName = {});
    void selectRows(const QList<int>& rows);

    std::unique_ptr<TempStore> m_store;
    std::shared_ptr<QCJobTemplateModel> m_model;
    std::shared_ptr<QCJobTemplate> m_template;
    std::shared_ptr<CheckPoint> m_checkPoint;
    std::unique_ptr<CheckZonePropertiesDialog> m_dialog;
};

void tst_CheckZonePropertiesDialog::init()
{
    QSettings().clear();
    m_store = std::make_unique<TempStore>();
    m_model = std::make_shared<QCJobTemplateModel>(m_store->model());
    m_template = named<QCJobTemplate>("T");
    m_model->setJobTemplate(m_template);
    m_checkPoint = named<CheckPoint>("Hood");
}

void tst_CheckZonePropertiesDialog::cleanup()
{
    m_dialog.reset();
    m_model.reset();
    m_store.reset();
}

std::unique_ptr<CheckZonePropertiesDialog> tst_CheckZonePropertiesDialog::makeDialog()
{
    auto dialog = std::make_unique<CheckZonePropertiesDialog>(m_checkPoint, m_model, nullptr);
    dialog->setMarloModel(&m_store->model());
    return dialog;
}

void tst_CheckZonePropertiesDialog::invoke(const char* slot, std::shared_ptr<Response> response)
{
    QVERIFY(QMetaObject::invokeMethod(m_dialog.get(), slot, Q_ARG(std::shared_ptr<vemi::Response>, response)));
}

void tst_CheckZonePropertiesDialog::save(std::shared_ptr<NamedObject> object, const std::string& folderName)
{
    auto update = std::make_shared<UpdateObject>();
    update->setObject(object);
    if (!folderName.empty()) {
        const auto created = m_store->run(std::make_shared<CreateFolder>(object->objectTypeId(), "", folderName));
        const auto folder = std::dynamic_pointer_cast<FolderResponse>(created.response);
        QVERIFY(folder);
        update->setFolderId(folder->folder().id);
    }
    QVERIFY(m_store->run(update).response);
}

// Ctrl-clicks the rows of the shown dialog's property table, in the order given.
void tst_CheckZonePropertiesDialog::selectRows(const QList<int>& rows)
{
    auto* table = child<QTableWidget>("tagTable");
    for (int row : rows) {
        const QRect cell = table->visualRect(table->model()->index(row, 0));
        QTest::mouseClick(table->viewport(), Qt::LeftButton, Qt::ControlModifier, cell.center());
    }
}

// --- Standards

void tst_CheckZonePropertiesDialog::standardSelection_data()
{
    // The template's standards are named by "standards"; the checkpoint's
    // standard is the template's standard at "own" (-1: none, -2: a standard
    // "Gone" that the template does not have).
    QTest::addColumn<QStringList>("standards");
    QTest::addColumn<int>("own");
    QTest::addColumn<bool>("autoStandard");
    QTest::addColumn<int>("current"); // -1: the list stays empty
    QTest::addColumn<QString>("result"); // standard(): "" for none

    const QStringList two{"Red", "Blue"};
    QTest::newRow("a fixed standard is preselected") << two << 1 << false << 2 << "Blue";
    QTest::newRow("the automatic flag shows Auto Select even with a standard") << two << 1 << true << 0 << "";
    QTest::newRow("no standard shows Auto Select") << two << -1 << false << 0 << "";
    QTest::newRow("a standard the template no longer has falls back to Auto Select")
        << two << -2 << false << 0 << "";
    QTest::newRow("of two equal names the first is selected") << QStringList{"Red", "Red"} << 1 << false << 1 << "Red";
    QTest::newRow("a template without standards keeps the checkpoint's") << QStringList{} << -2 << false << -1 << "Gone";
}

void tst_CheckZonePropertiesDialog::standardSelection()
{
    QFETCH(QStringList, standards);
    QFETCH(int, own);
    QFETCH(bool, autoStandard);
    QFETCH(int, current);
    QFETCH(QString, result);
    std::vector<std::shared_ptr<Standard>> templateStandards;
    for (const QString& name : standards)
        templateStandards.push_back(named<Standard>(name.toStdString()));
    m_template->setStandards(templateStandards);
    const auto gone = named<Standard>("Gone");
    m_checkPoint->setStandard(own >= 0 ? templateStandards[std::size_t(own)] : own == -2 ? gone : nullptr);
    m_checkPoint->setAutoStandard(autoStandard);

    m_dialog = makeDialog();

    auto* combo = child<QComboBox>("standardsComboBox");
    QCOMPARE(combo->currentIndex(), current);
    QCOMPARE(comboTexts(combo), standards.isEmpty() ? QStringList() : QStringList{"Auto Select"} + standards);
    const auto chosen = m_dialog->standard();
    QCOMPARE(chosen ? QString::fromStdString(chosen->name()) : QString(), result);
    if (current > 0) // the template's own object, not a copy
        QCOMPARE(chosen, templateStandards[std::size_t(current - 1)]);

    if (standards.isEmpty())
        return;
    // The user's choice is the result; "Auto Select" means none.
    combo->setCurrentIndex(standards.size());
    QCOMPARE(m_dialog->standard(), templateStandards.back());
    combo->setCurrentIndex(0);
    QVERIFY(!m_dialog->standard());
}

void tst_CheckZonePropertiesDialog::standardsShowTheirSwatch()
{
    auto coloured = named<Standard>("Red");
    coloured->setDisplayRGB(std::make_shared<RGBValue>(200, 20, 30));
    m_template->setStandards({coloured, named<Standard>("Plain")});
    m_dialog = makeDialog();
    auto* combo = child<QComboBox>("standardsComboBox");
    const QImage swatch = combo->itemIcon(1).pixmap(10, 10).toImage();
    QCOMPARE(swatch.pixelColor(5, 5), UIHelper::toColor(*coloured->displayRGB()));
    QVERIFY(!combo->itemIcon(2).availableSizes().contains(QSize(10, 10)));
    QVERIFY(!combo->itemIcon(0).isNull());
}

void tst_CheckZonePropertiesDialog::placeholderNameIsSelected_data()
{
    QTest::addColumn<QString>("name");
    QTest::addColumn<bool>("selected");
    QTest::newRow("an empty name") << "" << true;
    QTest::newRow("a name beginning with three dots") << "...Checkpoint 4" << true;
    QTest::newRow("a real name") << "New Checkpoint" << false;
}

void tst_CheckZonePropertiesDialog::placeholderNameIsSelected()
{
    QFETCH(QString, name);
    QFETCH(bool, selected);
    m_checkPoint->setName(name.toStdString());
    m_dialog = makeDialog();
    auto* edit = child<QLineEdit>("checkPointName");
    QCOMPARE(edit->text(), name);
    QCOMPARE(m_dialog->focusWidget() == edit, selected);
    QCOMPARE(edit->selectedText(), selected ? name : QString());
}

// --- Properties

void tst_CheckZonePropertiesDialog::removeProperties_data()
{
    addRemovalRows();
}

void tst_CheckZonePropertiesDialog::removeProperties()
{
    QFETCH(QList<int>, clickedRows);
    QFETCH(QStringList, values);
    QFETCH(QStringList, remainingDefinitions);
    QFETCH(QStringList, remainingValues);
    std::vector<std::shared_ptr<TagDefinition>> definitions;
    std::vector<std::shared_ptr<TagValue>> tagValues;
    numberedProperties(values, &definitions, &tagValues);
    m_checkPoint->setTagDefinitions(definitions);
    m_checkPoint->setTagValues(tagValues);
    m_dialog = makeDialog();
    m_dialog->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_dialog.get()));

    auto* remove = child<QAbstractButton>("removeTagButton");
    QVERIFY(!remove->isEnabled());
    selectRows(clickedRows);
    QVERIFY(remove->isEnabled());
    QTest::mouseClick(remove, Qt::LeftButton);

    QCOMPARE(names(m_dialog->tagDefinitions()), remainingDefinitions);
    QCOMPARE(valueTexts(definitions, m_dialog->tagValues()), remainingValues); // no value left without definition
    QCOMPARE(child<QTableWidget>("tagTable")->rowCount(), remainingDefinitions.size());
    QVERIFY(!remove->isEnabled());
    QCOMPARE(m_checkPoint->tagDefinitions().size(), std::size_t(4)); // only the dialog's copy changed
    QCOMPARE(m_checkPoint->tagValues(), tagValues);
}

void tst_CheckZonePropertiesDialog::editPropertyValue_data()
{
    QTest::addColumn<bool>("accept");
    QTest::newRow("an accepted value is the dialog's result") << true;
    QTest::newRow("a cancelled edit changes nothing") << false;
}

void tst_CheckZonePropertiesDialog::editPropertyValue()
{
    QFETCH(bool, accept);
    m_checkPoint->setTagDefinitions({definition("Plant"), definition("Line", "7")});
    const auto line = TagValue::forDefinition(*m_checkPoint->tagDefinitions()[1], "7");
    m_checkPoint->setTagValues({line});
    m_dialog = makeDialog();
    ModalAnswer::actOnNextModal([accept](QWidget* modal) {
        auto* dialog = qobject_cast<QDialog*>(modal);
        QVERIFY(dialog);
        auto* edit = dialog->findChild<QLineEdit*>(QStringLiteral("valueEdit"));
        QVERIFY(edit);
        edit->setText(QStringLiteral("Süd"));
        if (accept)
            dialog->accept();
        else
            dialog->reject();
    });
    auto* table = child<QTableWidget>("tagTable");
    table->selectRow(0);
    emit table->cellDoubleClicked(0, 0);

    QStringList result = valueTexts(m_dialog->tagDefinitions(), m_dialog->tagValues());
    result.sort();
    QCOMPARE(result, accept ? QStringList({"Line=7", "Plant=Süd"}) : QStringList{"Line=7"});
    QCOMPARE(table->item(0, 1)->text(), accept ? QStringLiteral("Süd") : QString());
    QVERIFY(table->selectedItems().isEmpty());
    QVERIFY(!child<QAbstractButton>("removeTagButton")->isEnabled());
    QCOMPARE(m_checkPoint->tagValues(), std::vector<std::shared_ptr<TagValue>>{line});
}

// The template has the property "Plant", the checkpoint "Shift"; the store
// holds, in the folder "Shelf", a property "Line" (default "7") and a
// library with "Plant", "Colour" and "Line".
void tst_CheckZonePropertiesDialog::pickersFetchIntoTheDialog_data()
{
    QTest::addColumn<QString>("button");
    QTest::addColumn<QString>("entry");
    QTest::addColumn<QString>("title");
    QTest::addColumn<QStringList>("definitions");
    QTest::addColumn<QStringList>("values");
    QTest::newRow("a property with its default value")
        << "AddTagsButton" << "Line" << "Select properties to insert" << QStringList{"Shift", "Line"}
        << QStringList{"Line=7"};
    QTest::newRow("a library less the template's own property")
        << "AddPropertyLibrary" << "Library" << "Add properties in selected library"
        << QStringList{"Shift", "Colour", "Line"} << QStringList{"Line=7"};
}

void tst_CheckZonePropertiesDialog::pickersFetchIntoTheDialog()
{
    QFETCH(QString, button);
    QFETCH(QString, entry);
    QFETCH(QString, title);
    QFETCH(QStringList, definitions);
    QFETCH(QStringList, values);
    m_template->setTagDefinitions({definition("Plant")});
    m_checkPoint->setTagDefinitions({definition("Shift")});
    if (entry == "Line") {
        save(definition("Line", "7"), "Shelf");
    } else {
        auto library = named<PropertyLibrary>("Library");
        library->setProperties({definition("Plant", "Nord"), definition("Colour"), definition("Line", "7")});
        for (const auto& member : library->properties())
            save(member);
        save(library, "Shelf");
    }
    m_dialog = makeDialog();

    QString shownTitle;
    pickInNextDialog({}, {"Shelf"}, {entry}, &shownTitle);
    QTest::mouseClick(child<QAbstractButton>(button.toLatin1().constData()), Qt::LeftButton);
    QCOMPARE(shownTitle, title);
    QTRY_COMPARE_WITH_TIMEOUT(names(m_dialog->tagDefinitions()), definitions, 5000);
    QCOMPARE(valueTexts(m_dialog->tagDefinitions(), m_dialog->tagValues()), values);
    QCOMPARE(child<QTableWidget>("tagTable")->rowCount(), definitions.size());
    QCOMPARE(names(m_template->tagDefinitions()), QStringList{"Plant"});
    QCOMPARE(names(m_checkPoint->tagDefinitions()), QStringList{"Shift"});
    QSettings settings;
    QCOMPARE(settings.value("Opal QC/PropertyPath/LastSelectedPath").toString(), QStringLiteral("/Shelf"));
    QCOMPARE(settings.value("Opal QC/PropertyPath/DispatcherId").toString(), QString());
}

// The dialog reads the place at each opening and writes it where the
// template editor's property pickers keep theirs, both ways round.
void tst_CheckZonePropertiesDialog::pickerPlaceIsSharedWithTheEditor()
{
    save(definition("Line"), "Shelf");
    save(definition("Colour"), "Rack");
    auto settings = std::make_shared<GeneralSettings>(std::vector<std::string>{""}, "D65", "10");
    auto editor = std::make_unique<QCJobTemplateDetailWidget>(m_store->model(), nullptr, m_model, settings);
    editor->reloadFromModel();
    pickInNextDialog({}, {"Rack"}, {"Colour"});
    QTest::mouseClick(editor->findChild<QAbstractButton*>(QStringLiteral("addProperty")), Qt::LeftButton);

    m_dialog = makeDialog();
    std::shared_ptr<SelectedPath> openedAt;
    pickInNextDialog({}, {"Shelf"}, {"Line"}, nullptr, &openedAt);
    QTest::mouseClick(child<QAbstractButton>("AddTagsButton"), Qt::LeftButton);
    QVERIFY(openedAt);
    QCOMPARE(openedAt->path(), std::vector<std::string>{"Rack"});

    editor = std::make_unique<QCJobTemplateDetailWidget>(m_store->model(), nullptr, m_model, settings);
    editor->reloadFromModel();
    pickInNextDialog({}, {}, {}, nullptr, &openedAt);
    QTest::mouseClick(editor->findChild<QAbstractButton*>(QStringLiteral("addPropertyLibrary")), Qt::LeftButton);
    QVERIFY(openedAt);
    QCOMPARE(openedAt->path(), std::vector<std::string>{"Shelf"});
}

// The template has "Plant", the checkpoint "Shift"; each row hands the
// dialog's answer slots one fetched object.
void tst_CheckZonePropertiesDialog::fetchedPropertiesMeetWhatIsThere_data()
{
    QTest::addColumn<QString>("fetched");
    QTest::addColumn<QStringList>("definitions");
    QTest::addColumn<QStringList>("values");
    QTest::newRow("a name the template has is skipped") << "property Plant" << QStringList{"Shift"} << QStringList{};
    QTest::newRow("a name the checkpoint has is skipped") << "property Shift" << QStringList{"Shift"} << QStringList{};
    QTest::newRow("a property without default adds no value")
        << "property Line" << QStringList{"Shift", "Line"} << QStringList{};
    QTest::newRow("a name twice in a library is added once")
        << "library Line Line Plant" << QStringList{"Shift", "Line"} << QStringList{"Line=d"};
    QTest::newRow("a standard given to the property slot changes nothing")
        << "wrong property" << QStringList{"Shift"} << QStringList{};
    QTest::newRow("a property given to the library slot changes nothing")
        << "wrong library" << QStringList{"Shift"} << QStringList{};
    QTest::newRow("an answer that is no fetch changes nothing") << "no fetch" << QStringList{"Shift"} << QStringList{};
}

void tst_CheckZonePropertiesDialog::fetchedPropertiesMeetWhatIsThere()
{
    QFETCH(QString, fetched);
    QFETCH(QStringList, definitions);
    QFETCH(QStringList, values);
    m_template->setTagDefinitions({definition("Plant")});
    m_checkPoint->setTagDefinitions({definition("Shift")});
    m_dialog = makeDialog();

    if (fetched.startsWith("property ")) {
        invoke("onPropertyLoaded", answer(definition(fetched.section(' ', 1).toStdString())));
    } else if (fetched.startsWith("library ")) {
        auto library = named<PropertyLibrary>("Library");
        std::vector<std::shared_ptr<TagDefinition>> members;
        for (const QString& name : fetched.section(' ', 1).split(' '))
            members.push_back(definition(name.toStdString(), "d"));
        library->setProperties(members);
        invoke("onPropertyLibraryLoaded", answer(library));
    } else if (fetched == "wrong property") {
        invoke("onPropertyLoaded", answer(named<Standard>("Line")));
    } else if (fetched == "wrong library") {
        invoke("onPropertyLibraryLoaded", answer(definition("Line")));
    } else {
        invoke("onPropertyLoaded", std::make_shared<Response>());
    }

    QCOMPARE(names(m_dialog->tagDefinitions()), definitions);
    QCOMPARE(valueTexts(m_dialog->tagDefinitions(), m_dialog->tagValues()), values);
    QCOMPARE(child<QTableWidget>("tagTable")->rowCount(), definitions.size());
}

// --- Results

void tst_CheckZonePropertiesDialog::checkPointAndTemplateStayUntouched_data()
{
    QTest::addColumn<bool>("accept");
    QTest::newRow("cancelled") << false;
    QTest::newRow("accepted: the caller writes back, not the dialog") << true;
}

void tst_CheckZonePropertiesDialog::checkPointAndTemplateStayUntouched()
{
    QFETCH(bool, accept);
    const auto red = named<Standard>("Red");
    const auto blue = named<Standard>("Blue");
    m_template->setStandards({red, blue});
    m_template->setTagDefinitions({definition("Plant")});
    m_checkPoint->setStandard(red);
    m_checkPoint->setAutoStandard(false);
    m_checkPoint->setTagDefinitions({definition("Shift", "early"), definition("Line")});
    m_checkPoint->setTagValues({TagValue::forDefinition(*m_checkPoint->tagDefinitions()[0], "early")});
    const auto definitionsBefore = m_checkPoint->tagDefinitions();
    const auto valuesBefore = m_checkPoint->tagValues();
    m_dialog = makeDialog();
    m_dialog->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_dialog.get()));

    QTest::keyClicks(child<QLineEdit>("checkPointName"), " front");
    auto* skippable = child<QCheckBox>("skippableCheckBox");
    QTest::mouseClick(skippable, Qt::LeftButton, {}, QPoint(4, skippable->height() / 2)); // on the box
    child<QComboBox>("standardsComboBox")->setCurrentIndex(2);
    invoke("onPropertyLoaded", answer(definition("Colour", "blue")));
    selectRows({0});
    QTest::mouseClick(child<QAbstractButton>("removeTagButton"), Qt::LeftButton);

    ModalAnswer::actOnNextModal([accept](QWidget* modal) {
        auto* dialog = qobject_cast<QDialog*>(modal);
        QVERIFY(dialog);
        if (accept)
            dialog->accept();
        else
            dialog->reject();
    });
    m_dialog->hide(); // exec() makes only a hidden dialog modal
    QCOMPARE(m_dialog->exec(), accept ? int(QDialog::Accepted) : int(QDialog::Rejected));

    QCOMPARE(m_dialog->name(), QStringLiteral("Hood front"));
    QVERIFY(m_dialog->skippable());
    QCOMPARE(m_dialog->standard(), blue);
    QCOMPARE(names(m_dialog->tagDefinitions()), QStringList({"Line", "Colour"}));
    QCOMPARE(valueTexts(m_dialog->tagDefinitions(), m_dialog->tagValues()), QStringList{"Colour=blue"});

    QCOMPARE(m_checkPoint->name(), std::string("Hood"));
    QVERIFY(!m_checkPoint->skippable());
    QCOMPARE(m_checkPoint->standard(), red);
    QVERIFY(!m_checkPoint->autoStandard());
    QCOMPARE(m_checkPoint->tagDefinitions(), definitionsBefore);
    QCOMPARE(m_checkPoint->tagValues(), valuesBefore);
    QCOMPARE(names(m_template->tagDefinitions()), QStringList{"Plant"});
    QCOMPARE(m_template->standards(), (std::vector<std::shared_ptr<Standard>>{red, blue}));
}

QC_TEST_MAIN(tst_CheckZonePropertiesDialog)
#include "tst_checkzonepropertiesdialog.moc"
