#include "checkpoints/CheckZonePropertiesDialog.h"

#include "host/domain/CheckPoint.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"

#include <QCheckBox>
#include <QDialogButtonBox>
#include <QFormLayout>
#include <QLineEdit>

CheckZonePropertiesDialog::CheckZonePropertiesDialog(std::shared_ptr<vemi::CheckPoint> checkPoint,
                                                     std::shared_ptr<QCJobTemplateModel> model, QWidget* parent)
    : QDialog(parent)
    , m_checkPoint(std::move(checkPoint))
    , m_model(std::move(model))
    , m_name(new QLineEdit(QString::fromStdString(m_checkPoint->name()), this))
    , m_skippable(new QCheckBox(tr("Skippable"), this))
{
    m_name->setObjectName(QStringLiteral("checkPointName"));
    m_skippable->setObjectName(QStringLiteral("skippableCheckBox"));
    m_skippable->setChecked(m_checkPoint->skippable());
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    auto* layout = new QFormLayout(this);
    layout->addRow(tr("Name:"), m_name);
    layout->addRow(m_skippable);
    layout->addRow(buttons);
}

void CheckZonePropertiesDialog::setMarloModel(vemi::MarloModel* store)
{
    m_store = store;
}

QString CheckZonePropertiesDialog::name() const
{
    return m_name->text();
}

bool CheckZonePropertiesDialog::skippable() const
{
    return m_skippable->isChecked();
}

std::shared_ptr<vemi::Standard> CheckZonePropertiesDialog::standard() const
{
    return m_checkPoint->standard();
}

std::vector<std::shared_ptr<vemi::TagDefinition>> CheckZonePropertiesDialog::tagDefinitions() const
{
    return m_checkPoint->tagDefinitions();
}

std::vector<std::shared_ptr<vemi::TagValue>> CheckZonePropertiesDialog::tagValues() const
{
    return m_checkPoint->tagValues();
}
