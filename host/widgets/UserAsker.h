#pragma once

#include <QString>
#include <QStringList>

#include <optional>

class QWidget;

namespace vemi {

// The questions a browser puts to the user while it manages folders and
// entries. DialogAsker asks with modal dialogs; tests answer from a script.
class UserAsker
{
public:
    virtual ~UserAsker() = default;
    // The text entered, or nothing when the user cancelled.
    virtual std::optional<QString> askText(QWidget* parent, const QString& title, const QString& label,
                                           const QString& suggestion) = 0;
    // Whether the user answered yes.
    virtual bool confirm(QWidget* parent, const QString& title, const QString& question) = 0;
};

} // namespace vemi
