#pragma once

#include "host/domain/NamedObject.h"

#include <memory>
#include <vector>

namespace vemi {

class Tolerance;

// A named group of tolerances applied together.
class ToleranceSet : public NamedObject
{
public:
    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::vector<std::shared_ptr<Tolerance>> tolerances() const { return m_tolerances; }
    void setTolerances(const std::vector<std::shared_ptr<Tolerance>>& tolerances);

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::vector<std::shared_ptr<Tolerance>> m_tolerances;
};

} // namespace vemi
