#pragma once

#include <array>
#include <optional>
#include <string>
#include <vector>

namespace vemi {

// The CIE colorimetric tables that reflectance spectra are turned into
// tristimulus values with, every 5 nm from 380 to 780 nm: the colour-matching
// functions of the 1931 (2 degree) and 1964 (10 degree) standard observers
// and the relative spectral power of the illuminants a colour standard is
// commonly given under.
class CieTables
{
public:
    static constexpr int kFirstWavelength = 380;
    static constexpr int kStep = 5;
    static constexpr int kCount = 81;
    using Table = std::array<double, kCount>;

    struct Observer
    {
        const Table& x;
        const Table& y;
        const Table& z;
    };

    static int wavelength(int index) { return kFirstWavelength + index * kStep; }

    // "2" or "10"; empty for any other observer.
    static std::optional<Observer> observer(const std::string& name);
    // One of illuminantNames(), with 100 at 560 nm; empty for any other.
    static std::optional<Table> illuminant(const std::string& name);
    static const std::vector<std::string>& illuminantNames();
};

} // namespace vemi
