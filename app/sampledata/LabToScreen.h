#pragma once

#include <QColor>

#include <memory>

namespace vemi {

// Lab (D65 white) to 8-bit sRGB through Little CMS. Relative colorimetric
// intent maps the Lab white onto the screen white; the 8-bit output clips
// colours outside the sRGB gamut channel by channel.
class LabToScreen
{
public:
    // Null when Little CMS cannot build the transform.
    static std::unique_ptr<LabToScreen> create();

    ~LabToScreen();
    LabToScreen(const LabToScreen&) = delete;
    LabToScreen& operator=(const LabToScreen&) = delete;

    // Out-of-range L, a and b are clamped to the Lab encoding first.
    QColor convert(double L, double a, double b) const;

private:
    explicit LabToScreen(void* transform) : m_transform(transform) {}

    void* m_transform; // a cmsHTRANSFORM, never null
};

} // namespace vemi
