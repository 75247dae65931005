#pragma once

#include <QString>

namespace vemi {

// A failed command: what went wrong, in words a person can act on.
class ErrorInfo
{
public:
    explicit ErrorInfo(QString message) : m_message(std::move(message)) {}
    QString message() const { return m_message; }

private:
    QString m_message;
};

} // namespace vemi
