#include "host/store/CommandSender.h"

#include "host/store/Command.h"
#include "host/store/CommandDispatcher.h"
#include "host/store/ErrorInfo.h"
#include "host/store/MarloModel.h"
#include "host/store/QtCommand.h"

#include <QEventLoop>
#include <QTimer>

namespace vemi {

namespace {

std::shared_ptr<ErrorInfo> failure(const Command& command, const QString& cause)
{
    return std::make_shared<ErrorInfo>(
        QStringLiteral("Cannot %1: %2").arg(QString::fromStdString(command.description()), cause));
}

std::shared_ptr<ErrorInfo> noStoreNamed(const Command& command, const std::string& dispatcherId)
{
    return failure(command, QStringLiteral("there is no store named \"%1\".").arg(QString::fromStdString(dispatcherId)));
}

} // namespace

void CommandSender::send(const MarloModel& store, const std::string& dispatcherId, std::shared_ptr<Command> command,
                         QObject* context, OnResponse onResponse, OnError onError)
{
    Q_ASSERT(context);
    const auto dispatcher = store.commandDispatcher(dispatcherId);
    if (!dispatcher) {
        // Queued like a store's answer: a caller never sees its callback run inside send().
        QMetaObject::invokeMethod(context, [onError, error = noStoreNamed(*command, dispatcherId)]() {
            if (onError)
                onError(error);
        }, Qt::QueuedConnection);
        return;
    }
    // The connections go through context, so Qt drops them when it is destroyed.
    auto wrapper = std::make_shared<QtCommand>(std::move(command));
    QObject::connect(wrapper.get(), &QtCommand::responseReceived, context,
                     [onResponse](std::shared_ptr<Response> response) {
                         if (onResponse)
                             onResponse(response);
                     });
    QObject::connect(wrapper.get(), &QtCommand::errorReceived, context, [onError](std::shared_ptr<ErrorInfo> error) {
        if (onError)
            onError(error);
    });
    dispatcher->dispatch(wrapper);
}

CommandSender::Answer CommandSender::sendAndWait(const MarloModel& store, const std::string& dispatcherId,
                                                 std::shared_ptr<Command> command, int timeoutMs)
{
    Answer answer;
    const auto dispatcher = store.commandDispatcher(dispatcherId);
    if (!dispatcher) {
        answer.error = noStoreNamed(*command, dispatcherId);
        return answer;
    }
    QEventLoop loop;
    QTimer deadline;
    deadline.setSingleShot(true);
    QObject::connect(&deadline, &QTimer::timeout, &loop, [&, timeoutMs]() {
        answer.timedOut = true;
        answer.error = failure(*command, QStringLiteral("the store \"%1\" did not answer within %2 ms.")
                                             .arg(QString::fromStdString(dispatcher->id())).arg(timeoutMs));
        loop.quit();
    });
    auto wrapper = std::make_shared<QtCommand>(command);
    QObject::connect(wrapper.get(), &QtCommand::responseReceived, &loop, [&](std::shared_ptr<Response> response) {
        answer.response = std::move(response);
        loop.quit();
    });
    QObject::connect(wrapper.get(), &QtCommand::errorReceived, &loop, [&](std::shared_ptr<ErrorInfo> error) {
        answer.error = error ? error : failure(*command, QStringLiteral("the store gave no reason."));
        loop.quit();
    });
    deadline.start(timeoutMs);
    dispatcher->dispatch(std::move(wrapper));
    // A dispatcher that answers inside dispatch() has already quit a loop not yet running.
    if (!answer.response && !answer.error)
        loop.exec();
    return answer;
}

} // namespace vemi
