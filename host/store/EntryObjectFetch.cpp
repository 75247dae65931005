#include "host/store/EntryObjectFetch.h"

#include "host/domain/BaseObject.h"
#include "host/domain/GlobalDirEntry.h"
#include "host/store/ErrorInfo.h"
#include "host/store/GetMarloObject.h"
#include "host/store/GetMarloObjectResponse.h"

namespace vemi {

std::string EntryObjectFetch::dispatcherOf(const DirEntry& entry, const std::string& listedFrom)
{
    if (const auto* global = dynamic_cast<const GlobalDirEntry*>(&entry))
        return global->dispatcherId();
    return listedFrom;
}

void EntryObjectFetch::fetch(const MarloModel& store, const DirEntry& entry, const std::string& listedFrom,
                             QObject* context, OnObject onObject, CommandSender::OnError onError, int depth)
{
    auto command = std::make_shared<GetMarloObject>();
    command->setType(entry.entryObjectType());
    command->setId(entry.entryObjectId());
    command->setDepth(depth);
    const std::string description = command->description();
    CommandSender::send(
        store, dispatcherOf(entry, listedFrom), command, context,
        [onObject, onError, description](const std::shared_ptr<Response>& response) {
            const auto answer = std::dynamic_pointer_cast<GetMarloObjectResponse>(response);
            if (answer && answer->object()) {
                // Members of a library that could not be read are left out of
                // it; the log says which, so that a shorter library is explained.
                for (const QString& problem : answer->problems())
                    qWarning("%s", qPrintable(problem));
                if (onObject)
                    onObject(answer->object());
            } else if (onError) {
                onError(std::make_shared<ErrorInfo>(
                    QStringLiteral("Cannot %1: the store gave no object.").arg(QString::fromStdString(description))));
            }
        },
        onError);
}

} // namespace vemi
