#include "host/widgets/DialogAsker.h"

#include "host/widgets/NameDialog.h"

#include <QCoreApplication>
#include <algorithm>
#include <vector>

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

std::optional<int> DialogAsker::choose(QWidget* parent, const QString& title, const QString& question,
                                       const QStringList& choices, int defaultChoice)
{
    QMessageBox box(QMessageBox::Question, title, question, QMessageBox::NoButton, parent);
    std::vector<QPushButton*> buttons;
    for (const QString& choice : choices)
        buttons.push_back(box.addButton(choice, QMessageBox::AcceptRole));
    QPushButton* cancel =
        box.addButton(QCoreApplication::translate("vemi::DialogAsker", "&Cancel"), QMessageBox::RejectRole);
    box.setEscapeButton(cancel);
    if (defaultChoice >= 0 && size_t(defaultChoice) < buttons.size())
        box.setDefaultButton(buttons[size_t(defaultChoice)]);
    box.exec();
    const auto chosen = std::find(buttons.begin(), buttons.end(), box.clickedButton());
    if (chosen == buttons.end())
        return std::nullopt;
    return int(chosen - buttons.begin());
}

} // namespace vemi
