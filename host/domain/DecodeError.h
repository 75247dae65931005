#pragma once

#include <stdexcept>
#include <string>

namespace vemi {

// A stored object whose bytes cannot be turned back into an object.
class DecodeError : public std::runtime_error
{
public:
    explicit DecodeError(const std::string& what) : std::runtime_error(what) {}
};

} // namespace vemi
