#include "host/widgets/DirEntryTreeModel.h"

#include "host/store/CommandDispatcher.h"
#include "host/store/CommandSender.h"
#include "host/store/CreateFolder.h"
#include "host/store/DeleteDirItems.h"
#include "host/domain/DirEntry.h"
#include "host/widgets/DirEntryTreeBuilder.h"
#include "host/store/DirectoryTreeResponse.h"
#include "host/store/EntryObjectFetch.h"
#include "host/store/ErrorInfo.h"
#include "host/store/FolderResponse.h"
#include "host/store/GetDirectoryTree.h"
#include "host/domain/Header.h"
#include "host/widgets/ImageRepository.h"
#include "host/store/MarloModel.h"
#include "host/store/MoveDirItem.h"
#include "host/domain/NamedObject.h"
#include "host/store/RenameDirItem.h"
#include "host/store/UpdateObject.h"
#include "host/store/UpdateObjectResponse.h"
#include "host/domain/ObjectCodec.h"
#include "host/widgets/FirstFreeName.h"

#include <QUuid>

#include <QIcon>

#include <algorithm>


namespace vemi {

DirEntryTreeModel::DirEntryNode::DirEntryNode(std::shared_ptr<DirEntry> entry, std::string folderId)
    : m_entry(std::move(entry)), m_folderId(std::move(folderId))
{
}

QString DirEntryTreeModel::DirEntryNode::displayName() const
{
    if (object())
        return Node::displayName();
    return m_entry ? QString::fromStdString(m_entry->header()->name()) : QString();
}

DirEntryTreeModel::DirEntryTreeModel(MarloModel& store, QObject* parent)
    : BaseObjectTreeModel(parent), m_store(store)
{
}

void DirEntryTreeModel::run(std::shared_ptr<Command> command, const OnResponse& onResponse, const Done& done)
{
    CommandSender::send(m_store, m_dispatcherId, std::move(command), this,
                        [onResponse, done](const std::shared_ptr<Response>& response) {
                            onResponse(response);
                            if (done)
                                done(true);
                        },
                        failure(done));
}

std::function<void(const std::shared_ptr<ErrorInfo>&)> DirEntryTreeModel::failure(const Done& done)
{
    return [this, done](const std::shared_ptr<ErrorInfo>& error) {
        emit sgErrorOccurred(error->message());
        if (done)
            done(false);
    };
}

std::string DirEntryTreeModel::folderIdOf(const Node* folder)
{
    const auto* folderNode = dynamic_cast<const FolderNode*>(folder);
    return folderNode ? folderNode->folder().id : std::string();
}

void DirEntryTreeModel::load(const Done& done)
{
    if (const auto dispatcher = m_store.commandDispatcher(m_dispatcherId))
        connect(dispatcher.get(), &CommandDispatcher::sgStoreChanged, this, &DirEntryTreeModel::sgStoreChanged,
                Qt::UniqueConnection);
    run(std::make_shared<GetDirectoryTree>(m_objectType),
        [this](const std::shared_ptr<Response>& response) {
            if (const auto tree = std::dynamic_pointer_cast<DirectoryTreeResponse>(response))
                applyListing(*tree);
        },
        done);
}

void DirEntryTreeModel::applyListing(const DirectoryTreeResponse& tree)
{
    rebuildTree([&tree](std::vector<std::unique_ptr<Node>>& previous, Node* root) {
        DirEntryTreeBuilder(previous).build(tree, root);
    });
}

DirEntryTreeModel::FolderNode* DirEntryTreeModel::folderFor(Node* node) const
{
    for (Node* current = node; current && current != root(); current = current->parent()) {
        if (auto* folder = dynamic_cast<FolderNode*>(current))
            return folder;
    }
    return nullptr;
}

std::vector<std::string> DirEntryTreeModel::namesIn(const Node* folder) const
{
    std::vector<std::string> names;
    for (const auto& child : (folder ? folder : root())->children())
        names.push_back(child->displayName().toStdString());
    return names;
}

std::vector<std::string> DirEntryTreeModel::pathOf(const Node* node) const
{
    std::vector<std::string> path;
    for (const Node* current = node; current && current != root(); current = current->parent()) {
        if (const auto* folder = dynamic_cast<const FolderNode*>(current))
            path.insert(path.begin(), folder->folder().name);
    }
    return path;
}

DirEntryTreeModel::DirEntryNode* DirEntryTreeModel::addUnsavedObject(Node* folder, std::shared_ptr<NamedObject> object)
{
    auto node = std::make_unique<DirEntryNode>(nullptr, folderIdOf(folder));
    node->setObject(std::move(object));
    node->setModified(true);
    return static_cast<DirEntryNode*>(insertNode(folder ? folder : root(), std::move(node)));
}

void DirEntryTreeModel::loadObject(DirEntryNode* node, const Done& done)
{
    const quint64 serial = node->serial();
    EntryObjectFetch::fetch(m_store, *node->dirEntry(), m_dispatcherId, this,
                            [this, serial, done](const std::shared_ptr<BaseObject>& object) {
                                auto* target = dynamic_cast<DirEntryNode*>(findBySerial(serial));
                                // Unless gone, or loaded (and maybe edited) meanwhile.
                                if (target && !target->object()) {
                                    target->setObject(std::dynamic_pointer_cast<NamedObject>(object));
                                    nodeChanged(target);
                                }
                                if (done)
                                    done(true);
                            },
                            [this, serial, done](const std::shared_ptr<ErrorInfo>& error) {
                                explainFailedLoad(serial, error->message(), done);
                            });
}

void DirEntryTreeModel::explainFailedLoad(quint64 serial, const QString& message, const Done& done)
{
    const auto fail = [this, message, done]() {
        emit sgErrorOccurred(message);
        if (done)
            done(false);
    };
    auto* node = dynamic_cast<DirEntryNode*>(findBySerial(serial));
    if (!node || !node->isSaved()) {
        fail();
        return;
    }
    // An entry deleted in another window or program can no longer be read: the
    // store's listing tells that case from a damaged object. Only when the entry
    // is gone is the tree read again (reading it again would select a damaged
    // object anew, and fail anew).
    const std::string entryId = node->dirEntry()->id();
    const QString name = node->displayName();
    CommandSender::send(
        m_store, m_dispatcherId, std::make_shared<GetDirectoryTree>(m_objectType), this,
        [this, entryId, name, fail, done](const std::shared_ptr<Response>& response) {
            const auto tree = std::dynamic_pointer_cast<DirectoryTreeResponse>(response);
            const auto& entries = tree ? tree->entries() : std::vector<std::shared_ptr<DirEntry>>();
            const bool listed = !tree || std::any_of(entries.begin(), entries.end(), [&entryId](const auto& entry) {
                return entry->id() == entryId;
            });
            if (listed) {
                fail();
                return;
            }
            applyListing(*tree);
            emit sgErrorOccurred(tr("Cannot open \"%1\": it was deleted elsewhere, in another window or program. "
                                    "The list now shows what the store holds.")
                                     .arg(name));
            if (done)
                done(false);
        },
        [fail](const std::shared_ptr<ErrorInfo>&) { fail(); });
}

void DirEntryTreeModel::saveObject(DirEntryNode* node, const Done& done)
{
    auto command = std::make_shared<UpdateObject>();
    command->setObject(node->object());
    // Also for a stored object: should its entry have been deleted meanwhile,
    // the store files it again instead of keeping an object nobody can find.
    command->setFolderId(node->folderId());
    const quint64 serial = node->serial();
    const quint64 revision = node->revision();
    const auto onError = [this, serial, done, fail = failure(done)](const std::shared_ptr<ErrorInfo>& error) {
        if (!error->isConflict()) {
            fail(error);
            return;
        }
        emit sgSaveConflict(serial, error->message());
        if (done)
            done(false);
    };
    CommandSender::send(m_store, m_dispatcherId, command, this,
                        [this, serial, revision, done](const std::shared_ptr<Response>& response) {
                            applySave(serial, revision, response);
                            if (done)
                                done(true);
                        },
                        onError);
}

void DirEntryTreeModel::applySave(quint64 serial, quint64 revision, const std::shared_ptr<Response>& response)
{
    auto* target = dynamic_cast<DirEntryNode*>(findBySerial(serial));
    if (!target)
        return;
    const auto answer = std::dynamic_pointer_cast<UpdateObjectResponse>(response);
    if (answer && answer->entry() && !target->isSaved())
        target->setDirEntry(answer->entry());
    if (target->isSaved())
        target->dirEntry()->header()->setName(target->object()->name());
    // An edit made while the save ran is not in the store yet.
    if (target->revision() == revision)
        target->setModified(false);
    nodeChanged(target);
    if (target->isSaved()) {
        auto entry = target->dirEntry();
        emit sgItemChanged(entry);
    }
}

void DirEntryTreeModel::discardObject(DirEntryNode* node)
{
    node->setObject(nullptr);
    node->setModified(false);
    nodeChanged(node);
}

void DirEntryTreeModel::saveCopy(DirEntryNode* node, const Done& done)
{
    if (!node->object())
        return;
    auto copy = std::dynamic_pointer_cast<NamedObject>(ObjectCodec::clone<BaseObject>(*node->object()));
    if (!copy)
        return;
    copy->setId(QUuid::createUuid().toString(QUuid::WithoutBraces).toStdString());
    Node* folder = node->parent() && node->parent() != root() ? node->parent() : nullptr;
    copy->setName(firstFreeName(copy->name() + tr(" (copy)").toStdString(), namesIn(folder)));
    saveObject(addUnsavedObject(folder, copy), done);
}

void DirEntryTreeModel::createFolder(Node* parentFolder, const std::string& name, const Done& done)
{
    const quint64 parentSerial = parentFolder ? parentFolder->serial() : 0;
    run(std::make_shared<CreateFolder>(m_objectType, folderIdOf(parentFolder), name),
        [this, parentSerial](const std::shared_ptr<Response>& response) {
            const auto answer = std::dynamic_pointer_cast<FolderResponse>(response);
            Node* parent = parentSerial ? findBySerial(parentSerial) : root();
            if (answer && parent)
                insertNode(parent, std::make_unique<FolderNode>(answer->folder()));
        }, done);
}

void DirEntryTreeModel::renameNode(Node* node, const std::string& name, const Done& done)
{
    auto* entryNode = dynamic_cast<DirEntryNode*>(node);
    // The open object takes the name at once, so that a save sent after the
    // rename carries it too.
    const std::string oldName = node->displayName().toStdString();
    if (entryNode && entryNode->object())
        entryNode->object()->setName(name);
    if (entryNode && !entryNode->isSaved()) {
        entryNode->setModified(true);
        nodeChanged(entryNode);
        if (done)
            done(true);
        return;
    }
    const bool isFolder = node->isFolder();
    const std::string id = isFolder ? folderIdOf(node) : entryNode->dirEntry()->id();
    const quint64 serial = node->serial();
    auto rename = std::make_shared<RenameDirItem>(isFolder ? DirItemKind::Folder : DirItemKind::Entry, id, name);
    if (entryNode)
        rename->setOpenObject(entryNode->object());
    run(rename,
        [this, serial, name](const std::shared_ptr<Response>&) { applyRename(serial, name); },
        [this, serial, name, oldName, done](bool ok) {
            if (!ok)
                undoRename(serial, name, oldName);
            if (done)
                done(ok);
        });
}

void DirEntryTreeModel::applyRename(quint64 serial, const std::string& name)
{
    Node* target = findBySerial(serial);
    if (auto* folder = dynamic_cast<FolderNode*>(target))
        folder->setName(name);
    if (auto* entry = dynamic_cast<DirEntryNode*>(target); entry && entry->isSaved()) {
        entry->dirEntry()->header()->setName(name);
        auto changed = entry->dirEntry();
        emit sgItemChanged(changed);
    }
    if (target)
        nodeChanged(target);
}

void DirEntryTreeModel::undoRename(quint64 serial, const std::string& name, const std::string& oldName)
{
    auto* entry = dynamic_cast<DirEntryNode*>(findBySerial(serial));
    if (entry && entry->object() && entry->object()->name() == name) {
        entry->object()->setName(oldName);
        nodeChanged(entry);
    }
}

void DirEntryTreeModel::moveNode(Node* node, Node* targetFolder, const Done& done)
{
    const std::string targetId = folderIdOf(targetFolder);
    const quint64 serial = node->serial();
    const quint64 targetSerial = targetFolder ? targetFolder->serial() : 0;
    const auto relocate = [this, serial, targetSerial, targetId]() {
        Node* moving = findBySerial(serial);
        Node* target = targetSerial ? findBySerial(targetSerial) : root();
        if (!moving || !target)
            return;
        if (auto* entry = dynamic_cast<DirEntryNode*>(moving)) {
            entry->setFolderId(targetId);
            if (entry->dirEntry())
                entry->dirEntry()->setFolderId(targetId);
        }
        insertNode(target, takeNode(moving));
    };
    auto* entryNode = dynamic_cast<DirEntryNode*>(node);
    if (entryNode && !entryNode->isSaved()) {
        relocate();
        if (done)
            done(true);
        return;
    }
    const bool isFolder = node->isFolder();
    run(std::make_shared<MoveDirItem>(isFolder ? DirItemKind::Folder : DirItemKind::Entry,
                                      isFolder ? folderIdOf(node) : entryNode->dirEntry()->id(), targetId),
        [relocate](const std::shared_ptr<Response>&) { relocate(); }, done);
}

void DirEntryTreeModel::deleteNodes(const std::vector<Node*>& nodes, const Done& done)
{
    std::vector<std::string> folderIds;
    std::vector<std::string> entryIds;
    std::vector<quint64> serials;
    for (Node* node : nodes) {
        serials.push_back(node->serial());
        if (node->isFolder())
            folderIds.push_back(folderIdOf(node));
        else if (auto* entry = dynamic_cast<DirEntryNode*>(node); entry && entry->isSaved())
            entryIds.push_back(entry->dirEntry()->id());
    }
    run(std::make_shared<DeleteDirItems>(folderIds, entryIds),
        [this, serials](const std::shared_ptr<Response>&) {
            for (quint64 serial : serials) {
                if (Node* node = findBySerial(serial))
                    removeNode(node);
            }
        }, done);
}

QIcon DirEntryTreeModel::iconFor(const Node* node) const
{
    if (node->isFolder())
        return ImageRepository::instance().folderIcon();
    return ImageRepository::instance().iconForType(m_objectType);
}

} // namespace vemi
