#include "ColorValue.h"
