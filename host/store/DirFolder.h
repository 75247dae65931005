#pragma once

#include <string>

namespace vemi {

// A folder of the store's tree for one object type; an empty parentId is the top level.
struct DirFolder
{
    std::string id;
    std::string parentId;
    std::string name;
    std::string objectType;
};

enum class DirItemKind { Folder, Entry };

} // namespace vemi
