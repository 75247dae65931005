#include "host/widgets/ObjectBrowserDialog.h"

#include "host/domain/DirEntry.h"
#include "host/domain/GlobalDirEntry.h"
#include "host/domain/Header.h"
#include "host/store/MarloModel.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "host/widgets/ObjectTypeNames.h"
#include "host/widgets/SelectedPath.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QGridLayout>
#include <QGuiApplication>
#include <QLabel>
#include <QPushButton>
#include <QScreen>
#include <QStandardItemModel>
#include <QTreeView>
#include <QVBoxLayout>

#include <algorithm>

namespace vemi {

namespace {

constexpr int PreferredWidth = 480;
constexpr int PreferredHeight = 520;

// "" and the default store's own id name the same store.
std::string normalised(const std::string& dispatcherId)
{
    return dispatcherId.empty() ? MarloModel::defaultDispatcherId() : dispatcherId;
}

std::shared_ptr<GlobalDirEntry> globalEntry(const DirEntry& entry, const std::string& dispatcherId)
{
    auto global = std::make_shared<GlobalDirEntry>();
    global->setId(entry.id());
    global->header()->setName(entry.header()->name());
    global->header()->setDescription(entry.header()->description());
    global->setEntryObjectId(entry.entryObjectId());
    global->setEntryObjectType(entry.entryObjectType());
    global->setFolderId(entry.folderId());
    global->setDispatcherId(dispatcherId);
    return global;
}

} // namespace

ObjectBrowserDialog::ObjectBrowserDialog(MarloModel& store, QWidget* parent)
    : QDialog(parent), m_store(store), m_dispatcherCombo(new QComboBox(this)), m_typeCombo(new QComboBox(this)),
      m_typeLabel(new QLabel(tr("&Type:"), this)), m_folderTree(new QTreeView(this)), m_statusLabel(new QLabel(this)),
      m_buttonBox(new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this))
{
    buildLayout();
    fillDispatcherCombo();
    updateOkButton();
    fitToScreen();
}

ObjectBrowserDialog::~ObjectBrowserDialog() = default;

QString ObjectBrowserDialog::defaultStoreText()
{
    return QString::fromStdString(MarloModel::defaultDispatcherId());
}

void ObjectBrowserDialog::buildLayout()
{
    m_dispatcherCombo->setObjectName(QStringLiteral("dispatcherCombo"));
    m_typeCombo->setObjectName(QStringLiteral("typeCombo"));
    m_folderTree->setObjectName(QStringLiteral("folderTree"));
    m_statusLabel->setObjectName(QStringLiteral("statusLabel"));
    m_buttonBox->setObjectName(QStringLiteral("buttonBox"));

    // Long store ids and names are shortened in the middle, where similar
    // names differ least; tool tips give them whole.
    for (QComboBox* combo : {m_dispatcherCombo, m_typeCombo}) {
        combo->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
        combo->setMinimumContentsLength(16);
        combo->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
    }
    m_folderTree->setHeaderHidden(true);
    m_folderTree->setUniformRowHeights(true);
    m_folderTree->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_folderTree->setTextElideMode(Qt::ElideMiddle);
    m_folderTree->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    m_statusLabel->setWordWrap(true);
    m_statusLabel->setTextFormat(Qt::PlainText);

    auto* storeLabel = new QLabel(tr("&Store:"), this);
    storeLabel->setBuddy(m_dispatcherCombo);
    m_typeLabel->setBuddy(m_typeCombo);
    auto* choices = new QGridLayout;
    choices->addWidget(storeLabel, 0, 0);
    choices->addWidget(m_dispatcherCombo, 0, 1);
    choices->addWidget(m_typeLabel, 1, 0);
    choices->addWidget(m_typeCombo, 1, 1);
    choices->setColumnStretch(1, 1);

    auto* layout = new QVBoxLayout(this);
    layout->addLayout(choices);
    layout->addWidget(m_folderTree, 1);
    layout->addWidget(m_statusLabel);
    layout->addWidget(m_buttonBox);
    m_typeLabel->hide();
    m_typeCombo->hide();

    connect(m_buttonBox, &QDialogButtonBox::accepted, this, &ObjectBrowserDialog::accept);
    connect(m_buttonBox, &QDialogButtonBox::rejected, this, &QDialog::reject);
    connect(m_dispatcherCombo, QOverload<int>::of(&QComboBox::currentIndexChanged), this,
            &ObjectBrowserDialog::scheduleLoad);
    connect(m_typeCombo, QOverload<int>::of(&QComboBox::currentIndexChanged), this,
            &ObjectBrowserDialog::scheduleLoad);
    connect(m_folderTree, &QAbstractItemView::activated, this, &ObjectBrowserDialog::activateIndex);
}

