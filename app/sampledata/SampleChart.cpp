#include "app/sampledata/SampleChart.h"

#include "colour/LabToScreen.h"
#include "host/domain/AppearanceValues.h"
#include "host/domain/LabValue.h"
#include "host/domain/RGBValue.h"
#include "host/domain/Standard.h"

#include <array>

namespace vemi {

namespace {

struct Patch
{
    const char* name;
    double L;
    double a;
    double b;
};

// CIELAB D50, 2 degree observer, of the 24-patch colour rendition chart as its
// maker publishes them for charts made from November 2014 on. Stored exactly
// as published, so a user can compare them with the printed data sheet.
const std::array<Patch, 24> kPatches = {{
    {"Dark Skin", 37.54, 14.37, 14.92},     {"Light Skin", 64.66, 19.27, 17.50},
    {"Blue Sky", 49.32, -3.82, -22.54},     {"Foliage", 43.46, -12.74, 22.72},
    {"Blue Flower", 54.94, 9.61, -24.79},   {"Bluish Green", 70.48, -32.26, -0.37},
    {"Orange", 62.73, 35.83, 56.50},        {"Purplish Blue", 39.43, 10.75, -45.17},
    {"Moderate Red", 50.57, 48.64, 16.67},  {"Purple", 30.10, 22.54, -20.87},
    {"Yellow Green", 71.77, -24.13, 58.19}, {"Orange Yellow", 71.51, 18.24, 67.37},
    {"Blue", 28.37, 15.42, -49.80},         {"Green", 54.38, -39.72, 32.27},
    {"Red", 42.43, 51.05, 28.62},           {"Yellow", 81.80, 2.67, 80.41},
    {"Magenta", 50.63, 51.28, -14.12},      {"Cyan", 49.57, -29.71, -28.32},
    {"White 9.5", 95.19, -1.03, 2.93},      {"Neutral 8", 81.29, -0.57, 0.44},
    {"Neutral 6.5", 66.89, -0.75, -0.06},   {"Neutral 5", 50.76, -0.13, 0.14},
    {"Neutral 3.5", 35.63, -0.46, -0.48},   {"Black 2", 20.64, 0.07, -0.46},
}};

std::shared_ptr<Standard> makeStandard(const Patch& patch, int number, const LabToScreen& toScreen)
{
    auto lab = std::make_shared<LabValue>(patch.L, patch.a, patch.b);
    lab->setColorimetricCondition(SampleChart::kCondition);
    auto appearance = std::make_shared<AppearanceValues>();
    appearance->setColorValues({lab});

    const QColor colour = toScreen.convert(patch.L, patch.a, patch.b);
    auto standard = std::make_shared<Standard>();
    standard->setName(patch.name);
    standard->setDescription("Patch " + std::to_string(number) + " of the 24-patch colour chart, D50/2.");
    standard->setAppearanceValuesList({appearance});
    standard->setDisplayRGB(std::make_shared<RGBValue>(colour.red(), colour.green(), colour.blue()));
    return standard;
}

} // namespace

const char* const SampleChart::kCondition = "D50/2";

std::vector<std::shared_ptr<Standard>> SampleChart::standards(const LabToScreen& toScreen)
{
    std::vector<std::shared_ptr<Standard>> standards;
    for (std::size_t i = 0; i < kPatches.size(); ++i)
        standards.push_back(makeStandard(kPatches[i], int(i) + 1, toScreen));
    return standards;
}

} // namespace vemi
