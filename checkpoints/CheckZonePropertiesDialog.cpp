#include "checkpoints/CheckZonePropertiesDialog.h"
#include "ui_CheckZonePropertiesDialog.h"

#include "detail/ObjectPicker.h"
#include "detail/PropertyList.h"
#include "detail/StandardIcon.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/store/ErrorInfo.h"
#include "host/store/HostMetaTypes.h"
#include "host/widgets/ImageRepository.h"
#include "host/widgets/SelectedPath.h"
#include "model/QCJobTemplateModel.h"
#include "plugin/PellamSettingsKeys.h"

#include <QEvent>

#include <algorithm>

using vemi::ObjectPicker;
using vemi::PropertyList;

CheckZonePropertiesDialog::CheckZonePropertiesDialog(std::shared_ptr<vemi::CheckPoint> checkPoint,
                                                     std::shared_ptr<QCJobTemplateModel> model, QWidget* parent)
    : QDialog(parent)
    , m_ui(new Ui::CheckZonePropertiesDialog)
    , m_model(std::move(model))
    , m_checkPoint(std::move(checkPoint))
{
    m_ui->setupUi(this);
    m_formTitle = windowTitle();

    if (m_checkPoint)
        m_selectedStandard = m_checkPoint->standard();
    m_properties = std::make_unique<PropertyList>(m_checkPoint ? m_checkPoint->tagDefinitions() : PropertyList::Definitions(),
                                                  m_checkPoint ? m_checkPoint->tagValues() : PropertyList::Values());
    const QString name = m_checkPoint ? QString::fromStdString(m_checkPoint->name()) : QString();
    m_ui->checkPointName->setText(name);
    m_ui->skippableCheckBox->setChecked(m_checkPoint && m_checkPoint->skippable());

    connect(m_ui->tagDisplayWidget, SIGNAL(tagRowsSelected(int, QStringList)), this,
            SLOT(tagRowsSelected(int, QStringList)));
    connect(m_ui->tagDisplayWidget, SIGNAL(tagRowDoubleClicked(int, std::string)), this,
            SLOT(tagEditSelected(int, std::string)));

    fillStandardsList();
    showProperties();

    // A name that is still a placeholder is meant to be typed over.
    if (name.isEmpty() || name.startsWith(QLatin1String("..."))) {
        m_ui->checkPointName->setFocus(Qt::OtherFocusReason);
        m_ui->checkPointName->selectAll();
    }
    m_ui->removeTagButton->setEnabled(false);
}

CheckZonePropertiesDialog::~CheckZonePropertiesDialog()
{
    delete m_ui;
}

void CheckZonePropertiesDialog::setMarloModel(vemi::MarloModel* store)
{
    m_store = store;
}

QString CheckZonePropertiesDialog::name() const
{
    return m_ui->checkPointName->text();
}

bool CheckZonePropertiesDialog::skippable() const
{
    return m_ui->skippableCheckBox->isChecked();
}

std::shared_ptr<vemi::Standard> CheckZonePropertiesDialog::standard() const
{
    return m_selectedStandard;
}

std::vector<std::shared_ptr<vemi::TagDefinition>> CheckZonePropertiesDialog::tagDefinitions() const
{
    return m_properties->definitions();
}

std::vector<std::shared_ptr<vemi::TagValue>> CheckZonePropertiesDialog::tagValues() const
{
    return m_properties->values();
}

void CheckZonePropertiesDialog::changeEvent(QEvent* event)
{
    if (event->type() == QEvent::LanguageChange) {
        // The caller names the dialog after its checkpoint; keep that name.
        const QString title = windowTitle();
        const bool callerTitle = title != m_formTitle;
        m_ui->retranslateUi(this);
        m_formTitle = windowTitle();
        if (callerTitle)
            setWindowTitle(title);
        if (m_ui->standardsComboBox->count() > 0)
            m_ui->standardsComboBox->setItemText(0, tr("Auto Select"));
    }
    QDialog::changeEvent(event);
}

// --- Standards

// Item 0 is "Auto Select"; the others are the template's standards in its
// order. A template without standards leaves the list empty and the
// checkpoint's standard as it is.
void CheckZonePropertiesDialog::fillStandardsList()
{
    QComboBox* list = m_ui->standardsComboBox;
    list->clear();
    const auto standards = m_model && m_model->jobTemplate() ? m_model->standards()
                                                             : std::vector<std::shared_ptr<vemi::Standard>>();
    if (standards.empty())
        return;
    const QIcon base = vemi::ImageRepository::instance().iconForType(vemi::Standard::typeId(), 0);
    // The first item becomes current and so empties the selected standard.
    list->addItem(base, tr("Auto Select"));
    for (const auto& standard : standards) {
        if (!standard)
            continue;
        list->addItem(vemi::StandardIcon::of(base, *standard), QString::fromStdString(standard->name()),
                      QVariant::fromValue(std::shared_ptr<vemi::BaseObject>(standard)));
    }
    selectCheckPointStandard();
}

