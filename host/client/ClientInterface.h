#pragma once

#include <QString>
#include <QtPlugin>

#include <vector>

class QWidget;

namespace vemi {

class AppWidget;
class MarloModel;
class Version;

// What the host asks of a client plug-in's root object.
class ClientInterface
{
public:
    virtual ~ClientInterface() = default;
    virtual QString clientTitle() const = 0;
    // A message from the host to every client (e.g. that the store changed).
    virtual void clientNotification(const QString& message) = 0;
    // The caller owns the widget through its Qt parent.
    virtual AppWidget* createAppWidget(MarloModel& store, QWidget* parent) = 0;
    // Where the host places the client's tab: a group, then a position in it.
    virtual int clientGroup() const = 0;
    virtual int clientPosition() const = 0;
    // The name of the host style sheet for the client's tab.
    virtual QString styleSheetName() const = 0;
    virtual std::vector<QString> clientIdentifiers() const = 0;
    virtual const Version& version() const = 0;
};

} // namespace vemi

Q_DECLARE_INTERFACE(vemi::ClientInterface, "ClientInterface")
