#pragma once

#include <QWidget>

#include <memory>

class QFormLayout;
class QLabel;

namespace vemi {

class MeasurementConditions;

// Edits an instrument's measurement conditions in place: one field per
// setting, in the order of the settings tree; every change is written into
// the object shown at once.
class MeasurementConditionsWidget : public QWidget
{
    Q_OBJECT

public:
    explicit MeasurementConditionsWidget(QWidget* parent = nullptr);

    // Shares the object with the caller; an empty handle clears the widget.
    void setMeasurementConditions(std::shared_ptr<MeasurementConditions> conditions);
    std::shared_ptr<MeasurementConditions> measurementConditions() const { return m_conditions; }

private:
    void clearFields();
    QWidget* fieldFor(const QString& key);

    std::shared_ptr<MeasurementConditions> m_conditions;
    QLabel* m_placeholder;
    QFormLayout* m_fields;
};

} // namespace vemi
