#pragma once

#include "host/widgets/BaseObjectTreeModel.h"
#include "host/widgets/DirEntryBrowserInterface.h"

#include <QDialog>
#include <QVector>

#include <memory>
#include <string>

class QPushButton;
class QSplitter;

namespace Ui {
class MeasurementConfigurationDialog;
}

namespace vemi {

class DirEntry;
class FolderBrowserWidget;
class GeneralSettings;
class MarloModel;
class MeasurementConfiguration;
class MeasurementConfigurationWidget;
class Response;

// Chooses a job template's measurement configuration: the stored
// configurations in a folder browser on the left (which creates, duplicates
// and deletes them in the store), the one selected in an editor on the right.
// The dialog itself stores nothing; its caller takes measurementConfiguration()
// after exec() returned 1. Results 0 and -1 (after a store error) choose nothing.
class MeasurementConfigurationDialog : public QDialog, public DirEntryBrowserInterface
{
    Q_OBJECT

public:
    // store must outlive the dialog; settings may be empty.
    MeasurementConfigurationDialog(MarloModel& store, std::shared_ptr<GeneralSettings> settings,
                                   QWidget* parent = nullptr);
    ~MeasurementConfigurationDialog() override;

    // The configuration shown, with the user's edits written into it; empty
    // when none was loaded. Each call writes the edits again.
    std::shared_ptr<MeasurementConfiguration> measurementConfiguration();

    std::shared_ptr<NamedObject> newNamedObject() override;
    std::string namedObjectTypeId() override;

    FolderBrowserWidget* folderBrowser() const { return m_browser; }
    MeasurementConfigurationWidget* configurationWidget() const { return m_configurationWidget; }
    QSplitter* splitter() const { return m_splitter; }

protected:
    void changeEvent(QEvent* event) override;

private slots:
    void onErrorOccurred(QString errorString);
    void onDirEntryChanged(std::shared_ptr<vemi::DirEntry> dirEntry);
    void onSelectedObjectsLoaded(std::shared_ptr<vemi::Response> response);

private:
    void onSelectionChanged(const QVector<BaseObjectTreeModel::Node*>& nodes);
    QPushButton* okButton() const;
    void restoreSplitter();

    Ui::MeasurementConfigurationDialog* m_ui;
    FolderBrowserWidget* m_browser;
    MeasurementConfigurationWidget* m_configurationWidget;
    MarloModel& m_store;
    QSplitter* m_splitter;
    std::string m_shownId; // id of the configuration the editor shows; empty for none
};

} // namespace vemi
