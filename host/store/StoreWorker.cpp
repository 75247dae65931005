#include "StoreWorker.h"

#include "Command.h"
#include "DecodeError.h"
#include "ErrorInfo.h"
#include "QtCommand.h"
#include "Response.h"
#include "StoreDatabase.h"
#include "StoreError.h"

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
    return {};
}

void StoreWorker::close()
{
    m_database.reset();
}

void StoreWorker::run(std::shared_ptr<QtCommand> command)
{
    const QString openError = ensureOpen();
    if (!openError.isEmpty()) {
        command->postError(std::make_shared<ErrorInfo>(openError));
        return;
    }
    const std::string what = command->command()->description();
    try {
        command->postResponse(command->command()->execute(*m_database));
    } catch (const StoreError& error) {
        command->postError(std::make_shared<ErrorInfo>(
            QStringLiteral("Cannot %1: %2").arg(QString::fromStdString(what), QString::fromUtf8(error.what()))));
    } catch (const DecodeError& error) {
        command->postError(std::make_shared<ErrorInfo>(
            QStringLiteral("Cannot %1: the stored object is damaged (%2): %3")
                .arg(QString::fromStdString(what), QString::fromUtf8(error.what()), m_path)));
    } catch (const std::exception& error) {
        command->postError(std::make_shared<ErrorInfo>(
            QStringLiteral("Cannot %1: %2").arg(QString::fromStdString(what), QString::fromUtf8(error.what()))));
    }
}

} // namespace vemi
