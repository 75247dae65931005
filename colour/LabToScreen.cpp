#include "colour/LabToScreen.h"

#include "host/domain/ColorimetricCondition.h"

#include <lcms2.h>

#include <algorithm>
#include <map>
#include <string>

namespace vemi {

namespace {

// Chromaticities of the illuminants' whites for the 2 degree observer
// (CIE 15:2004), for every illuminant CieTables holds.
bool whiteOf(const std::string& illuminant, cmsCIExyY* white)
{
    static const std::map<std::string, cmsCIExyY> whites = {
        {"A", {0.44757, 0.40745, 1.0}},   {"D50", {0.3457, 0.3585, 1.0}},   {"D55", {0.33242, 0.34743, 1.0}},
        {"D65", {0.3127, 0.3290, 1.0}},   {"D75", {0.29902, 0.31485, 1.0}}, {"F2", {0.37208, 0.37529, 1.0}},
        {"F11", {0.38052, 0.37713, 1.0}},
    };
    const auto found = whites.find(illuminant);
    if (found == whites.end())
        return false;
    *white = found->second;
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
