#pragma once

#include "app/sampledata/SampleColours.h"

#include <QImage>

namespace vemi {

// The schematic drawings of the sample job templates, painted in the display
// colours of the sample standards. Each part's regions are flat, so an area
// inside one shows exactly that region's colour.
class SampleDrawings
{
public:
    // A front door trim panel seen from inside the car, its front edge on the left.
    static QImage doorPanel(const Palette& colours);

    // An instrument panel fascia seen from the driver's seat.
    static QImage dashboard(const Palette& colours);
};

} // namespace vemi
