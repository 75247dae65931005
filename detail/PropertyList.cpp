#include "detail/PropertyList.h"

#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/widgets/TagDefinitionDialog.h"

#include <algorithm>
#include <functional>

namespace vemi {

PropertyList::PropertyList(Definitions definitions, Values values)
    : m_definitions(std::move(definitions))
    , m_values(std::move(values))
{
}

bool PropertyList::hasDefinitionNamed(const Definitions& definitions, const std::string& name)
{
    return std::any_of(definitions.begin(), definitions.end(),
                       [&name](const std::shared_ptr<TagDefinition>& d) { return d && d->name() == name; });
}

bool PropertyList::add(const std::shared_ptr<TagDefinition>& definition, const Definitions& takenElsewhere)
{
    if (!definition || hasDefinitionNamed(m_definitions, definition->name())
        || hasDefinitionNamed(takenElsewhere, definition->name()))
        return false;
    m_definitions.push_back(definition);
    if (!definition->defaultValue().empty())
        m_values.push_back(TagValue::forDefinition(*definition, definition->defaultValue()));
    return true;
}

bool PropertyList::removeRows(std::vector<int> rows)
{
    // Highest first, so that each erase leaves the lower positions valid.
    std::sort(rows.begin(), rows.end(), std::greater<int>());
    rows.erase(std::unique(rows.begin(), rows.end()), rows.end());
    bool removed = false;
    for (int row : rows) {
        if (row < 0 || row >= int(m_definitions.size()))
            continue;
        const auto definition = m_definitions[std::size_t(row)];
        m_definitions.erase(m_definitions.begin() + row);
        removed = true;
        if (!definition)
            continue;
        const std::string id = definition->id();
        m_values.erase(std::remove_if(m_values.begin(), m_values.end(),
                                      [&id](const std::shared_ptr<TagValue>& v) { return v && v->definitionId() == id; }),
                       m_values.end());
    }
    return removed;
}

bool PropertyList::editRow(int row, MarloModel& store, QWidget* parent)
{
    if (row < 0 || row >= int(m_definitions.size()))
        return false;
    TagDefinitionDialog dialog(parent);
    return dialog.edit(store, m_values, m_definitions[std::size_t(row)]);
}

} // namespace vemi
