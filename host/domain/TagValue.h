#pragma once

#include "host/domain/BaseObject.h"

#include <memory>

namespace vemi {

class TagDefinition;

// The value an object gives to one of its tag definitions, which it names by id.
class TagValue : public BaseObject
{
public:
    TagValue();

    static const std::string& typeId();
    std::string objectTypeId() const override;

    static std::shared_ptr<TagValue> forDefinition(const TagDefinition& definition, std::string value);

    std::string definitionId() const { return m_definitionId; }
    void setDefinitionId(const std::string& id) { m_definitionId = id; }
    std::string value() const { return m_value; }
    void setValue(const std::string& value) { m_value = value; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::string m_definitionId;
    std::string m_value;
};

} // namespace vemi
