#include "host/domain/CheckListItem.h"
