#include "host/widgets/TagDefinitionDialog.h"

#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/widgets/TagValueEdit.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QVBoxLayout>

namespace vemi {

TagDefinitionDialog::TagDefinitionDialog(QWidget* parent)
    : QDialog(parent)
    , m_nameLabel(new QLabel(this))
    , m_valueEdit(new QLineEdit(this))
    , m_valueChoice(new QComboBox(this))
    , m_errorLabel(new QLabel(this))
{
    setWindowTitle(tr("Edit Property"));
    m_nameLabel->setObjectName(QStringLiteral("nameLabel"));
    m_nameLabel->setTextFormat(Qt::PlainText);
    m_valueEdit->setObjectName(QStringLiteral("valueEdit"));
    m_valueChoice->setObjectName(QStringLiteral("valueChoice"));
    m_errorLabel->setObjectName(QStringLiteral("errorLabel"));
    m_errorLabel->setTextFormat(Qt::PlainText);
    m_errorLabel->setWordWrap(true);
    m_errorLabel->hide();

    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    buttons->setObjectName(QStringLiteral("buttonBox"));
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);

    auto* form = new QFormLayout;
    form->addRow(tr("Property:"), m_nameLabel);
    form->addRow(tr("Value:"), m_valueEdit);
    form->addRow(QString(), m_valueChoice);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(form);
    layout->addWidget(m_errorLabel);
    layout->addWidget(buttons);
}

bool TagDefinitionDialog::edit(MarloModel& /*store*/, std::vector<std::shared_ptr<TagValue>>& values,
                               const std::shared_ptr<TagDefinition>& definition)
{
    if (!definition)
        return false;
    m_definition = definition;
    show(*definition, TagValueEdit::shownValue(values, *definition));
    if (exec() != QDialog::Accepted)
        return false;
    return TagValueEdit::write(values, *definition, enteredText().toStdString());
}

void TagDefinitionDialog::show(const TagDefinition& definition, const std::string& value)
{
    m_nameLabel->setText(QString::fromStdString(definition.name()));
    m_errorLabel->hide();
    const std::vector<std::string> allowed = definition.allowedValues();
    const bool choice = !allowed.empty();
    m_valueEdit->setVisible(!choice);
    m_valueChoice->setVisible(choice);
    m_valueChoice->clear();
    for (const std::string& option : allowed)
        m_valueChoice->addItem(QString::fromStdString(option));
    // A stored value outside the list stays selectable, so that opening and
    // accepting the dialog never changes it.
    const QString current = QString::fromStdString(value);
    m_openedWith = current;
    if (choice && m_valueChoice->findText(current, Qt::MatchExactly | Qt::MatchCaseSensitive) < 0)
        m_valueChoice->insertItem(0, current);
    m_valueChoice->setCurrentIndex(m_valueChoice->findText(current, Qt::MatchExactly | Qt::MatchCaseSensitive));
    m_valueEdit->setText(current);
    m_valueEdit->selectAll();
}

QString TagDefinitionDialog::enteredText() const
{
    return m_valueChoice->isVisibleTo(this) ? m_valueChoice->currentText() : m_valueEdit->text().trimmed();
}

void TagDefinitionDialog::accept()
{
    // The value it opened with is never refused: accepting it changes nothing.
    const QString text = enteredText();
    const QString why = m_definition && text != m_openedWith ? TagValueEdit::rejection(*m_definition, text) : QString();
    if (!why.isEmpty()) {
        m_errorLabel->setText(why);
        m_errorLabel->show();
        return;
    }
    QDialog::accept();
}

} // namespace vemi
