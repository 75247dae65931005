#pragma once

#include <memory>

namespace vemi {

class GeneralSettings;

// Gives the user's settings. General settings are read from the default
// QSettings store ("General/…" keys) each time they are asked for.
class SettingsManager
{
public:
    static SettingsManager& instance();

    std::shared_ptr<GeneralSettings> getGeneralSettings() const;

private:
    SettingsManager() = default;
};

} // namespace vemi
