#include "detail/QCJobTemplateDetailWidget.h"
#include "detail/ObjectPicker.h"
#include "detail/PropertyList.h"
#include "detail/StandardIcon.h"
#include "ui_QCJobTemplateDetailWidget.h"

#include "checkpoints/CheckZoneEditor.h"
#include "checkpoints/SchematicGraphicsView.h"
#include "detail/GraphicsZoomView.h"
#include "detail/SchematicImageDecoder.h"

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
#include "host/store/CommandDispatcher.h"
#include "host/store/HostMetaTypes.h"
#include "host/store/MarloModel.h"
#include "host/store/Progress.h"
#include "host/store/QtCommand.h"
#include "host/store/UpdateObject.h"
#include "host/widgets/ImageRepository.h"
#include "host/widgets/QGraphicsItemLayer.h"
#include "host/widgets/SelectedPath.h"
#include "measurement/MeasurementConfigurationDialog.h"
#include "model/QCJobTemplateModel.h"
#include "plugin/PellamSettingsKeys.h"

#include <QDir>
#include <QFileDialog>
#include <QFileInfo>
#include <QGraphicsEllipseItem>
#include <QGraphicsPixmapItem>
#include <QGraphicsRectItem>
#include <QGraphicsScene>
#include <QGraphicsSimpleTextItem>
#include <QGuiApplication>
#include <QMessageBox>
#include <QSettings>
#include <QStandardPaths>

#include <algorithm>

