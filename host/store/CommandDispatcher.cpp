#include "host/store/CommandDispatcher.h"

namespace vemi {

CommandDispatcher::CommandDispatcher(std::string id, QObject* parent)
    : QObject(parent), m_id(std::move(id))
{
}

} // namespace vemi
