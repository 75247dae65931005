#pragma once

#include <QDialog>

#include <memory>
#include <string>
#include <vector>

class QComboBox;
class QLabel;
class QLineEdit;

namespace vemi {

class MarloModel;
class TagDefinition;
class TagValue;

// Edits the value of one tag definition: a line edit for text and numbers,
// a list for a definition with allowed values. Refuses to close on a value
// the definition does not allow, and says why.
class TagDefinitionDialog : public QDialog
{
    Q_OBJECT

public:
    explicit TagDefinitionDialog(QWidget* parent = nullptr);

    // Runs the dialog modally on definition's value in values. True when the
    // user accepted a changed value; values then holds it (see TagValueEdit::write).
    // The store is where definitions come from; the value is edited on its own.
    bool edit(MarloModel& store, std::vector<std::shared_ptr<TagValue>>& values,
              const std::shared_ptr<TagDefinition>& definition);

    void accept() override;

private:
    void show(const TagDefinition& definition, const std::string& value);
    QString enteredText() const;

    std::shared_ptr<TagDefinition> m_definition;
    QString m_openedWith;
    QLabel* m_nameLabel;
    QLineEdit* m_valueEdit;
    QComboBox* m_valueChoice;
    QLabel* m_errorLabel;
};

} // namespace vemi
