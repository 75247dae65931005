#include "colour/SpectralToLab.h"

#include "colour/CieTables.h"
#include "host/domain/ColorimetricCondition.h"

#include <lcms2.h>

namespace vemi {

namespace {

// How much each given wavelength contributes to the spectrum's value at one
// grid wavelength: linear interpolation inside, the nearest end outside.
void addInterpolation(const std::vector<double>& wavelengths, double at, double weight[3],
                      std::vector<SpectralToLab::Triple>& weights)
{
    const auto add = [&](size_t index, double share) {
        for (int i = 0; i < 3; ++i)
            weights[index][size_t(i)] += share * weight[i];
    };
    if (at <= wavelengths.front()) {
        add(0, 1.0);
        return;
    }
    if (at >= wavelengths.back()) {
        add(wavelengths.size() - 1, 1.0);
        return;
    }
    size_t upper = 1;
    while (wavelengths[upper] < at)
        ++upper;
    const double share = (at - wavelengths[upper - 1]) / (wavelengths[upper] - wavelengths[upper - 1]);
    add(upper - 1, 1.0 - share);
    add(upper, share);
}

} // namespace

std::unique_ptr<SpectralToLab> SpectralToLab::create(const ColorimetricCondition& condition,
                                                     const std::vector<double>& wavelengths)
{
    const auto observer = CieTables::observer(condition.observer());
    const auto illuminant = CieTables::illuminant(condition.illuminant());
    if (!observer || !illuminant || wavelengths.size() < 2)
        return nullptr;
    for (size_t i = 1; i < wavelengths.size(); ++i) {
        if (!(wavelengths[i] > wavelengths[i - 1]))
            return nullptr;
    }

    // Normalised so that the perfect reflector has Y = 100.
    double ySum = 0.0;
    for (int i = 0; i < CieTables::kCount; ++i)
        ySum += (*illuminant)[size_t(i)] * observer->y[size_t(i)];
    const double k = 100.0 / ySum;

    std::unique_ptr<SpectralToLab> converter(new SpectralToLab);
    converter->m_weights.assign(wavelengths.size(), Triple{});
    for (int i = 0; i < CieTables::kCount; ++i) {
        const size_t at = size_t(i);
        const double power = k * (*illuminant)[at];
        double weight[3] = {power * observer->x[at], power * observer->y[at], power * observer->z[at]};
        addInterpolation(wavelengths, CieTables::wavelength(i), weight, converter->m_weights);
        for (int c = 0; c < 3; ++c)
            converter->m_white[size_t(c)] += weight[c];
    }
    return converter;
}

SpectralToLab::Triple SpectralToLab::xyz(const double* reflectance) const
{
    Triple sum{};
    for (size_t i = 0; i < m_weights.size(); ++i) {
        for (size_t c = 0; c < 3; ++c)
            sum[c] += m_weights[i][c] * reflectance[i];
    }
    return sum;
}

SpectralToLab::Triple SpectralToLab::lab(const double* reflectance) const
{
    const Triple tristimulus = xyz(reflectance);
    const cmsCIEXYZ white = {m_white[0] / 100.0, m_white[1] / 100.0, m_white[2] / 100.0};
    const cmsCIEXYZ colour = {tristimulus[0] / 100.0, tristimulus[1] / 100.0, tristimulus[2] / 100.0};
    cmsCIELab result;
    cmsXYZ2Lab(&white, &result, &colour);
    return {result.L, result.a, result.b};
}

} // namespace vemi
