#include "host/instruments/Instrument.h"

#include "host/instruments/MeasurementConditions.h"

namespace vemi {

Instrument::Instrument(QString modelName, ConditionsMaker makeConditions)
    : m_modelName(std::move(modelName)), m_makeConditions(std::move(makeConditions))
{
}

std::shared_ptr<MeasurementConditions> Instrument::measurementConditions() const
{
    return m_makeConditions ? m_makeConditions() : nullptr;
}

} // namespace vemi
