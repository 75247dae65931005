#pragma once

#include "host/domain/BaseObject.h"

namespace vemi {

// The illuminant and standard observer under which a colour is measured.
class ColorimetricCondition : public BaseObject
{
public:
    explicit ColorimetricCondition(std::string illuminant = "D65", std::string observer = "10");

    static const std::string& typeId();
    std::string objectTypeId() const override;

    std::string illuminant() const { return m_illuminant; }
    void setIlluminant(const std::string& illuminant) { m_illuminant = illuminant; }
    std::string observer() const { return m_observer; }
    void setObserver(const std::string& observer) { m_observer = observer; }

    // "<illuminant>/<observer>", e.g. "D65/10".
    std::string toString() const;

    // Compares illuminant and observer only, not the ids.
    bool operator==(const ColorimetricCondition& other) const;
    bool operator!=(const ColorimetricCondition& other) const { return !(*this == other); }

    void writeFields(QCborMap& map) const override;
    void readFields(const QCborMap& map) override;

private:
    std::string m_illuminant;
    std::string m_observer;
};

} // namespace vemi
