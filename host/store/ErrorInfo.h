#pragma once

#include <QString>

namespace vemi {

// A failed command: what went wrong, in words a person can act on.
class ErrorInfo
{
public:
    explicit ErrorInfo(QString message, bool conflict = false)
        : m_message(std::move(message)), m_conflict(conflict) {}
    QString message() const { return m_message; }
    // A save refused because someone else stored the object since it was read.
    bool isConflict() const { return m_conflict; }

private:
    QString m_message;
    bool m_conflict;
};

} // namespace vemi
