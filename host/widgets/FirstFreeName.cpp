#include "host/widgets/FirstFreeName.h"

#include <algorithm>

namespace vemi {

std::string firstFreeName(const std::string& base, const std::vector<std::string>& taken)
{
    const auto isFree = [&taken](const std::string& name) {
        return std::find(taken.begin(), taken.end(), name) == taken.end();
    };
    if (isFree(base))
        return base;
    // Among n taken names at most n candidates can be taken: the loop ends.
    for (int number = 2;; ++number) {
        const std::string candidate = base + " " + std::to_string(number);
        if (isFree(candidate))
            return candidate;
    }
}

} // namespace vemi
