#pragma once

#include "host/store/Command.h"

namespace vemi {

// Fetches one object by type and id; depth 2 also fetches the objects it refers
// to. A damaged object fails the command; members that no longer exist are
// left out, damaged members too and are named in the answer's problems().
class GetMarloObject : public Command
{
public:
    void setType(const std::string& type) { m_type = type; }
    std::string type() const { return m_type; }
    void setId(const std::string& id) { m_id = id; }
    std::string id() const { return m_id; }
    void setDepth(int depth) { m_depth = depth; }
    int depth() const { return m_depth; }

    std::shared_ptr<Response> execute(StoreDatabase& database) override;
    std::string description() const override;

private:
    std::string m_type;
    std::string m_id;
    int m_depth = 1;
};

} // namespace vemi
