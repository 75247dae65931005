#pragma once

#include "host/widgets/UserAsker.h"

#include <QDialog>

class QDialogButtonBox;
class QLabel;
class QLineEdit;

namespace vemi {

// Asks for the name of a folder or an entry. While the check refuses the
// text, OK stays disabled and the reason shows under the field.
class NameDialog : public QDialog
{
    Q_OBJECT

public:
    NameDialog(const QString& title, const QString& label, const QString& suggestion,
               UserAsker::TextCheck check, QWidget* parent = nullptr);

    // The text entered, without blanks around it.
    QString name() const;

private:
    void onTextChanged(const QString& text);

    UserAsker::TextCheck m_check;
    QLineEdit* m_edit;
    QLabel* m_problem;
    QDialogButtonBox* m_buttons;
};

} // namespace vemi
