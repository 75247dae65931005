#pragma once

#include <QWidget>

#include <memory>
#include <string>
#include <vector>

namespace Ui {
class MeasurementConfigurationWidget;
}

namespace vemi {

class GeneralSettings;
class MeasurementConditions;
class MeasurementConditionsWidget;
class MeasurementConfiguration;
class Property;

// Edits one measurement configuration: its description, the instrument model
// (a driver's library name) and that instrument's measurement conditions,
// which the configuration stores as key/value properties. Edits stay in the
// fields until measurementConfiguration() writes them into the configuration.
class MeasurementConfigurationWidget : public QWidget
{
    Q_OBJECT

public:
    // settings: the user's default illuminant and observer; may be empty.
    MeasurementConfigurationWidget(std::shared_ptr<GeneralSettings> settings, QWidget* parent = nullptr);
    ~MeasurementConfigurationWidget() override;

    // Shows config, shared with the caller; an empty handle is ignored.
    void setMeasurementConfiguration(std::shared_ptr<MeasurementConfiguration> config);
    // Writes the edits into the configuration shown and returns it; empty
    // when none was shown.
    std::shared_ptr<MeasurementConfiguration> measurementConfiguration();
    void setConfigurationName(const std::string& name);

protected:
    void changeEvent(QEvent* event) override;

private slots:
    void onInstrumentModelChanged(int index);

private:
    std::shared_ptr<MeasurementConditions> conditionsWithDefaults(const QString& libraryName) const;
    void selectInstrumentModel(const QString& libraryName);
    int indexOfLibrary(const QString& libraryName) const;
    void fillInstrumentList();
    std::vector<std::shared_ptr<Property>> currentProperties() const;

    Ui::MeasurementConfigurationWidget* m_ui;
    std::shared_ptr<GeneralSettings> m_generalSettings;
    MeasurementConditionsWidget* m_conditionsWidget;
    std::shared_ptr<MeasurementConfiguration> m_configuration;
    // Set while the configuration shown could not be given live conditions
    // (its driver is missing or unknown): writing back then keeps its stored
    // model and properties, until the user chooses an instrument.
    bool m_keepStoredConditions = false;
};

} // namespace vemi
