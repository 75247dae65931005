#pragma once

#include <QString>
#include <QtGlobal>

namespace vemi {

// A client's version: three 16-bit numbers and the kind of build.
class Version
{
public:
    enum Type { Development = 1, Alpha = 2, Beta = 3, Release = 4 };

    Version(quint16 major, quint16 minor, quint16 patch, Type type)
        : m_major(major), m_minor(minor), m_patch(patch), m_type(type) {}

    quint16 major() const { return m_major; }
    quint16 minor() const { return m_minor; }
    quint16 patch() const { return m_patch; }
    Type type() const { return m_type; }
    // "1.3.0", with " beta" and the like for builds that are not releases.
    QString toString() const;

private:
    quint16 m_major;
    quint16 m_minor;
    quint16 m_patch;
    Type m_type;
};

} // namespace vemi
