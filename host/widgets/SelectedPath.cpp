#include "host/widgets/SelectedPath.h"

namespace vemi {

namespace {

constexpr char Separator = '/';
constexpr char Escape = '\\';

} // namespace

SelectedPath::SelectedPath(std::string dispatcherId, std::vector<std::string> path)
    : m_dispatcherId(std::move(dispatcherId)), m_path(std::move(path))
{
}

std::string SelectedPath::pathToString(const std::vector<std::string>& path)
{
    std::string text;
    for (const std::string& name : path) {
        text += Separator;
        // Byte-wise is safe for UTF-8: no byte of a multi-byte character is ASCII.
        for (const char c : name) {
            if (c == Separator || c == Escape)
                text += Escape;
            text += c;
        }
    }
    return text;
}

std::vector<std::string> SelectedPath::pathFromString(const std::string& text)
{
    std::vector<std::string> path;
    if (text.empty())
        return path;
    std::size_t at = 0;
    if (text.front() == Separator)
        ++at;
    path.emplace_back();
    for (; at < text.size(); ++at) {
        const char c = text[at];
        const bool escapes = c == Escape && at + 1 < text.size()
            && (text[at + 1] == Separator || text[at + 1] == Escape);
        if (escapes) {
            path.back() += text[++at];
        } else if (c == Separator) {
            path.emplace_back();
        } else {
            path.back() += c;
        }
    }
    return path;
}

} // namespace vemi
