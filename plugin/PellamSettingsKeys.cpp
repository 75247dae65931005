#include "plugin/PellamSettingsKeys.h"

namespace vemi {
namespace PellamKeys {

const QString MainSplitterState = QStringLiteral("UI/Pellam/mainSplitterState");

} // namespace PellamKeys
} // namespace vemi
