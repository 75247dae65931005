#include "tests/common/TestMain.h"

#include "colour/CieTables.h"
#include "colour/SpectralToLab.h"
#include "host/domain/ColorimetricCondition.h"

#include <cmath>
#include <vector>

using namespace vemi;

namespace {

std::vector<double> everyTenNm() // 380 … 730 nm, as instruments commonly report
{
    std::vector<double> wavelengths;
    for (int nm = 380; nm <= 730; nm += 10)
        wavelengths.push_back(nm);
    return wavelengths;
}

} // namespace

class tst_SpectralToLab : public QObject
{
    Q_OBJECT

private slots:
    void whitesMatchPublishedValues_data();
    void whitesMatchPublishedValues();
    void flatSpectraAreNeutral_data();
    void flatSpectraAreNeutral();
    void refusesWhatHasNoTable();
};

// The tristimulus values of each illuminant's perfect reflector, as ASTM E308
// and CIE 15 publish them. A wrong entry in a colour-matching function or an
// illuminant moves them, so this pins the tables.
void tst_SpectralToLab::whitesMatchPublishedValues_data()
{
    QTest::addColumn<QString>("illuminant");
    QTest::addColumn<QString>("observer");
    QTest::addColumn<double>("X");
    QTest::addColumn<double>("Z");
    QTest::newRow("D65/2") << "D65" << "2" << 95.047 << 108.883;
    QTest::newRow("D65/10") << "D65" << "10" << 94.811 << 107.304;
    QTest::newRow("D50/2") << "D50" << "2" << 96.422 << 82.521;
    QTest::newRow("D50/10") << "D50" << "10" << 96.720 << 81.427;
    QTest::newRow("A/2") << "A" << "2" << 109.850 << 35.585;
    QTest::newRow("A/10") << "A" << "10" << 111.144 << 35.200;
    QTest::newRow("F2/2") << "F2" << "2" << 99.187 << 67.395;
    QTest::newRow("F2/10") << "F2" << "10" << 103.280 << 69.026;
    QTest::newRow("F11/2") << "F11" << "2" << 100.966 << 64.370;
    QTest::newRow("F11/10") << "F11" << "10" << 103.866 << 65.627;
    QTest::newRow("D55/2") << "D55" << "2" << 95.682 << 92.149;
    QTest::newRow("D75/2") << "D75" << "2" << 94.972 << 122.638;
}

void tst_SpectralToLab::whitesMatchPublishedValues()
{
    QFETCH(QString, illuminant);
    QFETCH(QString, observer);
    QFETCH(double, X);
    QFETCH(double, Z);
    const auto converter =
        SpectralToLab::create(ColorimetricCondition(illuminant.toStdString(), observer.toStdString()), everyTenNm());
    QVERIFY(converter);
    const std::vector<double> perfect(everyTenNm().size(), 1.0);
    const auto xyz = converter->xyz(perfect.data());
    // The published values are summed every nanometre, these every 5 nm.
    QVERIFY2(std::abs(xyz[0] - X) < 0.05, qPrintable(QString::number(xyz[0], 'f', 3)));
    QVERIFY2(std::abs(xyz[1] - 100.0) < 1e-9, qPrintable(QString::number(xyz[1], 'f', 3)));
    QVERIFY2(std::abs(xyz[2] - Z) < 0.05, qPrintable(QString::number(xyz[2], 'f', 3)));
}

// A spectrum that reflects every wavelength alike is grey under any light:
// a = b = 0, and L follows from Y alone (the perfect reflector is L = 100).
void tst_SpectralToLab::flatSpectraAreNeutral_data()
{
    QTest::addColumn<QString>("condition");
    QTest::addColumn<double>("reflectance");
    QTest::addColumn<double>("L");
    QTest::newRow("perfect reflector, D65/10") << "D65/10" << 1.0 << 100.0;
    QTest::newRow("perfect reflector, F11/2") << "F11/2" << 1.0 << 100.0;
    QTest::newRow("half grey, D50/2") << "D50/2" << 0.5 << 116.0 * std::cbrt(0.5) - 16.0;
    QTest::newRow("dark grey, A/10") << "A/10" << 0.005 << 903.2962963 * 0.005;
}

void tst_SpectralToLab::flatSpectraAreNeutral()
{
    QFETCH(QString, condition);
    QFETCH(double, reflectance);
    QFETCH(double, L);
    const QStringList parts = condition.split('/');
    // A spectrum narrower than the tables: its ends are carried outwards.
    std::vector<double> wavelengths = {400, 420, 460, 500, 550, 600, 650, 700};
    const auto converter =
        SpectralToLab::create(ColorimetricCondition(parts[0].toStdString(), parts[1].toStdString()), wavelengths);
    QVERIFY(converter);
    const std::vector<double> spectrum(wavelengths.size(), reflectance);
    const auto lab = converter->lab(spectrum.data());
    QVERIFY2(std::abs(lab[0] - L) < 1e-6, qPrintable(QString::number(lab[0], 'f', 6)));
    QVERIFY2(std::abs(lab[1]) < 1e-6 && std::abs(lab[2]) < 1e-6,
             qPrintable(QStringLiteral("%1 %2").arg(lab[1]).arg(lab[2])));
}

void tst_SpectralToLab::refusesWhatHasNoTable()
{
    QVERIFY(!SpectralToLab::create(ColorimetricCondition("D93", "10"), everyTenNm()));
    QVERIFY(!SpectralToLab::create(ColorimetricCondition("D65", "4"), everyTenNm()));
    QVERIFY(!SpectralToLab::create(ColorimetricCondition("D65", "10"), {500.0, 500.0, 510.0}));
    QVERIFY(!SpectralToLab::create(ColorimetricCondition("D65", "10"), {500.0}));
}

QC_TEST_MAIN(tst_SpectralToLab)
#include "tst_spectraltolab.moc"
