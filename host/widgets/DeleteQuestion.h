#pragma once

#include "host/widgets/BaseObjectTreeModel.h"

#include <QString>

#include <string>
#include <vector>

namespace vemi {

// The question put before nodes of a browser's tree are deleted: it says what
// will go (how many objects and folders, everything below a folder going with
// it) and names each object whose changes are not saved.
class DeleteQuestion
{
public:
    // typeId: the type of the tree's objects; nodes: the nodes chosen.
    static QString text(const std::string& typeId, const std::vector<const BaseObjectTreeModel::Node*>& nodes);

private:
    // "3 Job Templates and 1 folder"
    static QString amount(const std::string& typeId, int objects, int folders);
};

} // namespace vemi
