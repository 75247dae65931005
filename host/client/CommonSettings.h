#pragma once

#include <memory>
#include <string>

namespace vemi {

class SettingsList;

// Base of the settings object of a client (and of measurement conditions):
// a named tree of settings that the host shows in its settings pages.
class CommonSettings
{
public:
    // name identifies the settings; title is shown to the user; userVisible
    // puts them into the host's settings pages; expertOnly hides them unless
    // expert mode is on.
    CommonSettings(std::string name, std::string title, bool userVisible, bool expertOnly);
    virtual ~CommonSettings();

    std::string settingsName() const { return m_name; }
    std::string title() const { return m_title; }
    bool isUserVisible() const { return m_userVisible; }
    bool isExpertOnly() const { return m_expertOnly; }

    std::shared_ptr<SettingsList> settings() const { return m_settings; }

    virtual void setExpertMode(bool on);
    bool expertMode() const { return m_expertMode; }

private:
    std::string m_name;
    std::string m_title;
    bool m_userVisible;
    bool m_expertOnly;
    bool m_expertMode = false;
    std::shared_ptr<SettingsList> m_settings;
};

} // namespace vemi

#include <QObject>

Q_DECLARE_INTERFACE(vemi::CommonSettings, "CommonSettings")
