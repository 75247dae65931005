#pragma once

#include "host/domain/BaseObject.h"

#include <memory>
#include <string>
#include <vector>

namespace vemi {

class TagDefinition;
class TagValue;

// An object with a user-visible name, a description and properties: tag
// definitions with the values given to them.
class NamedObject : public BaseObject
{
public:
    std::string name() const;
    void setName(const std::string& name);
    std::string description() const;
    void setDescription(const std::string& description);

    std::vector<std::shared_ptr<TagDefinition>> tagDefinitions() const { return m_tagDefinitions; }
    void setTagDefinitions(const std::vector<std::shared_ptr<TagDefinition>>& definitions);
    std::vector<std::shared_ptr<TagValue>> tagValues() const { return m_tagValues; }
    void setTagValues(const std::vector<std::shared_ptr<TagValue>>& values);

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::vector<std::shared_ptr<TagDefinition>> m_tagDefinitions;
    std::vector<std::shared_ptr<TagValue>> m_tagValues;
};

} // namespace vemi
