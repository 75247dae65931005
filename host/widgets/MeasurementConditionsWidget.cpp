#include "host/widgets/MeasurementConditionsWidget.h"

#include "host/client/BaseSetting.h"
#include "host/client/SettingsGroup.h"
#include "host/client/SettingsList.h"
#include "host/client/SettingsSection.h"
#include "host/instruments/MeasurementConditions.h"

#include <QComboBox>
#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QVBoxLayout>

namespace vemi {

MeasurementConditionsWidget::MeasurementConditionsWidget(QWidget* parent)
    : QWidget(parent), m_placeholder(new QLabel(tr("No measurement conditions to show."), this)),
      m_fields(new QFormLayout)
{
    m_placeholder->setEnabled(false);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(m_placeholder);
    layout->addLayout(m_fields);
    layout->addStretch(1);
}

void MeasurementConditionsWidget::setMeasurementConditions(std::shared_ptr<MeasurementConditions> conditions)
{
    clearFields();
    m_conditions = std::move(conditions);
    m_placeholder->setVisible(!m_conditions);
    if (!m_conditions)
        return;
    for (const auto& group : m_conditions->settings()->groups())
        for (const auto& section : group->sections())
            for (const auto& setting : section->settings()) {
                const QString key = QString::fromStdString(setting->name());
                m_fields->addRow(key + QLatin1Char(':'), fieldFor(key));
            }
}

void MeasurementConditionsWidget::clearFields()
{
    while (m_fields->rowCount() > 0)
        m_fields->removeRow(0);
}

// A list of the values the instrument allows, or free text when it names none.
// The field is named after its setting, so that each can be found by name.
QWidget* MeasurementConditionsWidget::fieldFor(const QString& key)
{
    const auto conditions = m_conditions;
    const QString value = conditions->settingValue(key);
    const QStringList allowed = conditions->allowedValues(key);
    if (allowed.isEmpty()) {
        auto* edit = new QLineEdit(value, this);
        edit->setObjectName(key);
        connect(edit, &QLineEdit::textEdited, this,
                [conditions, key](const QString& text) { conditions->setSettingValue(key, text); });
        return edit;
    }
    auto* box = new QComboBox(this);
    box->setObjectName(key);
    box->addItems(allowed);
    // A stored value this instrument does not offer stays visible as it is.
    if (!allowed.contains(value))
        box->addItem(value);
    box->setCurrentText(value);
    connect(box, &QComboBox::currentTextChanged, this,
            [conditions, key](const QString& text) { conditions->setSettingValue(key, text); });
    return box;
}

} // namespace vemi
