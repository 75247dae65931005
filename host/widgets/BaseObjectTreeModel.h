#pragma once

#include <QAbstractItemModel>

#include <functional>
#include <memory>
#include <vector>

namespace vemi {

class NamedObject;

// A tree of nodes that may hold a stored object; one column, the node's name.
// Folders sort before objects, then by name.
class BaseObjectTreeModel : public QAbstractItemModel
{
    Q_OBJECT

public:
    class Node
    {
    public:
        Node();
        Node(const Node&) = delete;
        Node& operator=(const Node&) = delete;
        virtual ~Node();

        // Stays the same for the node's life and is never reused: lets an
        // answer from the store find its node again, or find that it is gone.
        quint64 serial() const { return m_serial; }
        Node* parent() const { return m_parent; }
        const std::vector<std::unique_ptr<Node>>& children() const { return m_children; }
        int row() const;

        // The node's object; empty until it has been loaded from the store.
        std::shared_ptr<NamedObject> object() const { return m_object; }
        void setObject(std::shared_ptr<NamedObject> object) { m_object = std::move(object); }
        // Changed since it was last saved (or never saved).
        bool isModified() const { return m_modified; }
        // Marking a node modified also counts a new revision of its object.
        void setModified(bool modified);
        quint64 revision() const { return m_revision; }

        virtual QString displayName() const;
        virtual bool isFolder() const { return false; }

    private:
        friend class BaseObjectTreeModel;
        quint64 m_serial;
        Node* m_parent = nullptr;
        std::vector<std::unique_ptr<Node>> m_children;
        std::shared_ptr<NamedObject> m_object;
        bool m_modified = false;
        quint64 m_revision = 0;
    };

    explicit BaseObjectTreeModel(QObject* parent = nullptr);
    ~BaseObjectTreeModel() override;

    Node* root() const { return m_root.get(); }
    Node* nodeFromIndex(const QModelIndex& index) const;
    QModelIndex indexFromNode(const Node* node) const;

    // Takes ownership of node and inserts it among parent's children in sort order.
    Node* insertNode(Node* parent, std::unique_ptr<Node> node);
    // Destroys the node and everything below it.
    void removeNode(Node* node);
    // Takes the node (with everything below it) out of the tree and hands it over.
    std::unique_ptr<Node> takeNode(Node* node);
    // Re-sorts the node among its siblings and repaints it after a change.
    void nodeChanged(Node* node);
    // Null when the node is gone.
    Node* findBySerial(quint64 serial) const;
    // Every node below start, depth first.
    std::vector<Node*> descendants(const Node* start) const;

    QModelIndex index(int row, int column, const QModelIndex& parent = {}) const override;
    QModelIndex parent(const QModelIndex& child) const override;
    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;

    // For building a tree outside the model: append, then sort once.
    static void adopt(Node* parent, std::unique_ptr<Node> child);
    static void sortRecursively(Node* parent);

protected:
    virtual QIcon iconFor(const Node* node) const;
    using Rebuild = std::function<void(std::vector<std::unique_ptr<Node>>& previous, Node* root)>;
    // Takes every node out of the tree, each without parent and children, and
    // lets build put the tree together again from them and new nodes; nodes it
    // leaves in previous are destroyed. Views see one reset.
    void rebuildTree(const Rebuild& build);

private:
    static bool sortsBefore(const Node* a, const Node* b);
    int insertPosition(const Node* parent, const Node* node) const;

    std::unique_ptr<Node> m_root;
};

} // namespace vemi

Q_DECLARE_METATYPE(vemi::BaseObjectTreeModel::Node*)
