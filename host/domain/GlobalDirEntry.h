#pragma once

#include "host/domain/DirEntry.h"

namespace vemi {

// A folder-tree entry that also names the dispatcher of the store holding it.
class GlobalDirEntry : public DirEntry
{
public:
    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::string dispatcherId() const { return m_dispatcherId; }
    void setDispatcherId(const std::string& id) { m_dispatcherId = id; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::string m_dispatcherId;
};

} // namespace vemi
