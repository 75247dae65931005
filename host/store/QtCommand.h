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

    // Thread-safe: queue the answer for delivery on the wrapper's thread. They
    // take the caller's handle into the posted event, which is deleted on the
    // wrapper's thread after delivery, so that the wrapper (a QObject) is
    // released there, never on the worker's; the caller must not touch the
    // wrapper afterwards.
    static void deliverResponse(std::shared_ptr<QtCommand> command, std::shared_ptr<Response> response);
    static void deliverError(std::shared_ptr<QtCommand> command, std::shared_ptr<ErrorInfo> error);
    // Thread-safe, for a command that is still running; the caller must hold
    // a handle of its own.
    void postProgress(std::shared_ptr<Progress> progress);

protected:
    bool event(QEvent* event) override;

signals:
    void responseReceived(std::shared_ptr<vemi::Response> response);
    void errorReceived(std::shared_ptr<vemi::ErrorInfo> error);
    void progressReceived(std::shared_ptr<vemi::Progress> progress);

private:
    class AnswerEvent;
    static void post(std::unique_ptr<AnswerEvent> answer);

    std::shared_ptr<Command> m_command;
};

} // namespace vemi
