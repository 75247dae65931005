#pragma once

#include "host/domain/NamedObject.h"

#include <memory>
#include <vector>

namespace vemi {

class Property;

// The instrument model to measure with and its measurement conditions as
// key/value properties.
class MeasurementConfiguration : public NamedObject
{
public:
    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::string instrumentModel() const { return m_instrumentModel; }
    void setInstrumentModel(const std::string& model) { m_instrumentModel = model; }
    std::vector<std::shared_ptr<Property>> properties() const { return m_properties; }
    void setProperties(const std::vector<std::shared_ptr<Property>>& properties);

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::string m_instrumentModel;
    std::vector<std::shared_ptr<Property>> m_properties;
};

} // namespace vemi
