#pragma once

#include <string>
#include <vector>

namespace vemi {

// A remembered place in the folder tree of one store: the store's dispatcher
// id ("" or "Local" for the default store) and the folder names from the top
// level down.
class SelectedPath
{
public:
    explicit SelectedPath(std::string dispatcherId = {}, std::vector<std::string> path = {});

    std::string dispatcherId() const { return m_dispatcherId; }
    std::vector<std::string> path() const { return m_path; }

    // One line of text for the settings store, "/Charts/Plant 2". Each name
    // is preceded by '/', so the top level is "" and a folder with an empty
    // name is "/"; '/' and '\' inside a name are escaped with '\'.
    static std::string pathToString(const std::vector<std::string>& path);
    // The inverse of pathToString. Text edited by hand is read leniently: a
    // missing leading '/' is assumed, '\' before any other character or at
    // the end stands for itself.
    static std::vector<std::string> pathFromString(const std::string& text);

private:
    std::string m_dispatcherId;
    std::vector<std::string> m_path;
};

} // namespace vemi
