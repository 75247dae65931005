#include "QCJobTemplateModel.h"

#include "ColorStandardsLibrary.h"
#include "CommandDispatcher.h"
#include "GetMarloObjects.h"
#include "Header.h"
#include "MarloModel.h"
#include "QCJobTemplate.h"
#include "QtCommand.h"
#include "TagDefinition.h"
#include "TagValue.h"
#include "UpdateObject.h"

QCJobTemplateModel::QCJobTemplateModel(vemi::MarloModel& store)
    : m_store(store)
{
}

QCJobTemplateModel::~QCJobTemplateModel() = default;

void QCJobTemplateModel::runCommand(std::shared_ptr<vemi::Command> command,
                                    void (QCJobTemplateModel::*handler)(std::shared_ptr<vemi::Response>))
{
    const auto dispatcher = m_store.commandDispatcher("");
    if (!dispatcher)
        return;
    auto wrapper = std::make_shared<vemi::QtCommand>(std::move(command));
    connect(wrapper.get(), &vemi::QtCommand::responseReceived, this, handler);
    dispatcher->dispatch(wrapper);
}

void QCJobTemplateModel::setJobTemplate(std::shared_ptr<vemi::QCJobTemplate> jobTemplate)
{
    auto request = std::make_shared<vemi::GetMarloObjects>();
    request->setType(vemi::ColorStandardsLibrary::typeId());
    runCommand(request, &QCJobTemplateModel::onLibrariesReceived);
    m_template = std::move(jobTemplate);
}

std::shared_ptr<vemi::QCJobTemplate> QCJobTemplateModel::jobTemplate() const
{
    return m_template;
}

void QCJobTemplateModel::notifyMeasurementConfigLoaded()
{
    emit sgMeasurementConfigLoaded();
}

void QCJobTemplateModel::saveJobTemplate()
{
    auto update = std::make_shared<vemi::UpdateObject>();
    update->setObject(std::static_pointer_cast<vemi::BaseObject>(m_template));
    runCommand(update, &QCJobTemplateModel::onTemplateSaved);
}

void QCJobTemplateModel::onLibrariesReceived(std::shared_ptr<vemi::Response>)
{
}

void QCJobTemplateModel::onTemplateSaved(std::shared_ptr<vemi::Response>)
{
}

void QCJobTemplateModel::setDescription(const std::string& description)
{
    m_template->header()->setDescription(description);
}

std::vector<std::shared_ptr<vemi::TagDefinition>> QCJobTemplateModel::tagDefinitions() const
{
    return m_template->tagDefinitions();
}

void QCJobTemplateModel::setTagDefinitions(const std::vector<std::shared_ptr<vemi::TagDefinition>>& definitions)
{
    m_template->setTagDefinitions(definitions);
}

std::vector<std::shared_ptr<vemi::TagValue>> QCJobTemplateModel::tagValues() const
{
    return m_template->tagValues();
}

void QCJobTemplateModel::setTagValues(const std::vector<std::shared_ptr<vemi::TagValue>>& values)
{
    m_template->setTagValues(values);
}

void QCJobTemplateModel::setEnableRepeat(bool enable)
{
    m_template->setEnableRepeat(enable);
}
