#include "CheckListItem.h"
