#pragma once

#include <stdexcept>
#include <string>

namespace vemi {

// A command that the store could not carry out; what() is shown to the user.
class StoreError : public std::runtime_error
{
public:
    explicit StoreError(const std::string& what) : std::runtime_error(what) {}
};

} // namespace vemi
