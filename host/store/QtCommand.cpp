#include "host/store/QtCommand.h"

#include "host/store/Command.h"
#include "host/store/ErrorInfo.h"
#include "host/store/Progress.h"
#include "host/store/Response.h"

namespace vemi {

QtCommand::QtCommand(std::shared_ptr<Command> command)
    : m_command(std::move(command))
{
}

QtCommand::~QtCommand() = default;

// Each delivery holds a handle to the wrapper: it stays alive until its
// signal has been emitted on its own thread.
void QtCommand::deliverResponse(std::shared_ptr<QtCommand> command, std::shared_ptr<Response> response)
{
    QtCommand* receiver = command.get();
    QMetaObject::invokeMethod(receiver, [self = std::move(command), response]() {
        emit self->responseReceived(response);
    }, Qt::QueuedConnection);
}

void QtCommand::deliverError(std::shared_ptr<QtCommand> command, std::shared_ptr<ErrorInfo> error)
{
    QtCommand* receiver = command.get();
    QMetaObject::invokeMethod(receiver, [self = std::move(command), error]() {
        emit self->errorReceived(error);
    }, Qt::QueuedConnection);
}

void QtCommand::postProgress(std::shared_ptr<Progress> progress)
{
    QMetaObject::invokeMethod(this, [self = shared_from_this(), progress]() {
        emit self->progressReceived(progress);
    }, Qt::QueuedConnection);
}

} // namespace vemi
