#pragma once

#include "host/widgets/BaseObjectTreeModel.h"

#include <QDialog>

#include <optional>
#include <vector>

class QDialogButtonBox;
class QStandardItem;
class QStandardItemModel;
class QTreeView;

namespace vemi {

// A modal choice of one place in a browser's folder tree: an entry to open,
// or a folder (or the top level) to move to. It lists a copy of the tree made
// at construction, so answers from the store that rebuild the tree while it is
// open do not disturb it; the choice comes back as the node's serial.
class TreePickerDialog : public QDialog
{
    Q_OBJECT

public:
    using Node = BaseObjectTreeModel::Node;
    enum class Choice { Entry, Folder };

    // Entry offers folders and entries, only an entry can be chosen; Folder
    // offers the top level and the folders. excluded: nodes not offered, with
    // everything below them (the folders being moved).
    TreePickerDialog(const BaseObjectTreeModel& model, Choice choice, const QString& title, const QString& label,
                     QWidget* parent, const std::vector<const Node*>& excluded = {});
    ~TreePickerDialog() override;

    // Makes node current with its folders expanded; null is the top level.
    void preselect(const Node* node);
    // The serial of the chosen node, 0 for the top level; nothing until a
    // valid choice was accepted.
    std::optional<quint64> chosenSerial() const;
    QTreeView* view() const { return m_view; }

    static QString topLevelText();

    // Runs a picker modally with preselected current; the serial chosen, or
    // nothing when cancelled. The picker runs its own event loop, in which the
    // tree may be rebuilt (hence a serial, not a node) and parent may close
    // (then the picker dies with it and nothing is chosen).
    static std::optional<quint64> choose(const BaseObjectTreeModel& model, Choice choice, const QString& title,
                                         const QString& label, QWidget* parent, const Node* preselected,
                                         const std::vector<const Node*>& excluded = {});

private:
    void addChildren(const Node* parent, QStandardItem* into, int depth, const std::vector<const Node*>& excluded);
    QStandardItem* itemFor(const Node* node, int depth);
    QModelIndex indexOfSerial(quint64 serial, const QModelIndex& parent = {}) const;
    bool isChoosable(const QModelIndex& index) const;
    void updateOkButton();
    void acceptIfChoosable(const QModelIndex& index);
    void fitToScreen();

    const BaseObjectTreeModel& m_source;
    Choice m_choice;
    QStandardItemModel* m_items;
    QTreeView* m_view;
    QDialogButtonBox* m_buttons;
    int m_widestText = 0;
    std::optional<quint64> m_chosen;
};

} // namespace vemi
