#include "host/widgets/TreePickerDialog.h"

#include <QDialogButtonBox>
#include <QGuiApplication>
#include <QLabel>
#include <QPointer>
#include <QPushButton>
#include <QScreen>
#include <QScrollBar>
#include <QStandardItemModel>
#include <QStyle>
#include <QTreeView>
#include <QVBoxLayout>

#include <algorithm>

namespace vemi {

namespace {

constexpr int SerialRole = Qt::UserRole + 1;
constexpr int ChoosableRole = Qt::UserRole + 2;
constexpr int MinimumWidth = 360;
constexpr int PreferredHeight = 420;

} // namespace

TreePickerDialog::TreePickerDialog(const BaseObjectTreeModel& model, Choice choice, const QString& title,
                                   const QString& label, QWidget* parent, const std::vector<const Node*>& excluded)
    : QDialog(parent), m_source(model), m_choice(choice), m_items(new QStandardItemModel(this)),
      m_view(new QTreeView(this)),
      m_buttons(new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this))
{
    setWindowTitle(title);
    m_view->setHeaderHidden(true);
    m_view->setUniformRowHeights(true);
    m_view->setEditTriggers(QAbstractItemView::NoEditTriggers);
    // Names wider than the dialog are shortened in the middle (their ends tell
    // similar names apart); the tooltip gives the whole name.
    m_view->setTextElideMode(Qt::ElideMiddle);
    m_view->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);

    QStandardItem* top = m_items->invisibleRootItem();
    if (m_choice == Choice::Folder) {
        top = new QStandardItem(topLevelText());
        top->setData(quint64(0), SerialRole);
        top->setData(true, ChoosableRole);
        top->setEditable(false);
        m_items->appendRow(top);
    }
    addChildren(model.root(), top, m_choice == Choice::Folder ? 1 : 0, excluded);
    m_view->setModel(m_items);
    if (m_choice == Choice::Folder)
        m_view->expand(top->index());

    auto* layout = new QVBoxLayout(this);
    auto* caption = new QLabel(label, this);
    caption->setBuddy(m_view);
    layout->addWidget(caption);
    layout->addWidget(m_view);
    layout->addWidget(m_buttons);

    connect(m_buttons, &QDialogButtonBox::accepted, this, [this] { acceptIfChoosable(m_view->currentIndex()); });
    connect(m_buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    connect(m_view, &QAbstractItemView::activated, this, &TreePickerDialog::acceptIfChoosable);
    connect(m_view->selectionModel(), &QItemSelectionModel::currentChanged, this, &TreePickerDialog::updateOkButton);
    updateOkButton();
    fitToScreen();
}

TreePickerDialog::~TreePickerDialog() = default;

QString TreePickerDialog::topLevelText()
{
    return tr("(top level)");
}

void TreePickerDialog::addChildren(const Node* parent, QStandardItem* into, int depth,
                                   const std::vector<const Node*>& excluded)
{
    // The model keeps its children in the browser's order, which the copy keeps.
    for (const auto& child : parent->children()) {
        const Node* node = child.get();
        if (std::find(excluded.begin(), excluded.end(), node) != excluded.end())
            continue;
        if (m_choice == Choice::Folder && !node->isFolder())
            continue;
        QStandardItem* item = itemFor(node, depth);
        into->appendRow(item);
        addChildren(node, item, depth + 1, excluded);
    }
}

QStandardItem* TreePickerDialog::itemFor(const Node* node, int depth)
{
    const QString name = node->displayName();
    const QModelIndex source = m_source.indexFromNode(node);
    auto* item = new QStandardItem(source.data(Qt::DecorationRole).value<QIcon>(), name);
    item->setToolTip(name);
    item->setEditable(false);
    item->setData(node->serial(), SerialRole);
    item->setData(m_choice == Choice::Folder || !node->isFolder(), ChoosableRole);
    const int textWidth = m_view->fontMetrics().horizontalAdvance(name);
    m_widestText = std::max(m_widestText, textWidth + depth * m_view->indentation());
    return item;
}

QModelIndex TreePickerDialog::indexOfSerial(quint64 serial, const QModelIndex& parent) const
{
    for (int row = 0; row < m_items->rowCount(parent); ++row) {
        const QModelIndex index = m_items->index(row, 0, parent);
        if (index.data(SerialRole).toULongLong() == serial)
            return index;
        const QModelIndex below = indexOfSerial(serial, index);
        if (below.isValid())
            return below;
    }
    return {};
}

void TreePickerDialog::preselect(const Node* node)
{
    // A node that is not offered (a folder being moved) leaves the top level,
    // in an entry choice nothing, preselected.
    QModelIndex index = node ? indexOfSerial(node->serial()) : QModelIndex();
    if (!index.isValid() && m_choice == Choice::Folder)
        index = m_items->index(0, 0);
    if (!index.isValid())
        return;
    for (QModelIndex parent = index.parent(); parent.isValid(); parent = parent.parent())
        m_view->expand(parent);
    m_view->selectionModel()->setCurrentIndex(index, QItemSelectionModel::ClearAndSelect);
    m_view->scrollTo(index);
}

bool TreePickerDialog::isChoosable(const QModelIndex& index) const
{
    return index.isValid() && index.data(ChoosableRole).toBool();
}

void TreePickerDialog::updateOkButton()
{
    m_buttons->button(QDialogButtonBox::Ok)->setEnabled(isChoosable(m_view->currentIndex()));
}

void TreePickerDialog::acceptIfChoosable(const QModelIndex& index)
{
    if (!isChoosable(index))
        return;
    m_chosen = index.data(SerialRole).toULongLong();
    accept();
}

std::optional<quint64> TreePickerDialog::chosenSerial() const
{
    return result() == QDialog::Accepted ? m_chosen : std::nullopt;
}

void TreePickerDialog::fitToScreen()
{
    QScreen* screen = parentWidget() ? parentWidget()->screen() : QGuiApplication::primaryScreen();
    const QRect available = screen ? screen->availableGeometry() : QRect(0, 0, 800, 600);
    // Wide enough for the widest name (with its icon, the tree's frame and
    // scroll bar and the dialog's margins) where the screen has room for it.
    const int decoration = style()->pixelMetric(QStyle::PM_SmallIconSize) + 2 * m_view->frameWidth()
        + m_view->verticalScrollBar()->sizeHint().width() + 2 * layout()->contentsMargins().left() + 16;
    const int largest = available.width() * 2 / 3;
    const int width = std::clamp(m_widestText + decoration, std::min(MinimumWidth, largest), largest);
    const int height = std::min(PreferredHeight, available.height() * 2 / 3);
    setMaximumSize(available.size());
    resize(width, height);
}

std::optional<quint64> TreePickerDialog::choose(const BaseObjectTreeModel& model, Choice choice, const QString& title,
                                                const QString& label, QWidget* parent, const Node* preselected,
                                                const std::vector<const Node*>& excluded)
{
    QPointer<TreePickerDialog> picker = new TreePickerDialog(model, choice, title, label, parent, excluded);
    picker->preselect(preselected);
    picker->exec();
    if (!picker)
        return std::nullopt;
    const std::optional<quint64> chosen = picker->chosenSerial();
    delete picker;
    return chosen;
}

} // namespace vemi
