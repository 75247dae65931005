#include "host/domain/Header.h"

#include <utility>

namespace vemi {

Header::Header(std::string name, std::string description)
    : m_name(std::move(name)), m_description(std::move(description))
{
}

} // namespace vemi
