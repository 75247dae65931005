#include "host/widgets/FolderBrowserWidget.h"

#include "host/domain/NamedObject.h"
#include "host/domain/ObjectCodec.h"
#include "host/store/MarloModel.h"
#include "host/widgets/DirEntryBrowserInterface.h"
#include "host/widgets/DirEntryBrowserWidget.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "host/widgets/FolderCommands.h"
#include "host/widgets/ObjectTypeNames.h"

#include <QAction>
#include <QHBoxLayout>
#include <QItemSelectionModel>
#include <QPointer>
#include <QStyle>
#include <QToolButton>
#include <QTreeView>
#include <QUuid>
#include <QVBoxLayout>

namespace vemi {

using Node = BaseObjectTreeModel::Node;
using DirEntryNode = DirEntryTreeModel::DirEntryNode;

FolderBrowserWidget::FolderBrowserWidget(QWidget* parent)
    : QWidget(parent), m_browser(new DirEntryBrowserWidget(this))
{
    m_create = makeButton(QIcon(QStringLiteral(":/Images/Icon-Add-BL.png")), &FolderBrowserWidget::createObject);
    m_duplicate = makeButton(QIcon::fromTheme(QStringLiteral("edit-copy"), style()->standardIcon(QStyle::SP_FileIcon)),
                             &FolderBrowserWidget::duplicateObject);
    m_delete = makeButton(QIcon(QStringLiteral(":/Images/Icon-Trash-BL.png")), &FolderBrowserWidget::deleteSelection);
    m_create->setText(tr("New"));
    m_duplicate->setText(tr("Duplicate"));
    m_delete->setText(tr("Delete"));

    auto* buttons = new QHBoxLayout;
    buttons->setContentsMargins(4, 0, 4, 0);
    for (QToolButton* button : {m_create, m_duplicate, m_delete})
        buttons->addWidget(button);
    buttons->addStretch(1);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addLayout(buttons);
    layout->addWidget(m_browser);
    connect(m_browser, &DirEntryBrowserWidget::sgSelectionChanged, this, [this](const QVector<Node*>& nodes) {
        updateButtons();
        emit sgSelectionChanged(nodes);
    });
    updateButtons();
}

FolderBrowserWidget::~FolderBrowserWidget()
{
    if (m_callbacks && m_callbacks->folderBrowser() == this)
        m_callbacks->setFolderBrowser(nullptr);
}

QToolButton* FolderBrowserWidget::makeButton(const QIcon& icon, void (FolderBrowserWidget::*action)())
{
    auto* button = new QToolButton(this);
    button->setIcon(icon);
    button->setIconSize(QSize(20, 20));
    button->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    connect(button, &QToolButton::clicked, this, action);
    return button;
}

void FolderBrowserWidget::initialize(DirEntryTreeModel* model, bool multiSelection,
                                     DirEntryBrowserInterface* callbacks, const std::string& appName)
{
    m_model = model;
    m_callbacks = callbacks;
    const std::string typeId = callbacks ? callbacks->namedObjectTypeId() : model->objectType();
    m_browser->initialize(model, callbacks, typeId, ObjectTypeNames::plural(typeId),
                          tr("New %1").arg(ObjectTypeNames::singular(typeId)), appName, nullptr, !multiSelection);
    // New objects are stored at once by this widget, not left unsaved in the tree.
    disconnect(m_browser->actionNew(), &QAction::triggered, m_browser, nullptr);
    connect(m_browser->actionNew(), &QAction::triggered, this, &FolderBrowserWidget::createObject);
    // Store errors are the client's to report (it hears the model), not twice.
    disconnect(model, &DirEntryTreeModel::sgErrorOccurred, m_browser, nullptr);
    // Names of new objects must be free in the folder this widget files them into.
    if (m_callbacks)
        m_callbacks->setFolderBrowser(this);
    updateButtons();
}

void FolderBrowserWidget::setToolTips(const QString& createTip, const QString& duplicateTip, const QString& deleteTip)
{
    m_create->setToolTip(createTip);
    m_duplicate->setToolTip(duplicateTip);
    m_delete->setToolTip(deleteTip);
}

std::vector<std::string> FolderBrowserWidget::namesInTargetFolder() const
{
    if (!m_model)
        return {};
    return m_model->namesIn(m_targetFolder ? m_model->findBySerial(m_targetFolder) : nullptr);
}

void FolderBrowserWidget::clientDestroyed(DirEntryBrowserInterface* client)
{
    if (m_callbacks == client)
        m_callbacks = nullptr;
    m_browser->clientDestroyed(client);
}

QVector<Node*> FolderBrowserWidget::selectedNodes() const
{
    QVector<Node*> nodes;
    if (!m_model)
        return nodes;
    for (const QModelIndex& index : m_browser->treeView()->selectionModel()->selectedRows())
        nodes.append(m_model->nodeFromIndex(index));
    return nodes;
}

// The one selected object whose object is loaded; null otherwise.
Node* FolderBrowserWidget::currentObjectNode() const
{
    const QVector<Node*> nodes = selectedNodes();
    if (nodes.size() != 1 || nodes.first()->isFolder() || !nodes.first()->object())
        return nullptr;
    return nodes.first();
}

void FolderBrowserWidget::updateButtons()
{
    const bool writable = m_model && m_browser->isWritable();
    m_create->setEnabled(writable && m_callbacks);
    m_duplicate->setEnabled(writable && currentObjectNode());
    m_delete->setEnabled(writable && !selectedNodes().isEmpty());
}

void FolderBrowserWidget::createObject()
{
    if (!m_model || !m_callbacks || !m_browser->isWritable())
        return;
    const QVector<Node*> nodes = selectedNodes();
    Node* folder = m_model->folderFor(nodes.isEmpty() ? nullptr : nodes.first());
    m_targetFolder = folder ? folder->serial() : 0;
    std::shared_ptr<NamedObject> object = m_callbacks->newNamedObject();
    if (!object)
        return;
    object->setName(m_callbacks->defaultNamedObjectName(QString()));
    storeAndSelect(object, folder);
}

void FolderBrowserWidget::duplicateObject()
{
    Node* original = currentObjectNode();
    if (!original || !m_callbacks || !m_browser->isWritable())
        return;
    Node* folder = m_model->folderFor(original);
    m_targetFolder = folder ? folder->serial() : 0;
    std::shared_ptr<NamedObject> copy = ObjectCodec::clone(*original->object());
    copy->setId(QUuid::createUuid().toString(QUuid::WithoutBraces).toStdString());
    copy->setName(m_callbacks->defaultNamedObjectName(tr("%1 Copy").arg(original->displayName())));
    storeAndSelect(copy, folder);
}

void FolderBrowserWidget::storeAndSelect(std::shared_ptr<NamedObject> object, Node* folder)
{
    DirEntryNode* node = m_model->addUnsavedObject(folder, std::move(object));
    const quint64 serial = node->serial();
    m_model->saveObject(node, [this, self = QPointer<FolderBrowserWidget>(this), serial](bool ok) {
        Node* saved = self ? m_model->findBySerial(serial) : nullptr;
        if (!saved)
            return;
        // The store refused the object (the model reported why): it exists nowhere.
        if (!ok) {
            m_model->removeNode(saved);
            return;
        }
        QTreeView* tree = m_browser->treeView();
        const QModelIndex index = m_model->indexFromNode(saved);
        tree->expand(index.parent());
        tree->selectionModel()->setCurrentIndex(index, QItemSelectionModel::ClearAndSelect);
        tree->scrollTo(index);
        tree->setFocus();
    });
}

void FolderBrowserWidget::deleteSelection()
{
    if (m_model && m_browser->isWritable())
        m_browser->folderCommands()->remove(selectedNodes());
}

} // namespace vemi
