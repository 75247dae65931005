#include "host/domain/ColorValue.h"
