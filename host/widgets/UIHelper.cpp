#include "host/widgets/UIHelper.h"

#include "host/domain/RGBValue.h"

#include <algorithm>

namespace vemi {

namespace {

int channel(int value)
{
    return std::clamp(value, 0, 255);
}

} // namespace

QColor UIHelper::toColor(const RGBValue& rgb)
{
    return QColor(channel(rgb.red()), channel(rgb.green()), channel(rgb.blue()));
}

} // namespace vemi
