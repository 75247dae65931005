#pragma once

#include <QObject>
#include <QPointF>

class QGraphicsView;

// Zooms a graphics view with the mouse wheel while the exact modifier state
// set here is held, keeping the scene point under the mouse in place. Lives
// as a child of the view it zooms.
class GraphicsZoomView : public QObject
{
    Q_OBJECT

public:
    explicit GraphicsZoomView(QGraphicsView* view);

    void gentleZoom(double factor);
    void setModifiers(Qt::KeyboardModifiers modifiers);
    void setZoomFactorBase(double value);
    // Zoom buttons have no mouse position: they zoom about the bottom centre.
    void setTargetToViewBottomCentre();
    QPointF mapToScene(QPoint viewportPos) const;
    void resetZoom();

signals:
    void zoomed();

protected:
    bool eventFilter(QObject* object, QEvent* event) override;

private:
    QGraphicsView* m_view;
    Qt::KeyboardModifiers m_modifiers = Qt::ControlModifier;
    double m_zoomFactorBase = 1.0;
    QPointF m_targetScenePos;
    QPointF m_targetViewportPos;
};
