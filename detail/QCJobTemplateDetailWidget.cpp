#include "detail/QCJobTemplateDetailWidget.h"
#include "detail/ObjectPicker.h"
#include "detail/PropertyList.h"
#include "detail/StandardIcon.h"
#include "ui_QCJobTemplateDetailWidget.h"

#include "checkpoints/CheckZoneEditor.h"

#include "host/client/GeneralSettings.h"
#include "host/client/ToleranceFactory.h"
#include "host/domain/AppearanceValues.h"
#include "host/domain/ColorStandardsLibrary.h"
#include "host/domain/ColorimetricCondition.h"
#include "host/domain/LabToleranceBase.h"
#include "host/domain/LabValue.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/RGBValue.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/domain/ToleranceSet.h"
#include "host/instruments/InstrumentManager.h"
#include "host/store/ErrorInfo.h"
#include "host/store/GetMarloObjectResponse.h"
#include "host/store/HostMetaTypes.h"
#include "host/widgets/ImageRepository.h"
#include "host/widgets/SelectedPath.h"
#include "model/QCJobTemplateModel.h"
#include "plugin/PellamSettingsKeys.h"

#include <QGraphicsPixmapItem>
#include <QGraphicsScene>
#include <QMessageBox>
#include <QSettings>

#include <algorithm>

