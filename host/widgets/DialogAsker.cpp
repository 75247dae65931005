#include "host/widgets/DialogAsker.h"

#include "host/widgets/NameDialog.h"

#include <QCoreApplication>
#include <QInputDialog>
#include <QMessageBox>
#include <QPushButton>

namespace vemi {

std::optional<QString> DialogAsker::askText(QWidget* parent, const QString& title, const QString& label,
                                            const QString& suggestion, const TextCheck& check)
{
    NameDialog dialog(title, label, suggestion, check, parent);
    return dialog.exec() == QDialog::Accepted ? std::optional<QString>(dialog.name()) : std::nullopt;
}

bool DialogAsker::confirm(QWidget* parent, const QString& title, const QString& question,
                          DefaultAnswer defaultAnswer)
{
    QMessageBox box(QMessageBox::Question, title, question, QMessageBox::Yes | QMessageBox::No, parent);
    box.button(QMessageBox::Yes)->setText(QCoreApplication::translate("vemi::DialogAsker", "&Yes"));
    box.button(QMessageBox::No)->setText(QCoreApplication::translate("vemi::DialogAsker", "&No"));
    box.setDefaultButton(defaultAnswer == DefaultAnswer::Yes ? QMessageBox::Yes : QMessageBox::No);
    box.setEscapeButton(QMessageBox::No);
    return box.exec() == QMessageBox::Yes;
}

} // namespace vemi
