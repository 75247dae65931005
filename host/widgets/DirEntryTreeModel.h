#pragma once

#include "host/widgets/BaseObjectTreeModel.h"
#include "host/store/DirFolder.h"

#include <functional>
#include <memory>
#include <string>

namespace vemi {

class Command;
class DirEntry;
class DirectoryTreeResponse;
class ErrorInfo;
class MarloModel;
class Response;

// The folder tree of one object type in a store, kept in step with the store
// through its commands. Every change is asynchronous; its outcome arrives as
// a callback on the GUI thread, and a failure also as sgErrorOccurred.
class DirEntryTreeModel : public BaseObjectTreeModel
{
    Q_OBJECT

public:
    class FolderNode : public Node
    {
    public:
        explicit FolderNode(DirFolder folder) : m_folder(std::move(folder)) {}
        const DirFolder& folder() const { return m_folder; }
        void setFolder(DirFolder folder) { m_folder = std::move(folder); }
        void setName(const std::string& name) { m_folder.name = name; }
        QString displayName() const override { return QString::fromStdString(m_folder.name); }
        bool isFolder() const override { return true; }

    private:
        DirFolder m_folder;
    };

    // An object of the tree: a stored entry, or an object created here and not
    // saved yet (no entry, filed in folderId when it is saved).
    class DirEntryNode : public Node
    {
    public:
        DirEntryNode(std::shared_ptr<DirEntry> entry, std::string folderId);
        std::shared_ptr<DirEntry> dirEntry() const { return m_entry; }
        void setDirEntry(std::shared_ptr<DirEntry> entry) { m_entry = std::move(entry); }
        bool isSaved() const { return m_entry != nullptr; }
        std::string folderId() const { return m_folderId; }
        void setFolderId(const std::string& folderId) { m_folderId = folderId; }
        QString displayName() const override;

    private:
        std::shared_ptr<DirEntry> m_entry;
        std::string m_folderId;
    };

    using Done = std::function<void(bool ok)>;

    DirEntryTreeModel(MarloModel& store, QObject* parent = nullptr);

    MarloModel& store() const { return m_store; }
    std::string objectType() const { return m_objectType; }
    void setObjectType(const std::string& typeId) { m_objectType = typeId; }
    std::string dispatcherId() const { return m_dispatcherId; }
    void setDispatcherId(const std::string& dispatcherId) { m_dispatcherId = dispatcherId; }

    // Reads the tree from the store. The nodes already there stay (with their
    // objects, changed or not), so answers still on their way find them; an
    // object changed here whose entry is gone stays as an unsaved object.
    void load(const Done& done = {});
    // The folder a new object goes into when node is current (null: top level).
    FolderNode* folderFor(Node* node) const;
    std::vector<std::string> namesIn(const Node* folder) const;
    // Folder names from the top down to node's folder.
    std::vector<std::string> pathOf(const Node* node) const;

    DirEntryNode* addUnsavedObject(Node* folder, std::shared_ptr<NamedObject> object);
    // Fetches from the store the entry names (EntryObjectFetch), which for a
    // GlobalDirEntry may be another than the model's own. When the entry was
    // deleted elsewhere, the error says so and the tree is read again.
    void loadObject(DirEntryNode* node, const Done& done);
    // A save refused because the object was changed elsewhere comes as
    // sgSaveConflict instead of sgErrorOccurred; the node stays modified.
    void saveObject(DirEntryNode* node, const Done& done);
    // Drops the node's object, changes and all: the next load reads the stored one.
    void discardObject(DirEntryNode* node);
    // Saves a copy of the node's object (a new id, "name (copy)") beside it,
    // as a new entry; the node itself is left as it is.
    void saveCopy(DirEntryNode* node, const Done& done);
    void createFolder(Node* parentFolder, const std::string& name, const Done& done);
    void renameNode(Node* node, const std::string& name, const Done& done);
    void moveNode(Node* node, Node* targetFolder, const Done& done);
    void deleteNodes(const std::vector<Node*>& nodes, const Done& done);

signals:
    void sgErrorOccurred(QString message);
    void sgItemChanged(std::shared_ptr<vemi::DirEntry>& entry);
    // Another program changed the store (see CommandDispatcher::sgStoreChanged).
    void sgStoreChanged();
    // The save of the node with this serial was refused: message says why.
    void sgSaveConflict(quint64 serial, QString message);

protected:
    QIcon iconFor(const Node* node) const override;

private:
    using OnResponse = std::function<void(const std::shared_ptr<Response>&)>;
    // Sends to the model's own store; a failure goes to sgErrorOccurred and done(false).
    void run(std::shared_ptr<Command> command, const OnResponse& onResponse, const Done& done);
    std::function<void(const std::shared_ptr<ErrorInfo>&)> failure(const Done& done);
    static std::string folderIdOf(const Node* folder);
    void applyListing(const DirectoryTreeResponse& tree);
    void explainFailedLoad(quint64 serial, const QString& message, const Done& done);
    void applySave(quint64 serial, quint64 revision, const std::shared_ptr<Response>& response);
    void applyRename(quint64 serial, const std::string& name);
    void undoRename(quint64 serial, const std::string& name, const std::string& oldName);

    MarloModel& m_store;
    std::string m_objectType;
    std::string m_dispatcherId;
};

} // namespace vemi