void ObjectBrowserDialog::initialize(bool multiSelection, bool allowEmptySelection,
                                     const std::vector<std::string>& typeIds, const QString& title, bool storeFixed)
{
    m_multiSelection = multiSelection;
    m_allowEmptySelection = allowEmptySelection;
    m_storeFixed = storeFixed;
    m_typeIds = typeIds;
    setWindowTitle(title);
    m_folderTree->setSelectionMode(multiSelection ? QAbstractItemView::ExtendedSelection
                                                  : QAbstractItemView::SingleSelection);
    m_dispatcherCombo->setEnabled(!storeFixed);
    fillTypeCombo();
    updateOkButton();
    scheduleLoad();
}

void ObjectBrowserDialog::setDispatcherList(const std::vector<std::string>& dispatcherIds)
{
    m_dispatcherIds = dispatcherIds;
    fillDispatcherCombo();
    scheduleLoad();
}

void ObjectBrowserDialog::setLastSelectedPath(std::shared_ptr<SelectedPath> path)
{
    m_lastSelectedPath = std::move(path);
    fillDispatcherCombo();
    scheduleLoad();
}

void ObjectBrowserDialog::fillDispatcherCombo()
{
    const QSignalBlocker blocker(m_dispatcherCombo);
    m_dispatcherCombo->clear();
    auto* items = qobject_cast<QStandardItemModel*>(m_dispatcherCombo->model());
    std::vector<std::string> ids = m_dispatcherIds.empty() ? std::vector<std::string>{std::string()} : m_dispatcherIds;
    std::vector<std::string> listed;
    for (const std::string& id : ids) {
        if (std::find(listed.begin(), listed.end(), normalised(id)) != listed.end())
            continue;
        listed.push_back(normalised(id));
        const QString name = QString::fromStdString(normalised(id));
        const bool available = m_store.commandDispatcher(id) != nullptr;
        m_dispatcherCombo->addItem(available ? name : tr("%1 (not set up)").arg(name), QString::fromStdString(id));
        QStandardItem* item = items->item(m_dispatcherCombo->count() - 1);
        item->setToolTip(available ? name : tr("No store is set up under the name \"%1\".").arg(name));
        item->setEnabled(available);
    }
    // The remembered store if it can be chosen, else the first that can.
    int row = m_lastSelectedPath ? comboRowOf(m_lastSelectedPath->dispatcherId()) : -1;
    for (int candidate = 0; candidate < m_dispatcherCombo->count() && row < 0; ++candidate) {
        if (items->item(candidate)->isEnabled())
            row = candidate;
    }
    m_dispatcherCombo->setCurrentIndex(row);
}

int ObjectBrowserDialog::comboRowOf(const std::string& dispatcherId) const
{
    const auto* items = qobject_cast<QStandardItemModel*>(m_dispatcherCombo->model());
    for (int row = 0; row < m_dispatcherCombo->count(); ++row) {
        const std::string id = m_dispatcherCombo->itemData(row).toString().toStdString();
        if (normalised(id) == normalised(dispatcherId) && items->item(row)->isEnabled())
            return row;
    }
    return -1;
}

void ObjectBrowserDialog::fillTypeCombo()
{
    const QSignalBlocker blocker(m_typeCombo);
    m_typeCombo->clear();
    for (const std::string& typeId : m_typeIds)
        m_typeCombo->addItem(ObjectTypeNames::plural(typeId), QString::fromStdString(typeId));
    const bool several = m_typeIds.size() > 1;
    m_typeLabel->setVisible(several);
    m_typeCombo->setVisible(several);
}

std::string ObjectBrowserDialog::currentDispatcherId() const
{
    return m_dispatcherCombo->currentData().toString().toStdString();
}

std::string ObjectBrowserDialog::currentTypeId() const
{
    return m_typeCombo->currentData().toString().toStdString();
}

void ObjectBrowserDialog::scheduleLoad()
{
    // The setters come one after the other before exec(); the tree is read once.
    if (m_loadScheduled)
        return;
    m_loadScheduled = true;
    QMetaObject::invokeMethod(this, [this] {
        m_loadScheduled = false;
        loadTree();
    }, Qt::QueuedConnection);
}

