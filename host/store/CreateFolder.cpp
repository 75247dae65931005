#include "host/store/CreateFolder.h"

#include "host/store/DirectoryQueries.h"
#include "host/store/FolderResponse.h"
#include "host/store/StoreDatabase.h"

#include <QUuid>

namespace vemi {

std::shared_ptr<Response> CreateFolder::execute(StoreDatabase& database)
{
    DirFolder folder{QUuid::createUuid().toString(QUuid::WithoutBraces).toStdString(), m_parentId, m_name,
                     m_objectType};
    database.writeTransaction([&] { DirectoryQueries(database).insertFolder(folder); });
    return std::make_shared<FolderResponse>(folder);
}

} // namespace vemi
