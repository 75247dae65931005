#pragma once

#include <QColor>

#include <array>

namespace vemi {

// The sample colour standards. The catalogue's standards and the drawings'
// palette are both indexed by it.
enum SampleColour { IvoryBeige, GraphiteGrey, SignalRed, OceanBlue, LeafGreen, SunYellow, SampleColourCount };

// The display colour of each sample standard.
using Palette = std::array<QColor, SampleColourCount>;

} // namespace vemi
