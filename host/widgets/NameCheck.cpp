#include "host/widgets/NameCheck.h"

#include <QCoreApplication>

#include <algorithm>

namespace vemi {

QString NameCheck::problem(const QString& name, const std::vector<std::string>& taken)
{
    const QString trimmed = name.trimmed();
    if (trimmed.isEmpty())
        return QCoreApplication::translate("vemi::NameCheck", "A name cannot be empty.");
    if (std::find(taken.begin(), taken.end(), trimmed.toStdString()) != taken.end())
        return QCoreApplication::translate("vemi::NameCheck", "\"%1\" is already used in this folder.").arg(trimmed);
    return {};
}

} // namespace vemi
