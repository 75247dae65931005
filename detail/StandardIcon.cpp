#include "detail/StandardIcon.h"

#include "host/domain/RGBValue.h"
#include "host/domain/Standard.h"
#include "host/widgets/UIHelper.h"

#include <QPixmap>

namespace vemi {

QIcon StandardIcon::of(const QIcon& base, const Standard& standard)
{
    QIcon icon = base;
    if (const auto rgb = standard.displayRGB()) {
        QPixmap swatch(10, 10);
        swatch.fill(UIHelper::toColor(*rgb));
        icon.addPixmap(swatch, QIcon::Normal, QIcon::Off);
        icon.addPixmap(swatch, QIcon::Selected, QIcon::Off);
    }
    return icon;
}

} // namespace vemi
