#pragma once

#include <string>
#include <vector>

namespace vemi {

// The user's general settings, read from the host's settings store.
class GeneralSettings
{
public:
    GeneralSettings(std::vector<std::string> dispatcherList, std::string illuminant, std::string observer)
        : m_dispatcherList(std::move(dispatcherList)), m_illuminant(std::move(illuminant)), m_observer(std::move(observer)) {}

    // Ids of the stores the user may browse.
    std::vector<std::string> dispatcherList() const { return m_dispatcherList; }
    // The default colorimetric condition, as "D65" and "10".
    std::string illuminant() const { return m_illuminant; }
    std::string observer() const { return m_observer; }

private:
    std::vector<std::string> m_dispatcherList;
    std::string m_illuminant;
    std::string m_observer;
};

} // namespace vemi
