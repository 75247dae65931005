#pragma once

#include "host/domain/Tolerance.h"

#include <memory>

namespace vemi {

class ColorimetricCondition;

// A tolerance on Lab differences, valid under one colorimetric condition.
class LabToleranceBase : public Tolerance
{
public:
    static const std::string& typeId();
    std::string objectTypeId() const override;

    // May be empty.
    virtual std::shared_ptr<ColorimetricCondition> colorimetricCondition() const { return m_condition; }
    void setColorimetricCondition(const std::shared_ptr<ColorimetricCondition>& condition);

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::shared_ptr<ColorimetricCondition> m_condition;
};

} // namespace vemi
