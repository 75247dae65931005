#pragma once

#include "host/widgets/UserAsker.h"

namespace vemi {

// Asks with modal dialogs: a NameDialog for texts, Qt's standard dialogs
// (QInputDialog, QMessageBox) for the rest.
class DialogAsker : public UserAsker
{
public:
    std::optional<QString> askText(QWidget* parent, const QString& title, const QString& label,
                                   const QString& suggestion, const TextCheck& check) override;
    bool confirm(QWidget* parent, const QString& title, const QString& question,
                 DefaultAnswer defaultAnswer) override;
    std::optional<int> choose(QWidget* parent, const QString& title, const QString& question,
                              const QStringList& choices, int defaultChoice) override;
};

} // namespace vemi
