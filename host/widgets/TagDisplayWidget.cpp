#include "host/widgets/TagDisplayWidget.h"

#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/widgets/TagValueEdit.h"

#include <QHeaderView>
#include <QItemSelectionModel>
#include <QTableWidget>
#include <QVBoxLayout>

#include <algorithm>

namespace vemi {

namespace {

enum Column { NameColumn, ValueColumn };

QTableWidgetItem* readOnlyItem(const QString& text)
{
    auto* item = new QTableWidgetItem(text);
    item->setFlags(Qt::ItemIsSelectable | Qt::ItemIsEnabled);
    return item;
}

} // namespace

TagDisplayWidget::TagDisplayWidget(QWidget* parent)
    : QWidget(parent)
    , m_table(new QTableWidget(0, 2, this))
{
    m_table->setObjectName(QStringLiteral("tagTable"));
    m_table->setHorizontalHeaderLabels({tr("Property"), tr("Value")});
    m_table->horizontalHeader()->setStretchLastSection(true);
    m_table->verticalHeader()->hide();
    m_table->setSelectionBehavior(QAbstractItemView::SelectRows);
    m_table->setSelectionMode(QAbstractItemView::ExtendedSelection);
    m_table->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_table->setWordWrap(false);

    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(m_table);

    connect(m_table->selectionModel(), &QItemSelectionModel::selectionChanged, this,
            &TagDisplayWidget::onSelectionChanged);
    connect(m_table, &QTableWidget::cellDoubleClicked, this, &TagDisplayWidget::onCellDoubleClicked);
}

void TagDisplayWidget::setTags(const std::vector<std::shared_ptr<TagValue>>& values,
                               const std::vector<std::shared_ptr<TagDefinition>>& definitions)
{
    m_table->clearSelection();
    m_table->setRowCount(0);
    m_names.clear();
    for (const auto& definition : definitions) {
        if (definition)
            addRow(*definition, values);
    }
}

void TagDisplayWidget::addRow(const TagDefinition& definition, const std::vector<std::shared_ptr<TagValue>>& values)
{
    const int row = m_table->rowCount();
    m_table->insertRow(row);
    m_names.push_back(definition.name());
    m_table->setItem(row, NameColumn, readOnlyItem(QString::fromStdString(definition.name())));
    m_table->setItem(row, ValueColumn,
                     readOnlyItem(QString::fromStdString(TagValueEdit::shownValue(values, definition))));
}

std::vector<int> TagDisplayWidget::getSelectedRows() const
{
    std::vector<int> rows;
    for (const QModelIndex& index : m_table->selectionModel()->selectedRows())
        rows.push_back(index.row());
    std::sort(rows.begin(), rows.end());
    return rows;
}

void TagDisplayWidget::clearSelections()
{
    m_table->clearSelection();
}

void TagDisplayWidget::onSelectionChanged()
{
    const std::vector<int> rows = getSelectedRows();
    QStringList names;
    for (int row : rows)
        names << QString::fromStdString(m_names.at(size_t(row)));
    int row = -1;
    if (!rows.empty()) {
        // The row the user clicked last, when it is among the selected ones.
        const int current = m_table->currentRow();
        row = std::binary_search(rows.begin(), rows.end(), current) ? current : rows.front();
    }
    emit tagRowsSelected(row, names);
}

void TagDisplayWidget::onCellDoubleClicked(int row)
{
    if (row >= 0 && size_t(row) < m_names.size())
        emit tagRowDoubleClicked(row, m_names[size_t(row)]);
}

} // namespace vemi
