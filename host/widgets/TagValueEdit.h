#pragma once

#include <QString>

#include <memory>
#include <string>
#include <vector>

namespace vemi {

class TagDefinition;
class TagValue;

// The rules for the value of one tag definition inside an object's list of
// tag values, in which each value names its definition by id.
class TagValueEdit
{
public:
    // The value that names definition; empty when there is none.
    static std::shared_ptr<TagValue> valueOf(const std::vector<std::shared_ptr<TagValue>>& values,
                                             const TagDefinition& definition);
    // What the definition currently holds: its value, else its default value.
    static std::string shownValue(const std::vector<std::shared_ptr<TagValue>>& values,
                                  const TagDefinition& definition);
    // Empty when text may be the definition's value, else why not, for the user.
    // Blank is always allowed; a number is read in the user's locale or in C.
    static QString rejection(const TagDefinition& definition, const QString& text);
    // Gives definition the value text: replaces the value that names it by a
    // new one (keeping its id, so the old object is left as it was), or
    // appends one when there was none. Returns whether what the definition
    // holds changed; when not, values is left as it was.
    static bool write(std::vector<std::shared_ptr<TagValue>>& values, const TagDefinition& definition,
                      const std::string& text);
};

} // namespace vemi
