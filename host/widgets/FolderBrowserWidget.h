#pragma once

#include "host/widgets/BaseObjectTreeModel.h"
#include "host/widgets/FolderNames.h"

#include <QVector>
#include <QWidget>

#include <memory>
#include <string>

class QToolButton;

namespace vemi {

class DirEntryBrowserInterface;
class DirEntryBrowserWidget;
class DirEntryTreeModel;
class NamedObject;

// A compact folder tree of the stored objects of one type, for dialogs that
// choose one: a DirEntryBrowserWidget (folders, rename, delete, selection
// memory) with buttons that create, duplicate and delete objects. Objects it
// creates or duplicates are stored at once, under readable numbered names
// ("Measurement Configuration 2"), and selected. The tree model's errors and
// changed entries are for the client to handle (sgErrorOccurred, sgItemChanged).
class FolderBrowserWidget : public QWidget, public FolderNames
{
    Q_OBJECT

public:
    explicit FolderBrowserWidget(QWidget* parent = nullptr);
    ~FolderBrowserWidget() override;

    // model: not owned, must outlive this widget; multiSelection lets the user
    // select several entries; callbacks: the client (not owned), which names
    // the type and makes new objects; appName: where the last selection is kept.
    void initialize(DirEntryTreeModel* model, bool multiSelection, DirEntryBrowserInterface* callbacks,
                    const std::string& appName);
    void setToolTips(const QString& createTip, const QString& duplicateTip, const QString& deleteTip);

    DirEntryBrowserWidget* browser() const { return m_browser; }
    QToolButton* createButton() const { return m_create; }
    QToolButton* duplicateButton() const { return m_duplicate; }
    QToolButton* deleteButton() const { return m_delete; }

    std::vector<std::string> namesInTargetFolder() const override;
    void clientDestroyed(DirEntryBrowserInterface* client) override;

signals:
    // The selected nodes, each object entry with its object loaded.
    void sgSelectionChanged(QVector<vemi::BaseObjectTreeModel::Node*> selectedNodes);

private:
    QToolButton* makeButton(const QIcon& icon, void (FolderBrowserWidget::*action)());
    QVector<BaseObjectTreeModel::Node*> selectedNodes() const;
    BaseObjectTreeModel::Node* currentObjectNode() const;
    void updateButtons();
    void createObject();
    void duplicateObject();
    void deleteSelection();
    void storeAndSelect(std::shared_ptr<NamedObject> object, BaseObjectTreeModel::Node* folder);

    DirEntryBrowserWidget* m_browser;
    QToolButton* m_create;
    QToolButton* m_duplicate;
    QToolButton* m_delete;
    DirEntryTreeModel* m_model = nullptr;
    DirEntryBrowserInterface* m_callbacks = nullptr;
    quint64 m_targetFolder = 0; // serial of the folder a new object goes into; 0 = top level
};

} // namespace vemi
