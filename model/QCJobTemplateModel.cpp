#include "model/QCJobTemplateModel.h"

#include "host/domain/CheckPoint.h"
#include "host/domain/CheckPointCouple.h"
#include "host/domain/ColorStandardsLibrary.h"
#include "host/store/CommandSender.h"
#include "host/store/ErrorInfo.h"
#include "host/store/GetMarloObjects.h"
#include "host/domain/Header.h"
#include "host/store/MarloModel.h"
#include "host/domain/Position.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/store/UpdateObject.h"

#include <QBuffer>
#include <QFile>
#include <QFileInfo>
#include <QPixmap>
#include <QRect>

#include <algorithm>
#include <cstring>
#include <stdexcept>

namespace {

const char* const firstMatchPoint = "<CP1>";
const char* const secondMatchPoint = "<CP2>";

// One block copy: a schematic may hold 10 MB.
std::vector<unsigned char> toBytes(const QByteArray& bytes)
{
    std::vector<unsigned char> result(std::size_t(bytes.size()));
    if (!bytes.isEmpty())
        std::memcpy(result.data(), bytes.constData(), result.size());
    return result;
}

// The text after the last "." of the path, or the whole path without one.
std::string formatOfPath(const QString& path)
{
    const int dot = path.lastIndexOf(QLatin1Char('.'));
    return (dot < 0 ? path : path.mid(dot + 1)).toStdString();
}

} // namespace

QCJobTemplateModel::QCJobTemplateModel(vemi::MarloModel& store)
    : m_store(store)
{
}

QCJobTemplateModel::~QCJobTemplateModel() = default;

void QCJobTemplateModel::runCommand(std::shared_ptr<vemi::Command> command, ResponseHandler onResponse,
                                    ErrorHandler onError)
{
    vemi::CommandSender::OnError errorHandler;
    if (onError)
        errorHandler = [this, onError](const std::shared_ptr<vemi::ErrorInfo>& error) { (this->*onError)(error); };
    vemi::CommandSender::send(m_store, std::string(), std::move(command), this,
                              [this, onResponse](const std::shared_ptr<vemi::Response>& response) {
                                  (this->*onResponse)(response);
                              },
                              errorHandler);
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
    runCommand(update, &QCJobTemplateModel::onTemplateSaved, &QCJobTemplateModel::onTemplateSaveError);
}

void QCJobTemplateModel::onLibrariesReceived(std::shared_ptr<vemi::Response>)
{
}

void QCJobTemplateModel::onTemplateSaved(std::shared_ptr<vemi::Response>)
{
}

