#pragma once

#include "host/client/ClientInterface.h"

#include <QObject>

#include <memory>

namespace vemi {

class PellamSettings;

// The plug-in's root object: the one client of the process, created by the
// host through the plug-in entry point.
class PellamApp : public QObject, public ClientInterface
{
    Q_OBJECT
    Q_PLUGIN_METADATA(IID "ClientInterface")
    Q_INTERFACES(vemi::ClientInterface)

public:
    PellamApp();
    ~PellamApp() override;

    QString clientTitle() const override;
    void clientNotification(const QString& message) override;
    AppWidget* createAppWidget(MarloModel& store, QWidget* parent) override;
    int clientGroup() const override;
    int clientPosition() const override;
    QString styleSheetName() const override;
    std::vector<QString> clientIdentifiers() const override;
    const Version& version() const override;

private:
    std::shared_ptr<PellamSettings> m_settings;
};

} // namespace vemi
