#pragma once

#include <QString>
#include <QStringList>

#include <vector>

class QObject;

namespace vemi {

class ClientInterface;

// The client plug-ins of a folder: every file whose metadata names the IID
// "ClientInterface" and whose root object is a client. Other files are
// skipped, each with a message.
class PluginCatalog
{
public:
    struct Client
    {
        QString fileName;
        QObject* instance; // owned by the plug-in loader, alive while the plug-in is loaded
        ClientInterface* client;
    };

    void load(const QString& folder);

    // In the host's order: by group, then by position.
    const std::vector<Client>& clients() const { return m_clients; }
    const QStringList& messages() const { return m_messages; }

private:
    void loadFile(const QString& path);

    std::vector<Client> m_clients;
    QStringList m_messages;
};

} // namespace vemi
