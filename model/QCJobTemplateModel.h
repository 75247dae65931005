#pragma once

#include <QObject>

#include <memory>
#include <string>
#include <vector>

namespace vemi {
class Command;
class MarloModel;
class QCJobTemplate;
class Response;
class TagDefinition;
class TagValue;
} // namespace vemi

// The editing model of the open job template, shared by the browser, the
// detail editor and the checkpoint editor. It holds the very template object
// that the host browser's tree node holds, so every change it makes is a
// change of the object the host later saves. Lives on the GUI thread.
class QCJobTemplateModel : public QObject
{
    Q_OBJECT

public:
    explicit QCJobTemplateModel(vemi::MarloModel& store);
    ~QCJobTemplateModel() override;

    // Requests the colour standards libraries, then makes jobTemplate the one
    // being edited. Emits nothing.
    void setJobTemplate(std::shared_ptr<vemi::QCJobTemplate> jobTemplate);
    // Empty until the first setJobTemplate.
    std::shared_ptr<vemi::QCJobTemplate> jobTemplate() const;
    void notifyMeasurementConfigLoaded();
    // Stores the template at once through the default dispatcher.
    void saveJobTemplate();

    // The operations below need a template to be set and emit nothing.
    void setDescription(const std::string& description);
    std::vector<std::shared_ptr<vemi::TagDefinition>> tagDefinitions() const;
    void setTagDefinitions(const std::vector<std::shared_ptr<vemi::TagDefinition>>& definitions);
    std::vector<std::shared_ptr<vemi::TagValue>> tagValues() const;
    void setTagValues(const std::vector<std::shared_ptr<vemi::TagValue>>& values);
    void setEnableRepeat(bool enable);

signals:
    void sgMeasurementConfigLoaded();
    void sgSetTemplateSavable();

private:
    // Answers of the model's own commands change nothing here: a request's
    // only effect is on the store side.
    void onLibrariesReceived(std::shared_ptr<vemi::Response> response);
    void onTemplateSaved(std::shared_ptr<vemi::Response> response);
    void runCommand(std::shared_ptr<vemi::Command> command,
                    void (QCJobTemplateModel::*handler)(std::shared_ptr<vemi::Response>));

    vemi::MarloModel& m_store;
    std::shared_ptr<vemi::QCJobTemplate> m_template;
};
