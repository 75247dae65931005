#pragma once

#include <QGraphicsView>
#include <QPoint>

class QRubberBand;

// The view that shows the schematic. A drag with any mouse button draws a
// rubber band of at most 55 x 55 pixels; the schematic pane reads the band
// when the user takes it as a checkpoint's area. Mouse events are not passed
// on, so the scene's items never see them. Points are viewport coordinates.
class SchematicGraphicsView : public QGraphicsView
{
    Q_OBJECT

public:
    explicit SchematicGraphicsView(QWidget* parent = nullptr);

    void setBandVisible(bool on);
    void resetBand();
    // Corners of the drag, both included; not limited to the band's size.
    QRect selectionRect() const;
    QPoint bandTopLeft() const;
    QSize bandSize() const;

public slots:
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;

private:
    QRubberBand* m_band;
    bool m_dragging = false;
    QPoint m_origin;
    QPoint m_endPoint;
    bool m_bandVisible = false;
};
