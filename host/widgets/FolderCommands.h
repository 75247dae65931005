#pragma once

#include "host/widgets/BaseObjectTreeModel.h"

#include <QObject>
#include <QVector>

#include <memory>
#include <optional>
#include <string>
#include <vector>

class QWidget;

namespace vemi {

class DirEntryTreeModel;
class UserAsker;

// The folder commands of a browser: new folder, rename, move and delete, each
// asking the user first. The questions go through a UserAsker, so that tests
// can answer them without dialogs.
class FolderCommands : public QObject
{
    Q_OBJECT

public:
    // dialogParent: the widget the dialogs belong to (also this object's parent).
    explicit FolderCommands(QWidget* dialogParent);
    ~FolderCommands() override;

    // The tree the commands work on; not owned, must outlive this object.
    void setModel(DirEntryTreeModel* model) { m_model = model; }
    // Not owned, must outlive this object; null brings the standard dialogs back.
    void setAsker(UserAsker* asker);
    UserAsker* asker() const { return m_asker; }

    // Each does nothing when the user cancels; current is the node the user
    // works from (null: the top level).
    void createFolder(BaseObjectTreeModel::Node* current);
    void rename(BaseObjectTreeModel::Node* node);
    void move(const QVector<BaseObjectTreeModel::Node*>& nodes);
    void remove(const QVector<BaseObjectTreeModel::Node*>& nodes);

signals:
    // A command could not run; the store's own refusals come through the model.
    void sgErrorOccurred(QString message);
    // A move has been answered by the store; keys (SelectionMemory::keyOf)
    // name the nodes moved, each where the store now files it.
    void sgMoved(const std::vector<std::string>& keys);

private:
    // The names of the node's siblings, folders and entries alike.
    std::vector<std::string> namesBeside(const BaseObjectTreeModel::Node* node) const;
    // The serial of the folder chosen, 0 for the top level; nothing when cancelled.
    std::optional<quint64> askTargetFolder(const QVector<BaseObjectTreeModel::Node*>& nodes);
    static std::vector<quint64> serialsOf(const QVector<BaseObjectTreeModel::Node*>& nodes);
    std::vector<BaseObjectTreeModel::Node*> liveNodes(const std::vector<quint64>& serials) const;

    QWidget* m_dialogParent;
    DirEntryTreeModel* m_model = nullptr;
    std::unique_ptr<UserAsker> m_dialogs;
    UserAsker* m_asker;
};

} // namespace vemi
