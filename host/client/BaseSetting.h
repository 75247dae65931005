#pragma once

#include <QVariant>

#include <string>

namespace vemi {

// One named value of a settings tree.
class BaseSetting
{
public:
    explicit BaseSetting(std::string name, QVariant value = {}) : m_name(std::move(name)), m_value(std::move(value)) {}
    virtual ~BaseSetting() = default;

    std::string name() const { return m_name; }
    QVariant value() const { return m_value; }
    void setValue(const QVariant& value) { m_value = value; }

private:
    std::string m_name;
    QVariant m_value;
};

} // namespace vemi
