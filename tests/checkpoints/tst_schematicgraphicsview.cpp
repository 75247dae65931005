#include "tests/common/TestMain.h"

#include "checkpoints/SchematicGraphicsView.h"

#include <QGraphicsScene>
#include <QMouseEvent>
#include <QRubberBand>

#include <memory>

using Points = QVector<QPoint>;

namespace {

// Moves are sent as events of their own: the view must see the buttons held
// (or not) during each move, whatever QTest remembers of earlier presses.
void moveMouse(QWidget* viewport, QPoint pos, Qt::MouseButtons buttons)
{
    QMouseEvent move(QEvent::MouseMove, pos, viewport->mapToGlobal(pos), Qt::NoButton, buttons, Qt::NoModifier);
    QApplication::sendEvent(viewport, &move);
}

} // namespace

class tst_SchematicGraphicsView : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void dragGivesSelectionAndBand_data();
    void dragGivesSelectionAndBand();
    void bandIsShownOnlyWhenVisible_data();
    void bandIsShownOnlyWhenVisible();
    void movesWithoutAPressedButtonChangeNothing();
    void resetLeavesAnEmptyBandAtTheOrigin();

private:
    QRubberBand* band() const { return m_view->findChild<QRubberBand*>(); }
    void drag(QPoint from, const Points& moves, Qt::MouseButton button = Qt::LeftButton);

    std::unique_ptr<QGraphicsScene> m_scene;
    std::unique_ptr<SchematicGraphicsView> m_view;
};

void tst_SchematicGraphicsView::init()
{
    m_scene = std::make_unique<QGraphicsScene>(0, 0, 800, 600);
    m_view = std::make_unique<SchematicGraphicsView>();
    m_view->setScene(m_scene.get());
    m_view->resize(400, 300);
    m_view->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_view.get()));
}

void tst_SchematicGraphicsView::cleanup()
{
    m_view.reset();
    m_scene.reset();
}

void tst_SchematicGraphicsView::drag(QPoint from, const Points& moves, Qt::MouseButton button)
{
    QWidget* viewport = m_view->viewport();
    QTest::mousePress(viewport, button, Qt::NoModifier, from);
    for (const QPoint& to : moves)
        moveMouse(viewport, to, button);
    QTest::mouseRelease(viewport, button, Qt::NoModifier, moves.isEmpty() ? from : moves.last());
}

void tst_SchematicGraphicsView::dragGivesSelectionAndBand_data()
{
    QTest::addColumn<QPoint>("from");
    QTest::addColumn<Points>("moves");
    QTest::addColumn<QRect>("selection");
    QTest::addColumn<QRect>("band");

    QTest::newRow("down and right, longer than the band")
        << QPoint(10, 10) << Points{{200, 150}} << QRect(QPoint(10, 10), QPoint(200, 150)) << QRect(10, 10, 55, 55);
    QTest::newRow("up and left, longer than the band")
        << QPoint(200, 150) << Points{{10, 10}} << QRect(QPoint(10, 10), QPoint(200, 150)) << QRect(10, 10, 55, 55);
    QTest::newRow("up and right")
        << QPoint(20, 150) << Points{{60, 120}} << QRect(QPoint(20, 120), QPoint(60, 150)) << QRect(20, 120, 41, 31);
    QTest::newRow("down and left")
        << QPoint(150, 20) << Points{{100, 60}} << QRect(QPoint(100, 20), QPoint(150, 60)) << QRect(100, 20, 51, 41);
    QTest::newRow("tall and narrow, cut to 55 high")
        << QPoint(10, 10) << Points{{20, 280}} << QRect(QPoint(10, 10), QPoint(20, 280)) << QRect(10, 10, 11, 55);
    QTest::newRow("the last of several moves counts")
        << QPoint(10, 10) << Points{{100, 100}, {5, 3}, {30, 20}} << QRect(QPoint(10, 10), QPoint(30, 20))
        << QRect(10, 10, 21, 11);
    // The press alone leaves the end point at the origin of the viewport.
    QTest::newRow("press without a move")
        << QPoint(100, 80) << Points{} << QRect(QPoint(0, 0), QPoint(100, 80)) << QRect(100, 80, 0, 0);
}

void tst_SchematicGraphicsView::dragGivesSelectionAndBand()
{
    QFETCH(QPoint, from);
    QFETCH(Points, moves);
    QFETCH(QRect, selection);
    QFETCH(QRect, band);
    m_view->setBandVisible(true);

    drag(from, moves);

    QCOMPARE(m_view->selectionRect(), selection);
    QCOMPARE(m_view->bandTopLeft(), band.topLeft());
    QCOMPARE(m_view->bandSize(), band.size());
    QCOMPARE(this->band()->geometry().size(), band.size());
}

void tst_SchematicGraphicsView::bandIsShownOnlyWhenVisible_data()
{
    QTest::addColumn<bool>("visible");
    QTest::addColumn<int>("button");
    QTest::newRow("visible, left button") << true << int(Qt::LeftButton);
    QTest::newRow("visible, right button") << true << int(Qt::RightButton);
    QTest::newRow("hidden") << false << int(Qt::LeftButton);
}

// A hidden band still follows the mouse, so that showing it later shows the
// latest drag; it just is not drawn.
void tst_SchematicGraphicsView::bandIsShownOnlyWhenVisible()
{
    QFETCH(bool, visible);
    QFETCH(int, button);
    m_view->setBandVisible(visible);

    drag(QPoint(30, 40), Points{{60, 70}}, Qt::MouseButton(button));

    QCOMPARE(band()->isVisible(), visible);
    QCOMPARE(m_view->bandTopLeft(), QPoint(30, 40));
    QCOMPARE(m_view->bandSize(), QSize(31, 31));
    QCOMPARE(m_view->selectionRect(), QRect(QPoint(30, 40), QPoint(60, 70)));
}

void tst_SchematicGraphicsView::movesWithoutAPressedButtonChangeNothing()
{
    m_view->setBandVisible(true);
    moveMouse(m_view->viewport(), QPoint(90, 90), Qt::NoButton);
    QCOMPARE(m_view->selectionRect(), QRect(QPoint(0, 0), QPoint(0, 0)));

    drag(QPoint(10, 20), Points{{40, 50}});
    moveMouse(m_view->viewport(), QPoint(150, 120), Qt::NoButton);
    moveMouse(m_view->viewport(), QPoint(5, 5), Qt::LeftButton);

    QCOMPARE(m_view->selectionRect(), QRect(QPoint(10, 20), QPoint(40, 50)));
    QCOMPARE(m_view->bandTopLeft(), QPoint(10, 20));
    QCOMPARE(m_view->bandSize(), QSize(31, 31));
}

// After an area was taken nothing is selected: the band is empty, so taking
// an area again takes nothing until the next drag.
void tst_SchematicGraphicsView::resetLeavesAnEmptyBandAtTheOrigin()
{
    m_view->setBandVisible(true);
    drag(QPoint(10, 20), Points{{40, 50}});

    m_view->resetBand();

    QCOMPARE(m_view->bandTopLeft(), QPoint(0, 0));
    QVERIFY(m_view->bandSize().isEmpty());
    QCOMPARE(m_view->selectionRect(), QRect(QPoint(0, 0), QPoint(0, 0)));
}

QC_TEST_MAIN(tst_SchematicGraphicsView)
#include "tst_schematicgraphicsview.moc"
