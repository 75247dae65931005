#include "host/store/FillEmptyStore.h"

#include "host/store/DirectoryQueries.h"
#include "host/store/FillEmptyStoreResponse.h"
#include "host/store/StoreDatabase.h"
#include "host/store/UpdateObject.h"

#include <QByteArray>
#include <QUuid>

namespace vemi {

FillEmptyStore::FillEmptyStore(std::string description)
    : m_description(std::move(description))
{
}

FillEmptyStore::~FillEmptyStore() = default;

std::string FillEmptyStore::addFolder(const std::string& objectType, const std::string& parentId,
                                      const std::string& name)
{
    DirFolder folder{QUuid::createUuid().toString(QUuid::WithoutBraces).toStdString(), parentId, name, objectType};
    m_folders.push_back(folder);
    return folder.id;
}

void FillEmptyStore::addObject(std::shared_ptr<BaseObject> object, const std::string& folderId)
{
    auto update = std::make_shared<UpdateObject>();
    update->setObject(std::move(object));
    update->setFolderId(folderId);
    m_objects.push_back(std::move(update));
}

void FillEmptyStore::prepare()
{
    for (const auto& update : m_objects)
        update->prepare();
}

std::shared_ptr<Response> FillEmptyStore::execute(StoreDatabase& database)
{
    // A store that is in use is recognised without a write lock, so that a
    // read-only store with content is no failure.
    if (holdsAnything(database))
        return std::make_shared<FillEmptyStoreResponse>(false);
    std::vector<QByteArray> encoded;
    encoded.reserve(m_objects.size());
    for (const auto& update : m_objects)
        encoded.push_back(update->encode());

    bool written = false;
    database.writeTransaction([&] {
        // Asked again under the write lock: another program may have filled it since.
        if (holdsAnything(database))
            return;
        DirectoryQueries queries(database);
        for (const DirFolder& folder : m_folders)
            queries.insertFolder(folder);
        for (size_t i = 0; i < m_objects.size(); ++i)
            m_objects[i]->write(database, encoded[i]);
        written = true;
    });
    for (const auto& update : m_objects)
        update->commitRevision();
    return std::make_shared<FillEmptyStoreResponse>(written);
}

bool FillEmptyStore::holdsAnything(StoreDatabase& database)
{
    return database.scalar(QStringLiteral("SELECT EXISTS(SELECT 1 FROM folders) OR EXISTS(SELECT 1 FROM objects)"))
        .toBool();
}

} // namespace vemi