// A fixed standard is found by name, the first of equal names; one that the
// template no longer has leaves "Auto Select".
void CheckZonePropertiesDialog::selectCheckPointStandard()
{
    const auto standard = m_checkPoint ? m_checkPoint->standard() : nullptr;
    int row = 0;
    if (standard && !m_checkPoint->autoStandard())
        row = std::max(0, m_ui->standardsComboBox->findText(QString::fromStdString(standard->name()),
                                                            Qt::MatchExactly | Qt::MatchCaseSensitive));
    m_ui->standardsComboBox->setCurrentIndex(row);
    on_standardsComboBox_currentIndexChanged(row);
}

void CheckZonePropertiesDialog::on_standardsComboBox_currentIndexChanged(int index)
{
    if (index == 0) {
        m_selectedStandard.reset();
        return;
    }
    const auto object = m_ui->standardsComboBox->itemData(index).value<std::shared_ptr<vemi::BaseObject>>();
    m_selectedStandard = std::dynamic_pointer_cast<vemi::Standard>(object);
}

// --- Properties

void CheckZonePropertiesDialog::showProperties()
{
    m_ui->tagDisplayWidget->setTags(m_properties->values(), m_properties->definitions());
}

std::vector<std::shared_ptr<vemi::TagDefinition>> CheckZonePropertiesDialog::templateDefinitions() const
{
    if (!m_model || !m_model->jobTemplate())
        return {};
    return m_model->tagDefinitions();
}

void CheckZonePropertiesDialog::tagRowsSelected(int index, QStringList)
{
    m_ui->removeTagButton->setEnabled(index >= 0);
}

void CheckZonePropertiesDialog::tagEditSelected(int index, std::string)
{
    m_ui->removeTagButton->setEnabled(false);
    if (m_store && m_properties->editRow(index, *m_store, this))
        showProperties();
    m_ui->tagDisplayWidget->clearSelections();
}

void CheckZonePropertiesDialog::on_removeTagButton_clicked()
{
    if (m_properties->removeRows(m_ui->tagDisplayWidget->getSelectedRows()))
        showProperties();
    m_ui->removeTagButton->setEnabled(false);
    m_ui->tagDisplayWidget->clearSelections();
}

void CheckZonePropertiesDialog::on_AddTagsButton_clicked()
{
    runPropertyPicker(QT_TR_NOOP("Select properties to insert"), vemi::TagDefinition::typeId(), false, 0,
                      &CheckZonePropertiesDialog::onPropertyLoaded);
}

void CheckZonePropertiesDialog::on_AddPropertyLibrary_clicked()
{
    runPropertyPicker(QT_TR_NOOP("Add properties in selected library"), vemi::PropertyLibrary::typeId(), true, 2,
                      &CheckZonePropertiesDialog::onPropertyLibraryLoaded);
}

// The place is the template editor's property place: read from the settings
// at every opening, so that both start where the user last browsed.
void CheckZonePropertiesDialog::runPropertyPicker(const char* title, const std::string& typeId, bool firstEntryOnly,
                                                  int depth, ResponseSlot onResponse)
{
    if (!m_store)
        return;
    ObjectPicker::Request request;
    request.title = tr(title);
    request.typeId = typeId;
    request.firstEntryOnly = firstEntryOnly;
    request.depth = depth;
    m_propertyPath = ObjectPicker::loadPosition(vemi::PellamKeys::PropertyPathGroup);
    ObjectPicker::run(
        *m_store, this, request, m_propertyPath,
        [this] { ObjectPicker::savePosition(vemi::PellamKeys::PropertyPathGroup, m_propertyPath); }, this,
        [this, onResponse](const std::shared_ptr<vemi::Response>& answer) { (this->*onResponse)(answer); });
}

// Names already used on the template or on this checkpoint are skipped.
void CheckZonePropertiesDialog::onPropertyLoaded(std::shared_ptr<vemi::Response> response)
{
    if (m_properties->add(ObjectPicker::answerObject<vemi::TagDefinition>(response), templateDefinitions()))
        showProperties();
}

void CheckZonePropertiesDialog::onPropertyLibraryLoaded(std::shared_ptr<vemi::Response> response)
{
    const auto library = ObjectPicker::answerObject<vemi::PropertyLibrary>(response);
    if (!library)
        return;
    const auto taken = templateDefinitions();
    for (const auto& property : library->properties())
        m_properties->add(property, taken);
    showProperties();
}

// Not connected: the dialog stores nothing itself. A store error is logged,
// never shown in a box that would block the user.
void CheckZonePropertiesDialog::onSavedMc(std::shared_ptr<vemi::Response>) {}
void CheckZonePropertiesDialog::onSaveProgress(std::shared_ptr<vemi::Response>) {}

void CheckZonePropertiesDialog::onSaveError(std::shared_ptr<vemi::ErrorInfo> errorInfo)
{
    qWarning("%s", qPrintable(tr("Unable to save: ") + (errorInfo ? errorInfo->message() : QString())));
}
