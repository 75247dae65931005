#pragma once

#include "host/store/DirFolder.h"

#include <QVariant>

#include <string>

namespace vemi {

class StoreDatabase;

// Checks on the folder tree that the directory commands share.
class DirectoryQueries
{
public:
    explicit DirectoryQueries(StoreDatabase& database) : m_database(database) {}

    // A folder id as the tables hold it: NULL for the top level.
    static QVariant folderValue(const std::string& folderId);

    // Throws StoreError when folderId names no folder of the object type (an
    // empty id is the top level, which every type has).
    void requireFolder(const std::string& folderId, const std::string& objectType);
    // Throws StoreError when a sibling folder already has the name.
    void requireFreeFolderName(const std::string& objectType, const std::string& parentId,
                               const std::string& name, const std::string& exceptId);
    // Inserts the folder after checking its parent and its name; runs inside
    // the caller's transaction.
    void insertFolder(const DirFolder& folder);
    bool isInSubtree(const std::string& folderId, const std::string& rootId);

private:
    StoreDatabase& m_database;
};

} // namespace vemi
