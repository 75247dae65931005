#include "app/PluginCatalog.h"

#include "host/client/ClientInterface.h"

#include <QDir>
#include <QFileInfo>
#include <QJsonObject>
#include <QLibrary>
#include <QPluginLoader>

#include <algorithm>

namespace vemi {

void PluginCatalog::load(const QString& folder)
{
    const QDir directory(folder);
    if (!directory.exists()) {
        m_messages << QStringLiteral("The plug-in folder %1 does not exist.").arg(folder);
        return;
    }
    for (const QFileInfo& file : directory.entryInfoList(QDir::Files, QDir::Name)) {
        if (QLibrary::isLibrary(file.fileName()))
            loadFile(file.absoluteFilePath());
    }
    std::stable_sort(m_clients.begin(), m_clients.end(), [](const Client& a, const Client& b) {
        if (a.client->clientGroup() != b.client->clientGroup())
            return a.client->clientGroup() < b.client->clientGroup();
        return a.client->clientPosition() < b.client->clientPosition();
    });
}

void PluginCatalog::loadFile(const QString& path)
{
    QPluginLoader loader(path);
    const QJsonObject metaData = loader.metaData();
    if (metaData.isEmpty()) {
        m_messages << QStringLiteral("Skipped %1: not a plug-in (%2).").arg(path, loader.errorString());
        return;
    }
    const QString iid = metaData.value(QStringLiteral("IID")).toString();
    if (iid != QLatin1String("ClientInterface")) {
        m_messages << QStringLiteral("Skipped %1: its interface is \"%2\", not \"ClientInterface\".").arg(path, iid);
        return;
    }
    QObject* instance = loader.instance();
    auto* client = qobject_cast<ClientInterface*>(instance);
    if (!client) {
        m_messages << QStringLiteral("Skipped %1: %2").arg(
            path, instance ? QStringLiteral("its root object is not a client.") : loader.errorString());
        return;
    }
    m_clients.push_back({path, instance, client});
}

} // namespace vemi
