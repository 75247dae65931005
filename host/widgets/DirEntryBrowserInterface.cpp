#include "host/widgets/DirEntryBrowserInterface.h"

#include "host/widgets/FirstFreeName.h"
#include "host/widgets/FolderNames.h"
#include "host/widgets/ObjectTypeNames.h"

#include <vector>

namespace vemi {

DirEntryBrowserInterface::~DirEntryBrowserInterface()
{
    if (m_folderBrowser)
        m_folderBrowser->clientDestroyed(this);
}

std::string DirEntryBrowserInterface::defaultNamedObjectName(QString base)
{
    if (base.isEmpty())
        base = ObjectTypeNames::singular(namedObjectTypeId());
    const std::vector<std::string> taken = m_folderBrowser ? m_folderBrowser->namesInTargetFolder()
                                                           : std::vector<std::string>();
    return firstFreeName(base.toStdString(), taken);
}

} // namespace vemi
