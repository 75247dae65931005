#pragma once

#include <QString>

namespace vemi {
namespace PellamKeys {

// Keys of the plug-in's state in the host's QSettings store. Each exists once
// for the whole plug-in, from library load to unload.
extern const QString MainSplitterState;

} // namespace PellamKeys
} // namespace vemi
