#include "host/widgets/NameDialog.h"

#include <QDialogButtonBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace vemi {

NameDialog::NameDialog(const QString& title, const QString& label, const QString& suggestion,
                       UserAsker::TextCheck check, QWidget* parent)
    : QDialog(parent), m_check(std::move(check)), m_edit(new QLineEdit(suggestion, this)),
      m_problem(new QLabel(this)),
      m_buttons(new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this))
{
    setWindowTitle(title);
    auto* caption = new QLabel(label, this);
    caption->setBuddy(m_edit);
    m_problem->setObjectName(QStringLiteral("problem"));
    m_problem->setWordWrap(true);
    QPalette palette = m_problem->palette();
    palette.setColor(QPalette::WindowText, QColor(0xb0, 0x00, 0x20));
    m_problem->setPalette(palette);
    m_edit->selectAll();
    // Long names stay readable without the dialog growing past the screen.
    m_edit->setMinimumWidth(320);

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(caption);
    layout->addWidget(m_edit);
    layout->addWidget(m_problem);
    layout->addWidget(m_buttons);
    connect(m_buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(m_buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    connect(m_edit, &QLineEdit::textChanged, this, &NameDialog::onTextChanged);
    onTextChanged(suggestion);
}

QString NameDialog::name() const
{
    return m_edit->text().trimmed();
}

void NameDialog::onTextChanged(const QString& text)
{
    const QString problem = m_check ? m_check(text) : QString();
    m_problem->setText(problem);
    m_problem->setVisible(!problem.isEmpty());
    m_buttons->button(QDialogButtonBox::Ok)->setEnabled(problem.isEmpty());
}

} // namespace vemi
