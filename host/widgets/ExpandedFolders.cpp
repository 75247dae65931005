#include "host/widgets/ExpandedFolders.h"

#include "host/widgets/BaseObjectTreeModel.h"
#include "host/widgets/SelectionMemory.h"

#include <QTreeView>

namespace vemi {

void ExpandedFolders::capture(const QTreeView& view, const BaseObjectTreeModel& model)
{
    m_keys.clear();
    for (const BaseObjectTreeModel::Node* node : model.descendants(model.root())) {
        if (node->isFolder() && view.isExpanded(model.indexFromNode(node)))
            m_keys.insert(SelectionMemory::keyOf(node));
    }
}

void ExpandedFolders::restore(QTreeView& view, const BaseObjectTreeModel& model) const
{
    if (m_keys.empty())
        return;
    for (const BaseObjectTreeModel::Node* node : model.descendants(model.root())) {
        if (node->isFolder() && m_keys.count(SelectionMemory::keyOf(node)))
            view.expand(model.indexFromNode(node));
    }
}

} // namespace vemi
