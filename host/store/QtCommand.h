#pragma once

#include <QObject>

#include <memory>

namespace vemi {

class Command;
class ErrorInfo;
class Progress;
class Response;

// Carries one command to a dispatcher and its answer back as a Qt signal,
// emitted on the thread that created the wrapper. Held by std::shared_ptr;
// while an answer is on its way, the answer itself holds the wrapper, so the
// requester need not keep a handle.
class QtCommand : public QObject, public std::enable_shared_from_this<QtCommand>
{
    Q_OBJECT

public:
    explicit QtCommand(std::shared_ptr<Command> command);
    ~QtCommand() override;

    std::shared_ptr<Command> command() const { return m_command; }

    // Thread-safe: queue the answer for delivery on this wrapper's thread.
    void postResponse(std::shared_ptr<Response> response);
    void postError(std::shared_ptr<ErrorInfo> error);
    void postProgress(std::shared_ptr<Progress> progress);

signals:
    void responseReceived(std::shared_ptr<vemi::Response> response);
    void errorReceived(std::shared_ptr<vemi::ErrorInfo> error);
    void progressReceived(std::shared_ptr<vemi::Progress> progress);

private:
    std::shared_ptr<Command> m_command;
};

} // namespace vemi
