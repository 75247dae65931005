#pragma once

#include <string>

namespace vemi {

// Display name and description of a stored object.
class Header
{
public:
    Header() = default;
    explicit Header(std::string name, std::string description = {});

    std::string name() const { return m_name; }
    void setName(const std::string& name) { m_name = name; }
    std::string description() const { return m_description; }
    void setDescription(const std::string& description) { m_description = description; }

private:
    std::string m_name;
    std::string m_description;
};

} // namespace vemi
