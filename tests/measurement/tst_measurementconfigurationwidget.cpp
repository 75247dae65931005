#include "tests/common/TestMain.h"
#include "tests/common/ModalAnswer.h"

#include "host/client/GeneralSettings.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/ObjectCodec.h"
#include "host/domain/Property.h"
#include "host/instruments/InstrumentManager.h"
#include "host/instruments/MeasurementConditions.h"
#include "host/widgets/MeasurementConditionsWidget.h"
#include "measurement/MeasurementConfigurationWidget.h"

#include <QAbstractButton>
#include <QComboBox>
#include <QDialog>
#include <QLineEdit>

using namespace vemi;

namespace {

// "Key=Value" for each property, in stored order.
QStringList propertyTexts(const MeasurementConfiguration& configuration)
{
    QStringList texts;
    for (const auto& property : configuration.properties())
        texts << QString::fromStdString(property->key() + "=" + property->value());
    return texts;
}

std::shared_ptr<MeasurementConfiguration> configuration(const std::string& model, const QStringList& properties,
                                                        const std::string& name = "Stored")
{
    auto result = std::make_shared<MeasurementConfiguration>();
    result->setName(name);
    result->setDescription("Stored description");
    result->setInstrumentModel(model);
    std::vector<std::shared_ptr<Property>> list;
    for (const QString& text : properties)
        list.push_back(std::make_shared<Property>(text.section('=', 0, 0).toStdString(),
                                                  text.section('=', 1).toStdString()));
    result->setProperties(list);
    return result;
}

// Closes and records any modal dialog where none is expected, so that an
// unexpected warning fails the test instead of blocking it.
class UnexpectedModals
{
public:
    UnexpectedModals()
    {
        QObject::connect(&m_timer, &QTimer::timeout, [this]() {
            if (auto* dialog = qobject_cast<QDialog*>(QApplication::activeModalWidget())) {
                m_titles << dialog->windowTitle();
                dialog->reject();
            }
        });
        m_timer.start(20);
    }
    const QStringList& titles() const { return m_titles; }

private:
    QTimer m_timer;
    QStringList m_titles;
};

} // namespace

class tst_MeasurementConfigurationWidget : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();

    void startsEmptyWithEveryDriverListed();
    void loadsDefaultsBeforeStoredProperties_data();
    void loadsDefaultsBeforeStoredProperties();
    void sameInstrumentStartsFromItsDefaults();
    void missingDriverKeepsWhatIsStored_data();
    void missingDriverKeepsWhatIsStored();
    void writingBackTwiceGivesTheSameContent();

private:
    QComboBox* instruments() const { return m_widget->findChild<QComboBox*>("instrumentComboBox"); }
    MeasurementConditionsWidget* conditionsWidget() const { return m_widget->findChild<MeasurementConditionsWidget*>(); }

    std::unique_ptr<MeasurementConfigurationWidget> m_widget;
};

void tst_MeasurementConfigurationWidget::init()
{
    m_widget = std::make_unique<MeasurementConfigurationWidget>(
        std::make_shared<GeneralSettings>(std::vector<std::string>{""}, "D50", "2"));
}

void tst_MeasurementConfigurationWidget::cleanup()
{
    m_widget.reset();
}

void tst_MeasurementConfigurationWidget::startsEmptyWithEveryDriverListed()
{
    QStringList listed;
    for (int index = 0; index < instruments()->count(); ++index)
        listed << instruments()->itemData(index).toString();
    QCOMPARE(listed, (QStringList{"simcolor45", "simcolorsphere", "simgloss60"}));
    QCOMPARE(instruments()->currentIndex(), -1);
    QVERIFY(!instruments()->isEnabled());
    QVERIFY(!m_widget->findChild<QLineEdit*>("descLineEdit")->isEnabled());
    QVERIFY(!conditionsWidget()->measurementConditions());
    QVERIFY(!m_widget->measurementConfiguration());
}

void tst_MeasurementConfigurationWidget::loadsDefaultsBeforeStoredProperties_data()
{
    QTest::addColumn<QString>("model");
    QTest::addColumn<QStringList>("stored");
    QTest::addColumn<QStringList>("written"); // every setting of the instrument, in its order

    QTest::newRow("sphere: user's defaults, then the stored values")
        << "simcolorsphere" << QStringList{"Aperture=6 mm", "Illuminant=A"}
        << QStringList{"Illuminant=A", "Observer=2", "Specular Component=Included", "Aperture=6 mm", "UV Filter=Off"};
    QTest::newRow("45/0: a stored observer overrides the user's default")
        << "simcolor45" << QStringList{"Observer=10"} << QStringList{"Illuminant=D50", "Observer=10", "Aperture=8 mm"};
    QTest::newRow("45/0: a key of another instrument is dropped")
        << "simcolor45" << QStringList{"UV Filter=UV cut 400 nm"}
        << QStringList{"Illuminant=D50", "Observer=2", "Aperture=8 mm"};
    QTest::newRow("no instrument model: no conditions") << "" << QStringList{"Illuminant=A"} << QStringList{};
}

