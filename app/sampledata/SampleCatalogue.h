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
    struct Samples
    {
        std::array<std::shared_ptr<Standard>, SampleColourCount> standards;
        Palette colours; // the standards' display colours
        std::vector<std::shared_ptr<TagDefinition>> tagDefinitions; // Supplier, Part Number, Material
        std::shared_ptr<ToleranceSet> toleranceSet;
        std::shared_ptr<MeasurementConfiguration> configuration;
    };

    static Samples samples(const LabToScreen& toScreen);

    // The libraries hold the samples' own objects, which are stored before them.
    static std::shared_ptr<ColorStandardsLibrary> standardsLibrary(const Samples& samples);
    static std::shared_ptr<PropertyLibrary> propertyLibrary(const Samples& samples);

    // Templates are self-contained: they hold copies (same ids) of the
    // samples, never the samples themselves.
    static std::vector<std::shared_ptr<QCJobTemplate>> jobTemplates(const Samples& samples);
};

} // namespace vemi
