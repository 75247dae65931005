#pragma once

#include <memory>
#include <string>
#include <vector>

namespace vemi {

class SettingsSection;

class SettingsGroup
{
public:
    explicit SettingsGroup(std::string name) : m_name(std::move(name)) {}

    std::string name() const { return m_name; }
    const std::vector<std::shared_ptr<SettingsSection>>& sections() const { return m_sections; }
    void addSection(std::shared_ptr<SettingsSection> section) { m_sections.push_back(std::move(section)); }

private:
    std::string m_name;
    std::vector<std::shared_ptr<SettingsSection>> m_sections;
};

} // namespace vemi
