#include "host/store/StoreWorker.h"

#include "host/store/Command.h"
#include "host/domain/DecodeError.h"
#include "host/store/ErrorInfo.h"
#include "host/store/QtCommand.h"
#include "host/store/Response.h"
#include "host/store/StoreDatabase.h"
#include "host/store/StoreError.h"

namespace vemi {

StoreWorker::StoreWorker(QString path, StoreOptions options)
    : m_path(std::move(path)), m_options(options)
{
}

StoreWorker::~StoreWorker() = default;

QString StoreWorker::ensureOpen()
{
    if (m_database)
        return {};
    auto database = std::make_unique<StoreDatabase>(m_path, m_options);
    try {
        database->open();
    } catch (const StoreError& error) {
        return QString::fromStdString(error.what());
    }
    m_database = std::move(database);
    m_database->watchChanges(this, [this] { emit sgStoreChanged(); });
    return {};
}

void StoreWorker::close()
{
    m_database.reset();
}

void StoreWorker::run(std::shared_ptr<QtCommand> command)
{
    std::shared_ptr<ErrorInfo> error;
    std::shared_ptr<Response> response;
    const QString openError = ensureOpen();
    if (openError.isEmpty()) {
        response = execute(*command->command(), error);
        // The next command connects anew, e.g. to a server that is back.
        if (m_database->isConnectionLost())
            m_database.reset();
    } else
        error = std::make_shared<ErrorInfo>(openError);
    // The handle moves into the delivery: the worker keeps none of its own.
    if (error)
        QtCommand::deliverError(std::move(command), std::move(error));
    else
        QtCommand::deliverResponse(std::move(command), std::move(response));
}

std::shared_ptr<Response> StoreWorker::execute(Command& command, std::shared_ptr<ErrorInfo>& error)
{
    const QString what = QString::fromStdString(command.description());
    const auto fail = [&](const QString& cause, bool conflict = false) {
        error = std::make_shared<ErrorInfo>(QStringLiteral("Cannot %1: %2").arg(what, cause), conflict);
        return nullptr;
    };
    try {
        return command.execute(*m_database);
    } catch (const StoreError& failure) {
        return fail(QString::fromUtf8(failure.what()), failure.isConflict());
    } catch (const DecodeError& failure) {
        return fail(QStringLiteral("the stored object is damaged (%1): %2").arg(QString::fromUtf8(failure.what()), m_path));
    } catch (const std::exception& failure) {
        return fail(QString::fromUtf8(failure.what()));
    }
}

} // namespace vemi
