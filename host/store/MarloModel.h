#pragma once

#include "host/store/StoreOptions.h"

#include <QString>

#include <map>
#include <memory>
#include <string>

namespace vemi {

class CommandDispatcher;

// The object store: a set of stores, each reached through the dispatcher of
// its id. The empty id and defaultDispatcherId() both name the default store.
class MarloModel
{
public:
    static const std::string& defaultDispatcherId();
    // Where the default store lives unless the user names another file.
    static QString standardStorePath();

    explicit MarloModel(QString defaultStorePath, StoreOptions options = {});
    ~MarloModel();

    // Opens the default store and waits for the outcome (start-up only).
    // Returns the error text, empty on success.
    QString open();

    // An empty handle for an id that names no store.
    std::shared_ptr<CommandDispatcher> commandDispatcher(const std::string& dispatcherId) const;
    // Adds the store of another dispatcher id: a file, or a postgresql:// address.
    void addStore(const std::string& dispatcherId, const QString& path);
    // Puts another dispatcher in place of the one of the id (tests record commands this way).
    void setCommandDispatcher(const std::string& dispatcherId, std::shared_ptr<CommandDispatcher> dispatcher);

    QString defaultStorePath() const { return m_defaultStorePath; }
    // Whether the store of the id can take writes: false when the stores were
    // opened read-only, or its file or the file's folder (which holds the
    // journal) may not be written by this user.
    bool isWritable(const std::string& dispatcherId = std::string()) const;

private:
    QString openDefault();
    static std::string normalised(const std::string& dispatcherId);

    QString m_defaultStorePath;
    StoreOptions m_options;
    std::map<std::string, std::shared_ptr<CommandDispatcher>> m_dispatchers;
};

} // namespace vemi
