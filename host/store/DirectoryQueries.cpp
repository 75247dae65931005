#include "host/store/DirectoryQueries.h"

#include "host/store/StoreDatabase.h"
#include "host/store/StoreError.h"

namespace vemi {

QVariant DirectoryQueries::folderValue(const std::string& folderId)
{
    return folderId.empty() ? QVariant(QVariant::String) : QVariant(QString::fromStdString(folderId));
}

void DirectoryQueries::requireFolder(const std::string& folderId, const std::string& objectType)
{
    if (folderId.empty())
        return;
    const QVariant type = m_database.scalar(QStringLiteral("SELECT object_type FROM folders WHERE id = ?"),
                                            {QString::fromStdString(folderId)});
    if (!type.isValid())
        throw StoreError("the folder no longer exists");
    if (type.toString().toStdString() != objectType)
        throw StoreError("the folder holds objects of another type");
}

void DirectoryQueries::requireFreeFolderName(const std::string& objectType, const std::string& parentId,
                                             const std::string& name, const std::string& exceptId)
{
    if (name.empty())
        throw StoreError("a folder needs a name");
    const QVariant clash = m_database.scalar(
        QStringLiteral("SELECT 1 FROM folders WHERE object_type = ? AND parent_id IS NOT DISTINCT FROM ? AND name = ? AND id <> ?"),
        {QString::fromStdString(objectType), folderValue(parentId), QString::fromStdString(name),
         QString::fromStdString(exceptId)});
    if (clash.isValid())
        throw StoreError("a folder named \"" + name + "\" already exists there");
}

void DirectoryQueries::insertFolder(const DirFolder& folder)
{
    requireFolder(folder.parentId, folder.objectType);
    requireFreeFolderName(folder.objectType, folder.parentId, folder.name, std::string());
    m_database.run(QStringLiteral("INSERT INTO folders(id, object_type, parent_id, name) VALUES(?, ?, ?, ?)"),
                   {QString::fromStdString(folder.id), QString::fromStdString(folder.objectType),
                    folderValue(folder.parentId), QString::fromStdString(folder.name)});
}

bool DirectoryQueries::isInSubtree(const std::string& folderId, const std::string& rootId)
{
    return m_database.scalar(
        QStringLiteral("WITH RECURSIVE sub(id) AS (SELECT CAST(? AS TEXT) UNION"
                       " SELECT f.id FROM folders f JOIN sub ON f.parent_id = sub.id)"
                       " SELECT 1 FROM sub WHERE id = ?"),
        {QString::fromStdString(rootId), QString::fromStdString(folderId)}).isValid();
}

} // namespace vemi
