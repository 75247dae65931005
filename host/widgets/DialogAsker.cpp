#include "host/widgets/DialogAsker.h"

#include <QInputDialog>
#include <QMessageBox>

namespace vemi {

std::optional<QString> DialogAsker::askText(QWidget* parent, const QString& title, const QString& label,
                                            const QString& suggestion)
{
    bool ok = false;
    const QString text = QInputDialog::getText(parent, title, label, QLineEdit::Normal, suggestion, &ok);
    return ok ? std::optional<QString>(text) : std::nullopt;
}

bool DialogAsker::confirm(QWidget* parent, const QString& title, const QString& question)
{
    return QMessageBox::question(parent, title, question) == QMessageBox::Yes;
}

} // namespace vemi
