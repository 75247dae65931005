#pragma once

#include <QObject>

#include <memory>
#include <string>

namespace vemi {

class QtCommand;

// Runs the commands handed to it, in the order they were dispatched, and
// answers through each wrapper's signals.
class CommandDispatcher : public QObject
{
    Q_OBJECT

public:
    explicit CommandDispatcher(std::string id, QObject* parent = nullptr);

    std::string id() const { return m_id; }
    // Returns at once; the answer arrives later on the caller's thread.
    // The result is an id for the dispatched command.
    virtual std::string dispatch(std::shared_ptr<QtCommand> command) = 0;

signals:
    // Another program changed the store (where the store can tell: a server
    // announces every write). Emitted on the dispatcher's thread.
    void sgStoreChanged();

private:
    std::string m_id;
};

} // namespace vemi
