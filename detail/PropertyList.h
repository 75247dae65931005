#pragma once

#include <memory>
#include <string>
#include <vector>

class QWidget;

namespace vemi {

class MarloModel;
class TagDefinition;
class TagValue;

// A working list of properties: tag definitions in display order and the
// values that name them. Values are not indexed like the definitions (a
// definition without a default adds no value, and edits append), so every
// operation matches values to definitions by the definition's id.
class PropertyList
{
public:
    using Definitions = std::vector<std::shared_ptr<TagDefinition>>;
    using Values = std::vector<std::shared_ptr<TagValue>>;

    PropertyList(Definitions definitions, Values values);

    const Definitions& definitions() const { return m_definitions; }
    const Values& values() const { return m_values; }

    // Appends definition with its default value, if it has one, unless a
    // definition of the same name is already here or among takenElsewhere.
    // True when it was added.
    bool add(const std::shared_ptr<TagDefinition>& definition, const Definitions& takenElsewhere = {});
    // Removes the definitions at rows (display positions, in any order) with
    // the values that name them; rows out of range are ignored. True when
    // anything was removed.
    bool removeRows(std::vector<int> rows);
    // Opens the host's tag dialog on the value of the definition at row;
    // true when the user changed it. Definitions never change here.
    bool editRow(int row, MarloModel& store, QWidget* parent);

    static bool hasDefinitionNamed(const Definitions& definitions, const std::string& name);

private:
    Definitions m_definitions;
    Values m_values;
};

} // namespace vemi
