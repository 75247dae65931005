#pragma once

#include <memory>
#include <vector>

namespace vemi {

// Immutable bytes (an encoded image) that objects, snapshots and the codec
// share instead of copying.
using SharedBytes = std::shared_ptr<const std::vector<unsigned char>>;

} // namespace vemi
