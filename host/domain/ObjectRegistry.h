#pragma once

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>

namespace vemi {

class BaseObject;

// Creates an empty object of a class from its type id; knows every domain class.
class ObjectRegistry
{
public:
    // An empty handle for an unknown type id.
    static std::shared_ptr<BaseObject> create(const std::string& typeId);
    static bool knows(const std::string& typeId);
    // Every type id it can create, in sorted order.
    static std::vector<std::string> typeIds();

private:
    using Creators = std::map<std::string, std::function<std::shared_ptr<BaseObject>()>>;
    static const Creators& creators();
};

} // namespace vemi
