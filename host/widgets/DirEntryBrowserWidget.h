#pragma once

#include "host/widgets/BaseObjectTreeModel.h"
#include "host/widgets/ExpandedFolders.h"
#include "host/widgets/FolderNames.h"
#include "host/widgets/SelectionMemory.h"

#include <QPointer>
#include <QVector>
#include <QWidget>

#include <memory>
#include <string>
#include <vector>

class QAction;
class QItemSelectionModel;
class QLabel;
class QMenu;
class QTreeView;

namespace vemi {

class DirEntryBrowserInterface;
class DirEntryTreeModel;
class FolderCommands;
class NamedObject;

// A folder tree of stored objects of one type with the actions to create,
// open and save them and to manage the folders. Selecting entries loads their
// objects; an object reported modified is marked in the tree until it is saved.
// The folder commands are a FolderCommands of the browser; the last selected
// entry is kept by a SelectionMemory.
class DirEntryBrowserWidget : public QWidget, public FolderNames
{
    Q_OBJECT

public:
    explicit DirEntryBrowserWidget(QWidget* parent = nullptr);
    ~DirEntryBrowserWidget() override;

    // model: the tree to show (not owned; it must outlive this widget);
    // callbacks: the client's side (not owned); title: shown above the tree;
    // newText: the text of the new action; settingsName: where the last
    // selection is remembered; selectionModel: null for the view's own;
    // singleSelection: false lets the user select several items.
    void initialize(DirEntryTreeModel* model, DirEntryBrowserInterface* callbacks, const std::string& typeId,
                    const QString& title, const QString& newText, const std::string& settingsName,
                    QItemSelectionModel* selectionModel, bool singleSelection);

    QAction* actionNew() const { return m_actionNew; }
    QAction* actionOpen() const { return m_actionOpen; }
    QAction* actionSave() const { return m_actionSave; }
    // The keys of rename and delete (F2, Del) work while the focus is anywhere
    // inside scope: this browser until a client names its whole tab. Not owned.
    void setShortcutScope(QWidget* scope);
    // False when the store cannot be changed: the editing actions are disabled
    // and the title says "(read-only)".
    bool isWritable() const { return m_writable; }

    // Adds new, open and save to menu, and the folder actions (new folder,
    // rename, move, delete) when withFolderActions is set. The labels name one
    // object and several in the actions' texts and the questions asked.
    void createCustomMenus(QMenu* menu, const QString& singular, const QString& plural, bool withFolderActions);

    // Reads the tree again from the store; unsaved work, open folders and the
    // selection are kept. Unchanged objects that were saved elsewhere
    // meanwhile are read again.
    void refresh();
    // Asks Save / Discard / Cancel when objects are unsaved; true when the
    // browser may close (everything saved or the user chose to discard).
    bool mayClose();
    // The question mayClose() asks about the objects named (one or several)
    // of the type typeId.
    static QString unsavedChangesQuestion(const std::string& typeId, const QStringList& names);
    // The same when the store is read-only and the changes can only be lost.
    static QString unsavableChangesQuestion(const std::string& typeId, const QStringList& names);

    DirEntryTreeModel* treeModel() const { return m_model; }
    QTreeView* treeView() const { return m_tree; }
    FolderCommands* folderCommands() const { return m_folderCommands; }

    // Names already used in the folder that "new" files into.
    std::vector<std::string> namesInTargetFolder() const override;
    void clientDestroyed(DirEntryBrowserInterface* client) override;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

public slots:
    void namedObjectWasModified(std::shared_ptr<vemi::NamedObject> object);

signals:
    // The selected nodes, each object entry with its object loaded.
    void sgSelectionChanged(QVector<vemi::BaseObjectTreeModel::Node*> selectedNodes);

private:
    static QString nameList(const QStringList& names);
    void createActions();
    void keepNamesReadable();
    void keepViewState();
    void restoreViewState();
    void onTreeSelectionChanged();
    void emitSelection(quint64 generation);
    void rememberSelection();
    void restoreSelection(const std::vector<std::string>& keys);
    std::vector<std::string> selectionKeys() const;
    QVector<BaseObjectTreeModel::Node*> selectedNodes() const;
    BaseObjectTreeModel::Node* currentNode() const;
    void selectNode(BaseObjectTreeModel::Node* node);
    void updateActions();
    void showError(const QString& message);
    // Another save came between opening the object and saving it: the user
    // saves the edit as a copy, reloads the stored version, or keeps editing.
    void resolveSaveConflict(quint64 serial, const QString& message);
    void reloadStored(quint64 serial);
    void refreshSoon();
    void showContextMenu(const QPoint& position);

    void createNewObject();
    void openObject();
    void saveCurrentObject();
    bool saveAndWait(const std::vector<BaseObjectTreeModel::Node*>& nodes);
    std::vector<BaseObjectTreeModel::Node*> unsavedNodes() const;
    void createFolder();
    void renameCurrent();
    void moveSelection();
    void deleteSelection();

    DirEntryTreeModel* m_model = nullptr;
    DirEntryBrowserInterface* m_callbacks = nullptr;
    QLabel* m_title;
    QTreeView* m_tree;
    FolderCommands* m_folderCommands;
    SelectionMemory m_selectionMemory;
    ExpandedFolders m_expandedFolders;
    std::vector<std::string> m_keptSelection; // across a reload of the tree
    QAction* m_actionNew = nullptr;
    QAction* m_actionOpen = nullptr;
    QAction* m_actionSave = nullptr;
    QAction* m_actionNewFolder = nullptr;
    QAction* m_actionRename = nullptr;
    QAction* m_actionMove = nullptr;
    QAction* m_actionDelete = nullptr;
    QPointer<QWidget> m_shortcutScope;
    QString m_plural;
    bool m_writable = true;
    quint64 m_selectionGeneration = 0;
    static constexpr int kRefreshDelayMs = 200;
    bool m_refreshPending = false;
    quint64 m_newObjectFolder = 0; // serial of the folder "new" files into; 0 = top level
};

} // namespace vemi
