#include "plugin/PellamSettings.h"

namespace vemi {

PellamSettings::PellamSettings(QString name)
    : QObject(nullptr), CommonSettings(name.toStdString(), name.toStdString(), true, false)
{
}

PellamSettings::~PellamSettings() = default;

} // namespace vemi
