#pragma once

#include <QGraphicsItem>

namespace vemi {

// An item that draws nothing itself and only groups its child items, so that
// a whole layer of marks can be shown, hidden, added to or taken out of a
// scene at once. Unlike QGraphicsItemGroup it leaves its children's events
// and geometry alone. The children die with the layer.
class QGraphicsItemLayer : public QGraphicsItem
{
public:
    explicit QGraphicsItemLayer(QGraphicsItem* parent = nullptr);

    QRectF boundingRect() const override;
    void paint(QPainter* painter, const QStyleOptionGraphicsItem* option, QWidget* widget) override;
};

} // namespace vemi