void ObjectBrowserDialog::loadTree()
{
    // The combo box cuts a long store id; its tool tip shows it whole.
    m_dispatcherCombo->setToolTip(m_dispatcherCombo->currentText());
    auto* model = new DirEntryTreeModel(m_store, this);
    model->setDispatcherId(currentDispatcherId());
    model->setObjectType(currentTypeId());
    connect(model, &DirEntryTreeModel::sgErrorOccurred, this, &ObjectBrowserDialog::showError);

    QItemSelectionModel* oldSelection = m_folderTree->selectionModel();
    m_folderTree->setModel(model);
    delete oldSelection;
    // Answers still on their way to the old tree die with it.
    delete m_model;
    m_model = model;
    connect(m_folderTree->selectionModel(), &QItemSelectionModel::selectionChanged, this,
            &ObjectBrowserDialog::updateOkButton);
    updateOkButton();

    if (m_dispatcherCombo->currentIndex() < 0) {
        showError(tr("None of the stores in the list is set up."));
        return;
    }
    if (m_typeIds.empty())
        return;
    m_statusLabel->setText(tr("Reading the folders…"));
    model->load([this, model](bool ok) {
        if (!ok)
            return;
        // An empty tree alone would look like a store still being read.
        if (model->rowCount() == 0)
            m_statusLabel->setText(tr("The store \"%1\" holds no %2.")
                                       .arg(m_dispatcherCombo->currentText(), ObjectTypeNames::plural(model->objectType()).toLower()));
        else
            m_statusLabel->clear();
        openRemembered(model);
    });
}

void ObjectBrowserDialog::openRemembered(DirEntryTreeModel* model)
{
    if (!m_lastSelectedPath || normalised(m_lastSelectedPath->dispatcherId()) != normalised(model->dispatcherId()))
        return;
    // A folder deleted or renamed since leaves the top level open.
    const QModelIndex folder = folderIndexOf(model, m_lastSelectedPath->path());
    if (!folder.isValid())
        return;
    for (QModelIndex index = folder; index.isValid(); index = index.parent())
        m_folderTree->expand(index);
    m_folderTree->selectionModel()->setCurrentIndex(folder, QItemSelectionModel::NoUpdate);
    m_folderTree->scrollTo(folder);
}

QModelIndex ObjectBrowserDialog::folderIndexOf(DirEntryTreeModel* model, const std::vector<std::string>& path) const
{
    const DirEntryTreeModel::Node* current = model->root();
    for (const std::string& name : path) {
        const auto& children = current->children();
        const QString wanted = QString::fromStdString(name);
        const auto found = std::find_if(children.begin(), children.end(), [&wanted](const auto& child) {
            return child->isFolder() && child->displayName() == wanted;
        });
        if (found == children.end())
            return {};
        current = found->get();
    }
    return current == model->root() ? QModelIndex() : model->indexFromNode(current);
}

std::vector<QModelIndex> ObjectBrowserDialog::selectedEntryIndexes() const
{
    std::vector<QModelIndex> entries;
    if (!m_model || !m_folderTree->selectionModel())
        return entries;
    for (const QModelIndex& index : m_folderTree->selectionModel()->selectedRows()) {
        const auto* node = dynamic_cast<const DirEntryTreeModel::DirEntryNode*>(m_model->nodeFromIndex(index));
        if (node && node->isSaved())
            entries.push_back(index);
    }
    return entries;
}

void ObjectBrowserDialog::showError(const QString& message)
{
    m_statusLabel->setText(tr("Cannot show the store \"%1\": %2").arg(m_dispatcherCombo->currentText(), message));
}

void ObjectBrowserDialog::updateOkButton()
{
    m_buttonBox->button(QDialogButtonBox::Ok)->setEnabled(m_allowEmptySelection || !selectedEntryIndexes().empty());
}

void ObjectBrowserDialog::activateIndex(const QModelIndex& index)
{
    // Double-clicking a folder opens it (the tree's own behaviour); an entry is chosen.
    if (m_model && index.isValid() && !m_model->nodeFromIndex(index)->isFolder())
        accept();
}

void ObjectBrowserDialog::accept()
{
    const std::vector<QModelIndex> entries = selectedEntryIndexes();
    if (entries.empty() && !m_allowEmptySelection)
        return;
    const std::string dispatcherId = currentDispatcherId();
    m_selectedEntries.clear();
    for (const QModelIndex& index : entries) {
        const auto* node = static_cast<const DirEntryTreeModel::DirEntryNode*>(m_model->nodeFromIndex(index));
        m_selectedEntries.push_back(globalEntry(*node->dirEntry(), dispatcherId));
    }
    const DirEntryTreeModel::Node* current = m_model ? m_model->nodeFromIndex(m_folderTree->currentIndex()) : nullptr;
    m_lastSelectedPath = std::make_shared<SelectedPath>(dispatcherId, m_model ? m_model->pathOf(current) : std::vector<std::string>{});
    QDialog::accept();
}

void ObjectBrowserDialog::fitToScreen()
{
    QScreen* screen = parentWidget() ? parentWidget()->screen() : QGuiApplication::primaryScreen();
    const QRect available = screen ? screen->availableGeometry() : QRect(0, 0, 800, 600);
    setMaximumSize(available.size());
    resize(std::min(PreferredWidth, available.width() * 2 / 3), std::min(PreferredHeight, available.height() * 2 / 3));
}

} // namespace vemi
