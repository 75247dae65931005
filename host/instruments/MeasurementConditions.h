#pragma once

#include "host/client/CommonSettings.h"

#include <QString>
#include <QStringList>

#include <map>
#include <memory>

namespace vemi {

class BaseSetting;

// The settings an instrument measures with ("Illuminant", "Observer", …),
// as one group with one section in the settings tree, in the instrument's order.
// A setting that was never set holds its default.
class MeasurementConditions : public CommonSettings
{
public:
    explicit MeasurementConditions(const std::string& instrumentName);

    // Adds a setting; allowed lists the values it may take (empty: any text).
    void addSetting(const QString& key, const QString& defaultValue, const QStringList& allowed = {});

    // Empty for an unknown key.
    QString settingValue(const QString& key) const;
    // Both ignore a key the instrument does not have: a stored configuration
    // may name settings of another instrument or driver version.
    void setSettingValue(const QString& key, const QString& value);
    void setDefaultSettingValue(const QString& key, const QString& value);
    QStringList allowedValues(const QString& key) const;

private:
    struct Entry
    {
        std::shared_ptr<BaseSetting> setting;
        QString defaultValue;
        QStringList allowed;
    };

    std::map<QString, Entry> m_entries;
};

} // namespace vemi
