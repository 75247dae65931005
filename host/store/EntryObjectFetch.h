#pragma once

#include "host/store/CommandSender.h"

#include <functional>
#include <memory>
#include <string>

class QObject;

namespace vemi {

class BaseObject;
class DirEntry;
class MarloModel;

// Fetches the object that an entry of a folder tree names, from the store
// that holds it: a GlobalDirEntry names its store ("" = the default one); any
// other entry lies in the store it was listed from. Pickers and tree models
// call this, so that an entry from another store is never looked up in the
// default one.
class EntryObjectFetch
{
public:
    using OnObject = std::function<void(const std::shared_ptr<BaseObject>&)>;

    // The dispatcher id of the store that holds entry's object.
    static std::string dispatcherOf(const DirEntry& entry, const std::string& listedFrom);
    // Same contract as CommandSender::send: one callback, later, on the caller's
    // thread, while context lives. onObject never gets null.
    static void fetch(const MarloModel& store, const DirEntry& entry, const std::string& listedFrom,
                      QObject* context, OnObject onObject, CommandSender::OnError onError, int depth = 1);
};

} // namespace vemi
