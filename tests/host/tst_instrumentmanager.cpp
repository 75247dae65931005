#include "tests/common/TestMain.h"

#include "host/client/BaseSetting.h"
#include "host/client/SettingsGroup.h"
#include "host/client/SettingsList.h"
#include "host/client/SettingsSection.h"
#include "host/instruments/Instrument.h"
#include "host/instruments/InstrumentDriverInfo.h"
#include "host/instruments/InstrumentManager.h"
#include "host/instruments/MeasurementConditions.h"

using vemi::InstrumentManager;
using vemi::MeasurementConditions;

namespace {

QStringList settingNames(const MeasurementConditions& conditions)
{
    QStringList names;
    for (const auto& group : conditions.settings()->groups())
        for (const auto& section : group->sections())
            for (const auto& setting : section->settings())
                names << QString::fromStdString(setting->name());
    return names;
}

} // namespace

class tst_InstrumentManager : public QObject
{
    Q_OBJECT

private slots:
    void instrumentByLibraryName_data();
    void instrumentByLibraryName();
    void conditionsAreFreshAtEachCall();
    void valuesAndDefaults_data();
    void valuesAndDefaults();
    void signalsCarryTheInstrument();
};

void tst_InstrumentManager::instrumentByLibraryName_data()
{
    QTest::addColumn<QString>("libraryName");
    QTest::addColumn<QString>("model"); // empty: no instrument

    QTest::newRow("directional instrument") << "simcolor45" << "SimColor 45/0";
    QTest::newRow("sphere instrument") << "simcolorsphere" << "SimColor Sphere d/8";
    QTest::newRow("listed driver that is not installed") << "simgloss60" << "";
    QTest::newRow("display name instead of library name") << "SimColor 45/0 (simulated)" << "";
    QTest::newRow("library name differing in case") << "SIMCOLOR45" << "";
    QTest::newRow("empty name") << "" << "";
}

void tst_InstrumentManager::instrumentByLibraryName()
{
    QFETCH(QString, libraryName);
    QFETCH(QString, model);

    const auto instrument = InstrumentManager::instance()->instrument(libraryName);
    QCOMPARE(bool(instrument), !model.isEmpty());
    if (instrument) {
        QCOMPARE(instrument->modelName(), model);
        QCOMPARE(InstrumentManager::instance()->instrument(libraryName), instrument);
        // Every installed driver is also listed.
        bool listed = false;
        for (const auto& driver : InstrumentManager::instance()->supportedInstruments())
            listed = listed || driver->libraryName() == libraryName;
        QVERIFY(listed);
    }
}

void tst_InstrumentManager::conditionsAreFreshAtEachCall()
{
    const auto instrument = InstrumentManager::instance()->instrument("simcolorsphere");
    const auto first = instrument->measurementConditions();
    first->setSettingValue("Illuminant", "A");

    const auto second = instrument->measurementConditions();
    QVERIFY(second != first);
    QCOMPARE(second->settingValue("Illuminant"), QStringLiteral("D65"));
}

void tst_InstrumentManager::valuesAndDefaults_data()
{
    QTest::addColumn<QString>("defaultValue"); // empty: no new default
    QTest::addColumn<QString>("value");        // empty: not set
    QTest::addColumn<QString>("expected");

    QTest::newRow("the instrument's default") << "" << "" << "D65";
    QTest::newRow("a new default") << "D50" << "" << "D50";
    QTest::newRow("a set value wins over a new default") << "D50" << "F11" << "F11";
}

void tst_InstrumentManager::valuesAndDefaults()
{
    QFETCH(QString, defaultValue);
    QFETCH(QString, value);
    QFETCH(QString, expected);

    const auto conditions = InstrumentManager::instance()->instrument("simcolor45")->measurementConditions();
    if (!value.isEmpty())
        conditions->setSettingValue("Illuminant", value);
    if (!defaultValue.isEmpty())
        conditions->setDefaultSettingValue("Illuminant", defaultValue);

    QCOMPARE(conditions->settingValue("Illuminant"), expected);
    // A key the instrument lacks is neither stored nor listed.
    conditions->setSettingValue("Gloss Angle", "60");
    QVERIFY(conditions->settingValue("Gloss Angle").isEmpty());
    QVERIFY(!settingNames(*conditions).contains("Gloss Angle"));
}

void tst_InstrumentManager::signalsCarryTheInstrument()
{
    InstrumentManager* manager = InstrumentManager::instance();
    // Connected by signature, as a client connects them.
    QSignalSpy connected(manager, SIGNAL(sgInstrumentConnected(std::shared_ptr<vemi::Instrument>)));
    QSignalSpy disconnected(manager, SIGNAL(sgInstrumentDisconnected(std::shared_ptr<vemi::Instrument>)));
    QSignalSpy preferred(manager, SIGNAL(sgPreferredInstrumentChanged(std::shared_ptr<vemi::Instrument>)));
    QVERIFY(connected.isValid() && disconnected.isValid() && preferred.isValid());
    const auto sphere = manager->instrument("simcolorsphere");

    QVERIFY(manager->connectInstrument("simcolorsphere"));
    QVERIFY(!manager->connectInstrument("simcolorsphere"));
    QVERIFY(!manager->connectInstrument("simgloss60"));
    QVERIFY(manager->setPreferredInstrument("simcolorsphere"));
    QVERIFY(!manager->setPreferredInstrument("simcolorsphere"));
    QVERIFY(manager->disconnectInstrument("simcolorsphere"));
    QVERIFY(!manager->disconnectInstrument("simcolorsphere"));

    QCOMPARE(connected.count(), 1);
    QCOMPARE(preferred.count(), 1);
    QCOMPARE(disconnected.count(), 1);
    QCOMPARE(connected.first().at(0).value<std::shared_ptr<vemi::Instrument>>(), sphere);
    QCOMPARE(preferred.first().at(0).value<std::shared_ptr<vemi::Instrument>>(), sphere);
    QCOMPARE(disconnected.first().at(0).value<std::shared_ptr<vemi::Instrument>>(), sphere);
}

QC_TEST_GUILESS_MAIN(tst_InstrumentManager)
#include "tst_instrumentmanager.moc"
