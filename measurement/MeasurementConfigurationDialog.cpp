#include "measurement/MeasurementConfigurationDialog.h"
#include "ui_MeasurementConfigurationDialog.h"

#include "host/domain/DirEntry.h"
#include "host/domain/Header.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/store/CommandSender.h"
#include "host/store/GetMarloObjects.h"
#include "host/store/GetMarloObjectsResponse.h"
#include "host/store/MarloModel.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "host/widgets/FolderBrowserWidget.h"
#include "measurement/MeasurementConfigurationWidget.h"
#include "plugin/PellamSettingsKeys.h"

#include <QEvent>
#include <QMessageBox>
#include <QPushButton>
#include <QSettings>
#include <QSplitter>
#include <QVBoxLayout>

namespace vemi {

using Node = BaseObjectTreeModel::Node;

MeasurementConfigurationDialog::MeasurementConfigurationDialog(MarloModel& store,
                                                               std::shared_ptr<GeneralSettings> settings,
                                                               QWidget* parent)
    : QDialog(parent), m_ui(new Ui::MeasurementConfigurationDialog), m_browser(new FolderBrowserWidget(this)),
      m_configurationWidget(new MeasurementConfigurationWidget(std::move(settings), this)), m_store(store)
{
    m_ui->setupUi(this);
    auto* treeModel = new DirEntryTreeModel(m_store, this);
    m_browser->initialize(treeModel, true, this, "Pellam");
    m_browser->setToolTips(tr("Create New Measurement Configuration"), tr("Duplicate Measurement Configuration"),
                           tr("Delete Measurement Configuration"));
    connect(m_browser, &FolderBrowserWidget::sgSelectionChanged, this,
            &MeasurementConfigurationDialog::onSelectionChanged);
    connect(treeModel, &DirEntryTreeModel::sgErrorOccurred, this, &MeasurementConfigurationDialog::onErrorOccurred);
    connect(treeModel, &DirEntryTreeModel::sgItemChanged, this, &MeasurementConfigurationDialog::onDirEntryChanged);

    m_splitter = new QSplitter(Qt::Horizontal, this);
    m_splitter->addWidget(m_browser);
    m_splitter->addWidget(m_configurationWidget);
    auto* layout = new QVBoxLayout;
    layout->addWidget(m_splitter);
    m_ui->contentFrame->setLayout(layout);

    okButton()->setEnabled(false);
    restoreSplitter();
}

MeasurementConfigurationDialog::~MeasurementConfigurationDialog()
{
    QSettings().setValue(PellamKeys::DialogSplitterState, m_splitter->saveState());
    delete m_ui;
}

void MeasurementConfigurationDialog::restoreSplitter()
{
    const QByteArray state = QSettings().value(PellamKeys::DialogSplitterState, QVariant()).toByteArray();
    if (!m_splitter->restoreState(state))
        m_splitter->setSizes({200, 600});
}

QPushButton* MeasurementConfigurationDialog::okButton() const
{
    return m_ui->buttonBox->button(QDialogButtonBox::Ok);
}

std::shared_ptr<MeasurementConfiguration> MeasurementConfigurationDialog::measurementConfiguration()
{
    return m_configurationWidget->measurementConfiguration();
}

std::shared_ptr<NamedObject> MeasurementConfigurationDialog::newNamedObject()
{
    return std::make_shared<MeasurementConfiguration>();
}

std::string MeasurementConfigurationDialog::namedObjectTypeId()
{
    return MeasurementConfiguration::typeId();
}

void MeasurementConfigurationDialog::onSelectionChanged(const QVector<Node*>& nodes)
{
    std::vector<std::string> ids;
    for (Node* node : nodes) {
        const auto* entryNode = dynamic_cast<DirEntryTreeModel::DirEntryNode*>(node);
        if (entryNode && entryNode->dirEntry())
            ids.push_back(entryNode->dirEntry()->entryObjectId());
    }
    // Nothing to load (no selection, or folders only): a command without ids
    // would read every object of the store instead.
    if (ids.empty()) {
        okButton()->setEnabled(false);
        return;
    }
    auto command = std::make_shared<GetMarloObjects>();
    command->setIds(ids);
    CommandSender::send(m_store, std::string(), command, this, [this](const std::shared_ptr<Response>& response) {
        onSelectedObjectsLoaded(response);
    });
}

void MeasurementConfigurationDialog::onSelectedObjectsLoaded(std::shared_ptr<Response> response)
{
    const auto loaded = std::dynamic_pointer_cast<GetMarloObjectsResponse>(response);
    if (!loaded)
        return;
    const auto objects = loaded->objects();
    if (objects.empty()) {
        okButton()->setEnabled(false);
        return;
    }
    // With several entries selected, the first one is shown and chosen.
    const auto first = std::dynamic_pointer_cast<MeasurementConfiguration>(objects.front());
    if (first) {
        m_configurationWidget->setMeasurementConfiguration(first);
        m_shownId = first->id();
    }
    okButton()->setEnabled(m_shownId.size() > 0);
}

void MeasurementConfigurationDialog::onDirEntryChanged(std::shared_ptr<DirEntry> dirEntry)
{
    // Only the entry of the configuration shown names it; another entry
    // renamed in the browser must not.
    if (dirEntry && !m_shownId.empty() && dirEntry->entryObjectId() == m_shownId)
        m_configurationWidget->setConfigurationName(dirEntry->header()->name());
}

void MeasurementConfigurationDialog::onErrorOccurred(QString errorString)
{
    QMessageBox::critical(this, tr("Error Occurred"), errorString, QMessageBox::Ok);
    okButton()->setEnabled(false);
    done(-1);
}

void MeasurementConfigurationDialog::changeEvent(QEvent* event)
{
    QDialog::changeEvent(event);
    if (event->type() == QEvent::LanguageChange)
        setWindowTitle(QCoreApplication::translate("MeasurementConfigurationDialog", "Measurement Configuration"));
}

} // namespace vemi
