#pragma once

#include <string>
#include <vector>

namespace vemi {

// base, or base followed by " 2", " 3", … : the first of these that is not
// among taken. Names a new object or folder uniquely within its folder.
std::string firstFreeName(const std::string& base, const std::vector<std::string>& taken);

} // namespace vemi
