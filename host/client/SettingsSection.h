#pragma once

#include <memory>
#include <string>
#include <vector>

namespace vemi {

class BaseSetting;

class SettingsSection
{
public:
    explicit SettingsSection(std::string name) : m_name(std::move(name)) {}

    std::string name() const { return m_name; }
    const std::vector<std::shared_ptr<BaseSetting>>& settings() const { return m_settings; }
    void addSetting(std::shared_ptr<BaseSetting> setting) { m_settings.push_back(std::move(setting)); }

private:
    std::string m_name;
    std::vector<std::shared_ptr<BaseSetting>> m_settings;
};

} // namespace vemi
