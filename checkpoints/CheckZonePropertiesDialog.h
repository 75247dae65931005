#pragma once

#include <QDialog>
#include <QStringList>

#include <memory>
#include <string>
#include <vector>

class QCJobTemplateModel;

namespace Ui {
class CheckZonePropertiesDialog;
}

namespace vemi {
class CheckPoint;
class ErrorInfo;
class MarloModel;
class PropertyList;
class Response;
class SelectedPath;
class Standard;
class TagDefinition;
class TagValue;
} // namespace vemi

// Edits one checkpoint's name, skippable flag, standard (one of the
// template's, or none for automatic selection) and properties. Works on
// copies: neither the checkpoint nor the template is changed; the caller
// reads the results after exec() returned Accepted and writes them back.
// Modal, used once, GUI thread only; the store set with setMarloModel must
// outlive the dialog.
class CheckZonePropertiesDialog : public QDialog
{
    Q_OBJECT

public:
    CheckZonePropertiesDialog(std::shared_ptr<vemi::CheckPoint> checkPoint, std::shared_ptr<QCJobTemplateModel> model,
                              QWidget* parent);
    ~CheckZonePropertiesDialog() override;

    // The store the pickers and the value editor use; set before exec().
    void setMarloModel(vemi::MarloModel* store);

    QString name() const;
    bool skippable() const;
    // Null for "Auto Select".
    std::shared_ptr<vemi::Standard> standard() const;
    std::vector<std::shared_ptr<vemi::TagDefinition>> tagDefinitions() const;
    std::vector<std::shared_ptr<vemi::TagValue>> tagValues() const;

protected:
    void changeEvent(QEvent* event) override;

private slots:
    void tagEditSelected(int index, std::string tagName);
    void tagRowsSelected(int index, QStringList selectedTags);
    void on_standardsComboBox_currentIndexChanged(int index);
    void on_AddTagsButton_clicked();
    void on_removeTagButton_clicked();
    void onSavedMc(std::shared_ptr<vemi::Response> response);
    void onSaveError(std::shared_ptr<vemi::ErrorInfo> errorInfo);
    void onSaveProgress(std::shared_ptr<vemi::Response> response);
    void onPropertyLoaded(std::shared_ptr<vemi::Response> response);
    void onPropertyLibraryLoaded(std::shared_ptr<vemi::Response> response);
    void on_AddPropertyLibrary_clicked();

private:
    using ResponseSlot = void (CheckZonePropertiesDialog::*)(std::shared_ptr<vemi::Response>);

    void fillStandardsList();
    void selectCheckPointStandard();
    void showProperties();
    void runPropertyPicker(const char* title, const std::string& typeId, bool firstEntryOnly, int depth,
                           ResponseSlot onResponse);
    std::vector<std::shared_ptr<vemi::TagDefinition>> templateDefinitions() const;

    Ui::CheckZonePropertiesDialog* m_ui;
    std::shared_ptr<QCJobTemplateModel> m_model;
    std::shared_ptr<vemi::CheckPoint> m_checkPoint;
    std::shared_ptr<vemi::Standard> m_selectedStandard;
    std::unique_ptr<vemi::PropertyList> m_properties;
    vemi::MarloModel* m_store = nullptr;
    std::shared_ptr<vemi::SelectedPath> m_propertyPath;
    QString m_formTitle;
};
