#include "measurement/MeasurementConfigurationWidget.h"
#include "ui_MeasurementConfigurationWidget.h"

#include "host/client/BaseSetting.h"
#include "host/client/GeneralSettings.h"
#include "host/client/SettingsGroup.h"
#include "host/client/SettingsList.h"
#include "host/client/SettingsSection.h"
#include "host/domain/Header.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/Property.h"
#include "host/instruments/Instrument.h"
#include "host/instruments/InstrumentDriverInfo.h"
#include "host/instruments/InstrumentManager.h"
#include "host/instruments/MeasurementConditions.h"
#include "host/widgets/MeasurementConditionsWidget.h"

#include <QEvent>
#include <QMessageBox>

#include <map>

namespace vemi {

MeasurementConfigurationWidget::MeasurementConfigurationWidget(std::shared_ptr<GeneralSettings> settings,
                                                               QWidget* parent)
    : QWidget(parent), m_ui(new Ui::MeasurementConfigurationWidget)
{
    m_ui->setupUi(this);
    m_conditionsWidget = new MeasurementConditionsWidget(this);
    m_generalSettings = std::move(settings);
    m_ui->descLineEdit->setEnabled(false);
    m_ui->instrumentComboBox->setEnabled(false);
    m_conditionsWidget->adjustSize();
    m_ui->measCondLayout->addWidget(m_conditionsWidget);
    fillInstrumentList();
    connect(m_ui->instrumentComboBox, QOverload<int>::of(&QComboBox::currentIndexChanged), this,
            &MeasurementConfigurationWidget::onInstrumentModelChanged);
    m_ui->instrumentComboBox->setCurrentIndex(-1);
}

MeasurementConfigurationWidget::~MeasurementConfigurationWidget()
{
    delete m_ui;
}

void MeasurementConfigurationWidget::fillInstrumentList()
{
    for (const auto& driver : InstrumentManager::instance()->supportedInstruments())
        m_ui->instrumentComboBox->addItem(driver->displayName(), driver->libraryName());
}

std::shared_ptr<MeasurementConditions>
MeasurementConfigurationWidget::conditionsWithDefaults(const QString& libraryName) const
{
    const auto instrument = InstrumentManager::instance()->instrument(libraryName);
    const auto conditions = instrument ? instrument->measurementConditions() : nullptr;
    if (conditions && m_generalSettings) {
        conditions->setDefaultSettingValue(QStringLiteral("Illuminant"),
                                           QString::fromStdString(m_generalSettings->illuminant()));
        conditions->setDefaultSettingValue(QStringLiteral("Observer"),
                                           QString::fromStdString(m_generalSettings->observer()));
    }
    return conditions;
}

void MeasurementConfigurationWidget::onInstrumentModelChanged(int index)
{
    // The user chose an instrument: from now on the conditions shown are written back.
    m_keepStoredConditions = false;
    const QString libraryName = index == -1 ? QString() : m_ui->instrumentComboBox->itemData(index).toString();
    const bool installed = index != -1 && InstrumentManager::instance()->instrument(libraryName);
    if (index != -1 && !installed)
        QMessageBox::warning(this, m_ui->instrumentComboBox->itemText(index), tr("Instrument driver not installed."),
                             QMessageBox::Ok);
    m_conditionsWidget->setMeasurementConditions(installed ? conditionsWithDefaults(libraryName) : nullptr);
}

int MeasurementConfigurationWidget::indexOfLibrary(const QString& libraryName) const
{
    return m_ui->instrumentComboBox->findData(libraryName, Qt::UserRole, Qt::MatchExactly);
}

// By item, not by display text: two drivers may share a display name.
void MeasurementConfigurationWidget::selectInstrumentModel(const QString& libraryName)
{
    const int index = indexOfLibrary(libraryName);
    if (index != -1)
        m_ui->instrumentComboBox->setCurrentIndex(index);
}

void MeasurementConfigurationWidget::setMeasurementConfiguration(std::shared_ptr<MeasurementConfiguration> config)
{
    if (!config)
        return;
    m_configuration = std::move(config);
    m_ui->descLineEdit->setEnabled(true);
    m_ui->descLineEdit->setText(QString::fromStdString(m_configuration->header()->description()));
    // The beginning of a long description shows, not its end.
    m_ui->descLineEdit->setCursorPosition(0);
    m_ui->instrumentComboBox->setEnabled(true);
    const QString model = QString::fromStdString(m_configuration->instrumentModel());
    if (model.isEmpty()) {
        m_ui->instrumentComboBox->setCurrentIndex(-1);
        onInstrumentModelChanged(-1);
        return;
    }
    const int index = indexOfLibrary(model);
    if (index == -1) {
        // A model no driver lists: show no instrument rather than another's
        // conditions, and keep what the configuration stores.
        m_ui->instrumentComboBox->setCurrentIndex(-1);
        m_conditionsWidget->setMeasurementConditions(nullptr);
        m_keepStoredConditions = true;
        return;
    }
    if (index != m_ui->instrumentComboBox->currentIndex())
        selectInstrumentModel(model);
    else // Settings this configuration does not list start from the instrument's defaults.
        m_conditionsWidget->setMeasurementConditions(conditionsWithDefaults(model));
    const auto conditions = m_conditionsWidget->measurementConditions();
    if (!conditions) {
        // The driver is missing: nothing could show or edit the stored conditions.
        m_keepStoredConditions = true;
        return;
    }
    m_keepStoredConditions = false;
    for (const auto& property : m_configuration->properties())
        conditions->setSettingValue(QString::fromStdString(property->key()), QString::fromStdString(property->value()));
    m_conditionsWidget->setMeasurementConditions(conditions);
}

std::shared_ptr<MeasurementConfiguration> MeasurementConfigurationWidget::measurementConfiguration()
{
    if (!m_configuration)
        return nullptr;
    m_configuration->header()->setDescription(m_ui->descLineEdit->text().toStdString());
    if (m_keepStoredConditions)
        return m_configuration;
    m_configuration->setInstrumentModel(m_ui->instrumentComboBox->currentData(Qt::UserRole).toString().toStdString());
    m_configuration->setProperties(currentProperties());
    return m_configuration;
}

// Every setting of the conditions shown, in the settings tree's order. A
// property the configuration already has for a key is kept (with its id) and
// given the current value, so that writing back the same values twice stores
// the same object.
std::vector<std::shared_ptr<Property>> MeasurementConfigurationWidget::currentProperties() const
{
    std::vector<std::shared_ptr<Property>> properties;
    const auto conditions = m_conditionsWidget->measurementConditions();
    if (!conditions)
        return properties;
    std::map<std::string, std::shared_ptr<Property>> existing;
    for (const auto& property : m_configuration->properties())
        existing.emplace(property->key(), property);
    for (const auto& group : conditions->settings()->groups())
        for (const auto& section : group->sections())
            for (const auto& setting : section->settings()) {
                const std::string value = conditions->settingValue(QString::fromStdString(setting->name())).toStdString();
                const auto found = existing.find(setting->name());
                auto property = found != existing.end() ? found->second : std::make_shared<Property>(setting->name());
                property->setValue(value);
                properties.push_back(property);
            }
    return properties;
}

void MeasurementConfigurationWidget::setConfigurationName(const std::string& name)
{
    if (m_configuration)
        m_configuration->setName(name);
}

void MeasurementConfigurationWidget::changeEvent(QEvent* event)
{
    QWidget::changeEvent(event);
    if (event->type() == QEvent::LanguageChange)
        m_ui->retranslateUi(this);
}

} // namespace vemi
