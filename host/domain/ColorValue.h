#pragma once

#include "BaseObject.h"

namespace vemi {

// Common base of the colour values a standard's appearance values hold.
class ColorValue : public BaseObject
{
};

} // namespace vemi