namespace vemi {

namespace {

bool isFetchAnswer(const std::shared_ptr<Response>& response)
{
    return std::dynamic_pointer_cast<GetMarloObjectResponse>(response) != nullptr;
}

} // namespace

QCJobTemplateDetailWidget::QCJobTemplateDetailWidget(MarloModel& store, QWidget* parent,
                                                     std::shared_ptr<QCJobTemplateModel> model,
                                                     std::shared_ptr<GeneralSettings> generalSettings)
    : QWidget(parent)
    , m_store(store)
    , m_generalSettings(std::move(generalSettings))
    , m_ui(new Ui::QCJobTemplateDetailWidget)
{
    m_ui->setupUi(this);

    m_scene = std::make_unique<QGraphicsScene>();
    m_ui->schematicGraphicsView->setScene(m_scene.get());

    m_model = std::move(model);

    m_ui->schematicGraphicsView->setToolTip(tr("Select an image for Job Schematic."));
    m_ui->schematicToolbar->setAttribute(Qt::WA_NoSystemBackground);
    m_ui->schematicToolbar->setAttribute(Qt::WA_TranslucentBackground);

    InstrumentManager* instruments = InstrumentManager::instance();
    connect(instruments, SIGNAL(sgInstrumentConnected(std::shared_ptr<vemi::Instrument>)), this,
            SLOT(onInstrumentConnected(std::shared_ptr<vemi::Instrument>)));
    connect(instruments, SIGNAL(sgInstrumentDisconnected(std::shared_ptr<vemi::Instrument>)), this,
            SLOT(onInstrumentDisconnected(std::shared_ptr<vemi::Instrument>)));
    connect(instruments, SIGNAL(sgPreferredInstrumentChanged(std::shared_ptr<vemi::Instrument>)), this,
            SLOT(onPreferredInstrumentChanged(std::shared_ptr<vemi::Instrument>)));
    connect(m_model.get(), &QCJobTemplateModel::sgSetTemplateSavable, this,
            &QCJobTemplateDetailWidget::onTemplateSavable);
    connect(m_ui->checkZoneEditor, &CheckZoneEditor::sgSetTemplateSavable, this,
            &QCJobTemplateDetailWidget::onTemplateSavable);
    connect(m_ui->checkZoneEditor, &CheckZoneEditor::sgGrabRubberBandedArea, this,
            &QCJobTemplateDetailWidget::onGrabRubberBandedImageArea);
    connect(m_ui->tagDisplayWidget, SIGNAL(tagRowsSelected(int, QStringList)), this,
            SLOT(tagRowsSelected(int, QStringList)));
    connect(m_ui->tagDisplayWidget, SIGNAL(tagRowDoubleClicked(int, std::string)), this,
            SLOT(tagEditSelected(int, std::string)));

    m_ui->checkZoneEditor->init(m_store, m_model);

    m_tolerancePath = ObjectPicker::loadPosition(PellamKeys::TolerancePathGroup);
    m_libraryPath = ObjectPicker::loadPosition(PellamKeys::LibraryPathGroup);
    m_standardPath = ObjectPicker::loadPosition(PellamKeys::StandardPathGroup);
    m_propertyPath = ObjectPicker::loadPosition(PellamKeys::PropertyPathGroup);

    for (QWidget* button : {m_ui->cropSchematicButton, m_ui->resetZoomButton, m_ui->fitToWindowButton,
                            m_ui->zoomInButton, m_ui->zoomOutButton})
        button->hide();
    m_ui->needMeasureConfigNotice->hide();

    QSettings settings;
    m_ui->horizontalSplitter->restoreState(settings.value(PellamKeys::HorizontalSplitterState).toByteArray());
    m_ui->qcJobTemplateSplitter->restoreState(settings.value(PellamKeys::QcJobTemplateSplitterState).toByteArray());
}

QCJobTemplateDetailWidget::~QCJobTemplateDetailWidget()
{
    QSettings settings;
    settings.setValue(PellamKeys::HorizontalSplitterState, m_ui->horizontalSplitter->saveState());
    settings.setValue(PellamKeys::QcJobTemplateSplitterState, m_ui->qcJobTemplateSplitter->saveState());
    // The view dies with the form, after the scene; it must not draw a deleted scene.
    m_ui->schematicGraphicsView->setScene(nullptr);
    delete m_ui;
}

void QCJobTemplateDetailWidget::reloadFromModel()
{
    const auto jobTemplate = m_model->jobTemplate();
    if (!jobTemplate)
        return;
    showTemplateName(QString::fromStdString(jobTemplate->name()));
    m_ui->enableRepeatCheckBox->setChecked(jobTemplate->enableRepeat());

    clearSchematicScene();
    const auto schematic = jobTemplate->schematicImage();
    if (schematic && schematic->imageData().size() > 100) {
        const auto& bytes = schematic->imageData();
        QImage image;
        image.loadFromData(bytes.data(), int(bytes.size()), schematic->format().c_str());
        showSchematicImage(image);
        setSchematicControlsEnabled(true);
    }
    const QString schematicName = schematic ? QString::fromStdString(schematic->name()) : QString();
    m_ui->schematicNameLabel->setText(schematicName);
    m_ui->schematicNameLabel->setToolTip(schematicName);

    m_ui->descriptionEdit->setText(QString::fromStdString(jobTemplate->description()));
    // The beginning of a long description shows, not its end.
    m_ui->descriptionEdit->setCursorPosition(0);

    m_ui->needMeasureConfigNotice->hide();
    if (const auto configuration = jobTemplate->measurementConfiguration()) {
        m_ui->MeasConfigurationNameLabel->setText(QString::fromStdString(configuration->name()));
    } else {
        m_ui->MeasConfigurationNameLabel->setText(QString());
        m_ui->needMeasureConfigNotice->show();
        m_ui->tabWidget->setCurrentIndex(2);
    }

    m_ui->tagDisplayWidget->setTags(jobTemplate->tagValues(), jobTemplate->tagDefinitions());

    for (QWidget* control : {static_cast<QWidget*>(m_ui->browseSchematicButton), static_cast<QWidget*>(m_ui->addProperty),
                             static_cast<QWidget*>(m_ui->addPropertyLibrary), static_cast<QWidget*>(m_ui->libraryLoadButton),
                             static_cast<QWidget*>(m_ui->addStandardButton), static_cast<QWidget*>(m_ui->descriptionEdit),
                             static_cast<QWidget*>(m_ui->clearAllStandards),
                             static_cast<QWidget*>(m_ui->addMeasurementConfigurationButton)})
        control->setEnabled(true);

    fillStandardsList();
    fillToleranceList();
}

// The group box title carries the template's name; a long name is cut at the
// pane's edge instead of widening the window, so the tool tip shows it whole.
void QCJobTemplateDetailWidget::showTemplateName(const QString& name)
{
    m_ui->checkZoneGroupBox->setTitle(tr("Checkpoints for: ") + name);
    m_ui->checkZoneGroupBox->setToolTip(name);
}

void QCJobTemplateDetailWidget::refreshTemplateName()
{
    if (const auto jobTemplate = m_model->jobTemplate())
        showTemplateName(QString::fromStdString(jobTemplate->name()));
}

void QCJobTemplateDetailWidget::onTemplateSavable()
{
    emitModified();
}

void QCJobTemplateDetailWidget::emitModified()
{
    emit sgJobTemplateWasModified(m_model->jobTemplate());
}

// --- Description and repeat flag

void QCJobTemplateDetailWidget::on_descriptionEdit_textEdited(QString)
{
    emitModified();
    m_model->setDescription(m_ui->descriptionEdit->text().toStdString());
}

void QCJobTemplateDetailWidget::on_enableRepeatCheckBox_clicked()
{
    m_model->setEnableRepeat(m_ui->enableRepeatCheckBox->isChecked());
    emitModified();
}

// --- Standards, tolerances and properties

void QCJobTemplateDetailWidget::fillStandardsList()
{
    const auto standards = m_model->standards();
    m_ui->standardsListWidget->clear();
    if (standards.empty())
        return;
    const QIcon base = ImageRepository::instance().iconForType(Standard::typeId(), 1);
    for (const auto& standard : standards) {
        if (!standard)
            continue;
        auto* item = new QListWidgetItem(StandardIcon::of(base, *standard), QString::fromStdString(standard->name()));
        item->setData(Qt::UserRole, QVariant::fromValue(std::shared_ptr<BaseObject>(standard)));
        m_ui->standardsListWidget->addItem(item);
    }
}

void QCJobTemplateDetailWidget::fillToleranceList()
{
    const auto sets = m_model->sharedToleranceSets();
    m_ui->defaultToleranceList->clear();
    if (sets.empty()) {
        m_ui->removeToleranceButton->hide();
    } else {
        const QIcon icon = ImageRepository::instance().iconForType(Tolerance::typeId(), 0);
        for (const auto& set : sets) {
            auto* item = new QListWidgetItem(icon, set ? QString::fromStdString(set->name()) : QString());
            item->setData(Qt::UserRole, QVariant::fromValue(std::shared_ptr<BaseObject>(set)));
            m_ui->defaultToleranceList->addItem(item);
        }
        m_ui->removeToleranceButton->show();
    }
    // A template takes a second default set through this button, not a third.
    m_ui->insertToleranceButton->setVisible(sets.size() < 2);
}

void QCJobTemplateDetailWidget::on_clearAllStandards_clicked()
{
    m_model->removeAllStandards();
    fillStandardsList();
    emitModified();
}

void QCJobTemplateDetailWidget::on_removeToleranceButton_clicked()
{
    m_model->removeAllToleranceSets();
    fillToleranceList();
    emitModified();
}

void QCJobTemplateDetailWidget::tagRowsSelected(int index, QStringList)
{
    m_ui->removeTag->setEnabled(index >= 0);
}

void QCJobTemplateDetailWidget::on_removeTag_clicked()
{
    PropertyList properties(m_model->tagDefinitions(), m_model->tagValues());
    if (properties.removeRows(m_ui->tagDisplayWidget->getSelectedRows()))
        storeProperties(properties);
    m_ui->removeTag->setEnabled(false);
    m_ui->tagDisplayWidget->clearSelections();
}

void QCJobTemplateDetailWidget::tagEditSelected(int index, std::string)
{
    m_ui->removeTag->setEnabled(false);
    PropertyList properties(m_model->tagDefinitions(), m_model->tagValues());
    if (properties.editRow(index, m_store, this))
        storeProperties(properties);
    m_ui->tagDisplayWidget->clearSelections();
}

void QCJobTemplateDetailWidget::storeProperties(const PropertyList& properties)
{
    m_model->setTagDefinitions(properties.definitions());
    m_model->setTagValues(properties.values());
    m_ui->tagDisplayWidget->setTags(properties.values(), properties.definitions());
    emitModified();
}

bool QCJobTemplateDetailWidget::findConditionMismatch(const std::shared_ptr<ToleranceSet>& set,
                                                      QString* standardName, QString* standardCondition,
                                                      QString* toleranceCondition) const
{
    const auto jobTemplate = m_model->jobTemplate();
    if (set->tolerances().empty() || !jobTemplate)
        return false;
    const auto built = ToleranceFactory::toleranceFactory()->buildToleranceSet(set);
    const auto builtTolerances = built ? built->tolerances() : std::vector<std::shared_ptr<Tolerance>>();
    const auto lab = builtTolerances.empty() ? nullptr
                                             : std::dynamic_pointer_cast<LabToleranceBase>(builtTolerances.front());
    const auto condition = lab ? lab->colorimetricCondition() : nullptr;
    if (!condition)
        return false;
    const std::string wanted = condition->toString();
    for (const auto& standard : jobTemplate->standards()) {
        const auto appearance = standard ? standard->appearanceValues(0) : nullptr;
        const auto colours = appearance ? appearance->colorValues() : std::vector<std::shared_ptr<ColorValue>>();
        const auto labValue = colours.empty() ? nullptr : std::dynamic_pointer_cast<LabValue>(colours.front());
        if (!labValue || labValue->colorimetricCondition() == wanted)
            continue;
        *standardName = QString::fromStdString(standard->name());
        *standardCondition = QString::fromStdString(labValue->colorimetricCondition());
        *toleranceCondition = QString::fromStdString(wanted);
        return true;
    }
    return false;
}

void QCJobTemplateDetailWidget::onNewToleranceLoaded(std::shared_ptr<Response> response)
{
    if (!isFetchAnswer(response))
        return;
    const auto set = ObjectPicker::answerObject<ToleranceSet>(response);
    if (!set) {
        fillToleranceList();
        return;
    }
    QString standardName, standardCondition, toleranceCondition;
    if (findConditionMismatch(set, &standardName, &standardCondition, &toleranceCondition)) {
        QMessageBox::information(this, tr("Colorimetric Condition mismatch"),
                                 tr("Your standard \"%1\" uses %2, while the tolerance you want to add uses %3")
                                     .arg(standardName, standardCondition, toleranceCondition),
                                 QMessageBox::Ok);
        return;
    }
    auto sets = m_model->sharedToleranceSets();
    sets.push_back(set);
    m_model->setSharedToleranceSets(sets);
    emitModified();
    fillToleranceList();
}

// --- Pickers

void QCJobTemplateDetailWidget::on_addStandardButton_clicked()
{
    runPicker({QT_TR_NOOP("Add selected standard(s)"), Standard::typeId(), &m_standardPath, false, 2,
               &QCJobTemplateDetailWidget::onNewStandardLoaded});
}

void QCJobTemplateDetailWidget::on_libraryLoadButton_clicked()
{
    runPicker({QT_TR_NOOP("Add standards in selected library"), ColorStandardsLibrary::typeId(), &m_propertyPath,
               true, 2, &QCJobTemplateDetailWidget::onColorLibraryLoaded});
}

void QCJobTemplateDetailWidget::on_addProperty_clicked()
{
    runPicker({QT_TR_NOOP("Select properties to insert"), TagDefinition::typeId(), &m_propertyPath, false, 0,
               &QCJobTemplateDetailWidget::onPropertyLoaded});
}

void QCJobTemplateDetailWidget::on_addPropertyLibrary_clicked()
{
    runPicker({QT_TR_NOOP("Add properties in selected library"), PropertyLibrary::typeId(), &m_propertyPath, true,
               2, &QCJobTemplateDetailWidget::onPropertyLibraryLoaded});
}

void QCJobTemplateDetailWidget::on_insertToleranceButton_clicked()
{
    runPicker({QT_TR_NOOP("Select a default tolerance"), ToleranceSet::typeId(), &m_tolerancePath, true, 0,
               &QCJobTemplateDetailWidget::onNewToleranceLoaded});
}

void QCJobTemplateDetailWidget::runPicker(const Picker& picker)
{
    ObjectPicker::Request request;
    request.title = tr(picker.title);
    request.typeId = picker.typeId;
    request.firstEntryOnly = picker.firstEntryOnly;
    request.depth = picker.depth;
    if (m_generalSettings)
        request.dispatchers = m_generalSettings->dispatcherList();
    const ResponseSlot onResponse = picker.onResponse;
    ObjectPicker::run(
        m_store, this, request, *picker.position, [this] { saveSelectedPaths(); }, this,
        [this, onResponse](const std::shared_ptr<Response>& answer) { (this->*onResponse)(answer); });
}

void QCJobTemplateDetailWidget::saveSelectedPaths() const
{
    ObjectPicker::savePosition(PellamKeys::LibraryPathGroup, m_libraryPath);
    ObjectPicker::savePosition(PellamKeys::StandardPathGroup, m_standardPath);
    ObjectPicker::savePosition(PellamKeys::TolerancePathGroup, m_tolerancePath);
    ObjectPicker::savePosition(PellamKeys::PropertyPathGroup, m_propertyPath);
}

void QCJobTemplateDetailWidget::onNewStandardLoaded(std::shared_ptr<Response> response)
{
    if (!isFetchAnswer(response))
        return;
    if (const auto standard = ObjectPicker::answerObject<Standard>(response)) {
        const auto standards = m_model->standards();
        const bool known = std::any_of(standards.begin(), standards.end(), [&standard](const auto& s) {
            return s && s->name() == standard->name();
        });
        if (!known)
            m_model->addStandard(standard);
        emitModified();
    }
    fillStandardsList();
}

void QCJobTemplateDetailWidget::onColorLibraryLoaded(std::shared_ptr<Response> response)
{
    if (!isFetchAnswer(response))
        return;
    if (const auto library = ObjectPicker::answerObject<ColorStandardsLibrary>(response)) {
        m_model->setStandardsFromLibrary(library);
        emitModified();
    }
    fillStandardsList();
}

void QCJobTemplateDetailWidget::onPropertyLoaded(std::shared_ptr<Response> response)
{
    PropertyList properties(m_model->tagDefinitions(), m_model->tagValues());
    if (properties.add(ObjectPicker::answerObject<TagDefinition>(response)))
        storeProperties(properties);
}

void QCJobTemplateDetailWidget::onPropertyLibraryLoaded(std::shared_ptr<Response> response)
{
    const auto library = ObjectPicker::answerObject<PropertyLibrary>(response);
    if (!library)
        return;
    PropertyList properties(m_model->tagDefinitions(), m_model->tagValues());
    for (const auto& property : library->properties())
        properties.add(property);
    m_model->setTagDefinitions(properties.definitions());
    m_model->setTagValues(properties.values());
    m_ui->tagDisplayWidget->setTags(properties.values(), properties.definitions());
    emitModified();
}

// --- Schematic pane and measurement configuration: their behaviour is not
// part of this editor yet; the controls exist so the form is complete.

void QCJobTemplateDetailWidget::clearSchematicScene()
{
    m_scene->clear();
    setSchematicControlsEnabled(false);
}

void QCJobTemplateDetailWidget::showSchematicImage(const QImage& image)
{
    if (image.isNull())
        return;
    m_scene->addPixmap(QPixmap::fromImage(image));
    m_scene->setSceneRect(m_scene->itemsBoundingRect());
}

void QCJobTemplateDetailWidget::setSchematicControlsEnabled(bool on)
{
    for (QWidget* button : {m_ui->cropSchematicButton, m_ui->clearSchematicButton, m_ui->resetZoomButton,
                            m_ui->fitToWindowButton, m_ui->zoomInButton, m_ui->zoomOutButton})
        button->setEnabled(on);
}

void QCJobTemplateDetailWidget::on_browseSchematicButton_clicked() {}
void QCJobTemplateDetailWidget::on_cropSchematicButton_clicked() {}
void QCJobTemplateDetailWidget::on_fitToWindowButton_clicked() {}
void QCJobTemplateDetailWidget::on_resetZoomButton_clicked() {}
void QCJobTemplateDetailWidget::on_clearSchematicButton_clicked() {}
void QCJobTemplateDetailWidget::onSavedMc(std::shared_ptr<vemi::Response>) {}
void QCJobTemplateDetailWidget::onSaveError(std::shared_ptr<vemi::ErrorInfo>) {}
void QCJobTemplateDetailWidget::onSaveProgress(std::shared_ptr<vemi::Response>) {}
void QCJobTemplateDetailWidget::onGrabRubberBandedImageArea(int) {}
void QCJobTemplateDetailWidget::on_addMeasurementConfigurationButton_clicked() {}
void QCJobTemplateDetailWidget::on_zoomInButton_clicked() {}
void QCJobTemplateDetailWidget::on_zoomOutButton_clicked() {}

// Instrument events need no action in the template editor.
void QCJobTemplateDetailWidget::onInstrumentConnected(std::shared_ptr<vemi::Instrument>) {}
void QCJobTemplateDetailWidget::onInstrumentDisconnected(std::shared_ptr<vemi::Instrument>) {}
void QCJobTemplateDetailWidget::onPreferredInstrumentChanged(std::shared_ptr<vemi::Instrument>) {}

} // namespace vemi
