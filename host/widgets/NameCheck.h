#pragma once

#include <QString>

#include <string>
#include <vector>

namespace vemi {

// Whether a name may be given to a folder or an entry among its siblings.
class NameCheck
{
public:
    // Why name cannot be used beside the names taken (the other entries and
    // folders of the same folder); empty when it can. Blanks around the name
    // do not count, since they are dropped before the name is stored.
    static QString problem(const QString& name, const std::vector<std::string>& taken);
};

} // namespace vemi