// The editor believes a cleared picture is stored; it must hear otherwise.
void QCJobTemplateModel::onTemplateSaveError(std::shared_ptr<vemi::ErrorInfo> error)
{
    emit sgTemplateSaveFailed(error ? error->message() : QString());
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

// --- Check list -------------------------------------------------------------
// Every change edits a copy of the item list and writes it back whole.

bool QCJobTemplateModel::isItemIndex(int index) const
{
    return index >= 0 && size_t(index) < m_template->checkListItems().size();
}

bool QCJobTemplateModel::isCheckPointIndex(int index) const
{
    return index >= 0 && index < checkPointCount();
}

std::shared_ptr<vemi::CheckPointCouple> QCJobTemplateModel::coupleAt(int index) const
{
    if (!isItemIndex(index))
        return nullptr;
    return std::dynamic_pointer_cast<vemi::CheckPointCouple>(m_template->checkListItems()[size_t(index)]);
}

int QCJobTemplateModel::checkPointCount() const
{
    return int(m_template->checkPoints().size());
}

std::shared_ptr<vemi::CheckPoint> QCJobTemplateModel::checkPointAt(int index) const
{
    if (!isCheckPointIndex(index))
        throw std::out_of_range("invalid vector<T> subscript");
    return m_template->checkPoints()[size_t(index)];
}

int QCJobTemplateModel::checkZoneIndex(const std::shared_ptr<vemi::CheckPoint>& checkPoint) const
{
    return int(m_template->checkZoneIndex(checkPoint));
}

std::shared_ptr<vemi::CheckPoint> QCJobTemplateModel::addCheckPoint(const QString& name)
{
    auto items = m_template->checkListItems();
    auto checkPoint = std::make_shared<vemi::CheckPoint>();
    checkPoint->setName(name.toStdString());
    checkPoint->setPosition(std::make_shared<vemi::Position>());
    checkPoint->setSize(std::make_shared<vemi::Size>());
    checkPoint->setSchematicImage(std::make_shared<vemi::SchematicImage>());
    items.push_back(checkPoint);
    m_template->setCheckListItems(items);
    emit sgSetTemplateSavable();
    return checkPoint;
}

void QCJobTemplateModel::renameCheckPoint(int index, const QString& name)
{
    checkPointAt(index)->setName(name.toStdString());
    emit sgSetTemplateSavable();
}

void QCJobTemplateModel::removeCheckListItem(int index)
{
    if (!isItemIndex(index))
        return;
    auto items = m_template->checkListItems();
    items.erase(items.begin() + index);
    m_template->setCheckListItems(items);
    emit sgSetTemplateSavable();
}

void QCJobTemplateModel::swapCheckListItems(int a, int b)
{
    if (!isItemIndex(a) || !isItemIndex(b))
        return;
    auto items = m_template->checkListItems();
    std::swap(items[size_t(a)], items[size_t(b)]);
    m_template->setCheckListItems(items);
}

int QCJobTemplateModel::coupleCheckPoints(int first, int second, const std::string& name)
{
    if (first == second || !isCheckPointIndex(first) || !isCheckPointIndex(second))
        return -1;
    const auto a = checkPointAt(first);
    const auto b = checkPointAt(second);
    auto items = m_template->checkListItems();
    // A member of a couple is no item of its own; coupling it again would
    // put it into the check list twice.
    const auto position = std::find(items.begin(), items.end(), a);
    if (position == items.end() || std::find(items.begin(), items.end(), b) == items.end())
        return -1;

    a->setMatchPoint(firstMatchPoint);
    b->setMatchPoint(secondMatchPoint);
    auto couple = std::make_shared<vemi::CheckPointCouple>();
    couple->setName(name);
    couple->setCheckPoints({a, b});
    items.insert(position, couple);
    m_template->setCheckListItems(items);
    removeCheckPointItem(a);
    removeCheckPointItem(b);
    emit sgSetTemplateSavable();
    return first;
}

void QCJobTemplateModel::removeCheckPointItem(const std::shared_ptr<vemi::CheckPoint>& checkPoint)
{
    auto items = m_template->checkListItems();
    items.erase(std::remove(items.begin(), items.end(), checkPoint), items.end());
    m_template->setCheckListItems(items);
    emit sgSetTemplateSavable();
}

void QCJobTemplateModel::decoupleCheckPoints(int index)
{
    const auto couple = coupleAt(index);
    if (!couple)
        return;
    auto items = m_template->checkListItems();
    std::vector<std::shared_ptr<vemi::CheckListItem>> members;
    for (const auto& member : couple->checkPoints()) {
        if (!member)
            continue;
        member->setMatchPoint(std::string());
        members.push_back(member);
    }
    const auto position = items.erase(items.begin() + index);
    items.insert(position, members.begin(), members.end());
    m_template->setCheckListItems(items);
    emit sgSetTemplateSavable();
}

void QCJobTemplateModel::swapCoupledCheckPoints(int index)
{
    const auto couple = coupleAt(index);
    if (!couple)
        return;
    auto items = m_template->checkListItems();
    auto members = couple->checkPoints();
    if (members.size() != 2 || !members[0] || !members[1])
        return;
    std::swap(members[0], members[1]);
    auto swapped = std::make_shared<vemi::CheckPointCouple>();
    swapped->setName(couple->name());
    swapped->setCheckPoints(members);
    members[0]->setMatchPoint(firstMatchPoint);
    members[1]->setMatchPoint(secondMatchPoint);
    items[size_t(index)] = swapped;
    m_template->setCheckListItems(items);
    emit sgSetTemplateSavable();
}

// --- Schematic pictures -----------------------------------------------------

std::shared_ptr<vemi::SchematicImage> QCJobTemplateModel::templateSchematic()
{
    if (!m_template->schematicImage())
        m_template->setSchematicImage(std::make_shared<vemi::SchematicImage>());
    return m_template->schematicImage();
}

bool QCJobTemplateModel::readSchematicFile(const QString& path, std::vector<unsigned char>* bytes,
                                           QString* errorMessage)
{
    const auto fail = [&](const QString& cause) {
        if (errorMessage)
            *errorMessage = tr("Could not read the schematic image %1: %2").arg(path, cause);
        return false;
    };
    // Checked before opening: opening a pipe waits for a writer, and a
    // device may never end.
    const QFileInfo info(path);
    if (!info.exists())
        return fail(tr("No such file."));
    if (info.isDir())
        return fail(tr("It is a directory."));
    if (!info.isFile())
        return fail(tr("It is not a regular file."));
    const QString tooLarge = tr("It is larger than %1 bytes.").arg(MaximumSchematicFileBytes);
    if (info.size() > MaximumSchematicFileBytes)
        return fail(tooLarge);
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly | QIODevice::Unbuffered))
        return fail(file.errorString());
    // Read straight into the vector the template keeps: no copy of 10 MB.
    std::vector<unsigned char> read(std::size_t(info.size()));
    const qint64 count = file.read(reinterpret_cast<char*>(read.data()), qint64(read.size()));
    if (count < 0)
        return fail(file.errorString());
    read.resize(std::size_t(count));
    // The size was checked before reading; a file that grew since is refused
    // rather than read on.
    char extra = 0;
    if (file.read(&extra, 1) > 0)
        return fail(tr("It changed while it was read."));
    if (read.empty())
        return fail(tr("The file is empty."));
    *bytes = std::move(read);
    return true;
}

