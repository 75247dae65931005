#include "QtCommand.h"

#include "Command.h"
#include "ErrorInfo.h"
#include "Progress.h"
#include "Response.h"

namespace vemi {

QtCommand::QtCommand(std::shared_ptr<Command> command)
    : m_command(std::move(command))
{
}

QtCommand::~QtCommand() = default;

// Each post captures a handle to the wrapper: it stays alive until its
// signal has been emitted on its own thread.
void QtCommand::postResponse(std::shared_ptr<Response> response)
{
    QMetaObject::invokeMethod(this, [self = shared_from_this(), response]() {
        emit self->responseReceived(response);
    }, Qt::QueuedConnection);
}

void QtCommand::postError(std::shared_ptr<ErrorInfo> error)
{
    QMetaObject::invokeMethod(this, [self = shared_from_this(), error]() {
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
