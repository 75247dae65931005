#include "host/widgets/BaseObjectTreeModel.h"

#include "host/domain/NamedObject.h"
#include "host/widgets/NameOrder.h"

#include <QFont>
#include <QIcon>

#include <algorithm>

namespace vemi {

BaseObjectTreeModel::Node::Node()
{
    static quint64 nextSerial = 1;
    m_serial = nextSerial++;
}

BaseObjectTreeModel::Node::~Node() = default;

int BaseObjectTreeModel::Node::row() const
{
    if (!m_parent)
        return 0;
    const auto& siblings = m_parent->m_children;
    const auto found = std::find_if(siblings.begin(), siblings.end(),
                                    [this](const std::unique_ptr<Node>& node) { return node.get() == this; });
    return int(found - siblings.begin());
}

void BaseObjectTreeModel::Node::setModified(bool modified)
{
    m_modified = modified;
    if (modified)
        ++m_revision;
}

QString BaseObjectTreeModel::Node::displayName() const
{
    return m_object ? QString::fromStdString(m_object->name()) : QString();
}

BaseObjectTreeModel::BaseObjectTreeModel(QObject* parent)
    : QAbstractItemModel(parent), m_root(std::make_unique<Node>())
{
}

BaseObjectTreeModel::~BaseObjectTreeModel() = default;

BaseObjectTreeModel::Node* BaseObjectTreeModel::nodeFromIndex(const QModelIndex& index) const
{
    return index.isValid() ? static_cast<Node*>(index.internalPointer()) : m_root.get();
}

QModelIndex BaseObjectTreeModel::indexFromNode(const Node* node) const
{
    if (!node || node == m_root.get())
        return {};
    return createIndex(node->row(), 0, const_cast<Node*>(node));
}

bool BaseObjectTreeModel::sortsBefore(const Node* a, const Node* b)
{
    if (a->isFolder() != b->isFolder())
        return a->isFolder();
    return NameOrder::standard().lessThan(a->displayName(), b->displayName());
}

int BaseObjectTreeModel::insertPosition(const Node* parent, const Node* node) const
{
    const auto& siblings = parent->m_children;
    const auto at = std::find_if(siblings.begin(), siblings.end(), [node](const std::unique_ptr<Node>& other) {
        return other.get() != node && sortsBefore(node, other.get());
    });
    return int(at - siblings.begin());
}

BaseObjectTreeModel::Node* BaseObjectTreeModel::insertNode(Node* parent, std::unique_ptr<Node> node)
{
    const int row = insertPosition(parent, node.get());
    beginInsertRows(indexFromNode(parent), row, row);
    node->m_parent = parent;
    Node* inserted = node.get();
    parent->m_children.insert(parent->m_children.begin() + row, std::move(node));
    endInsertRows();
    return inserted;
}

void BaseObjectTreeModel::removeNode(Node* node)
{
    takeNode(node);
}

std::unique_ptr<BaseObjectTreeModel::Node> BaseObjectTreeModel::takeNode(Node* node)
{
    Node* parent = node->m_parent;
    if (!parent)
        return nullptr;
    const int row = node->row();
    beginRemoveRows(indexFromNode(parent), row, row);
    std::unique_ptr<Node> taken = std::move(parent->m_children[size_t(row)]);
    parent->m_children.erase(parent->m_children.begin() + row);
    taken->m_parent = nullptr;
    endRemoveRows();
    return taken;
}

void BaseObjectTreeModel::adopt(Node* parent, std::unique_ptr<Node> child)
{
    child->m_parent = parent;
    parent->m_children.push_back(std::move(child));
}

void BaseObjectTreeModel::sortRecursively(Node* parent)
{
    std::stable_sort(parent->m_children.begin(), parent->m_children.end(),
                     [](const std::unique_ptr<Node>& a, const std::unique_ptr<Node>& b) {
                         return sortsBefore(a.get(), b.get());
                     });
    for (auto& child : parent->m_children)
        sortRecursively(child.get());
}

void BaseObjectTreeModel::nodeChanged(Node* node)
{
    Node* parent = node->m_parent;
    if (!parent)
        return;
    const int from = node->row();
    int to = insertPosition(parent, node);
    if (to > from)
        --to; // the position counted the node itself before it moves
    if (to != from) {
        const QModelIndex parentIndex = indexFromNode(parent);
        beginMoveRows(parentIndex, from, from, parentIndex, to > from ? to + 1 : to);
        auto moving = std::move(parent->m_children[size_t(from)]);
        parent->m_children.erase(parent->m_children.begin() + from);
        parent->m_children.insert(parent->m_children.begin() + to, std::move(moving));
        endMoveRows();
    }
    const QModelIndex index = indexFromNode(node);
    emit dataChanged(index, index);
}

std::vector<BaseObjectTreeModel::Node*> BaseObjectTreeModel::descendants(const Node* start) const
{
    std::vector<Node*> nodes;
    for (const auto& child : start->m_children) {
        nodes.push_back(child.get());
        const auto below = descendants(child.get());
        nodes.insert(nodes.end(), below.begin(), below.end());
    }
    return nodes;
}

BaseObjectTreeModel::Node* BaseObjectTreeModel::findBySerial(quint64 serial) const
{
    for (Node* node : descendants(m_root.get())) {
        if (node->serial() == serial)
            return node;
    }
    return nullptr;
}

void BaseObjectTreeModel::rebuildTree(const Rebuild& build)
{
    beginResetModel();
    std::vector<std::unique_ptr<Node>> previous;
    previous.swap(m_root->m_children);
    // previous grows while it is walked: each node hands over its children in turn.
    for (size_t i = 0; i < previous.size(); ++i) {
        Node* node = previous[i].get();
        node->m_parent = nullptr;
        for (auto& child : node->m_children)
            previous.push_back(std::move(child));
        node->m_children.clear();
    }
    build(previous, m_root.get());
    endResetModel();
}

QModelIndex BaseObjectTreeModel::index(int row, int column, const QModelIndex& parent) const
{
    const Node* parentNode = nodeFromIndex(parent);
    if (column != 0 || row < 0 || row >= int(parentNode->m_children.size()))
        return {};
    return createIndex(row, column, parentNode->m_children[size_t(row)].get());
}

QModelIndex BaseObjectTreeModel::parent(const QModelIndex& child) const
{
    if (!child.isValid())
        return {};
    return indexFromNode(nodeFromIndex(child)->m_parent);
}

int BaseObjectTreeModel::rowCount(const QModelIndex& parent) const
{
    if (parent.column() > 0)
        return 0;
    return int(nodeFromIndex(parent)->m_children.size());
}

int BaseObjectTreeModel::columnCount(const QModelIndex&) const
{
    return 1;
}

QVariant BaseObjectTreeModel::data(const QModelIndex& index, int role) const
{
    const Node* node = nodeFromIndex(index);
    if (!index.isValid() || !node)
        return {};
    switch (role) {
    case Qt::DisplayRole:
        return node->isModified() ? node->displayName() + QStringLiteral(" *") : node->displayName();
    case Qt::EditRole:
    case Qt::ToolTipRole:
        return node->displayName();
    case Qt::DecorationRole:
        return iconFor(node);
    case Qt::FontRole:
        if (node->isModified()) {
            QFont font;
            font.setItalic(true);
            return font;
        }
        return {};
    default:
        return {};
    }
}

QIcon BaseObjectTreeModel::iconFor(const Node*) const
{
    return {};
}

} // namespace vemi

namespace {

// Registered when the host library is loaded, so that a browser's selection
// can travel through queued connections.
void registerTreeModelMetaTypes()
{
    qRegisterMetaType<QVector<vemi::BaseObjectTreeModel::Node*>>("QVector<vemi::BaseObjectTreeModel::Node*>");
}

} // namespace

Q_CONSTRUCTOR_FUNCTION(registerTreeModelMetaTypes)
