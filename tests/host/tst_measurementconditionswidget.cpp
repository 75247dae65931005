#include "tests/common/TestMain.h"

#include "host/instruments/Instrument.h"
#include "host/instruments/InstrumentManager.h"
#include "host/instruments/MeasurementConditions.h"
#include "host/widgets/MeasurementConditionsWidget.h"

#include <QComboBox>
#include <QLabel>
#include <QLineEdit>

using namespace vemi;

class tst_MeasurementConditionsWidget : public QObject
{
    Q_OBJECT

private slots:
    void fieldsFollowTheInstrument_data();
    void fieldsFollowTheInstrument();
    void editsGoIntoTheObjectShown();
    void freeTextSettingAndStrangeStoredValue();
};

void tst_MeasurementConditionsWidget::fieldsFollowTheInstrument_data()
{
    QTest::addColumn<QString>("libraryName");
    QTest::addColumn<QStringList>("fields");
    QTest::newRow("45/0") << "simcolor45" << QStringList{"Illuminant", "Observer", "Aperture"};
    QTest::newRow("sphere") << "simcolorsphere"
                            << QStringList{"Illuminant", "Observer", "Specular Component", "Aperture", "UV Filter"};
}

void tst_MeasurementConditionsWidget::fieldsFollowTheInstrument()
{
    QFETCH(QString, libraryName);
    QFETCH(QStringList, fields);
    MeasurementConditionsWidget widget;
    // Another instrument first: its fields must all go.
    widget.setMeasurementConditions(InstrumentManager::instance()->instrument("simcolorsphere")->measurementConditions());
    widget.setMeasurementConditions(InstrumentManager::instance()->instrument(libraryName)->measurementConditions());

    QStringList shown;
    for (auto* box : widget.findChildren<QComboBox*>())
        shown << box->objectName();
    QCOMPARE(shown, fields);

    widget.setMeasurementConditions(nullptr);
    QVERIFY(widget.findChildren<QComboBox*>().isEmpty());
    QVERIFY(!widget.measurementConditions());
}

void tst_MeasurementConditionsWidget::editsGoIntoTheObjectShown()
{
    const auto conditions = InstrumentManager::instance()->instrument("simcolorsphere")->measurementConditions();
    conditions->setSettingValue("Aperture", "6 mm");
    MeasurementConditionsWidget widget;
    widget.setMeasurementConditions(conditions);
    auto* aperture = widget.findChild<QComboBox*>("Aperture");
    QCOMPARE(aperture->currentText(), QStringLiteral("6 mm"));
    QCOMPARE(aperture->count(), 2);

    widget.findChild<QComboBox*>("UV Filter")->setCurrentText("UV cut 400 nm");
    QCOMPARE(conditions->settingValue("UV Filter"), QStringLiteral("UV cut 400 nm"));
    QCOMPARE(widget.measurementConditions(), conditions);
}

void tst_MeasurementConditionsWidget::freeTextSettingAndStrangeStoredValue()
{
    auto conditions = std::make_shared<MeasurementConditions>("Test");
    conditions->addSetting("Comment", "none");
    conditions->addSetting("Aperture", "8 mm", {"4 mm", "8 mm"});
    conditions->setSettingValue("Aperture", "5 mm"); // from an older driver
    MeasurementConditionsWidget widget;
    widget.setMeasurementConditions(conditions);

    auto* comment = widget.findChild<QLineEdit*>("Comment");
    QVERIFY(comment);
    QTest::keyClicks(comment, "!");
    QCOMPARE(conditions->settingValue("Comment"), QStringLiteral("none!"));
    // Shown as stored, not silently replaced by an allowed value.
    QCOMPARE(widget.findChild<QComboBox*>("Aperture")->currentText(), QStringLiteral("5 mm"));
    QCOMPARE(conditions->settingValue("Aperture"), QStringLiteral("5 mm"));
}

QC_TEST_MAIN(tst_MeasurementConditionsWidget)
#include "tst_measurementconditionswidget.moc"
