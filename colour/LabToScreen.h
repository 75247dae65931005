#pragma once

#include <QColor>

#include <array>
#include <memory>

namespace vemi {

class ColorimetricCondition;

// Lab to 8-bit sRGB through Little CMS, for Lab values whose white is that of
// one illuminant. The colour is adapted from that white to the screen white
// with the Bradford transform, so the Lab white shows as the screen white; the
// 8-bit output clips colours outside the sRGB gamut channel by channel.
class LabToScreen
{
public:
    // For Lab values under the condition's illuminant: A, D50, D55, D65, D75,
    // F2 or F11. The white is taken for the 2 degree observer, the one sRGB is
    // defined for. Null for another illuminant or when Little CMS cannot build
    // the transform.
    static std::unique_ptr<LabToScreen> create(const ColorimetricCondition& condition);

    ~LabToScreen();
    LabToScreen(const LabToScreen&) = delete;
    LabToScreen& operator=(const LabToScreen&) = delete;

    // Out-of-range L, a and b are clamped to the Lab encoding first.
    QColor convert(double L, double a, double b) const;

private:
    using Xyz = std::array<double, 3>;
    LabToScreen(void* transform, const Xyz& white) : m_transform(transform), m_white(white) {}

    void* m_transform; // a cmsHTRANSFORM from D50 XYZ, never null
    Xyz m_white;       // XYZ of the Lab values' white, Y = 1
};

} // namespace vemi
