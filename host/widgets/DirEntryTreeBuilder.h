#pragma once

#include "host/widgets/DirEntryTreeModel.h"

#include <map>
#include <memory>
#include <string>
#include <vector>

namespace vemi {

class DirectoryTreeResponse;

// Puts a folder tree together from the store's listing, reusing the nodes of
// the tree it replaces: a folder by its id, an entry by its id, an object not
// saved yet by its object id (its save may have reached the store meanwhile).
class DirEntryTreeBuilder
{
public:
    using Node = BaseObjectTreeModel::Node;
    using FolderNode = DirEntryTreeModel::FolderNode;
    using DirEntryNode = DirEntryTreeModel::DirEntryNode;

    // Takes over the nodes it can reuse; the others stay in previous.
    explicit DirEntryTreeBuilder(std::vector<std::unique_ptr<Node>>& previous);

    void build(const DirectoryTreeResponse& tree, Node* root);

private:
    void placeFolders(const DirectoryTreeResponse& tree, Node* root);
    void placeEntries(const DirectoryTreeResponse& tree, Node* root);
    void keepUnsavedWork(Node* root);
    static void dropIfStale(DirEntryNode& node);
    bool isInCycle(const std::string& folderId) const;
    Node* folderOr(const std::string& folderId, Node* root) const;

    std::map<std::string, std::unique_ptr<FolderNode>> m_folders;
    std::map<std::string, std::unique_ptr<DirEntryNode>> m_entries;
    std::map<std::string, std::unique_ptr<DirEntryNode>> m_unsaved;
    std::map<std::string, FolderNode*> m_placed;
    std::map<std::string, std::string> m_parentOf;
};

} // namespace vemi
