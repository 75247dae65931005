#include "host/store/StoreDispatcher.h"

#include "host/store/Command.h"
#include "host/store/QtCommand.h"
#include "host/store/StoreWorker.h"

namespace vemi {

StoreDispatcher::StoreDispatcher(std::string id, QString path, StoreOptions options)
    : CommandDispatcher(std::move(id))
    , m_path(path)
    , m_worker(new StoreWorker(path, options))
{
    m_thread.setObjectName(QStringLiteral("store:") + QString::fromStdString(this->id()));
    m_worker->moveToThread(&m_thread);
    connect(m_worker, &StoreWorker::sgStoreChanged, this, &CommandDispatcher::sgStoreChanged, Qt::QueuedConnection);
    m_thread.start();
}

StoreDispatcher::~StoreDispatcher()
{
    // Queued behind every pending command, so nothing dispatched is dropped.
    QMetaObject::invokeMethod(m_worker, [worker = m_worker]() {
        worker->close();
        QThread::currentThread()->quit();
    }, Qt::QueuedConnection);
    m_thread.wait();
    delete m_worker;
}

std::string StoreDispatcher::dispatch(std::shared_ptr<QtCommand> command)
{
    command->command()->prepare();
    QMetaObject::invokeMethod(m_worker, [worker = m_worker, command]() mutable {
        worker->run(std::move(command));
    }, Qt::QueuedConnection);
    return id() + "#" + std::to_string(m_nextCommand++);
}

QString StoreDispatcher::openAndWait()
{
    QString error;
    QMetaObject::invokeMethod(m_worker, [this, &error]() { error = m_worker->ensureOpen(); },
                              Qt::BlockingQueuedConnection);
    return error;
}

} // namespace vemi
