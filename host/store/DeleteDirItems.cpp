#include "host/store/DeleteDirItems.h"

#include "host/store/Response.h"
#include "host/store/StoreDatabase.h"

namespace vemi {

std::shared_ptr<Response> DeleteDirItems::execute(StoreDatabase& database)
{
    database.writeTransaction([&] {
        for (const std::string& folderId : m_folderIds) {
            const QString id = QString::fromStdString(folderId);
            database.run(QStringLiteral("WITH RECURSIVE sub(id) AS (SELECT CAST(? AS TEXT) UNION"
                                        " SELECT f.id FROM folders f JOIN sub ON f.parent_id = sub.id)"
                                        " DELETE FROM objects WHERE id IN"
                                        " (SELECT object_id FROM dir_entries WHERE folder_id IN (SELECT id FROM sub))"),
                         {id});
            database.run(QStringLiteral("DELETE FROM folders WHERE id = ?"), {id});
        }
        for (const std::string& entryId : m_entryIds) {
            database.run(QStringLiteral("DELETE FROM objects WHERE id IN"
                                        " (SELECT object_id FROM dir_entries WHERE id = ?)"),
                         {QString::fromStdString(entryId)});
        }
    });
    return std::make_shared<Response>();
}

} // namespace vemi