void tst_MeasurementConfigurationWidget::loadsDefaultsBeforeStoredProperties()
{
    QFETCH(QString, model);
    QFETCH(QStringList, stored);
    QFETCH(QStringList, written);
    UnexpectedModals modals;

    const auto config = configuration(model.toStdString(), stored);
    m_widget->setMeasurementConfiguration(config);
    QCOMPARE(instruments()->currentData().toString(), model);
    QCOMPARE(bool(conditionsWidget()->measurementConditions()), !model.isEmpty());

    QCOMPARE(m_widget->measurementConfiguration(), config);
    QCOMPARE(propertyTexts(*config), written);
    QCOMPARE(QString::fromStdString(config->instrumentModel()), model);
    QCOMPARE(modals.titles(), QStringList());
}

// A configuration that lists fewer settings than the one shown before must
// not inherit the earlier configuration's values.
void tst_MeasurementConfigurationWidget::sameInstrumentStartsFromItsDefaults()
{
    UnexpectedModals modals;
    m_widget->setMeasurementConfiguration(
        configuration("simcolorsphere", {"Aperture=6 mm", "UV Filter=UV cut 400 nm", "Observer=10"}, "First"));
    const auto second = configuration("simcolorsphere", {"Illuminant=C"}, "Second");
    m_widget->setMeasurementConfiguration(second);

    QCOMPARE(propertyTexts(*m_widget->measurementConfiguration()),
             (QStringList{"Illuminant=C", "Observer=2", "Specular Component=Included", "Aperture=12 mm",
                          "UV Filter=Off"}));
    QCOMPARE(modals.titles(), QStringList());
}

void tst_MeasurementConfigurationWidget::missingDriverKeepsWhatIsStored_data()
{
    QTest::addColumn<QString>("model");
    QTest::addColumn<QString>("warningTitle"); // empty: no warning

    QTest::newRow("listed driver that is not installed") << "simgloss60" << "SimGloss 60 (simulated)";
    QTest::newRow("model no driver lists") << "retired-spectro" << "";
}

void tst_MeasurementConfigurationWidget::missingDriverKeepsWhatIsStored()
{
    QFETCH(QString, model);
    QFETCH(QString, warningTitle);
    const QStringList stored{"Gloss Angle=60", "Illuminant=A"};
    // A sphere configuration first, so that there are conditions to lose.
    m_widget->setMeasurementConfiguration(configuration("simcolorsphere", {}));

    const auto config = configuration(model.toStdString(), stored);
    QString warning;
    if (warningTitle.isEmpty()) {
        UnexpectedModals modals;
        m_widget->setMeasurementConfiguration(config);
        QCOMPARE(modals.titles(), QStringList());
    } else {
        ModalAnswer::actOnNextModal([&warning](QWidget* box) {
            warning = box->windowTitle() + ": " + static_cast<QMessageBox*>(box)->text();
            static_cast<QMessageBox*>(box)->button(QMessageBox::Ok)->click();
        });
        m_widget->setMeasurementConfiguration(config);
        QCOMPARE(warning, warningTitle + ": Instrument driver not installed.");
    }
    QVERIFY(!conditionsWidget()->measurementConditions());

    m_widget->findChild<QLineEdit*>("descLineEdit")->setText("Edited");
    m_widget->measurementConfiguration();
    QCOMPARE(config->description(), std::string("Edited"));
    QCOMPARE(QString::fromStdString(config->instrumentModel()), model);
    QCOMPARE(propertyTexts(*config), stored);

    // Choosing an instrument makes its conditions the ones written back.
    instruments()->setCurrentIndex(instruments()->findData("simcolor45"));
    m_widget->measurementConfiguration();
    QCOMPARE(config->instrumentModel(), std::string("simcolor45"));
    QCOMPARE(propertyTexts(*config), (QStringList{"Illuminant=D50", "Observer=2", "Aperture=8 mm"}));
}

void tst_MeasurementConfigurationWidget::writingBackTwiceGivesTheSameContent()
{
    UnexpectedModals modals;
    const auto config = configuration("simcolorsphere", {"Illuminant=F11"});
    m_widget->setMeasurementConfiguration(config);
    auto* aperture = conditionsWidget()->findChild<QComboBox*>("Aperture");
    QVERIFY(aperture);
    aperture->setCurrentText("6 mm");
    m_widget->findChild<QLineEdit*>("descLineEdit")->setText("Large parts");

    const QByteArray first = ObjectCodec::serialize(*m_widget->measurementConfiguration());
    const QByteArray second = ObjectCodec::serialize(*m_widget->measurementConfiguration());
    QCOMPARE(second, first);
    QCOMPARE(propertyTexts(*config), (QStringList{"Illuminant=F11", "Observer=2", "Specular Component=Included",
                                                  "Aperture=6 mm", "UV Filter=Off"}));
    QCOMPARE(config->description(), std::string("Large parts"));
}

QC_TEST_MAIN(tst_MeasurementConfigurationWidget)
#include "tst_measurementconfigurationwidget.moc"
