#pragma once

#include "host/store/StoreOptions.h"

#include <QObject>
#include <QString>

#include <memory>

namespace vemi {

class Command;
class ErrorInfo;
class QtCommand;
class Response;
class StoreDatabase;

// Lives on a dispatcher's worker thread and owns that thread's connection,
// which it opens with the first command (and again after a failed open).
class StoreWorker : public QObject
{
    Q_OBJECT

public:
    StoreWorker(QString path, StoreOptions options);
    ~StoreWorker() override;

    // Runs one command and posts its answer to the wrapper's thread.
    void run(std::shared_ptr<QtCommand> command);
    // Opens the connection if needed; returns the error text, empty on success.
    QString ensureOpen();
    void close();

signals:
    // Another program wrote to the store.
    void sgStoreChanged();

private:
    // Runs the command; on failure sets error and returns null.
    std::shared_ptr<Response> execute(Command& command, std::shared_ptr<ErrorInfo>& error);

    QString m_path;
    StoreOptions m_options;
    std::unique_ptr<StoreDatabase> m_database;
};

} // namespace vemi
