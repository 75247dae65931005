#pragma once

#include "host/store/Command.h"

#include <vector>

namespace vemi {

// Fetches objects of one type: those with the given ids, in that order, or
// every object of the type (by name) when no ids are set. A missing id or one
// of another type fails the command; damaged objects are left out of the
// answer and named in its problems().
class GetMarloObjects : public Command
{
public:
    void setType(const std::string& type) { m_type = type; }
    std::string type() const { return m_type; }
    void setIds(const std::vector<std::string>& ids) { m_ids = ids; }
    std::vector<std::string> ids() const { return m_ids; }
    void setDepth(int depth) { m_depth = depth; }

    std::shared_ptr<Response> execute(StoreDatabase& database) override;
    std::string description() const override;

private:
    std::string m_type;
    std::vector<std::string> m_ids;
    int m_depth = 1;
};

} // namespace vemi
