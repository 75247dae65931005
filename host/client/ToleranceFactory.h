#pragma once

#include <memory>

namespace vemi {

class ToleranceSet;

// Turns a stored tolerance set into one ready to judge measurements.
class ToleranceFactory
{
public:
    // The one factory of the host; never null.
    static ToleranceFactory* toleranceFactory();

    // A new set with copies of set's tolerances (same ids and classes), in
    // which every Lab tolerance reports a colorimetric condition: those stored
    // without one get the user's default illuminant and observer. set itself
    // is not changed. Empty for an empty handle.
    std::shared_ptr<ToleranceSet> buildToleranceSet(const std::shared_ptr<ToleranceSet>& set) const;

private:
    ToleranceFactory() = default;
};

} // namespace vemi
