#pragma once

#include "host/store/Command.h"

namespace vemi {

// Creates a folder in the tree of one object type; answers a FolderResponse.
class CreateFolder : public Command
{
public:
    CreateFolder(std::string objectType, std::string parentId, std::string name)
        : m_objectType(std::move(objectType)), m_parentId(std::move(parentId)), m_name(std::move(name)) {}

    std::shared_ptr<Response> execute(StoreDatabase& database) override;
    std::string description() const override { return "create the folder \"" + m_name + "\""; }

private:
    std::string m_objectType;
    std::string m_parentId;
    std::string m_name;
};

} // namespace vemi
