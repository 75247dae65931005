#pragma once

#include <QString>

namespace vemi {
namespace PellamKeys {

// Keys of the plug-in's state in the host's QSettings store. Each exists once
// for the whole plug-in, from library load to unload.
extern const QString MainSplitterState;
extern const QString HorizontalSplitterState;
extern const QString QcJobTemplateSplitterState;
// The schematic file chosen last; the next file dialog starts beside it.
extern const QString SchematicImagePath;
extern const QString DialogSplitterState;

// Groups of the pickers' remembered positions, each holding the two keys below.
extern const QString LibraryPathGroup;
extern const QString StandardPathGroup;
extern const QString TolerancePathGroup;
extern const QString PropertyPathGroup;
extern const QString LastSelectedPath;
extern const QString DispatcherId;

} // namespace PellamKeys
} // namespace vemi
