#pragma once

#include <functional>
#include <memory>
#include <string>

class QObject;

namespace vemi {

class Command;
class ErrorInfo;
class MarloModel;
class Response;

// The one way to send a command to a store and get its answer back.
//
// send() is for code that runs on a thread with an event loop, the GUI above
// all: it returns at once and later calls exactly one of the two callbacks on
// the caller's thread, but only while context lives; once context is
// destroyed neither is called.
//
// sendAndWait() blocks the caller in a local event loop until the answer
// comes or the deadline passes. It is for start-up (before the first window
// shows) and for tests, never for code a running UI calls.
//
// dispatcherId "" names the default store. An id that names no store is
// answered as a failure ("Cannot …: there is no store named …").
class CommandSender
{
public:
    using OnResponse = std::function<void(const std::shared_ptr<Response>&)>;
    using OnError = std::function<void(const std::shared_ptr<ErrorInfo>&)>;

    struct Answer
    {
        std::shared_ptr<Response> response; // set when the store carried the command out
        std::shared_ptr<ErrorInfo> error;   // set on failure, and when the deadline passed
        bool timedOut = false;
    };

    // context must not be null. Either callback may be empty.
    static void send(const MarloModel& store, const std::string& dispatcherId, std::shared_ptr<Command> command,
                     QObject* context, OnResponse onResponse, OnError onError = {});
    static Answer sendAndWait(const MarloModel& store, const std::string& dispatcherId,
                              std::shared_ptr<Command> command, int timeoutMs);
};

} // namespace vemi
