#pragma once

#include <QWidget>

#include <memory>

class QCJobTemplateModel;
class QLabel;

namespace vemi {

class GeneralSettings;
class MarloModel;
class QCJobTemplate;

// The editor of the job template that is open in the browser. It shows
// which template is open; the editing panes build on it.
class QCJobTemplateDetailWidget : public QWidget
{
    Q_OBJECT

public:
    QCJobTemplateDetailWidget(MarloModel& store, QWidget* parent, std::shared_ptr<QCJobTemplateModel> model,
                              std::shared_ptr<GeneralSettings> generalSettings);
    ~QCJobTemplateDetailWidget() override;

    // Shows the model's template again, from scratch.
    void reloadFromModel();

signals:
    // Every edit made here ends in this signal with the edited template.
    void sgJobTemplateWasModified(std::shared_ptr<vemi::QCJobTemplate> jobTemplate);

private:
    MarloModel& m_store;
    std::shared_ptr<QCJobTemplateModel> m_model;
    std::shared_ptr<GeneralSettings> m_generalSettings;
    QLabel* m_heading;
    QLabel* m_summary;
};

} // namespace vemi
