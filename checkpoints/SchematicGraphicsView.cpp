#include "checkpoints/SchematicGraphicsView.h"

#include <QMouseEvent>
#include <QRubberBand>

namespace {

constexpr int MaximumBandSide = 55;

} // namespace

SchematicGraphicsView::SchematicGraphicsView(QWidget* parent)
    : QGraphicsView(parent)
    , m_band(new QRubberBand(QRubberBand::Rectangle, this))
{
    m_band->setMaximumSize(MaximumBandSide, MaximumBandSide);
    QPalette palette = m_band->palette();
    palette.setBrush(QPalette::WindowText, QBrush(Qt::green));
    palette.setBrush(QPalette::Base, QBrush(Qt::red));
    m_band->setPalette(palette);
    setInteractive(true);
    setRenderHint(QPainter::Antialiasing);
}

void SchematicGraphicsView::setBandVisible(bool on)
{
    m_bandVisible = on;
    m_band->setVisible(on);
}

void SchematicGraphicsView::resetBand()
{
    m_origin = QPoint();
    m_endPoint = QPoint();
    // Empty, not the single pixel at the origin: after a reset nothing is
    // selected until the next drag.
    m_band->setGeometry(QRect(m_origin, QSize(0, 0)));
}

QRect SchematicGraphicsView::selectionRect() const
{
    return QRect(QPoint(qMin(m_origin.x(), m_endPoint.x()), qMin(m_origin.y(), m_endPoint.y())),
                 QPoint(qMax(m_origin.x(), m_endPoint.x()), qMax(m_origin.y(), m_endPoint.y())));
}

QPoint SchematicGraphicsView::bandTopLeft() const
{
    return m_band->geometry().topLeft();
}

QSize SchematicGraphicsView::bandSize() const
{
    return m_band->geometry().size();
}

void SchematicGraphicsView::mousePressEvent(QMouseEvent* event)
{
    m_origin = event->pos();
    m_endPoint = QPoint();
    // Not normalised: away from (0, 0) this is an empty band at the press.
    m_band->setGeometry(QRect(m_origin, m_endPoint));
    if (m_bandVisible)
        m_band->show();
    m_dragging = true;
}

void SchematicGraphicsView::mouseMoveEvent(QMouseEvent* event)
{
    if (!m_dragging)
        return;
    m_endPoint = event->pos();
    m_band->setGeometry(QRect(m_origin, m_endPoint).normalized());
}

void SchematicGraphicsView::mouseReleaseEvent(QMouseEvent*)
{
    m_dragging = false;
}
