#include "host/widgets/FolderCommands.h"

#include "host/widgets/DeleteQuestion.h"
#include "host/widgets/DialogAsker.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "host/widgets/FirstFreeName.h"
#include "host/widgets/NameCheck.h"
#include "host/widgets/SelectionMemory.h"
#include "host/widgets/TreePickerDialog.h"

#include <QPointer>

#include <QWidget>

namespace vemi {

using Node = BaseObjectTreeModel::Node;

FolderCommands::FolderCommands(QWidget* dialogParent)
    : QObject(dialogParent), m_dialogParent(dialogParent), m_dialogs(std::make_unique<DialogAsker>()),
      m_asker(m_dialogs.get())
{
}

FolderCommands::~FolderCommands() = default;

void FolderCommands::setAsker(UserAsker* asker)
{
    m_asker = asker ? asker : m_dialogs.get();
}

// The questions run their own event loop, in which answers from the store may
// rebuild or shrink the tree: the commands hold serials across a question, not nodes.

std::vector<quint64> FolderCommands::serialsOf(const QVector<Node*>& nodes)
{
    std::vector<quint64> serials;
    for (const Node* node : nodes)
        serials.push_back(node ? node->serial() : 0);
    return serials;
}

std::vector<Node*> FolderCommands::liveNodes(const std::vector<quint64>& serials) const
{
    std::vector<Node*> nodes;
    for (quint64 serial : serials) {
        if (Node* node = m_model->findBySerial(serial))
            nodes.push_back(node);
    }
    return nodes;
}

std::vector<std::string> FolderCommands::namesBeside(const Node* node) const
{
    std::vector<std::string> names;
    for (const auto& sibling : node->parent()->children()) {
        if (sibling.get() != node)
            names.push_back(sibling->displayName().toStdString());
    }
    return names;
}

void FolderCommands::createFolder(Node* current)
{
    if (!m_model)
        return;
    Node* parent = m_model->folderFor(current);
    const std::vector<std::string> taken = m_model->namesIn(parent);
    const QString suggestion = QString::fromStdString(firstFreeName(tr("New Folder").toStdString(), taken));
    const quint64 parentSerial = parent ? parent->serial() : 0;
    const std::optional<QString> answer =
        m_asker->askText(m_dialogParent, tr("New Folder"), tr("Folder name:"), suggestion,
                         [taken](const QString& text) { return NameCheck::problem(text, taken); });
    if (!answer)
        return;
    const QString name = answer->trimmed();
    Node* liveParent = parentSerial ? m_model->findBySerial(parentSerial) : nullptr;
    if (parentSerial && !liveParent) {
        emit sgErrorOccurred(tr("The folder was deleted meanwhile."));
        return;
    }
    // The folder may have changed while the user typed.
    const QString problem = NameCheck::problem(name, m_model->namesIn(liveParent));
    if (!problem.isEmpty()) {
        emit sgErrorOccurred(tr("Cannot create the folder \"%1\". %2").arg(name, problem));
        return;
    }
    m_model->createFolder(liveParent, name.toStdString(), {});
}

void FolderCommands::rename(Node* node)
{
    if (!m_model || !node)
        return;
    const quint64 serial = node->serial();
    const QString oldName = node->displayName();
    const std::vector<std::string> taken = namesBeside(node);
    const std::optional<QString> answer =
        m_asker->askText(m_dialogParent, tr("Rename"), tr("New name:"), oldName,
                         [taken](const QString& text) { return NameCheck::problem(text, taken); });
    if (!answer)
        return;
    const QString name = answer->trimmed();
    node = m_model->findBySerial(serial);
    if (!node || name == oldName)
        return;
    // The folder may have changed while the user typed.
    const QString problem = NameCheck::problem(name, namesBeside(node));
    if (!problem.isEmpty()) {
        emit sgErrorOccurred(tr("Cannot rename \"%1\". %2").arg(oldName, problem));
        return;
    }
    m_model->renameNode(node, name.toStdString(), {});
}

void FolderCommands::move(const QVector<Node*>& nodes)
{
    if (!m_model || nodes.isEmpty())
        return;
    const std::vector<quint64> moving = serialsOf(nodes);
    std::vector<std::string> keys;
    for (const Node* node : nodes)
        keys.push_back(SelectionMemory::keyOf(node));
    const std::optional<quint64> targetSerial = askTargetFolder(nodes);
    if (!targetSerial)
        return;
    Node* target = *targetSerial ? m_model->findBySerial(*targetSerial) : nullptr;
    if (*targetSerial && !target) {
        emit sgErrorOccurred(tr("The folder was deleted meanwhile."));
        return;
    }
    const std::vector<Node*> live = liveNodes(moving);
    auto pending = std::make_shared<size_t>(live.size());
    const auto finishOne = [self = QPointer<FolderCommands>(this), pending, keys](bool) {
        if (--*pending == 0 && self)
            emit self->sgMoved(keys);
    };
    for (Node* node : live)
        m_model->moveNode(node, target, finishOne);
}

std::optional<quint64> FolderCommands::askTargetFolder(const QVector<Node*>& nodes)
{
    const std::vector<const Node*> moving(nodes.begin(), nodes.end());
    return TreePickerDialog::choose(*m_model, TreePickerDialog::Choice::Folder, tr("Move To"), tr("Folder:"),
                                    m_dialogParent,
                                    dynamic_cast<const DirEntryTreeModel::FolderNode*>(nodes.first()->parent()),
                                    moving);
}

void FolderCommands::remove(const QVector<Node*>& nodes)
{
    if (!m_model || nodes.isEmpty())
        return;
    const std::vector<quint64> serials = serialsOf(nodes);
    const std::vector<const Node*> chosen(nodes.begin(), nodes.end());
    // No is the default: Enter alone must never delete.
    if (!m_asker->confirm(m_dialogParent, tr("Delete"), DeleteQuestion::text(m_model->objectType(), chosen),
                          UserAsker::DefaultAnswer::No))
        return;
    const std::vector<Node*> deleting = liveNodes(serials);
    if (!deleting.empty())
        m_model->deleteNodes(deleting, {});
}

} // namespace vemi
