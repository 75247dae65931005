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
    // A save refused because the object was stored by someone else since it was read.
    static StoreError conflict(const std::string& what)
    {
        StoreError error(what);
        error.m_conflict = true;
        return error;
    }
    bool isConflict() const { return m_conflict; }
    // SQLite's (extended) result code when SQLite refused, else 0.
    int sqliteCode() const { return m_sqliteCode; }

private:
    int m_sqliteCode;
    bool m_conflict = false;
};

} // namespace vemi
