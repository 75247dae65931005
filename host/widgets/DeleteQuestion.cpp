#include "host/widgets/DeleteQuestion.h"

#include "host/widgets/ObjectTypeNames.h"

#include <QCoreApplication>

#include <algorithm>

namespace vemi {

using Node = BaseObjectTreeModel::Node;

namespace {

QString tr(const char* text)
{
    return QCoreApplication::translate("vemi::DeleteQuestion", text);
}

bool isBelowAny(const Node* node, const std::vector<const Node*>& folders)
{
    for (const Node* up = node->parent(); up; up = up->parent()) {
        if (std::find(folders.begin(), folders.end(), up) != folders.end())
            return true;
    }
    return false;
}

// The node and everything below it, depth first.
void collect(const Node* node, std::vector<const Node*>& going)
{
    going.push_back(node);
    for (const auto& child : node->children())
        collect(child.get(), going);
}

} // namespace

QString DeleteQuestion::amount(const std::string& typeId, int objects, int folders)
{
    QStringList parts;
    if (objects > 0)
        parts << QStringLiteral("%1 %2").arg(objects).arg(objects == 1 ? ObjectTypeNames::singular(typeId)
                                                                        : ObjectTypeNames::plural(typeId));
    if (folders > 0)
        parts << (folders == 1 ? tr("1 folder") : tr("%1 folders").arg(folders));
    return parts.join(tr(" and "));
}

QString DeleteQuestion::text(const std::string& typeId, const std::vector<const Node*>& nodes)
{
    // A node inside a chosen folder goes with the folder: it is not counted twice.
    std::vector<const Node*> chosen;
    for (const Node* node : nodes) {
        if (node && !isBelowAny(node, nodes) && std::find(chosen.begin(), chosen.end(), node) == chosen.end())
            chosen.push_back(node);
    }
    std::vector<const Node*> going;
    for (const Node* node : chosen)
        collect(node, going);
    int objects = 0;
    int folders = 0;
    QStringList unsaved;
    for (const Node* node : going) {
        if (node->isFolder()) {
            ++folders;
        } else {
            ++objects;
            if (node->isModified())
                unsaved << QStringLiteral("  • ") + node->displayName();
        }
    }

    QString question;
    const Node* only = chosen.size() == 1 ? chosen.front() : nullptr;
    if (only && !only->isFolder())
        question = tr("Delete the %1 \"%2\"?").arg(ObjectTypeNames::singular(typeId), only->displayName());
    else if (only && going.size() == 1)
        question = tr("Delete the empty folder \"%1\"?").arg(only->displayName());
    else if (only)
        question = tr("Delete the folder \"%1\" with everything in it: %2?")
                       .arg(only->displayName(), amount(typeId, objects, folders - 1));
    else if (folders == 0)
        question = tr("Delete these %1?").arg(amount(typeId, objects, 0));
    else
        question = tr("Delete these %1 items with everything in them: %2 in all?")
                       .arg(chosen.size())
                       .arg(amount(typeId, objects, folders));
    question += tr(" This cannot be undone.");
    if (!unsaved.isEmpty())
        question += tr("\n\nUnsaved changes will be lost in:\n") + unsaved.join(QLatin1Char('\n'));
    return question;
}

} // namespace vemi
