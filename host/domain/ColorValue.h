#pragma once

#include "host/domain/BaseObject.h"

namespace vemi {

// Common base of the colour values a standard's appearance values hold.
class ColorValue : public BaseObject
{
};

} // namespace vemi
