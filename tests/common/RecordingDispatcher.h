#pragma once

#include "host/store/CommandDispatcher.h"

#include <functional>
#include <memory>
#include <vector>

namespace vemi {
class Command;
class QtCommand;
} // namespace vemi

// Keeps every command handed to it, answers none: lets a test see which
// commands a class sent and in what order.
class RecordingDispatcher : public vemi::CommandDispatcher
{
    Q_OBJECT

public:
    RecordingDispatcher();

    std::string dispatch(std::shared_ptr<vemi::QtCommand> command) override;

    const std::vector<std::shared_ptr<vemi::QtCommand>>& wrappers() const { return m_wrappers; }
    std::vector<std::shared_ptr<vemi::Command>> commands() const;
    template <class T>
    std::vector<std::shared_ptr<T>> commandsOf() const
    {
        std::vector<std::shared_ptr<T>> found;
        for (const auto& command : commands()) {
            if (auto typed = std::dynamic_pointer_cast<T>(command))
                found.push_back(typed);
        }
        return found;
    }
    void clear() { m_wrappers.clear(); }

    // Called with each command as it is dispatched.
    std::function<void(const std::shared_ptr<vemi::Command>&)> onDispatch;

private:
    std::vector<std::shared_ptr<vemi::QtCommand>> m_wrappers;
};
