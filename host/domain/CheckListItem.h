#pragma once

#include "host/domain/NamedObject.h"

namespace vemi {

// An entry of a job template's check list: a CheckPoint or a
// CheckPointCouple, told apart by dynamic type.
class CheckListItem : public NamedObject
{
};

} // namespace vemi
