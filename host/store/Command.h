#pragma once

#include <memory>
#include <string>

namespace vemi {

class Response;
class StoreDatabase;

// A request to the object store. Commands are built and filled on the
// caller's thread, then run on the dispatcher's worker thread.
class Command
{
public:
    virtual ~Command() = default;

    // Called by the dispatcher on the caller's thread inside dispatch(): a
    // command that carries an object takes its snapshot here, so that later
    // edits of the object never race with the worker.
    virtual void prepare() {}
    // Runs on the worker thread. Throws StoreError (or DecodeError) on failure.
    virtual std::shared_ptr<Response> execute(StoreDatabase& database) = 0;
    // What the command does, for error messages ("save Job Template 2").
    virtual std::string description() const = 0;
};

} // namespace vemi
