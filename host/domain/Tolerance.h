#pragma once

#include "host/domain/NamedObject.h"

namespace vemi {

// A colour-difference limit: the difference formula and the largest accepted value.
class Tolerance : public NamedObject
{
public:
    static const std::string& typeId();
    std::string objectTypeId() const override;

    // The colour-difference formula, e.g. "dE2000".
    std::string method() const { return m_method; }
    void setMethod(const std::string& method) { m_method = method; }
    double limit() const { return m_limit; }
    void setLimit(double limit) { m_limit = limit; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::string m_method = "dE2000";
    double m_limit = 1.0;
};

} // namespace vemi
