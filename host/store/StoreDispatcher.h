#pragma once

#include "host/store/CommandDispatcher.h"
#include "host/store/StoreOptions.h"

#include <QString>
#include <QThread>

#include <atomic>

namespace vemi {

class StoreWorker;

// The dispatcher of one store file: runs its commands one after another on a
// worker thread of its own, with its own connection.
class StoreDispatcher : public CommandDispatcher
{
    Q_OBJECT

public:
    StoreDispatcher(std::string id, QString path, StoreOptions options = {});
    // Lets every command dispatched before finish, then stops the worker.
    ~StoreDispatcher() override;

    std::string dispatch(std::shared_ptr<QtCommand> command) override;

    // Opens the store on the worker and waits for the outcome; for start-up
    // checks only. Returns the error text, empty on success.
    QString openAndWait();
    QString path() const { return m_path; }

private:
    QString m_path;
    QThread m_thread;
    StoreWorker* m_worker; // lives on m_thread; deleted after the thread ends
    std::atomic<quint64> m_nextCommand{1};
};

} // namespace vemi
