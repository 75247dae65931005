#include "tests/common/RecordingDispatcher.h"

#include "host/store/QtCommand.h"

RecordingDispatcher::RecordingDispatcher()
    : vemi::CommandDispatcher("recording")
{
}

std::string RecordingDispatcher::dispatch(std::shared_ptr<vemi::QtCommand> command)
{
    if (onDispatch)
        onDispatch(command->command());
    m_wrappers.push_back(std::move(command));
    return "recorded#" + std::to_string(m_wrappers.size());
}

std::vector<std::shared_ptr<vemi::Command>> RecordingDispatcher::commands() const
{
    std::vector<std::shared_ptr<vemi::Command>> result;
    for (const auto& wrapper : m_wrappers)
        result.push_back(wrapper->command());
    return result;
}
