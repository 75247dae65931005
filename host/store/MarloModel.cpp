#include "host/store/MarloModel.h"

#include "host/store/StoreDialect.h"
#include "host/store/StoreDispatcher.h"

#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>

namespace vemi {

const std::string& MarloModel::defaultDispatcherId()
{
    static const std::string id = "Local";
    return id;
}

QString MarloModel::standardStorePath()
{
    return QStandardPaths::writableLocation(QStandardPaths::AppDataLocation) + QStringLiteral("/store.sqlite");
}

MarloModel::MarloModel(QString defaultStorePath, StoreOptions options)
    : m_defaultStorePath(std::move(defaultStorePath)), m_options(options)
{
    addStore(defaultDispatcherId(), m_defaultStorePath);
}

MarloModel::~MarloModel() = default;

QString MarloModel::open()
{
    if (StoreDialect::isServerLocation(m_defaultStorePath))
        return openDefault();
    const QString folder = QFileInfo(m_defaultStorePath).absolutePath();
    if (!QDir().mkpath(folder))
        return QStringLiteral("Cannot create the folder of the store: %1").arg(folder);
    return openDefault();
}

QString MarloModel::openDefault()
{
    auto dispatcher = std::dynamic_pointer_cast<StoreDispatcher>(commandDispatcher(defaultDispatcherId()));
    return dispatcher ? dispatcher->openAndWait() : QString();
}

std::shared_ptr<CommandDispatcher> MarloModel::commandDispatcher(const std::string& dispatcherId) const
{
    const auto found = m_dispatchers.find(normalised(dispatcherId));
    return found == m_dispatchers.end() ? nullptr : found->second;
}

void MarloModel::addStore(const std::string& dispatcherId, const QString& path)
{
    const std::string id = normalised(dispatcherId);
    m_dispatchers[id] = std::make_shared<StoreDispatcher>(id, path, m_options);
}

void MarloModel::setCommandDispatcher(const std::string& dispatcherId, std::shared_ptr<CommandDispatcher> dispatcher)
{
    m_dispatchers[normalised(dispatcherId)] = std::move(dispatcher);
}

bool MarloModel::isWritable(const std::string& dispatcherId) const
{
    if (m_options.readOnly)
        return false;
    const auto store = std::dynamic_pointer_cast<StoreDispatcher>(commandDispatcher(dispatcherId));
    if (!store)
        return commandDispatcher(dispatcherId) != nullptr;
    // What the login may change shows only when a write is tried.
    if (StoreDialect::isServerLocation(store->path()))
        return true;
    const QFileInfo file(store->path());
    const QFileInfo folder(file.absolutePath());
    return folder.isWritable() && (!file.exists() || file.isWritable());
}

std::string MarloModel::normalised(const std::string& dispatcherId)
{
    return dispatcherId.empty() ? defaultDispatcherId() : dispatcherId;
}

} // namespace vemi
