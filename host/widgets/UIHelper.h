#pragma once

#include <QColor>

namespace vemi {

class RGBValue;

// Conversions between domain values and what widgets show.
class UIHelper
{
public:
    // An opaque colour; each channel is clamped to 0–255, since stored values
    // may come from computations that overshoot the screen gamut.
    static QColor toColor(const RGBValue& rgb);
};

} // namespace vemi
