#include "app/sampledata/LabToScreen.h"

#include "host/domain/ColorimetricCondition.h"

#include <lcms2.h>

#include <algorithm>
#include <array>

namespace vemi {

namespace {

// Chromaticities of the illuminants' whites for the 2 degree observer.
bool whiteOf(const std::string& illuminant, cmsCIExyY* white)
{
    if (illuminant == "D50")
        *white = {0.3457, 0.3585, 1.0};
    else if (illuminant == "D65")
        *white = {0.3127, 0.3290, 1.0};
    else
        return false;
    return true;
}

} // namespace

std::unique_ptr<LabToScreen> LabToScreen::create(const ColorimetricCondition& condition)
{
    cmsCIExyY white;
    if (!whiteOf(condition.illuminant(), &white))
        return nullptr;
    cmsHPROFILE lab = cmsCreateLab4Profile(&white);
    cmsHPROFILE srgb = cmsCreate_sRGBProfile();
    cmsHTRANSFORM transform = nullptr;
    if (lab && srgb)
        transform = cmsCreateTransform(lab, TYPE_Lab_DBL, srgb, TYPE_RGB_8, INTENT_RELATIVE_COLORIMETRIC, 0);
    if (lab)
        cmsCloseProfile(lab);
    if (srgb)
        cmsCloseProfile(srgb);
    if (!transform)
        return nullptr;
    return std::unique_ptr<LabToScreen>(new LabToScreen(transform));
}

LabToScreen::~LabToScreen()
{
    cmsDeleteTransform(m_transform);
}

QColor LabToScreen::convert(double L, double a, double b) const
{
    cmsCIELab lab = {std::clamp(L, 0.0, 100.0), std::clamp(a, -128.0, 127.0), std::clamp(b, -128.0, 127.0)};
    std::array<unsigned char, 3> rgb = {};
    cmsDoTransform(m_transform, &lab, rgb.data(), 1);
    return QColor(rgb[0], rgb[1], rgb[2]);
}

} // namespace vemi
