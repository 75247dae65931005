#include "tests/common/ScriptedAsker.h"

std::optional<QString> ScriptedAsker::askText(QWidget*, const QString& title, const QString& label,
                                              const QString& suggestion)
{
    m_asked << QStringLiteral("%1: %2 [%3]").arg(title, label, suggestion);
    if (m_texts.empty())
        return std::nullopt;
    const std::optional<QString> answer = m_texts.front();
    m_texts.pop_front();
    return answer;
}

bool ScriptedAsker::confirm(QWidget*, const QString& title, const QString& question)
{
    m_asked << QStringLiteral("%1: %2").arg(title, question);
    if (m_confirmations.empty())
        return false;
    const bool yes = m_confirmations.front();
    m_confirmations.pop_front();
    return yes;
}