namespace vemi {

namespace {

bool isFetchAnswer(const std::shared_ptr<Response>& response)
{
    return std::dynamic_pointer_cast<GetMarloObjectResponse>(response) != nullptr;
}

// A stored schematic of this many bytes or fewer counts as no picture.
constexpr std::size_t StoredSchematicMinimumBytes = 100;

// Overlay circles are coloured by couple ordinal, twelve colours in turn,
// starting with Qt::red for single checkpoints.
Qt::GlobalColor circleColour(int coupleOrdinal)
{
    return Qt::GlobalColor(Qt::red + ((coupleOrdinal % 12) + 12) % 12);
}

// The number stays readable: black on light circles, white on dark ones.
QColor numberColour(Qt::GlobalColor circle)
{
    switch (circle) {
    case Qt::white:
    case Qt::lightGray:
    case Qt::green:
    case Qt::cyan:
    case Qt::magenta:
    case Qt::yellow:
        return QColor(Qt::black);
    default:
        return QColor(Qt::white);
    }
}

QPen overlayPen(const QColor& colour)
{
    return QPen(QBrush(colour), 1.0, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin);
}

// A view of the bytes without copying them; valid while they are.
QByteArray rawBytes(const std::vector<unsigned char>& bytes)
{
    return QByteArray::fromRawData(reinterpret_cast<const char*>(bytes.data()), int(bytes.size()));
}

QStringList chooseExistingFiles(QWidget* parent, const QString& startFolder, const QStringList& nameFilters)
{
    QFileDialog dialog(parent, QString(), QString(), QString());
    dialog.setDirectory(startFolder);
    dialog.setNameFilters(nameFilters);
    dialog.setFileMode(QFileDialog::ExistingFiles);
    return dialog.exec() == QDialog::Accepted ? dialog.selectedFiles() : QStringList();
}

} // namespace

QCJobTemplateDetailWidget::QCJobTemplateDetailWidget(MarloModel& store, QWidget* parent,
                                                     std::shared_ptr<QCJobTemplateModel> model,
                                                     std::shared_ptr<GeneralSettings> generalSettings)
    : QWidget(parent)
    , m_store(store)
    , m_generalSettings(std::move(generalSettings))
    , m_ui(new Ui::QCJobTemplateDetailWidget)
    , m_chooseFiles(chooseExistingFiles)
{
    m_ui->setupUi(this);

    m_scene = std::make_unique<QGraphicsScene>();
    m_overlayLayer = std::make_unique<QGraphicsItemLayer>();
    m_ui->schematicGraphicsView->setScene(m_scene.get());
    m_zoom = new GraphicsZoomView(m_ui->schematicGraphicsView);
    m_zoom->setModifiers(Qt::ControlModifier);

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
    connect(m_ui->checkZoneEditor, &CheckZoneEditor::sgAddCheckpointToSchematic, this,
            &QCJobTemplateDetailWidget::addCheckPointToSchematic);
    connect(m_ui->checkZoneEditor, &CheckZoneEditor::sgRefreshCheckPointLayer, this,
            &QCJobTemplateDetailWidget::refreshCheckPointLayer);
    connect(m_model.get(), &QCJobTemplateModel::sgTemplateSaveFailed, this,
            &QCJobTemplateDetailWidget::showTemplateSaveFailed);
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
    if (m_overlayInScene)
        m_scene->removeItem(m_overlayLayer.get());
    delete m_ui;
}

void QCJobTemplateDetailWidget::reloadFromModel()
{
    const auto jobTemplate = m_model->jobTemplate();
    if (!jobTemplate)
        return;
    showTemplateName(QString::fromStdString(jobTemplate->name()));
    m_ui->enableRepeatCheckBox->setChecked(jobTemplate->enableRepeat());

    showStoredSchematic();

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

// Instrument events need no action in the template editor.
void QCJobTemplateDetailWidget::onInstrumentConnected(std::shared_ptr<vemi::Instrument>) {}
void QCJobTemplateDetailWidget::onInstrumentDisconnected(std::shared_ptr<vemi::Instrument>) {}
void QCJobTemplateDetailWidget::onPreferredInstrumentChanged(std::shared_ptr<vemi::Instrument>) {}

// --- Schematic pane ----------------------------------------------------------

void QCJobTemplateDetailWidget::setFileChooser(FileChooser chooser)
{
    m_chooseFiles = chooser ? std::move(chooser) : FileChooser(chooseExistingFiles);
}

void QCJobTemplateDetailWidget::clearSchematicScene()
{
    refreshCheckPointLayer();
    setSchematicControlsEnabled(false);
    m_scene->clear();
    m_scene->setSceneRect(0, 0, 1, 1);
    m_zoom->resetZoom();
    m_overlayInScene = false;
    m_ui->schematicNameLabel->setText(QString());
    m_ui->schematicNameLabel->setToolTip(QString());
}

void QCJobTemplateDetailWidget::showSchematicImage(QImage image)
{
    setSchematicControlsEnabled(true);
    if (image.isNull())
        return;
    m_scene->setSceneRect(0, 0, image.width(), image.height());
    m_scene->addPixmap(QPixmap::fromImage(std::move(image)));
}

void QCJobTemplateDetailWidget::setSchematicControlsEnabled(bool on)
{
    for (QWidget* button : {m_ui->cropSchematicButton, m_ui->clearSchematicButton, m_ui->resetZoomButton,
                            m_ui->fitToWindowButton, m_ui->zoomInButton, m_ui->zoomOutButton})
        button->setEnabled(on);
    m_ui->schematicGraphicsView->setBandVisible(on);
    m_ui->schematicGraphicsView->resetBand();
}

void QCJobTemplateDetailWidget::showStoredSchematic()
{
    clearSchematicScene();
    const auto schematic = m_model->jobTemplate()->schematicImage();
    if (!schematic)
        return;
    const QString name = QString::fromStdString(schematic->name());
    const auto& data = schematic->imageData();
    if (data.size() > StoredSchematicMinimumBytes) {
        QImage image;
        QSize declared;
        const auto result = SchematicImageDecoder::decode(rawBytes(data), QByteArray::fromStdString(schematic->format()),
                                                          &image, &declared);
        // Shown in the pane rather than in a box: opening a template must not stop.
        if (result == SchematicImageDecoder::Result::TooLarge)
            showSchematicMessage(tr("The schematic picture %1 is not shown: it measures %2 × %3 pixels, more than "
                                    "a schematic may have.")
                                     .arg(name)
                                     .arg(declared.width())
                                     .arg(declared.height()));
        // Controls stay usable whatever was decoded, so a broken picture can be cleared.
        showSchematicImage(std::move(image));
    }
    m_ui->schematicNameLabel->setText(name);
    m_ui->schematicNameLabel->setToolTip(name);
}

// The configuration is stored at once, apart from the template, which the
// user saves from the browser; the template refers to it from now on.
void QCJobTemplateDetailWidget::on_addMeasurementConfigurationButton_clicked()
{
    MeasurementConfigurationDialog dialog(m_store, m_generalSettings, this);
    if (dialog.exec() != QDialog::Accepted)
        return;
    const auto configuration = dialog.measurementConfiguration();
    if (!configuration) {
        m_ui->MeasConfigurationNameLabel->setText(QString());
        m_ui->needMeasureConfigNotice->show();
        m_ui->tabWidget->setCurrentIndex(2);
        return;
    }
    storeMeasurementConfiguration(configuration);
    m_model->setMeasurementConfiguration(configuration);
    m_ui->MeasConfigurationNameLabel->setText(QString::fromStdString(configuration->name()));
    emit sgJobTemplateWasModified(m_model->jobTemplate());
    m_ui->needMeasureConfigNotice->hide();
}

void QCJobTemplateDetailWidget::storeMeasurementConfiguration(const std::shared_ptr<MeasurementConfiguration>& configuration)
{
    auto command = std::make_shared<UpdateObject>();
    command->setObject(configuration);
    // A configuration whose folder entry is gone is filed again at the top
    // level, so that it stays listed; one still filed keeps its folder.
    command->setFolderId(std::string());
    auto wrapper = std::make_shared<QtCommand>(command);
    connect(wrapper.get(), &QtCommand::responseReceived, this, &QCJobTemplateDetailWidget::onSavedMc);
    connect(wrapper.get(), &QtCommand::errorReceived, this, &QCJobTemplateDetailWidget::onSaveError);
    connect(wrapper.get(), &QtCommand::progressReceived, this,
            [this](const std::shared_ptr<Progress>&) { onSaveProgress(nullptr); });
    if (const auto dispatcher = m_store.commandDispatcher(std::string()))
        dispatcher->dispatch(wrapper);
    else
        onSaveError(std::make_shared<ErrorInfo>(tr("there is no default store.")));
}

// The editor does not wait for the store: the template took the
// configuration when the command was sent.
void QCJobTemplateDetailWidget::onSavedMc(std::shared_ptr<vemi::Response>) {}
void QCJobTemplateDetailWidget::onSaveProgress(std::shared_ptr<vemi::Response>) {}

void QCJobTemplateDetailWidget::onSaveError(std::shared_ptr<vemi::ErrorInfo> errorInfo)
{
    QMessageBox box(QMessageBox::Information, QStringLiteral("Not ok"),
                    QStringLiteral("Unable to save: ") + (errorInfo ? errorInfo->message() : QString()));
    box.exec();
}

void QCJobTemplateDetailWidget::showSchematicMessage(const QString& text)
{
    auto* notice = m_scene->addSimpleText(text);
    m_scene->setSceneRect(notice->boundingRect());
}

QString QCJobTemplateDetailWidget::chooseSchematicFile()
{
    QSettings settings;
    QString start = settings.value(PellamKeys::SchematicImagePath).toString();
    if (start.isEmpty())
        start = QStandardPaths::standardLocations(QStandardPaths::DesktopLocation).value(0);
    // The key holds the file chosen last; the dialog opens in its folder.
    const QFileInfo remembered(start);
    const QStringList files =
        m_chooseFiles(this, remembered.isFile() ? remembered.absolutePath() : start,
                      {tr("Image files (*.jpg *.jpeg *.png *.gif)"), tr("All files (*.*)")});
    if (files.isEmpty() || files.first().isEmpty())
        return QString();
    settings.setValue(PellamKeys::SchematicImagePath, files.first());
    return files.first();
}

void QCJobTemplateDetailWidget::on_browseSchematicButton_clicked()
{
    m_schematicPath = chooseSchematicFile();
    if (m_schematicPath.isEmpty())
        return;
    const QFileInfo file(m_schematicPath);
    const QString fileName = file.fileName();
    const auto inform = [this](const QString& text) {
        QMessageBox::information(this, QGuiApplication::applicationDisplayName(), text, QMessageBox::Ok);
    };
    if (file.size() > QCJobTemplateModel::MaximumSchematicFileBytes) {
        inform(tr(" Cannot load %1. Please limit image size to no more than 10 MB.")
                   .arg(QDir::toNativeSeparators(fileName)));
        return;
    }
    std::vector<unsigned char> bytes;
    QImage image;
    QSize declared;
    const bool read = QCJobTemplateModel::readSchematicFile(m_schematicPath, &bytes);
    // The content alone decides the decoder, whatever the file is called.
    const auto result = read ? SchematicImageDecoder::decode(rawBytes(bytes), QByteArray(), &image, &declared)
                             : SchematicImageDecoder::Result::NotAnImage;
    if (result == SchematicImageDecoder::Result::TooLarge) {
        inform(tr("Cannot load %1. The picture measures %2 × %3 pixels; a schematic may have at most %4 pixels "
                  "on a side and %5 million pixels in all.")
                   .arg(QDir::toNativeSeparators(fileName))
                   .arg(declared.width())
                   .arg(declared.height())
                   .arg(SchematicImageDecoder::MaximumSide)
                   .arg(SchematicImageDecoder::MaximumPixels / 1'000'000));
        return;
    }
    if (result != SchematicImageDecoder::Result::Decoded) {
        inform(tr("Cannot load %1.").arg(m_schematicPath));
        m_ui->schematicGraphicsView->setToolTip(tr("Select an image for Job Schematic."));
        return;
    }
    // The bytes just decoded are stored, not the file read once more: the file
    // may have changed in between.
    m_model->storeSchematicImage(fileName, m_schematicPath, std::move(bytes));
    clearSchematicScene();
    showSchematicImage(std::move(image));
    emitModified();
    m_ui->schematicNameLabel->setText(fileName);
    m_ui->schematicNameLabel->setToolTip(fileName);
}

void QCJobTemplateDetailWidget::on_clearSchematicButton_clicked()
{
    const auto answer = QMessageBox::question(this, QStringLiteral("Confirm Delete"),
                                              QStringLiteral("Are you sure you want to clear the schematic image?"),
                                              QMessageBox::Yes | QMessageBox::No, QMessageBox::NoButton);
    if (answer != QMessageBox::Yes)
        return;
    clearSchematicScene();
    m_model->clearSchematicImage();
    emitModified();
}

void QCJobTemplateDetailWidget::showTemplateSaveFailed(const QString& message)
{
    QMessageBox::warning(this, QGuiApplication::applicationDisplayName(),
                         tr("The template could not be saved after its schematic image was cleared: %1").arg(message),
                         QMessageBox::Ok);
}

// Replaces the scene by what the view shows now, without the overlay and the band.
void QCJobTemplateDetailWidget::on_cropSchematicButton_clicked()
{
    m_overlayLayer->setVisible(false);
    m_ui->schematicGraphicsView->setBandVisible(false);
    const QImage shown = m_ui->schematicGraphicsView->grab().toImage();
    const int width = shown.width();
    const int height = shown.height();
    const QImage part = shown.copy(0, 0, width - 10, height - 10);
    clearSchematicScene();
    m_scene->setSceneRect(0, 0, width, height);
    m_overlayLayer->setVisible(true);
    m_scene->addPixmap(QPixmap::fromImage(part));
    setSchematicControlsEnabled(true);
    emitModified();
}

void QCJobTemplateDetailWidget::on_fitToWindowButton_clicked()
{
    m_ui->schematicGraphicsView->fitInView(m_scene->itemsBoundingRect(), Qt::KeepAspectRatio);
}

void QCJobTemplateDetailWidget::on_resetZoomButton_clicked()
{
    m_zoom->resetZoom();
}

void QCJobTemplateDetailWidget::on_zoomInButton_clicked()
{
    m_zoom->setTargetToViewBottomCentre();
    m_zoom->gentleZoom(1.2);
}

void QCJobTemplateDetailWidget::on_zoomOutButton_clicked()
{
    m_zoom->setTargetToViewBottomCentre();
    m_zoom->gentleZoom(0.8);
}

// The area is cut from the band's own rectangle, exactly what the user sees;
// its position is stored in scene coordinates, its size in view pixels.
void QCJobTemplateDetailWidget::onGrabRubberBandedImageArea(int cpIndex)
{
    SchematicGraphicsView* view = m_ui->schematicGraphicsView;
    const QRect band(view->bandTopLeft(), view->bandSize());
    // A press without a drag leaves an empty band: there is no area to take.
    if (band.isEmpty() || cpIndex < 0 || cpIndex >= m_model->checkPointCount())
        return;
    view->setBandVisible(false);
    m_overlayLayer->setVisible(false);
    const QPixmap shown = view->grab();
    const qreal ratio = shown.devicePixelRatio();
    const QPixmap area = shown.copy(QRectF(QPointF(band.topLeft()) * ratio, QSizeF(band.size()) * ratio).toRect());
    const QPointF origin = m_zoom->mapToScene(band.topLeft());
    const QRect rect(int(origin.x()), int(origin.y()), band.width(), band.height());
    m_model->setCheckPointImage(cpIndex, area, rect);
    m_ui->checkZoneEditor->setCurrentThumbnail(cpIndex, area);
    view->setBandVisible(true);
    view->resetBand();
    refreshCheckPointLayer();
    m_overlayLayer->setVisible(true);
    m_ui->checkZoneEditor->publishCheckPoints();
}

void QCJobTemplateDetailWidget::addCheckPointToSchematic(int cpIndex, int coupletId, QRect rect)
{
    // A checkpoint whose area was never taken has size 0 × 0; a circle in the
    // picture's corner would point the operator at the wrong place.
    if (rect.isEmpty())
        return;
    const Qt::GlobalColor circle = circleColour(coupletId);
    const QColor number = numberColour(circle);
    QGraphicsItem* layer = m_overlayLayer.get();

    auto* area = new QGraphicsRectItem(rect, layer);
    area->setBrush(QColor(30, 100, 150, 100));
    area->setPen(overlayPen(QColor(50, 50, 50, 200)));

    auto* disc = new QGraphicsEllipseItem(rect.x() - 9, rect.y() - 9, 20, 20, layer);
    disc->setBrush(QColor(circle));
    disc->setPen(overlayPen(number));

    auto* label = new QGraphicsSimpleTextItem(QString::number(cpIndex + 1), layer);
    label->setPos(rect.x() - 2, rect.y() - 6);
    label->setBrush(number);
    label->setPen(QPen(number));

    // Items made under a layer that is already in the scene join it at once;
    // taking the layer out and in for each checkpoint would cost the square.
    if (!m_overlayInScene) {
        m_scene->addItem(layer);
        m_overlayInScene = true;
    }
}

void QCJobTemplateDetailWidget::refreshCheckPointLayer()
{
    if (!m_overlayInScene)
        return;
    m_scene->removeItem(m_overlayLayer.get());
    m_overlayLayer = std::make_unique<QGraphicsItemLayer>();
    m_overlayInScene = false;
}

} // namespace vemi
