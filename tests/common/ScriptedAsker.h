#pragma once

#include "host/widgets/UserAsker.h"

#include <deque>

// Answers a browser's questions from a script instead of dialogs, in the
// order they come, and keeps each question ("title: label [suggestion]",
// "title: question [default No]"). A question without a scripted answer is
// cancelled (or answered no). A text the question's check refuses is treated
// as the dialog treats it: the question is cancelled, and the refusal kept
// ("… refused: reason").
class ScriptedAsker : public vemi::UserAsker
{
public:
    // nothing: the user cancels.
    void scriptText(std::optional<QString> answer) { m_texts.push_back(std::move(answer)); }
    void scriptConfirm(bool yes) { m_confirmations.push_back(yes); }
    // The index among the choices offered; nothing: the user cancels.
    void scriptChoice(std::optional<int> choice) { m_choices.push_back(choice); }

    const QStringList& asked() const { return m_asked; }

    std::optional<QString> askText(QWidget* parent, const QString& title, const QString& label,
                                   const QString& suggestion, const TextCheck& check) override;
    bool confirm(QWidget* parent, const QString& title, const QString& question,
                 DefaultAnswer defaultAnswer) override;
    std::optional<int> choose(QWidget* parent, const QString& title, const QString& question,
                              const QStringList& choices, int defaultChoice) override;

private:
    std::deque<std::optional<QString>> m_texts;
    std::deque<bool> m_confirmations;
    std::deque<std::optional<int>> m_choices;
    QStringList m_asked;
};
