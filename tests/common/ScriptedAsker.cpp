#include "tests/common/ScriptedAsker.h"

std::optional<QString> ScriptedAsker::askText(QWidget*, const QString& title, const QString& label,
                                              const QString& suggestion, const TextCheck& check)
{
    m_asked << QStringLiteral("%1: %2 [%3]").arg(title, label, suggestion);
    if (m_texts.empty())
        return std::nullopt;
    const std::optional<QString> answer = m_texts.front();
    m_texts.pop_front();
    const QString problem = answer && check ? check(*answer) : QString();
    if (!problem.isEmpty()) {
        m_asked.last() += QStringLiteral(" refused: ") + problem;
        return std::nullopt;
    }
    return answer;
}

bool ScriptedAsker::confirm(QWidget*, const QString& title, const QString& question,
                            DefaultAnswer defaultAnswer)
{
    m_asked << QStringLiteral("%1: %2 [default %3]")
                   .arg(title, question, defaultAnswer == DefaultAnswer::Yes ? QStringLiteral("Yes")
                                                                             : QStringLiteral("No"));
    if (m_confirmations.empty())
        return false;
    const bool yes = m_confirmations.front();
    m_confirmations.pop_front();
    return yes;
}

std::optional<int> ScriptedAsker::choose(QWidget*, const QString& title, const QString& question,
                                         const QStringList& choices, int defaultChoice)
{
    m_asked << QStringLiteral("%1: %2 [%3, default %4]").arg(title, question, choices.join(QLatin1Char('|')),
                                                            choices.value(defaultChoice));
    if (m_choices.empty())
        return std::nullopt;
    const std::optional<int> choice = m_choices.front();
    m_choices.pop_front();
    return choice;
}
