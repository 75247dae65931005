#include "host/client/Version.h"

namespace vemi {

QString Version::toString() const
{
    QString text = QStringLiteral("%1.%2.%3").arg(m_major).arg(m_minor).arg(m_patch);
    switch (m_type) {
    case Development: return text + QStringLiteral(" development");
    case Alpha: return text + QStringLiteral(" alpha");
    case Beta: return text + QStringLiteral(" beta");
    case Release: return text;
    }
    return text;
}

} // namespace vemi
