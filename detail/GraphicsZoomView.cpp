#include "detail/GraphicsZoomView.h"

#include <QGraphicsView>
#include <QMouseEvent>
#include <QWheelEvent>

#include <cmath>

namespace {

// Small jitters of the mouse do not move the zoom target.
constexpr double TargetStep = 5.0;

} // namespace

GraphicsZoomView::GraphicsZoomView(QGraphicsView* view)
    : QObject(view)
    , m_view(view)
{
    m_view->viewport()->installEventFilter(this);
    m_view->setMouseTracking(true);
}

void GraphicsZoomView::gentleZoom(double factor)
{
    m_view->scale(factor, factor);
    m_view->centerOn(m_targetScenePos);
    const QPointF viewportCentre(m_view->viewport()->width() * 0.5, m_view->viewport()->height() * 0.5);
    const QPointF delta = m_targetViewportPos - viewportCentre;
    const QPointF centre = m_view->mapFromScene(m_targetScenePos) - delta;
    m_view->centerOn(m_view->mapToScene(centre.toPoint()));
    emit zoomed();
}

void GraphicsZoomView::setModifiers(Qt::KeyboardModifiers modifiers)
{
    m_modifiers = modifiers;
}

void GraphicsZoomView::setZoomFactorBase(double value)
{
    m_zoomFactorBase = value;
}

void GraphicsZoomView::setTargetToViewBottomCentre()
{
    m_targetScenePos = m_view->mapToScene(QPoint(m_view->viewport()->width() / 2, m_view->viewport()->height()));
}

QPointF GraphicsZoomView::mapToScene(QPoint viewportPos) const
{
    return m_view->mapToScene(viewportPos);
}

void GraphicsZoomView::resetZoom()
{
    m_view->resetTransform();
}

bool GraphicsZoomView::eventFilter(QObject*, QEvent* event)
{
    if (event->type() == QEvent::MouseMove) {
        const QPointF pos = static_cast<QMouseEvent*>(event)->localPos();
        if (std::abs(m_targetViewportPos.x() - pos.x()) > TargetStep
            || std::abs(m_targetViewportPos.y() - pos.y()) > TargetStep) {
            m_targetViewportPos = pos;
            m_targetScenePos = m_view->mapToScene(pos.toPoint());
        }
        return false;
    }
    if (event->type() == QEvent::Wheel) {
        const auto* wheel = static_cast<QWheelEvent*>(event);
        const QPoint delta = wheel->angleDelta();
        const bool vertical = std::abs(delta.y()) >= std::abs(delta.x());
        // The event's own modifiers: the keys held when the wheel turned.
        if (wheel->modifiers() == m_modifiers && vertical) {
            gentleZoom(std::pow(m_zoomFactorBase, delta.y()));
            return true;
        }
    }
    return false;
}
