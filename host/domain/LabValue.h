#pragma once

#include "host/domain/ColorValue.h"

#include <string>

namespace vemi {

// A CIELAB colour with the condition it was measured or computed under.
class LabValue : public ColorValue
{
public:
    explicit LabValue(double L = 0.0, double a = 0.0, double b = 0.0);

    static const std::string& typeId();
    std::string objectTypeId() const override;

    double L() const { return m_L; }
    void setL(double L) { m_L = L; }
    double a() const { return m_a; }
    void setA(double a) { m_a = a; }
    double b() const { return m_b; }
    void setB(double b) { m_b = b; }

    // The condition as ColorimetricCondition::toString() writes it ("D65/10");
    // empty when unknown.
    const std::string& colorimetricCondition() const { return m_condition; }
    void setColorimetricCondition(const std::string& condition) { m_condition = condition; }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    double m_L;
    double m_a;
    double m_b;
    std::string m_condition;
};

} // namespace vemi
