#pragma once

#include "host/store/Command.h"

namespace vemi {

// Lists the folders and entries of the tree for one object type.
class GetDirectoryTree : public Command
{
public:
    explicit GetDirectoryTree(std::string objectType) : m_objectType(std::move(objectType)) {}

    std::shared_ptr<Response> execute(StoreDatabase& database) override;
    std::string description() const override { return "list the folders of " + m_objectType; }

private:
    std::string m_objectType;
};

} // namespace vemi
