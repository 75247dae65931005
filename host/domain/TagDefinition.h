#pragma once

#include "host/domain/NamedObject.h"

namespace vemi {

// A property that objects can carry: its name, the value a new object gets
// and, when not empty, the only values it may take.
class TagDefinition : public NamedObject
{
public:
    // What a value may hold; a definition with allowed values takes only those.
    enum class ValueKind { Text, Number };

    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::string defaultValue() const { return m_defaultValue; }
    void setDefaultValue(const std::string& value) { m_defaultValue = value; }
    // Empty for a free-text property.
    std::vector<std::string> allowedValues() const { return m_allowedValues; }
    void setAllowedValues(const std::vector<std::string>& values) { m_allowedValues = values; }
    ValueKind valueKind() const { return m_valueKind; }
    void setValueKind(ValueKind kind) { m_valueKind = kind; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::string m_defaultValue;
    std::vector<std::string> m_allowedValues;
    ValueKind m_valueKind = ValueKind::Text;
};

} // namespace vemi
