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
    database.writeTransaction([&] {
        DirectoryQueries queries(database);
        queries.requireFolder(m_parentId, m_objectType);
        queries.requireFreeFolderName(m_objectType, m_parentId, m_name, std::string());
        database.run(QStringLiteral("INSERT INTO folders(id, object_type, parent_id, name) VALUES(?, ?, ?, ?)"),
                     {QString::fromStdString(folder.id), QString::fromStdString(m_objectType),
                      DirectoryQueries::folderValue(m_parentId),
                      QString::fromStdString(m_name)});
    });
    return std::make_shared<FolderResponse>(folder);
}

} // namespace vemi
