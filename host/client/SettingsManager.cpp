#include "host/client/SettingsManager.h"

#include "host/client/GeneralSettings.h"
#include "host/store/MarloModel.h"

#include <QSettings>
#include <QStringList>

namespace vemi {

SettingsManager& SettingsManager::instance()
{
    static SettingsManager manager;
    return manager;
}

std::shared_ptr<GeneralSettings> SettingsManager::getGeneralSettings() const
{
    QSettings settings;
    const QStringList stored = settings.value(QStringLiteral("General/DispatcherList")).toStringList();
    std::vector<std::string> dispatchers;
    for (const QString& id : stored)
        dispatchers.push_back(id.toStdString());
    if (dispatchers.empty())
        dispatchers.push_back(MarloModel::defaultDispatcherId());
    return std::make_shared<GeneralSettings>(
        dispatchers,
        settings.value(QStringLiteral("General/Illuminant"), QStringLiteral("D65")).toString().toStdString(),
        settings.value(QStringLiteral("General/Observer"), QStringLiteral("10")).toString().toStdString());
}

} // namespace vemi
