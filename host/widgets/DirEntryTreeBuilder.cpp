#include "host/widgets/DirEntryTreeBuilder.h"

#include "host/domain/DirEntry.h"
#include "host/store/DirectoryTreeResponse.h"
#include "host/domain/NamedObject.h"

#include <set>

namespace vemi {

namespace {

template <class T>
std::unique_ptr<T> takeFrom(std::map<std::string, std::unique_ptr<T>>& nodes, const std::string& key)
{
    const auto found = nodes.find(key);
    if (found == nodes.end())
        return nullptr;
    std::unique_ptr<T> node = std::move(found->second);
    nodes.erase(found);
    return node;
}

template <class T>
std::unique_ptr<T> castNode(std::unique_ptr<BaseObjectTreeModel::Node>& node)
{
    auto* typed = dynamic_cast<T*>(node.get());
    if (!typed)
        return nullptr;
    node.release();
    return std::unique_ptr<T>(typed);
}

} // namespace

DirEntryTreeBuilder::DirEntryTreeBuilder(std::vector<std::unique_ptr<Node>>& previous)
{
    for (auto& node : previous) {
        if (auto folder = castNode<FolderNode>(node)) {
            const std::string id = folder->folder().id;
            m_folders[id] = std::move(folder);
        } else if (auto entry = castNode<DirEntryNode>(node)) {
            if (entry->isSaved())
                m_entries[entry->dirEntry()->id()] = std::move(entry);
            else if (entry->object())
                m_unsaved[entry->object()->id()] = std::move(entry);
        }
    }
}

void DirEntryTreeBuilder::build(const DirectoryTreeResponse& tree, Node* root)
{
    placeFolders(tree, root);
    placeEntries(tree, root);
    keepUnsavedWork(root);
    BaseObjectTreeModel::sortRecursively(root);
}

void DirEntryTreeBuilder::placeFolders(const DirectoryTreeResponse& tree, Node* root)
{
    std::vector<std::unique_ptr<FolderNode>> folders;
    for (const DirFolder& folder : tree.folders()) {
        auto node = takeFrom(m_folders, folder.id);
        if (!node)
            node = std::make_unique<FolderNode>(folder);
        node->setFolder(folder);
        m_placed[folder.id] = node.get();
        m_parentOf[folder.id] = folder.parentId;
        folders.push_back(std::move(node));
    }
    // A damaged file may hold a cycle of folders: they go to the top level.
    for (auto& node : folders) {
        const DirFolder& folder = node->folder();
        Node* parent = isInCycle(folder.id) ? root : folderOr(folder.parentId, root);
        BaseObjectTreeModel::adopt(parent, std::move(node));
    }
}

bool DirEntryTreeBuilder::isInCycle(const std::string& folderId) const
{
    std::set<std::string> seen{folderId};
    for (auto parent = m_parentOf.find(folderId); parent != m_parentOf.end() && !parent->second.empty();
         parent = m_parentOf.find(parent->second)) {
        if (!seen.insert(parent->second).second)
            return true;
    }
    return false;
}

DirEntryTreeBuilder::Node* DirEntryTreeBuilder::folderOr(const std::string& folderId, Node* root) const
{
    const auto found = m_placed.find(folderId);
    return found == m_placed.end() ? root : found->second;
}

void DirEntryTreeBuilder::placeEntries(const DirectoryTreeResponse& tree, Node* root)
{
    for (const auto& entry : tree.entries()) {
        auto node = takeFrom(m_entries, entry->id());
        if (!node)
            node = takeFrom(m_unsaved, entry->entryObjectId());
        if (!node)
            node = std::make_unique<DirEntryNode>(entry, entry->folderId());
        node->setDirEntry(entry);
        node->setFolderId(entry->folderId());
        dropIfStale(*node);
        BaseObjectTreeModel::adopt(folderOr(entry->folderId(), root), std::move(node));
    }
}

// An unchanged object that was saved elsewhere since it was read is read
// again when next wanted; a changed one is kept (its save will be refused
// and the user asked).
void DirEntryTreeBuilder::dropIfStale(DirEntryNode& node)
{
    const auto& object = node.object();
    const std::int64_t listed = node.dirEntry()->entryObjectRevision();
    if (object && !node.isModified() && listed != 0 && object->storedRevision() != listed)
        node.setObject(nullptr);
}

void DirEntryTreeBuilder::keepUnsavedWork(Node* root)
{
    // An edited object whose entry was deleted elsewhere is not lost: it
    // stays as an object to be saved again.
    for (auto& [id, node] : m_entries) {
        if (!node->object() || !node->isModified())
            continue;
        node->setDirEntry(nullptr);
        const std::string objectId = node->object()->id();
        m_unsaved[objectId] = std::move(node);
    }
    for (auto& [id, node] : m_unsaved) {
        Node* folder = folderOr(node->folderId(), root);
        // Its folder was deleted too: it is shown, and so saved, at the top level.
        if (folder == root)
            node->setFolderId(std::string());
        BaseObjectTreeModel::adopt(folder, std::move(node));
    }
    m_unsaved.clear();
}

} // namespace vemi