bool QCJobTemplateModel::loadSchematicImage(const QString& name, const QString& path, QString* errorMessage)
{
    std::vector<unsigned char> bytes;
    if (!readSchematicFile(path, &bytes, errorMessage))
        return false;
    storeSchematicImage(name, path, std::move(bytes));
    return true;
}

void QCJobTemplateModel::storeSchematicImage(const QString& name, const QString& path,
                                             std::vector<unsigned char> bytes)
{
    const auto image = templateSchematic();
    image->setFormat(formatOfPath(path));
    image->setName(name.toStdString());
    image->setOriginalFilename(path.toStdString());
    image->setImageData(std::move(bytes));
}

void QCJobTemplateModel::clearSchematicImage()
{
    if (const auto image = m_template->schematicImage())
        image->setImageData({});
    saveJobTemplate();
}

bool QCJobTemplateModel::setCheckPointImage(int index, const QPixmap& area, const QRect& rect)
{
    const auto checkPoint = checkPointAt(index);
    QByteArray png;
    QBuffer buffer(&png);
    buffer.open(QIODevice::WriteOnly);
    // An empty area would replace the checkpoint's cut-out by nothing.
    if (!area.save(&buffer, "PNG", -1))
        return false;
    if (!checkPoint->schematicImage())
        checkPoint->setSchematicImage(std::make_shared<vemi::SchematicImage>());
    const auto image = checkPoint->schematicImage();
    image->setFormat("PNG");
    image->setImageData(toBytes(png));
    checkPoint->setPosition(std::make_shared<vemi::Position>(rect.x(), rect.y()));
    checkPoint->setSize(std::make_shared<vemi::Size>(rect.width(), rect.height()));
    emit sgSetTemplateSavable();
    return true;
}

// --- Standards, tolerances, measurement configuration -----------------------

std::vector<std::shared_ptr<vemi::Standard>> QCJobTemplateModel::standards() const
{
    return m_template->standards();
}

void QCJobTemplateModel::addStandard(const std::shared_ptr<vemi::Standard>& standard)
{
    // The editors and the stored template expect every entry to be a standard.
    if (!standard)
        return;
    auto list = m_template->standards();
    list.push_back(standard);
    m_template->setStandards(list);
}

void QCJobTemplateModel::setStandardsFromLibrary(const std::shared_ptr<vemi::ColorStandardsLibrary>& library)
{
    const auto list = library ? library->standards() : std::vector<std::shared_ptr<vemi::Standard>>();
    if (!list.empty())
        m_template->setStandards(list);
}

void QCJobTemplateModel::removeAllStandards()
{
    m_template->setStandards({});
}

std::vector<std::shared_ptr<vemi::ToleranceSet>> QCJobTemplateModel::sharedToleranceSets() const
{
    return m_template->sharedToleranceSets();
}

void QCJobTemplateModel::setSharedToleranceSets(const std::vector<std::shared_ptr<vemi::ToleranceSet>>& sets)
{
    m_template->setSharedToleranceSets(sets);
}

void QCJobTemplateModel::removeAllToleranceSets()
{
    m_template->setSharedToleranceSets({});
    m_template->setPrivateToleranceSets({});
}

std::shared_ptr<vemi::MeasurementConfiguration> QCJobTemplateModel::measurementConfiguration() const
{
    return m_template->measurementConfiguration();
}

void QCJobTemplateModel::setMeasurementConfiguration(
    const std::shared_ptr<vemi::MeasurementConfiguration>& configuration)
{
    m_template->setMeasurementConfiguration(configuration);
    emit sgMeasurementConfigLoaded();
}
