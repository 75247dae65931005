#include "app/sampledata/LabToScreen.h"

#include "host/domain/ColorimetricCondition.h"

#include <lcms2.h>

#include <algorithm>

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

// A Lab profile of Little CMS ignores its white point under the relative
// intent and reads every Lab value as D50. So the Lab value is turned into
// XYZ of its own white here and adapted to D50, the white of the transform's
// XYZ side, from which the sRGB profile carries it to the screen white.
std::unique_ptr<LabToScreen> LabToScreen::create(const ColorimetricCondition& condition)
{
    cmsCIExyY whiteChromaticity;
    if (!whiteOf(condition.illuminant(), &whiteChromaticity))
        return nullptr;
    cmsCIEXYZ white;
    cmsxyY2XYZ(&white, &whiteChromaticity);

    cmsHPROFILE xyz = cmsCreateXYZProfile();
    cmsHPROFILE srgb = cmsCreate_sRGBProfile();
    cmsHTRANSFORM transform = nullptr;
    if (xyz && srgb)
        transform = cmsCreateTransform(xyz, TYPE_XYZ_DBL, srgb, TYPE_RGB_8, INTENT_RELATIVE_COLORIMETRIC, 0);
    if (xyz)
        cmsCloseProfile(xyz);
    if (srgb)
        cmsCloseProfile(srgb);
    if (!transform)
        return nullptr;
    return std::unique_ptr<LabToScreen>(new LabToScreen(transform, {white.X, white.Y, white.Z}));
}

LabToScreen::~LabToScreen()
{
    cmsDeleteTransform(m_transform);
}

QColor LabToScreen::convert(double L, double a, double b) const
{
    const cmsCIELab lab = {std::clamp(L, 0.0, 100.0), std::clamp(a, -128.0, 127.0), std::clamp(b, -128.0, 127.0)};
    const cmsCIEXYZ white = {m_white[0], m_white[1], m_white[2]};
    cmsCIEXYZ underOwnWhite;
    cmsLab2XYZ(&white, &underOwnWhite, &lab);
    cmsCIEXYZ underD50;
    cmsAdaptToIlluminant(&underD50, &white, cmsD50_XYZ(), &underOwnWhite);
    unsigned char rgb[3] = {};
    cmsDoTransform(m_transform, &underD50, rgb, 1);
    return QColor(rgb[0], rgb[1], rgb[2]);
}

} // namespace vemi
