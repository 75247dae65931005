#include "tests/common/TestMain.h"

#include "host/domain/RGBValue.h"
#include "host/widgets/UIHelper.h"

class tst_UIHelper : public QObject
{
    Q_OBJECT

private slots:
    void toColor_data();
    void toColor();
};

void tst_UIHelper::toColor_data()
{
    QTest::addColumn<int>("red");
    QTest::addColumn<int>("green");
    QTest::addColumn<int>("blue");
    QTest::addColumn<QColor>("expected");

    QTest::newRow("channels kept in their own places") << 12 << 130 << 250 << QColor(12, 130, 250);
    QTest::newRow("black and white ends kept") << 0 << 255 << 0 << QColor(0, 255, 0);
    QTest::newRow("negative channels clamped to zero") << -1 << -300 << 5 << QColor(0, 0, 5);
    QTest::newRow("channels above 255 clamped to 255") << 256 << 1000 << 255 << QColor(255, 255, 255);
}

void tst_UIHelper::toColor()
{
    QFETCH(int, red);
    QFETCH(int, green);
    QFETCH(int, blue);
    QFETCH(QColor, expected);

    const QColor color = vemi::UIHelper::toColor(vemi::RGBValue(red, green, blue));
    QVERIFY(color.isValid());
    QCOMPARE(color, expected);
    QCOMPARE(color.alpha(), 255);
}

QC_TEST_GUILESS_MAIN(tst_UIHelper)
#include "tst_uihelper.moc"
