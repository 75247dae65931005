#pragma once

#include <QString>
#include <QStringList>

#include <functional>
#include <optional>

class QWidget;

namespace vemi {

// The questions a browser puts to the user while it manages folders and
// entries. DialogAsker asks with modal dialogs; tests answer from a script.
class UserAsker
{
public:
    // Why a text cannot be taken as it stands; empty when it can.
    using TextCheck = std::function<QString(const QString& text)>;
    enum class DefaultAnswer { Yes, No };

    virtual ~UserAsker() = default;
    // The text entered, or nothing when the user cancelled. A text that check
    // refuses cannot be confirmed; the user sees why.
    virtual std::optional<QString> askText(QWidget* parent, const QString& title, const QString& label,
                                           const QString& suggestion, const TextCheck& check) = 0;
    // Whether the user answered yes; defaultAnswer is what Enter chooses.
    virtual bool confirm(QWidget* parent, const QString& title, const QString& question,
                         DefaultAnswer defaultAnswer) = 0;
    // The index of the choice the user took among choices (button texts),
    // or nothing when the user cancelled; defaultChoice is what Enter takes.
    virtual std::optional<int> choose(QWidget* parent, const QString& title, const QString& question,
                                      const QStringList& choices, int defaultChoice) = 0;
};

} // namespace vemi
