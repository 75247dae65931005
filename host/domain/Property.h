#pragma once

#include "host/domain/BaseObject.h"

namespace vemi {

// One key/value setting of a measurement configuration.
class Property : public BaseObject
{
public:
    explicit Property(std::string key = {}, std::string value = {});

    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::string key() const { return m_key; }
    void setKey(const std::string& key) { m_key = key; }
    std::string value() const { return m_value; }
    void setValue(const std::string& value) { m_value = value; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::string m_key;
    std::string m_value;
};

} // namespace vemi
