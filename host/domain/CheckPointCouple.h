#pragma once

#include "host/domain/CheckListItem.h"

#include <memory>
#include <vector>

namespace vemi {

class CheckPoint;

// Two checkpoints that are measured as a pair; element 0 is the first member.
class CheckPointCouple : public CheckListItem
{
public:
    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::vector<std::shared_ptr<CheckPoint>> checkPoints() const { return m_checkPoints; }
    void setCheckPoints(const std::vector<std::shared_ptr<CheckPoint>>& checkPoints);

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::vector<std::shared_ptr<CheckPoint>> m_checkPoints;
};

} // namespace vemi
