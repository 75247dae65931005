#pragma once

#include <QString>

namespace vemi {

// One instrument driver the host knows: the name users read and the name of
// its library, which is what configurations store as the instrument model.
class InstrumentDriverInfo
{
public:
    InstrumentDriverInfo(QString displayName, QString libraryName)
        : m_displayName(std::move(displayName)), m_libraryName(std::move(libraryName)) {}

    QString displayName() const { return m_displayName; }
    QString libraryName() const { return m_libraryName; }

private:
    QString m_displayName;
    QString m_libraryName;
};

} // namespace vemi
