#pragma once

#include <QString>

namespace vemi {

// Progress of a long-running command: done out of total steps.
class Progress
{
public:
    Progress(int done, int total, QString text = {}) : m_done(done), m_total(total), m_text(std::move(text)) {}
    int done() const { return m_done; }
    int total() const { return m_total; }
    QString text() const { return m_text; }

private:
    int m_done;
    int m_total;
    QString m_text;
};

} // namespace vemi
