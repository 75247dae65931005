#pragma once

#include <QDialog>
#include <QVector>

#include <memory>
#include <string>
#include <vector>

class QComboBox;
class QDialogButtonBox;
class QLabel;
class QModelIndex;
class QTreeView;

namespace vemi {

class DirEntryTreeModel;
class GlobalDirEntry;
class MarloModel;
class SelectedPath;

// A modal choice of stored objects: the user picks a store from the
// dispatcher list, opens its folders and selects entries of the offered
// types. The folder tree is read asynchronously; the dialog never waits on a
// store. The store model must outlive the dialog.
class ObjectBrowserDialog : public QDialog
{
    Q_OBJECT

public:
    ObjectBrowserDialog(MarloModel& store, QWidget* parent = nullptr);
    ~ObjectBrowserDialog() override;

    // multiSelection: several entries may be chosen at once.
    // allowEmptySelection: OK may be pressed with no entry selected; when
    //   false, OK needs at least one entry (a folder alone is no choice).
    // typeIds: the object types offered, the first shown at start; with more
    //   than one a type list lets the user switch.
    // storeFixed: the store of the last selected path (or the first of the
    //   dispatcher list) is shown and cannot be switched.
    void initialize(bool multiSelection, bool allowEmptySelection, const std::vector<std::string>& typeIds,
                    const QString& title, bool storeFixed);
    // The stores offered; "" and "Local" both name the default store. An
    // empty list offers the default store alone. Ids that name no store are
    // listed but cannot be chosen.
    void setDispatcherList(const std::vector<std::string>& dispatcherIds);
    // Where the dialog opens. A folder that no longer exists opens the top
    // level of its store; a store that is not listed or cannot be chosen, the
    // first store that can. May be null.
    void setLastSelectedPath(std::shared_ptr<SelectedPath> path);
    // The store and folder current when OK was pressed; before that, the path set.
    std::shared_ptr<SelectedPath> lastSelectedPath() const { return m_lastSelectedPath; }
    // The entries chosen when OK was pressed, in the order of the selection,
    // each carrying the dispatcher id of its store; empty until then.
    QVector<std::shared_ptr<GlobalDirEntry>> selectedDirEntries() const { return m_selectedEntries; }

    static QString defaultStoreText();

public slots:
    // Accepts only a valid choice (see initialize).
    void accept() override;

private:
    void buildLayout();
    void fillDispatcherCombo();
    void fillTypeCombo();
    std::string currentDispatcherId() const;
    std::string currentTypeId() const;
    int comboRowOf(const std::string& dispatcherId) const;
    void scheduleLoad();
    void loadTree();
    void openRemembered(DirEntryTreeModel* model);
    QModelIndex folderIndexOf(DirEntryTreeModel* model, const std::vector<std::string>& path) const;
    std::vector<QModelIndex> selectedEntryIndexes() const;
    void showError(const QString& message);
    void updateOkButton();
    void activateIndex(const QModelIndex& index);
    void fitToScreen();

    MarloModel& m_store;
    bool m_multiSelection = true;
    bool m_allowEmptySelection = false;
    bool m_storeFixed = false;
    std::vector<std::string> m_typeIds;
    std::vector<std::string> m_dispatcherIds;
    std::shared_ptr<SelectedPath> m_lastSelectedPath;
    QVector<std::shared_ptr<GlobalDirEntry>> m_selectedEntries;
    bool m_loadScheduled = false;
    DirEntryTreeModel* m_model = nullptr;

    QComboBox* m_dispatcherCombo;
    QComboBox* m_typeCombo;
    QLabel* m_typeLabel;
    QTreeView* m_folderTree;
    QLabel* m_statusLabel;
    QDialogButtonBox* m_buttonBox;
};

} // namespace vemi
