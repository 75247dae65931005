#pragma once

#include <QString>

namespace vemi {
class QCJobTemplate;
}

// The check list as one line, for comparing whole lists in tests: items in
// order, a couple as "Name[first second]", every checkpoint by name followed
// by its match point, e.g. "A[P0<CP1> P2<CP2>], P1".
QString checkListText(const vemi::QCJobTemplate& jobTemplate);
