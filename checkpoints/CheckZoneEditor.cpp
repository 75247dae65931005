#include "checkpoints/CheckZoneEditor.h"
#include "ui_CheckZoneEditor.h"

#include "host/domain/MeasurementConfiguration.h"
#include "model/QCJobTemplateModel.h"

CheckZoneEditor::CheckZoneEditor(QWidget* parent)
    : QWidget(parent)
    , m_ui(new Ui::CheckZoneEditor)
{
    m_ui->setupUi(this);
}

CheckZoneEditor::~CheckZoneEditor()
{
    delete m_ui;
}

void CheckZoneEditor::init(vemi::MarloModel& store, std::shared_ptr<QCJobTemplateModel> model)
{
    m_store = &store;
    m_model = std::move(model);
    connect(m_model.get(), &QCJobTemplateModel::sgMeasurementConfigLoaded, this,
            &CheckZoneEditor::onMeasurementConfigLoaded);
}

void CheckZoneEditor::onMeasurementConfigLoaded()
{
    m_ui->addCheckZoneButton->setEnabled(m_model->measurementConfiguration() != nullptr);
    m_ui->checkZoneListWidget->clearSelection();
}

// filled in by the check list editor
void CheckZoneEditor::setCurrentThumbnail(int, QPixmap) {}

// filled in by the check list editor
void CheckZoneEditor::publishCheckPoints() {}
