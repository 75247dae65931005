#include "host/client/CorvoTopBar.h"

#include <QMenu>

namespace vemi {

CorvoTopBar::CorvoTopBar(QWidget* parent)
    : QMenuBar(parent)
{
}

void CorvoTopBar::addMenu(QMenu* menu)
{
    menu->setParent(this, menu->windowFlags());
    QMenuBar::addMenu(menu);
}

} // namespace vemi
