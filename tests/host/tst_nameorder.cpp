#include "tests/common/TestMain.h"

#include "host/widgets/NameOrder.h"

#include <algorithm>

using vemi::NameOrder;

class tst_NameOrder : public QObject
{
    Q_OBJECT

private slots:
    void sortsAsPeopleRead_data();
    void sortsAsPeopleRead();
    void namesEqualButForCaseKeepAFixedOrder();
};

void tst_NameOrder::sortsAsPeopleRead_data()
{
    QTest::addColumn<QLocale>("locale");
    QTest::addColumn<QStringList>("names");
    QTest::addColumn<QStringList>("expected");

    const QStringList parts{"Part 10", "part 2", "Ärmel", "Zierleiste", "Öse", "Part 1", "Part 100", "Part 11"};
    const QStringList partsInOrder{"Ärmel", "Öse", "Part 1", "part 2", "Part 10", "Part 11", "Part 100", "Zierleiste"};
    QTest::newRow("German") << QLocale(QLocale::German, QLocale::Germany) << parts << partsInOrder;
    QTest::newRow("C locale collates as English") << QLocale::c() << parts << partsInOrder;
    // Swedish puts Ä and Ö after Z, as its readers expect.
    QTest::newRow("Swedish") << QLocale(QLocale::Swedish, QLocale::Sweden)
                             << QStringList{"Öse", "Zierleiste", "Ärmel", "Ansats"}
                             << QStringList{"Ansats", "Zierleiste", "Ärmel", "Öse"};
    QTest::newRow("numbers inside names") << QLocale::c()
                                          << QStringList{"Door 2 rev 10", "Door 10 rev 1", "Door 2 rev 9"}
                                          << QStringList{"Door 2 rev 9", "Door 2 rev 10", "Door 10 rev 1"};
}

void tst_NameOrder::sortsAsPeopleRead()
{
    QFETCH(QLocale, locale);
    QFETCH(QStringList, names);
    QFETCH(QStringList, expected);

    const NameOrder order(locale);
    std::sort(names.begin(), names.end(), [&order](const QString& a, const QString& b) { return order.lessThan(a, b); });
    QCOMPARE(names, expected);
}

void tst_NameOrder::namesEqualButForCaseKeepAFixedOrder()
{
    const NameOrder order(QLocale::c());
    QVERIFY(order.lessThan("Bumper", "bumper") != order.lessThan("bumper", "Bumper"));
    QVERIFY(!order.lessThan("Bumper", "Bumper"));
}

QC_TEST_MAIN(tst_NameOrder)
#include "tst_nameorder.moc"
