#include "tests/common/PipeWithDeadline.h"

#include <QFile>

#include <chrono>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

PipeWithDeadline::PipeWithDeadline(const QString& path, int deadlineMs)
    : m_path(path)
{
    m_valid = ::mkfifo(QFile::encodeName(path).constData(), 0600) == 0;
    if (m_valid)
        m_watchdog = std::thread(&PipeWithDeadline::watch, this, deadlineMs);
}

PipeWithDeadline::~PipeWithDeadline()
{
    m_stop = true;
    if (m_watchdog.joinable())
        m_watchdog.join();
    if (m_valid)
        QFile::remove(m_path);
}

void PipeWithDeadline::watch(int deadlineMs)
{
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::milliseconds(deadlineMs);
    const QByteArray path = QFile::encodeName(m_path);
    while (!m_stop) {
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
        if (std::chrono::steady_clock::now() < deadline)
            continue;
        // Without a reader a non-blocking open for writing fails at once.
        const int fd = ::open(path.constData(), O_WRONLY | O_NONBLOCK);
        if (fd >= 0) {
            m_readerWasStuck = true;
            ::close(fd);
            return;
        }
    }
}
