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

std::optional<int> DialogAsker::askItem(QWidget* parent, const QString& title, const QString& label,
                                        const QStringList& items)
{
    bool ok = false;
    const QString chosen = QInputDialog::getItem(parent, title, label, items, 0, false, &ok);
    const int position = items.indexOf(chosen);
    return ok && position >= 0 ? std::optional<int>(position) : std::nullopt;
}

bool DialogAsker::confirm(QWidget* parent, const QString& title, const QString& question)
{
    return QMessageBox::question(parent, title, question) == QMessageBox::Yes;
}

} // namespace vemi
