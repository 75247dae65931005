#include "host/instruments/MeasurementConditions.h"

#include "host/client/BaseSetting.h"
#include "host/client/SettingsGroup.h"
#include "host/client/SettingsList.h"
#include "host/client/SettingsSection.h"

namespace vemi {

MeasurementConditions::MeasurementConditions(const std::string& instrumentName)
    : CommonSettings(instrumentName, "Measurement Conditions", true, false)
{
    auto group = std::make_shared<SettingsGroup>("Measurement");
    group->addSection(std::make_shared<SettingsSection>("Conditions"));
    settings()->addGroup(group);
}

void MeasurementConditions::addSetting(const QString& key, const QString& defaultValue, const QStringList& allowed)
{
    auto setting = std::make_shared<BaseSetting>(key.toStdString());
    settings()->groups().front()->sections().front()->addSetting(setting);
    m_entries[key] = Entry{setting, defaultValue, allowed};
}

QString MeasurementConditions::settingValue(const QString& key) const
{
    const auto found = m_entries.find(key);
    if (found == m_entries.end())
        return {};
    const QVariant value = found->second.setting->value();
    return value.isValid() ? value.toString() : found->second.defaultValue;
}

void MeasurementConditions::setSettingValue(const QString& key, const QString& value)
{
    const auto found = m_entries.find(key);
    if (found != m_entries.end())
        found->second.setting->setValue(value);
}

void MeasurementConditions::setDefaultSettingValue(const QString& key, const QString& value)
{
    const auto found = m_entries.find(key);
    if (found != m_entries.end())
        found->second.defaultValue = value;
}

QStringList MeasurementConditions::allowedValues(const QString& key) const
{
    const auto found = m_entries.find(key);
    return found == m_entries.end() ? QStringList() : found->second.allowed;
}

} // namespace vemi
