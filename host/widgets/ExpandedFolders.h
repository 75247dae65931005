#pragma once

#include <set>
#include <string>

class QTreeView;

namespace vemi {

class BaseObjectTreeModel;

// Which folders of a folder tree a view shows expanded, by key
// (SelectionMemory::keyOf), so that they open again after the model rebuilt
// its nodes (a reset forgets every expanded index).
class ExpandedFolders
{
public:
    // view shows model; call while model still holds the nodes to remember.
    void capture(const QTreeView& view, const BaseObjectTreeModel& model);
    // Expands the folders captured that model still holds.
    void restore(QTreeView& view, const BaseObjectTreeModel& model) const;

private:
    std::set<std::string> m_keys;
};

} // namespace vemi
