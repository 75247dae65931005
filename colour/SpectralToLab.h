#pragma once

#include <array>
#include <memory>
#include <vector>

namespace vemi {

class ColorimetricCondition;

// CIELAB of reflectance spectra under one illuminant and observer, for spectra
// sampled at one set of wavelengths (a measurement file's columns). The
// spectrum is interpolated linearly onto the 5 nm grid of the CIE tables and
// extended with its end values beyond its range; as both steps are linear,
// they are folded into one weight per given wavelength, so that converting a
// spectrum is one weighted sum per tristimulus value.
class SpectralToLab
{
public:
    using Triple = std::array<double, 3>;

    // Null when the condition's illuminant or observer has no CIE table, or
    // when the wavelengths are fewer than two or not strictly ascending.
    static std::unique_ptr<SpectralToLab> create(const ColorimetricCondition& condition,
                                                 const std::vector<double>& wavelengths);

    // reflectance: one factor per wavelength given to create (1 = a perfect
    // reflector). Thread-safe.
    Triple lab(const double* reflectance) const;
    Triple xyz(const double* reflectance) const; // Y of the perfect reflector = 100
    Triple white() const { return m_white; }

private:
    SpectralToLab() = default;

    std::vector<Triple> m_weights; // per given wavelength
    Triple m_white{};
};

} // namespace vemi
