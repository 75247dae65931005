#pragma once

#include "host/store/HostMetaTypes.h"

#include <QStringList>
#include <QWidget>

#include <memory>
#include <string>
#include <vector>

class QTableWidget;

namespace vemi {

class TagDefinition;
class TagValue;

// Shows tag definitions with their values, one row per definition in the
// order given. The user selects rows (several with Ctrl or Shift) and
// double-clicks a row to edit its value; the widget itself edits nothing.
class TagDisplayWidget : public QWidget
{
    Q_OBJECT

public:
    explicit TagDisplayWidget(QWidget* parent = nullptr);

    // A definition's value is the one that names it; without one it shows the
    // definition's default value (which may be blank). Clears the selection.
    void setTags(const std::vector<std::shared_ptr<TagValue>>& values,
                 const std::vector<std::shared_ptr<TagDefinition>>& definitions);
    // Ascending row indices.
    std::vector<int> getSelectedRows() const;
    void clearSelections();

signals:
    // row: the current selected row, or -1 when no row is selected;
    // names: the names of all selected rows, in row order.
    void tagRowsSelected(int row, QStringList names);
    void tagRowDoubleClicked(int row, std::string name);

private:
    void onSelectionChanged();
    void onCellDoubleClicked(int row);
    void addRow(const TagDefinition& definition, const std::vector<std::shared_ptr<TagValue>>& values);

    QTableWidget* m_table;
    std::vector<std::string> m_names;
};

} // namespace vemi
