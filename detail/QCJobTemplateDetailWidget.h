#pragma once

#include <QRect>
#include <QString>
#include <QStringList>
#include <QWidget>

#include <functional>
#include <memory>
#include <string>

class GraphicsZoomView;
class QCJobTemplateModel;
class QGraphicsScene;
class QImage;

namespace Ui {
class QCJobTemplateDetailWidget;
}

namespace vemi {

class ErrorInfo;
class GeneralSettings;
class Instrument;
class MarloModel;
class MeasurementConfiguration;
class PropertyList;
class QCJobTemplate;
class QGraphicsItemLayer;
class Response;
class SelectedPath;
class ToleranceSet;

// The editor of the job template that is open in the browser: description,
// properties, standards, measurement configuration, default tolerances, the
// repeat flag, the check list and the schematic. Every edit goes through the
// shared template model and ends in sgJobTemplateWasModified. GUI thread only;
// the store model must outlive the widget.
class QCJobTemplateDetailWidget : public QWidget
{
    Q_OBJECT

public:
    QCJobTemplateDetailWidget(MarloModel& store, QWidget* parent, std::shared_ptr<QCJobTemplateModel> model,
                              std::shared_ptr<GeneralSettings> generalSettings);
    ~QCJobTemplateDetailWidget() override;

    // Shows the model's template again, from scratch; the model must hold one.
    // Emits nothing.
    void reloadFromModel();
    // Shows the model's template's name again (after a rename in the browser);
    // nothing else is reloaded, so an edit in progress is left alone.
    void refreshTemplateName();

    // Asks for existing files in a dialog that opens in startFolder and offers
    // nameFilters; returns the chosen files, none when it was cancelled. Tests
    // replace it: a platform's native dialog cannot be driven.
    using FileChooser =
        std::function<QStringList(QWidget* parent, const QString& startFolder, const QStringList& nameFilters)>;
    void setFileChooser(FileChooser chooser);

signals:
    void sgJobTemplateWasModified(std::shared_ptr<vemi::QCJobTemplate> jobTemplate);

private slots:
    void on_browseSchematicButton_clicked();
    void on_cropSchematicButton_clicked();
    void on_fitToWindowButton_clicked();
    void on_resetZoomButton_clicked();
    void on_clearSchematicButton_clicked();
    void onSavedMc(std::shared_ptr<vemi::Response> response);
    void onSaveError(std::shared_ptr<vemi::ErrorInfo> errorInfo);
    void onSaveProgress(std::shared_ptr<vemi::Response> response);
    void onColorLibraryLoaded(std::shared_ptr<Response> response);
    void onPropertyLibraryLoaded(std::shared_ptr<Response> response);
    void onNewStandardLoaded(std::shared_ptr<Response> response);
    void onNewToleranceLoaded(std::shared_ptr<Response> response);
    void onGrabRubberBandedImageArea(int cpIndex);
    void on_addMeasurementConfigurationButton_clicked();
    void on_zoomInButton_clicked();
    void on_zoomOutButton_clicked();
    void on_addProperty_clicked();
    void on_libraryLoadButton_clicked();
    void on_addStandardButton_clicked();
    void on_clearAllStandards_clicked();
    void on_removeTag_clicked();
    void on_insertToleranceButton_clicked();
    void on_removeToleranceButton_clicked();
    void on_enableRepeatCheckBox_clicked();
    void on_descriptionEdit_textEdited(QString arg1);
    void on_addPropertyLibrary_clicked();

protected slots:
    void onInstrumentConnected(std::shared_ptr<vemi::Instrument> instrument);
    void onInstrumentDisconnected(std::shared_ptr<vemi::Instrument> instrument);
    void tagEditSelected(int index, std::string tagName);
    void tagRowsSelected(int index, QStringList selectedTags);
    void onPreferredInstrumentChanged(std::shared_ptr<vemi::Instrument> instrument);
    void onPropertyLoaded(std::shared_ptr<Response> response);

private:
    using ResponseSlot = void (QCJobTemplateDetailWidget::*)(std::shared_ptr<Response>);

    struct Picker
    {
        const char* title;
        const std::string& typeId;
        std::shared_ptr<SelectedPath>* position;
        bool firstEntryOnly;
        int depth;
        ResponseSlot onResponse;
    };

    void onTemplateSavable();
    void emitModified();
    // Runs one picker: the dialog, the remembered position, one fetch per entry.
    void runPicker(const Picker& picker);
    void saveSelectedPaths() const;
    // Puts properties into the template, shows and announces them.
    void storeProperties(const PropertyList& properties);
    void fillStandardsList();
    void fillToleranceList();
    // The name of the first standard whose colorimetric condition differs from
    // that of the set's first Lab tolerance, with both conditions; false when
    // the set may be added.
    bool findConditionMismatch(const std::shared_ptr<ToleranceSet>& set, QString* standardName,
                               QString* standardCondition, QString* toleranceCondition) const;
    void clearSchematicScene();
    void showSchematicImage(QImage image);
    void setSchematicControlsEnabled(bool on);
    // Shows the template's stored picture, unless it is too short or too large.
    void showStoredSchematic();
    QString chooseSchematicFile();
    void showSchematicMessage(const QString& text);
    void showTemplateSaveFailed(const QString& message);
    // The overlay: one numbered circle on a translucent rectangle per
    // checkpoint with an area, drawn by the check list editor's signals.
    void addCheckPointToSchematic(int cpIndex, int coupletId, QRect rect);
    void refreshCheckPointLayer();
    void showTemplateName(const QString& name);
    // Sends the UpdateObject; its answer comes to onSavedMc or onSaveError.
    void storeMeasurementConfiguration(const std::shared_ptr<MeasurementConfiguration>& configuration);

    MarloModel& m_store;
    std::shared_ptr<QCJobTemplateModel> m_model;
    std::shared_ptr<GeneralSettings> m_generalSettings;
    Ui::QCJobTemplateDetailWidget* m_ui;
    std::unique_ptr<QGraphicsScene> m_scene;
    // Owned here; while m_overlayInScene the scene holds it, and it is taken
    // out again before the scene is cleared or destroyed.
    std::unique_ptr<QGraphicsItemLayer> m_overlayLayer;
    bool m_overlayInScene = false;
    GraphicsZoomView* m_zoom = nullptr;
    FileChooser m_chooseFiles;
    QString m_schematicPath;
    std::shared_ptr<SelectedPath> m_libraryPath;
    std::shared_ptr<SelectedPath> m_standardPath;
    std::shared_ptr<SelectedPath> m_tolerancePath;
    std::shared_ptr<SelectedPath> m_propertyPath;
};

} // namespace vemi
