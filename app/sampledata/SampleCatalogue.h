#pragma once

#include "app/sampledata/SampleColours.h"

#include <array>
#include <memory>
#include <vector>

namespace vemi {

class ColorStandardsLibrary;
class LabToScreen;
class MeasurementConfiguration;
class PropertyLibrary;
class QCJobTemplate;
class Standard;
class TagDefinition;
class ToleranceSet;

// The sample objects, built in memory; nothing here touches a store.
class SampleCatalogue
{
public:
    // The objects stored on their own that the libraries and templates use.
    // The interior standards and their tolerance set are under D65/10, the
    // chart and its tolerance sets under D50/2, so that a template of interior
    // parts refuses a chart tolerance and the other way round.
    struct Samples
    {
        std::array<std::shared_ptr<Standard>, SampleColourCount> standards; // interior colours
        Palette colours; // the interior standards' display colours
        std::vector<std::shared_ptr<Standard>> chartStandards;
        std::vector<std::shared_ptr<TagDefinition>> tagDefinitions; // Supplier, Part Number, Material
        std::vector<std::shared_ptr<TagDefinition>> inspectionDefinitions;
        std::shared_ptr<ToleranceSet> toleranceSet; // the templates' default tolerance
        std::vector<std::shared_ptr<ToleranceSet>> otherToleranceSets;
        // Configurations of the simulated instruments; the templates carry copies.
        std::vector<std::shared_ptr<MeasurementConfiguration>> configurations;
    };

    // d65ToScreen and d50ToScreen convert the Lab values of the interior
    // standards and of the chart.
    static Samples samples(const LabToScreen& d65ToScreen, const LabToScreen& d50ToScreen);

    // The libraries hold the samples' own objects, which are stored before them.
    static std::vector<std::shared_ptr<ColorStandardsLibrary>> standardsLibraries(const Samples& samples);
    static std::vector<std::shared_ptr<PropertyLibrary>> propertyLibraries(const Samples& samples);
    // The templates' default first.
    static std::vector<std::shared_ptr<ToleranceSet>> toleranceSets(const Samples& samples);

    // Templates are self-contained: they hold copies (same ids) of the
    // samples, never the samples themselves.
    static std::vector<std::shared_ptr<QCJobTemplate>> jobTemplates(const Samples& samples);
};

} // namespace vemi
