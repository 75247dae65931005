#pragma once

#include <QIcon>

namespace vemi {

class Standard;

// The icon that lists show for a standard.
class StandardIcon
{
public:
    // base with, when the standard has a display colour, a 10 x 10 swatch of
    // it for the looks in which list rows are drawn.
    static QIcon of(const QIcon& base, const Standard& standard);
};

} // namespace vemi
