#pragma once

#include "host/widgets/UserAsker.h"

namespace vemi {

// Asks with Qt's standard modal dialogs (QInputDialog, QMessageBox).
class DialogAsker : public UserAsker
{
public:
    std::optional<QString> askText(QWidget* parent, const QString& title, const QString& label,
                                   const QString& suggestion) override;
    bool confirm(QWidget* parent, const QString& title, const QString& question) override;
};

} // namespace vemi
