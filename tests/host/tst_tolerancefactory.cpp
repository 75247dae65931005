#include "tests/common/TestMain.h"

#include "host/client/ToleranceFactory.h"
#include "host/domain/ColorimetricCondition.h"
#include "host/domain/LabToleranceBase.h"
#include "host/domain/ToleranceSet.h"

using vemi::ColorimetricCondition;
using vemi::LabToleranceBase;
using vemi::Tolerance;
using vemi::ToleranceFactory;
using vemi::ToleranceSet;

namespace {

std::shared_ptr<Tolerance> tolerance(const QString& kind)
{
    if (kind == "plain")
        return std::make_shared<Tolerance>();
    auto lab = std::make_shared<LabToleranceBase>();
    lab->setMethod("dECMC");
    if (kind != "lab")
        lab->setColorimetricCondition(std::make_shared<ColorimetricCondition>(
            kind.section('/', 0, 0).toStdString(), kind.section('/', 1).toStdString()));
    return lab;
}

} // namespace

class tst_ToleranceFactory : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void buildsConditionsOfLabTolerances_data();
    void buildsConditionsOfLabTolerances();
    void leavesTheStoredSetAlone();
};

void tst_ToleranceFactory::initTestCase()
{
    QSettings settings;
    settings.setValue("General/Illuminant", "F11");
    settings.setValue("General/Observer", "2");
}

void tst_ToleranceFactory::buildsConditionsOfLabTolerances_data()
{
    // Each tolerance: "plain", "lab" (no condition) or "lab" with a condition "D50/2".
    QTest::addColumn<QStringList>("kinds");
    // The built tolerances' conditions; "-" for one that is not a Lab tolerance.
    QTest::addColumn<QStringList>("expected");

    QTest::newRow("a Lab tolerance keeps its own condition") << QStringList{"D50/2"} << QStringList{"D50/2"};
    QTest::newRow("a Lab tolerance without one gets the user's default") << QStringList{"lab"}
                                                                          << QStringList{"F11/2"};
    QTest::newRow("a plain tolerance stays plain, in its place")
        << QStringList{"plain", "A/10", "lab"} << QStringList{"-", "A/10", "F11/2"};
    QTest::newRow("condition text kept exactly, case and blanks included") << QStringList{"d65 /10"}
                                                                           << QStringList{"d65 /10"};
    QTest::newRow("a set without tolerances") << QStringList{} << QStringList{};
}

void tst_ToleranceFactory::buildsConditionsOfLabTolerances()
{
    QFETCH(QStringList, kinds);
    QFETCH(QStringList, expected);

    auto set = std::make_shared<ToleranceSet>();
    std::vector<std::shared_ptr<Tolerance>> tolerances;
    for (const QString& kind : kinds)
        tolerances.push_back(tolerance(kind));
    set->setTolerances(tolerances);

    const auto built = ToleranceFactory::toleranceFactory()->buildToleranceSet(set);
    QVERIFY(built);
    QCOMPARE(built->id(), set->id());
    QStringList conditions;
    for (const auto& builtTolerance : built->tolerances()) {
        // Read through the base class, as a caller holding any tolerance does.
        const auto lab = std::dynamic_pointer_cast<LabToleranceBase>(builtTolerance);
        if (!lab) {
            conditions << "-";
            continue;
        }
        QVERIFY(lab->colorimetricCondition());
        conditions << QString::fromStdString(lab->colorimetricCondition()->toString());
    }
    QCOMPARE(conditions, expected);
}

void tst_ToleranceFactory::leavesTheStoredSetAlone()
{
    auto set = std::make_shared<ToleranceSet>();
    const auto lab = std::static_pointer_cast<LabToleranceBase>(tolerance("lab"));
    set->setTolerances({lab});

    const auto built = ToleranceFactory::toleranceFactory()->buildToleranceSet(set);

    QVERIFY(built != set);
    QVERIFY(built->tolerances().front() != lab);
    QVERIFY(!lab->colorimetricCondition());
    QCOMPARE(set->tolerances().size(), size_t(1));
    QVERIFY(!ToleranceFactory::toleranceFactory()->buildToleranceSet(nullptr));
}

QC_TEST_GUILESS_MAIN(tst_ToleranceFactory)
#include "tst_tolerancefactory.moc"
