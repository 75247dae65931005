#pragma once

#include <memory>
#include <vector>

namespace vemi {

class SettingsGroup;

// The root of a settings tree: groups, each of sections, each of settings.
class SettingsList
{
public:
    const std::vector<std::shared_ptr<SettingsGroup>>& groups() const { return m_groups; }
    void addGroup(std::shared_ptr<SettingsGroup> group) { m_groups.push_back(std::move(group)); }

private:
    std::vector<std::shared_ptr<SettingsGroup>> m_groups;
};

} // namespace vemi
