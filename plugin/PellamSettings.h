#pragma once

#include "host/client/CommonSettings.h"

#include <QObject>

namespace vemi {

// The plug-in's settings object for the host's settings pages. It defines no
// settings of its own. Shared by the client object and its tab widgets.
class PellamSettings : public QObject, public CommonSettings
{
    Q_OBJECT
    Q_INTERFACES(vemi::CommonSettings)

public:
    explicit PellamSettings(QString name);
    ~PellamSettings() override;
};

} // namespace vemi
