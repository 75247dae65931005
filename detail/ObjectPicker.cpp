#include "detail/ObjectPicker.h"

#include "host/domain/GlobalDirEntry.h"
#include "host/store/EntryObjectFetch.h"
#include "host/store/ErrorInfo.h"
#include "host/store/GetMarloObjectResponse.h"
#include "host/widgets/ObjectBrowserDialog.h"
#include "host/widgets/SelectedPath.h"
#include "plugin/PellamSettingsKeys.h"

#include <QSettings>

namespace vemi {

bool ObjectPicker::run(MarloModel& store, QWidget* parent, const Request& request,
                       std::shared_ptr<SelectedPath>& position, const std::function<void()>& onAccepted,
                       QObject* context, OnAnswer onAnswer)
{
    ObjectBrowserDialog dialog(store, parent);
    dialog.initialize(true, false, {request.typeId}, request.title, false);
    dialog.setDispatcherList(request.dispatchers);
    dialog.setLastSelectedPath(position);
    if (dialog.exec() != QDialog::Accepted)
        return false;
    position = dialog.lastSelectedPath();
    if (onAccepted)
        onAccepted();
    const auto entries = dialog.selectedDirEntries();
    for (const auto& entry : entries) {
        if (entry) {
            // The entry names its own store, so an object chosen in another
            // store is fetched from there.
            EntryObjectFetch::fetch(
                store, *entry, std::string(), context,
                [onAnswer](const std::shared_ptr<BaseObject>& object) {
                    onAnswer(std::make_shared<GetMarloObjectResponse>(object));
                },
                [](const std::shared_ptr<ErrorInfo>& error) {
                    qWarning("%s", qPrintable(error ? error->message() : QStringLiteral("Cannot fetch an object.")));
                },
                request.depth > 0 ? request.depth : 1);
        }
        if (request.firstEntryOnly)
            break;
    }
    return true;
}

std::shared_ptr<SelectedPath> ObjectPicker::loadPosition(const QString& group)
{
    QSettings settings;
    settings.beginGroup(group);
    const QString path = settings.value(PellamKeys::LastSelectedPath).toString();
    const QString dispatcherId = settings.value(PellamKeys::DispatcherId).toString();
    settings.endGroup();
    return std::make_shared<SelectedPath>(dispatcherId.toStdString(), SelectedPath::pathFromString(path.toStdString()));
}

void ObjectPicker::savePosition(const QString& group, const std::shared_ptr<SelectedPath>& position)
{
    if (!position)
        return;
    QSettings settings;
    settings.beginGroup(group);
    settings.setValue(PellamKeys::LastSelectedPath, QString::fromStdString(SelectedPath::pathToString(position->path())));
    settings.setValue(PellamKeys::DispatcherId, QString::fromStdString(position->dispatcherId()));
    settings.endGroup();
}

} // namespace vemi
