#pragma once

#include <QPixmap>
#include <QPointer>
#include <QRect>
#include <QStringList>
#include <QWidget>

#include <memory>

class CheckPointCouplet;
class CheckZoneListItem;
class QCJobTemplateModel;
class QListWidgetItem;

namespace Ui {
class CheckZoneEditor;
}

namespace vemi {
class CheckPoint;
class CheckPointCouple;
class MarloModel;
} // namespace vemi

// The check list of the open template beside the schematic: one row per
// single checkpoint or couple. Every change goes through the template model;
// the signals feed the schematic pane's overlay and the modified mark.
class CheckZoneEditor : public QWidget
{
    Q_OBJECT

public:
    explicit CheckZoneEditor(QWidget* parent = nullptr);
    ~CheckZoneEditor() override;

    // Attaches the editor to the store and the template model; once.
    void init(vemi::MarloModel& store, std::shared_ptr<QCJobTemplateModel> model);
    // Adding checkpoints needs a measurement configuration on the template.
    // Rebuilds the list from the template.
    void onMeasurementConfigLoaded();
    // Shows pixmap as the thumbnail of the selected checkpoint; cpIndex is not consulted.
    void setCurrentThumbnail(int cpIndex, QPixmap pixmap);
    // Emits sgAddCheckpointToSchematic for every checkpoint, with or without an area.
    void publishCheckPoints();

signals:
    void sgGrabRubberBandedArea(int selectedCheckZoneIndex);
    void sgAddCheckpointToSchematic(int cpIndex, int couplet_id, QRect rect);
    void sgSetTemplateSavable();
    void sgRefreshCheckPointLayer();

protected:
    void changeEvent(QEvent* event) override;

private slots:
    void on_addCheckZoneButton_clicked();
    void on_deleteCheckZoneButton_clicked();
    void on_checkZoneListWidget_itemPressed(QListWidgetItem* item);
    void on_checkZoneListWidget_itemClicked(QListWidgetItem* item);
    void on_addImageButton_clicked();
    void on_moveCheckZoneUpButton_clicked();
    void on_moveCheckZoneDownButton_clicked();
    void on_checkZonePropertiesButton_clicked();
    void on_coupleCheckPointsButton_clicked();
    void on_deCoupleCheckPointsButton_clicked();
    void on_swapCoupledCheckPoints_clicked();

private:
    // Makes item (may be null) the row the buttons act on; in a couple row
    // the cursor's height picks the member.
    void selectRow(QListWidgetItem* item);
    void updateButtons(bool enabled);
    bool selectionCanBeCoupled() const;
    void rebuild();
    void clearRows();
    void deleteRowWidget(QListWidgetItem* row);
    // Returns the new row's index. An empty checkPoint is a brand-new one:
    // its name gets the focus and its row is selected.
    int addCheckPointRow(const std::shared_ptr<vemi::CheckPoint>& checkPoint, const QString& name,
                         int coupletId, int cpIndex);
    // Returns the checkpoint index after the couple's members.
    int addCoupleRows(const std::shared_ptr<vemi::CheckPointCouple>& couple, int coupletId, int cpIndex);
    void coupleRows(QListWidgetItem* first, QListWidgetItem* second, bool fromTemplate, const QString& letter);
    // Gives every row its check-list index and every item its checkpoint
    // index, in list order.
    void renumberRows();
    // Redraws the overlay for the checkpoints that have an area image.
    void redrawSchematicOverlay();
    QString nextCoupleLetter();
    void moveCurrentRow(int direction);
    void renameCheckPoint(int cpIndex, const QString& name);
    CheckPointCouplet* coupletOf(QListWidgetItem* row) const;
    // The checkpoint item of the current row that the buttons act on; may be null.
    CheckZoneListItem* selectedPartItem() const;

    Ui::CheckZoneEditor* m_ui;
    vemi::MarloModel* m_store = nullptr;
    std::shared_ptr<QCJobTemplateModel> m_model;
    QListWidgetItem* m_currentRow = nullptr; // owned by the list widget
    int m_selectedPart = 0;
    QPointer<CheckZoneListItem> m_selectedItem;
    QStringList m_usedLetters;
};
