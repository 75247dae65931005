#pragma once

#include <memory>
#include <vector>

namespace vemi {

class LabToScreen;
class Standard;

// The 24 patches of the classic colour rendition chart as colour standards,
// with the chart's published Lab values under D50/2.
class SampleChart
{
public:
    static const char* const kCondition; // "D50/2"

    // In the chart's reading order, row by row; toScreen must convert D50 Lab.
    static std::vector<std::shared_ptr<Standard>> standards(const LabToScreen& toScreen);

    // The last six patches: the chart's grey scale from white to black.
    static constexpr int kFirstGrey = 18;
};

} // namespace vemi
