#include "app/sampledata/SampleDrawings.h"

#include <QPainter>
#include <QPainterPath>

namespace vemi {

namespace {

const QSize kCanvasSize(900, 560);
const QColor kBackground(0xf4, 0xf5, 0xf7);
const QColor kOutline(0x2b, 0x2f, 0x36);
const QColor kShadow(0, 0, 0, 28);

QImage blankCanvas()
{
    QImage image(kCanvasSize, QImage::Format_RGB32);
    image.fill(kBackground);
    return image;
}

void drawShape(QPainter& painter, const QPainterPath& shape, const QColor& fill, qreal penWidth = 2.5)
{
    painter.setPen(QPen(kOutline, penWidth, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    painter.setBrush(fill);
    painter.drawPath(shape);
}

// The part's outline over its drop shadow.
void drawBody(QPainter& painter, const QPainterPath& body, const QColor& fill)
{
    painter.fillPath(body.translated(6, 8), kShadow);
    drawShape(painter, body, fill, 3);
}

QPainterPath roundedRect(qreal x, qreal y, qreal width, qreal height, qreal radius)
{
    QPainterPath path;
    path.addRoundedRect(x, y, width, height, radius, radius);
    return path;
}

void drawSlats(QPainter& painter, const QRectF& vent, const QColor& colour)
{
    painter.setPen(QPen(colour, 3, Qt::SolidLine, Qt::RoundCap));
    for (qreal y = vent.top() + 12; y < vent.bottom() - 6; y += 11)
        painter.drawLine(QPointF(vent.left() + 8, y), QPointF(vent.right() - 8, y));
}

// --- Door panel -----------------------------------------------------------

QPainterPath doorCard()
{
    QPainterPath card;
    card.moveTo(120, 80);
    card.lineTo(800, 80);
    card.quadTo(840, 80, 840, 120);
    card.lineTo(840, 470);
    card.quadTo(840, 510, 800, 510);
    card.lineTo(240, 510);
    card.cubicTo(150, 510, 70, 440, 60, 330);
    card.lineTo(60, 140);
    card.quadTo(60, 80, 120, 80);
    return card;
}

// The fabric insert with its stitch line.
void drawInsert(QPainter& painter, const QColor& fabric)
{
    drawShape(painter, roundedRect(150, 175, 300, 165, 24), fabric);
    painter.setPen(QPen(fabric.lighter(150), 1.5, Qt::DashLine));
    painter.setBrush(Qt::NoBrush);
    painter.drawRoundedRect(QRectF(160, 185, 280, 145), 18, 18);
}

// The door handle and the armrest with its switch panel.
void drawHandleAndArmrest(QPainter& painter, const QColor& grey)
{
    drawShape(painter, roundedRect(520, 175, 140, 55, 20), grey);
    drawShape(painter, roundedRect(545, 195, 90, 16, 8), grey.darker(140), 1.5);

    drawShape(painter, roundedRect(470, 255, 340, 75, 32), grey);
    painter.setPen(QPen(kOutline, 1.5));
    painter.setBrush(grey.darker(125));
    painter.drawEllipse(QRectF(705, 272, 80, 40));
}

void drawMapPocket(QPainter& painter, const QColor& grey)
{
    QPainterPath pocket;
    pocket.moveTo(160, 395);
    pocket.lineTo(640, 395);
    pocket.quadTo(660, 395, 660, 415);
    pocket.lineTo(660, 470);
    pocket.quadTo(660, 485, 645, 485);
    pocket.lineTo(200, 485);
    pocket.quadTo(170, 485, 160, 460);
    pocket.closeSubpath();
    drawShape(painter, pocket, grey);
    painter.setPen(QPen(grey.darker(160), 3, Qt::SolidLine, Qt::RoundCap));
    painter.drawLine(QPointF(178, 412), QPointF(642, 412));
}

void drawSpeaker(QPainter& painter, const QColor& grey)
{
    const QPointF speaker(745, 420);
    QPainterPath grille;
    grille.addEllipse(speaker, 55, 55);
    drawShape(painter, grille, grey);
    painter.setPen(Qt::NoPen);
    painter.setBrush(grey.darker(160));
    for (int dy = -40; dy <= 40; dy += 10) {
        for (int dx = -40; dx <= 40; dx += 10) {
            if (dx * dx + dy * dy <= 42 * 42)
                painter.drawEllipse(speaker + QPointF(dx, dy), 2.6, 2.6);
        }
    }
}

// The clips along the front edge.
void drawFixings(QPainter& painter, const QColor& card)
{
    painter.setPen(QPen(kOutline, 1.5));
    painter.setBrush(card.darker(112));
    painter.drawEllipse(QPointF(100, 210), 7, 7);
    painter.drawEllipse(QPointF(100, 300), 7, 7);
}

// --- Dashboard ------------------------------------------------------------

QPainterPath fasciaOutline()
{
    QPainterPath fascia;
    fascia.moveTo(40, 210);
    fascia.cubicTo(130, 120, 770, 120, 860, 210);
    fascia.lineTo(860, 430);
    fascia.quadTo(860, 460, 830, 460);
    fascia.lineTo(70, 460);
    fascia.quadTo(40, 460, 40, 430);
    fascia.closeSubpath();
    return fascia;
}

void drawTopPad(QPainter& painter, const QColor& grey)
{
    QPainterPath topPad;
    topPad.moveTo(40, 210);
    topPad.cubicTo(130, 120, 770, 120, 860, 210);
    topPad.lineTo(860, 245);
    topPad.cubicTo(770, 170, 130, 170, 40, 245);
    topPad.closeSubpath();
    drawShape(painter, topPad, grey);
}

// The instrument hood with its two dials.
void drawInstruments(QPainter& painter, const QColor& grey, const QColor& needle)
{
    QPainterPath hood;
    hood.moveTo(120, 330);
    hood.lineTo(120, 268);
    hood.cubicTo(140, 205, 340, 205, 360, 268);
    hood.lineTo(360, 330);
    hood.closeSubpath();
    drawShape(painter, hood, grey);
    for (const QPointF& centre : {QPointF(190, 290), QPointF(290, 290)}) {
        painter.setPen(QPen(kOutline, 2));
        painter.setBrush(grey.darker(170));
        painter.drawEllipse(centre, 34, 34);
        painter.setPen(QPen(needle, 3, Qt::SolidLine, Qt::RoundCap));
        painter.drawLine(centre, centre + QPointF(-18, -16));
    }
}

// The air vents and the centre screen between the middle ones.
void drawVentsAndScreen(QPainter& painter, const QColor& grey)
{
    for (const QRectF& vent : {QRectF(62, 250, 48, 66), QRectF(395, 240, 50, 70), QRectF(455, 240, 50, 70),
                               QRectF(790, 250, 48, 66)}) {
        drawShape(painter, roundedRect(vent.x(), vent.y(), vent.width(), vent.height(), 10), grey);
        drawSlats(painter, vent, grey.darker(160));
    }
    drawShape(painter, roundedRect(392, 322, 116, 70, 8), QColor(0x1f, 0x23, 0x28));
}

void drawGlovebox(QPainter& painter, const QColor& lid, const QColor& grey)
{
    drawShape(painter, roundedRect(560, 245, 215, 80, 14), lid);
    drawShape(painter, roundedRect(735, 276, 26, 14, 5), grey, 1.5);
}

void drawDecorStrips(QPainter& painter, const QColor& decor)
{
    drawShape(painter, roundedRect(60, 340, 320, 38, 10), decor);
    drawShape(painter, roundedRect(520, 340, 320, 38, 10), decor);
}

// The cut-out for the steering column, open to the background.
void drawColumnCutOut(QPainter& painter)
{
    QPainterPath column;
    column.moveTo(180, 460);
    column.cubicTo(185, 405, 295, 405, 300, 460);
    drawShape(painter, column, kBackground);
}

} // namespace

QImage SampleDrawings::doorPanel(const Palette& colours)
{
    QImage image = blankCanvas();
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);

    const QColor grey = colours[GraphiteGrey];
    drawBody(painter, doorCard(), colours[IvoryBeige]);
    drawShape(painter, roundedRect(76, 94, 750, 48, 16), grey); // window sill
    drawInsert(painter, colours[OceanBlue]);
    drawHandleAndArmrest(painter, grey);
    drawMapPocket(painter, grey);
    drawSpeaker(painter, grey);
    drawFixings(painter, colours[IvoryBeige]);
    return image;
}

QImage SampleDrawings::dashboard(const Palette& colours)
{
    QImage image = blankCanvas();
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);

    const QColor grey = colours[GraphiteGrey];
    drawBody(painter, fasciaOutline(), colours[IvoryBeige]);
    drawTopPad(painter, grey);
    drawInstruments(painter, grey, colours[SignalRed]);
    drawVentsAndScreen(painter, grey);
    drawGlovebox(painter, colours[IvoryBeige], grey);
    drawDecorStrips(painter, colours[SignalRed]);
    drawColumnCutOut(painter);
    return image;
}

} // namespace vemi
