#pragma once

#include <QString>

#include <atomic>
#include <thread>

// A named pipe that code under test must not block on. Opening a pipe for
// reading waits for a writer; should the code do that, a watchdog thread
// opens the writing end after the deadline, so that the test fails instead of
// hanging. The pipe is removed again with this object.
class PipeWithDeadline
{
public:
    explicit PipeWithDeadline(const QString& path, int deadlineMs = 5000);
    ~PipeWithDeadline();
    PipeWithDeadline(const PipeWithDeadline&) = delete;
    PipeWithDeadline& operator=(const PipeWithDeadline&) = delete;

    bool isValid() const { return m_valid; }
    // A reader held the pipe open until the deadline.
    bool readerWasStuck() const { return m_readerWasStuck; }

private:
    void watch(int deadlineMs);

    QString m_path;
    bool m_valid = false;
    std::atomic<bool> m_stop{false};
    std::atomic<bool> m_readerWasStuck{false};
    std::thread m_watchdog;
};
