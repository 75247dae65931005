#include "host/client/CommonSettings.h"

#include "host/client/SettingsList.h"

namespace vemi {

CommonSettings::CommonSettings(std::string name, std::string title, bool userVisible, bool expertOnly)
    : m_name(std::move(name))
    , m_title(std::move(title))
    , m_userVisible(userVisible)
    , m_expertOnly(expertOnly)
    , m_settings(std::make_shared<SettingsList>())
{
}

CommonSettings::~CommonSettings() = default;

void CommonSettings::setExpertMode(bool on)
{
    m_expertMode = on;
}

} // namespace vemi
