#include "host/widgets/DirEntryBrowserWidget.h"

#include "host/domain/DirEntry.h"
#include "host/widgets/DirEntryBrowserInterface.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "host/widgets/FolderCommands.h"
#include "host/widgets/ObjectTypeNames.h"
#include "host/widgets/TreePickerDialog.h"
#include "host/widgets/UserAsker.h"
#include "host/domain/NamedObject.h"
#include "host/store/MarloModel.h"

#include <QAction>
#include <QEventLoop>
#include <QHeaderView>
#include <QLabel>
#include <QMenu>
#include <QMessageBox>
#include <QMouseEvent>
#include <QPointer>
#include <QPushButton>
#include <QStyle>
#include <QTimer>
#include <QTreeView>
#include <QVBoxLayout>

#include <algorithm>

namespace vemi {

using Node = BaseObjectTreeModel::Node;
using DirEntryNode = DirEntryTreeModel::DirEntryNode;

DirEntryBrowserWidget::DirEntryBrowserWidget(QWidget* parent)
    : QWidget(parent), m_title(new QLabel(this)), m_tree(new QTreeView(this)),
      m_folderCommands(new FolderCommands(this))
{
    QFont titleFont = m_title->font();
    titleFont.setBold(true);
    m_title->setFont(titleFont);
    m_tree->setHeaderHidden(true);
    m_tree->setContextMenuPolicy(Qt::CustomContextMenu);
    // A press, a move and a release must not sweep a range into the selection.
    m_tree->viewport()->installEventFilter(this);
    connect(m_tree, &QWidget::customContextMenuRequested, this, &DirEntryBrowserWidget::showContextMenu);
    connect(m_folderCommands, &FolderCommands::sgErrorOccurred, this, &DirEntryBrowserWidget::showError);
    connect(m_folderCommands, &FolderCommands::sgMoved, this, &DirEntryBrowserWidget::restoreSelection);
    keepNamesReadable();

    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(4, 4, 4, 4);
    layout->addWidget(m_title);
    layout->addWidget(m_tree);
    createActions();
}

void DirEntryBrowserWidget::keepNamesReadable()
{
    // Room for about twenty characters of a name beside its icon, so that a
    // narrow window or splitter cannot squeeze the tree until no name reads.
    const int nameRoom = m_tree->fontMetrics().averageCharWidth() * 20;
    const int decoration = m_tree->indentation() + style()->pixelMetric(QStyle::PM_SmallIconSize)
        + style()->pixelMetric(QStyle::PM_ScrollBarExtent) + 2 * m_tree->frameWidth() + 8;
    m_tree->setMinimumWidth(nameRoom + decoration);
}

DirEntryBrowserWidget::~DirEntryBrowserWidget()
{
    if (m_callbacks && m_callbacks->folderBrowser() == this)
        m_callbacks->setFolderBrowser(nullptr);
}

void DirEntryBrowserWidget::clientDestroyed(DirEntryBrowserInterface* client)
{
    if (m_callbacks == client)
        m_callbacks = nullptr;
}

void DirEntryBrowserWidget::createActions()
{
    const auto make = [this](const QString& text, QKeySequence shortcut, void (DirEntryBrowserWidget::*slot)()) {
        auto* action = new QAction(text, this);
        action->setShortcut(shortcut);
        connect(action, &QAction::triggered, this, slot);
        return action;
    };
    m_actionNew = make(tr("New"), QKeySequence::New, &DirEntryBrowserWidget::createNewObject);
    m_actionOpen = make(tr("Open…"), QKeySequence::Open, &DirEntryBrowserWidget::openObject);
    m_actionSave = make(tr("Save"), QKeySequence::Save, &DirEntryBrowserWidget::saveCurrentObject);
    m_actionNewFolder = make(tr("New Folder…"), {}, &DirEntryBrowserWidget::createFolder);
    m_actionRename = make(tr("Rename…"), QKeySequence(Qt::Key_F2), &DirEntryBrowserWidget::renameCurrent);
    m_actionMove = make(tr("Move To…"), {}, &DirEntryBrowserWidget::moveSelection);
    m_actionDelete = make(tr("Delete"), QKeySequence::Delete, &DirEntryBrowserWidget::deleteSelection);
    // Text fields take Del for themselves (ShortcutOverride), so the keys can
    // work from anywhere inside the scope without eating the user's typing.
    for (QAction* action : {m_actionRename, m_actionDelete})
        action->setShortcutContext(Qt::WidgetWithChildrenShortcut);
    setShortcutScope(this);
    updateActions();
}

void DirEntryBrowserWidget::setShortcutScope(QWidget* scope)
{
    for (QAction* action : {m_actionRename, m_actionDelete}) {
        if (m_shortcutScope)
            m_shortcutScope->removeAction(action);
        scope->addAction(action);
    }
    m_shortcutScope = scope;
}

bool DirEntryBrowserWidget::eventFilter(QObject* watched, QEvent* event)
{
    if (watched == m_tree->viewport() && event->type() == QEvent::MouseMove
        && static_cast<QMouseEvent*>(event)->buttons() != Qt::NoButton)
        return true;
    return QWidget::eventFilter(watched, event);
}

void DirEntryBrowserWidget::initialize(DirEntryTreeModel* model, DirEntryBrowserInterface* callbacks,
                                       const std::string& typeId, const QString& title, const QString& newText,
                                       const std::string& settingsName, QItemSelectionModel* selectionModel,
                                       bool singleSelection)
{
    m_model = model;
    m_folderCommands->setModel(model);
    m_callbacks = callbacks;
    if (m_callbacks)
        m_callbacks->setFolderBrowser(this);
    m_plural = title;
    m_writable = model->store().isWritable(model->dispatcherId());
    m_title->setText(m_writable ? title : tr("%1 (read-only)").arg(title));
    m_title->setToolTip(m_writable ? QString() : tr("The store cannot be changed: it was opened read-only "
                                                     "or its file may not be written."));
    m_actionNew->setText(newText);
    m_selectionMemory.setKey(settingsName, typeId);

    m_model->setObjectType(typeId);
    m_tree->setModel(m_model);
    if (selectionModel)
        m_tree->setSelectionModel(selectionModel);
    m_tree->setSelectionMode(singleSelection ? QAbstractItemView::SingleSelection
                                             : QAbstractItemView::ExtendedSelection);
    connect(m_tree->selectionModel(), &QItemSelectionModel::selectionChanged, this,
            &DirEntryBrowserWidget::onTreeSelectionChanged);
    connect(m_model, &DirEntryTreeModel::sgErrorOccurred, this, &DirEntryBrowserWidget::showError);
    connect(m_model, &DirEntryTreeModel::sgStoreChanged, this, &DirEntryBrowserWidget::refreshSoon);
    // Queued: the question is not asked inside the save's answer.
    connect(m_model, &DirEntryTreeModel::sgSaveConflict, this, &DirEntryBrowserWidget::resolveSaveConflict,
            Qt::QueuedConnection);
    // Every reload rebuilds the nodes; the view keeps its open folders and selection.
    connect(m_model, &QAbstractItemModel::modelAboutToBeReset, this, &DirEntryBrowserWidget::keepViewState);
    connect(m_model, &QAbstractItemModel::modelReset, this, &DirEntryBrowserWidget::restoreViewState);

    const std::string remembered = m_selectionMemory.remembered();
    m_model->load([this, self = QPointer<DirEntryBrowserWidget>(this), remembered](bool ok) {
        if (!self || !ok)
            return;
        m_tree->expandToDepth(0);
        restoreSelection({remembered});
        m_tree->setFocus();
    });
}

void DirEntryBrowserWidget::createCustomMenus(QMenu* menu, const QString& singular, const QString& plural,
                                              bool withFolderActions)
{
    m_plural = plural;
    m_actionOpen->setText(tr("Open %1…").arg(singular));
    m_actionSave->setText(tr("Save %1").arg(singular));
    menu->addAction(m_actionNew);
    menu->addAction(m_actionOpen);
    menu->addAction(m_actionSave);
    if (!withFolderActions)
        return;
    menu->addSeparator();
    menu->addAction(m_actionNewFolder);
    menu->addAction(m_actionRename);
    menu->addAction(m_actionMove);
    menu->addAction(m_actionDelete);
}

void DirEntryBrowserWidget::showContextMenu(const QPoint& position)
{
    QMenu menu(this);
    for (QAction* action : {m_actionNew, m_actionSave, m_actionNewFolder, m_actionRename, m_actionMove,
                            m_actionDelete})
        menu.addAction(action);
    menu.exec(m_tree->viewport()->mapToGlobal(position));
}

QVector<Node*> DirEntryBrowserWidget::selectedNodes() const
{
    QVector<Node*> nodes;
    if (!m_model)
        return nodes;
    for (const QModelIndex& index : m_tree->selectionModel()->selectedRows())
        nodes.append(m_model->nodeFromIndex(index));
    return nodes;
}

Node* DirEntryBrowserWidget::currentNode() const
{
    const QVector<Node*> nodes = selectedNodes();
    return nodes.size() == 1 ? nodes.first() : nullptr;
}

void DirEntryBrowserWidget::selectNode(Node* node)
{
    const QModelIndex index = m_model->indexFromNode(node);
    m_tree->expand(index.parent());
    m_tree->selectionModel()->setCurrentIndex(index, QItemSelectionModel::ClearAndSelect);
    m_tree->scrollTo(index);
}

void DirEntryBrowserWidget::onTreeSelectionChanged()
{
    const quint64 generation = ++m_selectionGeneration;
    auto pending = std::make_shared<int>(1);
    const auto finishOne = [this, self = QPointer<DirEntryBrowserWidget>(this), pending, generation](bool) {
        if (--*pending == 0 && self)
            emitSelection(generation);
    };
    for (Node* node : selectedNodes()) {
        auto* entry = dynamic_cast<DirEntryNode*>(node);
        if (entry && entry->isSaved() && !entry->object()) {
            ++*pending;
            m_model->loadObject(entry, finishOne);
        }
    }
    finishOne(true);
    updateActions();
}

void DirEntryBrowserWidget::emitSelection(quint64 generation)
{
    // A newer selection replaced this one while its objects were loading.
    if (generation != m_selectionGeneration)
        return;
    rememberSelection();
    updateActions();
    // An entry whose object could not be loaded (the error was shown) is left out.
    QVector<Node*> nodes;
    for (Node* node : selectedNodes()) {
        if (node->isFolder() || node->object())
            nodes.append(node);
    }
    emit sgSelectionChanged(nodes);
}

std::vector<std::string> DirEntryBrowserWidget::selectionKeys() const
{
    std::vector<std::string> keys;
    for (Node* node : selectedNodes())
        keys.push_back(SelectionMemory::keyOf(node));
    return keys;
}

void DirEntryBrowserWidget::rememberSelection()
{
    m_selectionMemory.remember(currentNode());
}

void DirEntryBrowserWidget::restoreSelection(const std::vector<std::string>& keys)
{
    QItemSelection selection;
    QModelIndex current;
    for (Node* node : m_model->descendants(m_model->root())) {
        if (std::find(keys.begin(), keys.end(), SelectionMemory::keyOf(node)) == keys.end())
            continue;
        const QModelIndex index = m_model->indexFromNode(node);
        for (QModelIndex parent = index.parent(); parent.isValid(); parent = parent.parent())
            m_tree->expand(parent);
        selection.select(index, index);
        current = index;
    }
    if (!current.isValid()) {
        // A reset clears the selection without a signal: say that it is empty.
        onTreeSelectionChanged();
        return;
    }
    m_tree->selectionModel()->setCurrentIndex(current, QItemSelectionModel::NoUpdate);
    m_tree->selectionModel()->select(selection, QItemSelectionModel::ClearAndSelect);
    m_tree->scrollTo(current);
}

void DirEntryBrowserWidget::updateActions()
{
    const bool ready = m_model != nullptr;
    Node* node = currentNode();
    const QVector<Node*> nodes = selectedNodes();
    const bool editable = ready && m_writable;
    m_actionNew->setEnabled(editable && m_callbacks);
    m_actionOpen->setEnabled(ready);
    m_actionSave->setEnabled(m_writable && node && !node->isFolder() && node->isModified() && node->object());
    m_actionNewFolder->setEnabled(editable);
    m_actionRename->setEnabled(editable && node != nullptr);
    m_actionMove->setEnabled(editable && !nodes.isEmpty());
    m_actionDelete->setEnabled(editable && !nodes.isEmpty());
}

void DirEntryBrowserWidget::showError(const QString& message)
{
    auto* box = new QMessageBox(QMessageBox::Warning, m_plural, message, QMessageBox::Ok, this);
    box->setAttribute(Qt::WA_DeleteOnClose);
    box->open();
}

void DirEntryBrowserWidget::namedObjectWasModified(std::shared_ptr<NamedObject> object)
{
    if (!m_model || !object)
        return;
    for (Node* node : m_model->descendants(m_model->root())) {
        if (node->object() == object) {
            node->setModified(true);
            m_model->nodeChanged(node);
        }
    }
    updateActions();
}

std::vector<std::string> DirEntryBrowserWidget::namesInTargetFolder() const
{
    if (!m_model)
        return {};
    const Node* folder = m_newObjectFolder ? m_model->findBySerial(m_newObjectFolder) : nullptr;
    return m_model->namesIn(folder);
}

void DirEntryBrowserWidget::createNewObject()
{
    if (!m_model || !m_callbacks || !m_writable)
        return;
    Node* folder = m_model->folderFor(currentNode());
    m_newObjectFolder = folder ? folder->serial() : 0;
    std::shared_ptr<NamedObject> object = m_callbacks->newNamedObject();
    if (!object)
        return;
    selectNode(m_model->addUnsavedObject(folder, object));
    // F2 and typing go to the new entry, wherever the user started New from.
    m_tree->setFocus();
}

void DirEntryBrowserWidget::openObject()
{
    if (!m_model)
        return;
    const auto nodes = m_model->descendants(m_model->root());
    if (std::none_of(nodes.begin(), nodes.end(), [](const Node* node) { return !node->isFolder(); })) {
        showError(tr("There is nothing to open yet."));
        return;
    }
    QString title = m_actionOpen->text();
    title.remove(QLatin1Char('&')).remove(QChar(0x2026));
    const std::optional<quint64> chosen = TreePickerDialog::choose(
        *m_model, TreePickerDialog::Choice::Entry, title, m_plural + QLatin1Char(':'), this, currentNode());
    if (Node* node = chosen ? m_model->findBySerial(*chosen) : nullptr)
        selectNode(node);
}

void DirEntryBrowserWidget::saveCurrentObject()
{
    auto* node = dynamic_cast<DirEntryNode*>(currentNode());
    if (!node || !node->object() || !node->isModified())
        return;
    m_actionSave->setEnabled(false);
    m_model->saveObject(node, [this, self = QPointer<DirEntryBrowserWidget>(this)](bool) {
        if (!self)
            return;
        rememberSelection();
        updateActions();
    });
}

void DirEntryBrowserWidget::resolveSaveConflict(quint64 serial, const QString& message)
{
    auto* node = dynamic_cast<DirEntryNode*>(m_model->findBySerial(serial));
    if (!node || !node->object()) {
        showError(message);
        return;
    }
    const QString question = message + QStringLiteral("\n\n")
        + tr("Save your edit as a copy beside it, or reload the stored version and drop your edit? "
             "Cancel keeps your edit open, unsaved.");
    const std::optional<int> choice = m_folderCommands->asker()->choose(
        this, tr("Changed elsewhere"), question, {tr("Save as &Copy"), tr("&Reload")}, 0);
    if (!choice)
        return;
    if (*choice == 1) {
        reloadStored(serial);
        return;
    }
    // The stored version is read again only once the copy is safe.
    m_model->saveCopy(node, [this, self = QPointer<DirEntryBrowserWidget>(this), serial](bool saved) {
        if (self && saved)
            reloadStored(serial);
    });
}

void DirEntryBrowserWidget::reloadStored(quint64 serial)
{
    if (auto* node = dynamic_cast<DirEntryNode*>(m_model->findBySerial(serial))) {
        m_model->discardObject(node);
        onTreeSelectionChanged();
    }
}

bool DirEntryBrowserWidget::saveAndWait(const std::vector<Node*>& nodes)
{
    struct Progress
    {
        int pending = 0;
        bool allSaved = true;
        QEventLoop loop;
    };
    // Shared with the callbacks, which may come after this function returned
    // (when the application quits the local event loop early).
    auto progress = std::make_shared<Progress>();
    progress->pending = int(nodes.size());
    for (Node* node : nodes) {
        m_model->saveObject(static_cast<DirEntryNode*>(node), [progress](bool ok) {
            progress->allSaved = progress->allSaved && ok;
            if (--progress->pending == 0)
                progress->loop.quit();
        });
    }
    // A local event loop keeps the window painting while the store writes;
    // user input waits, so that nothing is edited, deleted or closed meanwhile.
    if (progress->pending > 0)
        progress->loop.exec(QEventLoop::ExcludeUserInputEvents);
    updateActions();
    return progress->pending == 0 && progress->allSaved;
}

std::vector<Node*> DirEntryBrowserWidget::unsavedNodes() const
{
    std::vector<Node*> unsaved;
    for (Node* node : m_model->descendants(m_model->root())) {
        if (!node->isFolder() && node->isModified() && node->object())
            unsaved.push_back(node);
    }
    return unsaved;
}

bool DirEntryBrowserWidget::mayClose()
{
    if (!m_model)
        return true;
    const std::vector<Node*> unsaved = unsavedNodes();
    if (unsaved.empty())
        return true;
    QStringList names;
    for (const Node* node : unsaved)
        names << node->displayName();
    // A read-only store cannot take the changes: the user may only lose them or stay.
    const QString question = m_writable ? unsavedChangesQuestion(m_model->objectType(), names)
                                        : unsavableChangesQuestion(m_model->objectType(), names);
    QMessageBox box(QMessageBox::Question, tr("Unsaved changes"), question,
                    m_writable ? QMessageBox::Save | QMessageBox::Discard | QMessageBox::Cancel
                               : QMessageBox::Discard | QMessageBox::Cancel,
                    this);
    if (m_writable)
        box.button(QMessageBox::Save)->setText(tr("&Save"));
    box.button(QMessageBox::Discard)->setText(tr("&Discard"));
    box.button(QMessageBox::Cancel)->setText(tr("&Cancel"));
    box.setDefaultButton(m_writable ? QMessageBox::Save : QMessageBox::Cancel);
    const int answer = box.exec();
    if (answer == QMessageBox::Discard)
        return true;
    if (answer != QMessageBox::Save)
        return false;
    return saveAndWait(unsavedNodes());
}

QString DirEntryBrowserWidget::unsavedChangesQuestion(const std::string& typeId, const QStringList& names)
{
    const QString question = names.size() == 1
        ? tr("This %1 has unsaved changes. Save it before closing?").arg(ObjectTypeNames::singular(typeId))
        : tr("These %1 %2 have unsaved changes. Save them before closing?")
              .arg(names.size())
              .arg(ObjectTypeNames::plural(typeId));
    return question + nameList(names);
}

QString DirEntryBrowserWidget::unsavableChangesQuestion(const std::string& typeId, const QStringList& names)
{
    const QString question = names.size() == 1
        ? tr("This %1 has changes that cannot be saved, because the store is read-only. Close and lose them?")
              .arg(ObjectTypeNames::singular(typeId))
        : tr("These %1 %2 have changes that cannot be saved, because the store is read-only. Close and lose them?")
              .arg(names.size())
              .arg(ObjectTypeNames::plural(typeId));
    return question + nameList(names);
}

QString DirEntryBrowserWidget::nameList(const QStringList& names)
{
    QStringList lines;
    for (const QString& name : names)
        lines << QStringLiteral("  • ") + name;
    return QStringLiteral("\n\n") + lines.join(QLatin1Char('\n'));
}

void DirEntryBrowserWidget::refresh()
{
    if (!m_model)
        return;
    // Objects saved elsewhere were dropped from the tree: the selected ones
    // are read again and handed to the client.
    m_model->load([this, self = QPointer<DirEntryBrowserWidget>(this)](bool ok) {
        if (!self || !ok)
            return;
        const auto nodes = selectedNodes();
        const bool dropped = std::any_of(nodes.begin(), nodes.end(), [](Node* node) {
            auto* entry = dynamic_cast<DirEntryNode*>(node);
            return entry && entry->isSaved() && !entry->object();
        });
        if (dropped)
            onTreeSelectionChanged();
    });
}

// A burst of changes elsewhere (a folder of objects saved at once) makes one refresh.
void DirEntryBrowserWidget::refreshSoon()
{
    if (m_refreshPending)
        return;
    m_refreshPending = true;
    QTimer::singleShot(kRefreshDelayMs, this, [this] {
        m_refreshPending = false;
        refresh();
    });
}

void DirEntryBrowserWidget::keepViewState()
{
    m_expandedFolders.capture(*m_tree, *m_model);
    m_keptSelection = selectionKeys();
}

void DirEntryBrowserWidget::restoreViewState()
{
    m_expandedFolders.restore(*m_tree, *m_model);
    if (!m_keptSelection.empty())
        restoreSelection(m_keptSelection);
}

void DirEntryBrowserWidget::createFolder()
{
    if (m_writable)
        m_folderCommands->createFolder(currentNode());
}

void DirEntryBrowserWidget::renameCurrent()
{
    if (m_writable)
        m_folderCommands->rename(currentNode());
}

void DirEntryBrowserWidget::moveSelection()
{
    m_folderCommands->move(selectedNodes());
}

void DirEntryBrowserWidget::deleteSelection()
{
    if (m_writable)
        m_folderCommands->remove(selectedNodes());
}

} // namespace vemi
