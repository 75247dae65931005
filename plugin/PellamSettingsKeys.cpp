#include "plugin/PellamSettingsKeys.h"

namespace vemi {
namespace PellamKeys {

const QString MainSplitterState = QStringLiteral("UI/Pellam/mainSplitterState");
const QString HorizontalSplitterState = QStringLiteral("UI/Pellam/horizontalSplitterState");
const QString QcJobTemplateSplitterState = QStringLiteral("UI/Pellam/qcJobTemplateSplitterState");
const QString SchematicImagePath = QStringLiteral("UI/Pellam/SchematicImagePath");
const QString DialogSplitterState = QStringLiteral("UI/Pellam/dialogSplitterState");

const QString LibraryPathGroup = QStringLiteral("Opal QC/LibraryPath");
const QString StandardPathGroup = QStringLiteral("Opal QC/StandardPath");
const QString TolerancePathGroup = QStringLiteral("Opal QC/TolerancePath");
const QString PropertyPathGroup = QStringLiteral("Opal QC/PropertyPath");
const QString LastSelectedPath = QStringLiteral("LastSelectedPath");
const QString DispatcherId = QStringLiteral("DispatcherId");

} // namespace PellamKeys
} // namespace vemi
