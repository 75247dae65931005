#pragma once

#include <QString>

#include <string>

namespace vemi {

// The readable names of the object types that browsers show ("Job Template",
// "Job Templates"), for texts that speak of one object or of several.
class ObjectTypeNames
{
public:
    // For a type without a name of its own: "Object" and "Objects".
    static QString singular(const std::string& typeId);
    static QString plural(const std::string& typeId);
};

} // namespace vemi
