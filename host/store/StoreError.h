#pragma once

#include <stdexcept>
#include <string>

namespace vemi {

// A command that the store could not carry out; what() is shown to the user.
class StoreError : public std::runtime_error
{
public:
    explicit StoreError(const std::string& what, int sqliteCode = 0)
        : std::runtime_error(what), m_sqliteCode(sqliteCode) {}
    // SQLite's (extended) result code when SQLite refused, else 0.
    int sqliteCode() const { return m_sqliteCode; }

private:
    int m_sqliteCode;
};

} // namespace vemi
