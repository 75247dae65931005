#include "host/store/QtCommand.h"

#include "host/store/Command.h"
#include "host/store/ErrorInfo.h"
#include "host/store/Progress.h"
#include "host/store/Response.h"

#include <QCoreApplication>
#include <QEvent>

namespace vemi {

namespace {

QEvent::Type answerEventType()
{
    static const QEvent::Type type = QEvent::Type(QEvent::registerEventType());
    return type;
}

} // namespace

// One answer on its way to the wrapper's thread. It holds a handle to the
// wrapper: Qt deletes a posted event on the receiver's thread once it has
// been delivered, so the wrapper's last handle can only ever be dropped there.
// (A queued invokeMethod does not give that guarantee in Qt 5: the posting
// thread keeps a reference to the slot object until invokeMethod returns,
// and that reference may be the last.)
class QtCommand::AnswerEvent : public QEvent
{
public:
    explicit AnswerEvent(std::shared_ptr<QtCommand> command)
        : QEvent(answerEventType()), command(std::move(command)) {}

    std::shared_ptr<QtCommand> command;
    std::shared_ptr<Response> response;
    std::shared_ptr<ErrorInfo> error;
    std::shared_ptr<Progress> progress;
};

QtCommand::QtCommand(std::shared_ptr<Command> command)
    : m_command(std::move(command))
{
}

QtCommand::~QtCommand() = default;

void QtCommand::post(std::unique_ptr<AnswerEvent> answer)
{
    QtCommand* receiver = answer->command.get();
    // Takes ownership; nothing here touches the wrapper or the event afterwards.
    QCoreApplication::postEvent(receiver, answer.release());
}

void QtCommand::deliverResponse(std::shared_ptr<QtCommand> command, std::shared_ptr<Response> response)
{
    auto answer = std::make_unique<AnswerEvent>(std::move(command));
    answer->response = std::move(response);
    post(std::move(answer));
}

void QtCommand::deliverError(std::shared_ptr<QtCommand> command, std::shared_ptr<ErrorInfo> error)
{
    auto answer = std::make_unique<AnswerEvent>(std::move(command));
    answer->error = std::move(error);
    post(std::move(answer));
}

void QtCommand::postProgress(std::shared_ptr<Progress> progress)
{
    auto answer = std::make_unique<AnswerEvent>(shared_from_this());
    answer->progress = std::move(progress);
    post(std::move(answer));
}

bool QtCommand::event(QEvent* event)
{
    if (event->type() != answerEventType())
        return QObject::event(event);
    // The event keeps the wrapper alive while its slots run; Qt deletes the
    // event, and with it this handle, on this thread once this returns.
    auto* answer = static_cast<AnswerEvent*>(event);
    if (answer->progress)
        emit progressReceived(answer->progress);
    else if (answer->error)
        emit errorReceived(answer->error);
    else
        emit responseReceived(answer->response);
    return true;
}

} // namespace vemi
