#include "host/widgets/DirEntryBrowserInterface.h"

#include "host/widgets/DirEntryBrowserWidget.h"

#include <algorithm>
#include <vector>

namespace vemi {

DirEntryBrowserInterface::~DirEntryBrowserInterface()
{
    if (m_browserWidget)
        m_browserWidget->m_callbacks = nullptr;
}

std::string DirEntryBrowserInterface::defaultNamedObjectName(QString base)
{
    const std::vector<std::string> taken = m_browserWidget ? m_browserWidget->namesInNewObjectFolder()
                                                           : std::vector<std::string>();
    const std::string first = base.toStdString();
    const auto isFree = [&taken](const std::string& name) {
        return std::find(taken.begin(), taken.end(), name) == taken.end();
    };
    if (isFree(first))
        return first;
    for (int number = 2;; ++number) {
        const std::string candidate = first + " " + std::to_string(number);
        if (isFree(candidate))
            return candidate;
    }
}

} // namespace vemi
