#pragma once

#include <QString>

#include <functional>
#include <memory>

namespace vemi {

class MeasurementConditions;

// A measuring instrument of one model, as its driver presents it.
class Instrument
{
public:
    using ConditionsMaker = std::function<std::shared_ptr<MeasurementConditions>()>;

    // makeConditions may be empty for an instrument without settings.
    Instrument(QString modelName, ConditionsMaker makeConditions);

    QString modelName() const { return m_modelName; }
    // A new object at each call, holding the defaults, so that editing one
    // configuration's conditions never changes another's. May be empty.
    std::shared_ptr<MeasurementConditions> measurementConditions() const;

private:
    QString m_modelName;
    ConditionsMaker m_makeConditions;
};

} // namespace vemi
