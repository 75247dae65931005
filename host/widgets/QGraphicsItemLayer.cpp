#include "host/widgets/QGraphicsItemLayer.h"

namespace vemi {

QGraphicsItemLayer::QGraphicsItemLayer(QGraphicsItem* parent)
    : QGraphicsItem(parent)
{
    setFlag(ItemHasNoContents);
}

// The layer itself covers no area; its children are indexed on their own.
QRectF QGraphicsItemLayer::boundingRect() const
{
    return QRectF();
}

void QGraphicsItemLayer::paint(QPainter*, const QStyleOptionGraphicsItem*, QWidget*)
{
}

} // namespace vemi
