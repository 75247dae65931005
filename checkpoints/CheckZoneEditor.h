#pragma once

#include <QPixmap>
#include <QRect>
#include <QWidget>

#include <memory>

class QCJobTemplateModel;

namespace Ui {
class CheckZoneEditor;
}

namespace vemi {
class MarloModel;
}

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
    void onMeasurementConfigLoaded();
    void setCurrentThumbnail(int cpIndex, QPixmap pixmap);
    void publishCheckPoints();

signals:
    void sgGrabRubberBandedArea(int selectedCheckZoneIndex);
    void sgAddCheckpointToSchematic(int cpIndex, int couplet_id, QRect rect);
    void sgSetTemplateSavable();
    void sgRefreshCheckPointLayer();

private:
    Ui::CheckZoneEditor* m_ui;
    vemi::MarloModel* m_store = nullptr;
    std::shared_ptr<QCJobTemplateModel> m_model;
};
