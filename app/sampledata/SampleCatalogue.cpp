#include "app/sampledata/SampleCatalogue.h"

#include "colour/LabToScreen.h"
#include "app/sampledata/SampleChart.h"
#include "app/sampledata/SampleDrawings.h"
#include "host/domain/AppearanceValues.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/CheckPointCouple.h"
#include "host/domain/ColorStandardsLibrary.h"
#include "host/domain/ColorimetricCondition.h"
#include "host/domain/LabToleranceBase.h"
#include "host/domain/LabValue.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/ObjectCodec.h"
#include "host/domain/Position.h"
#include "host/domain/Property.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/RGBValue.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/domain/ToleranceSet.h"

#include <QBuffer>
#include <QString>
#include <QImage>
#include <QRect>

#include <initializer_list>
#include <map>
#include <utility>

namespace vemi {

namespace {

// --- Stored samples -------------------------------------------------------

struct StandardPlan
{
    const char* name;
    double L;
    double a;
    double b;
};

// In the order of SampleColour.
const std::array<StandardPlan, SampleColourCount> kStandardPlans = {{
    {"Ivory Beige", 82.6, 2.1, 17.9},
    {"Graphite Grey", 33.4, -0.6, -3.2},
    {"Signal Red", 38.2, 55.6, 33.1},
    {"Ocean Blue", 42.1, -8.3, -31.6},
    {"Leaf Green", 47.6, -36.2, 27.9},
    {"Sun Yellow", 80.4, 8.7, 82.3},
}};

std::shared_ptr<Standard> makeStandard(const StandardPlan& plan, const LabToScreen& toScreen)
{
    auto lab = std::make_shared<LabValue>(plan.L, plan.a, plan.b);
    lab->setColorimetricCondition(ColorimetricCondition("D65", "10").toString());
    auto appearance = std::make_shared<AppearanceValues>();
    appearance->setColorValues({lab});

    const QColor colour = toScreen.convert(plan.L, plan.a, plan.b);
    auto standard = std::make_shared<Standard>();
    standard->setName(plan.name);
    standard->setDescription("Interior trim colour, measured under D65/10.");
    standard->setAppearanceValuesList({appearance});
    standard->setDisplayRGB(std::make_shared<RGBValue>(colour.red(), colour.green(), colour.blue()));
    return standard;
}

// A definition with allowed values offers the first as its default; a free
// text definition has a default only when one is given.
std::shared_ptr<TagDefinition> makeTagDefinition(const char* name, const char* description,
                                                 const std::vector<std::string>& allowedValues = {},
                                                 const char* defaultValue = "")
{
    auto definition = std::make_shared<TagDefinition>();
    definition->setName(name);
    definition->setDescription(description);
    definition->setAllowedValues(allowedValues);
    definition->setDefaultValue(allowedValues.empty() ? defaultValue : allowedValues.front());
    return definition;
}

std::vector<std::shared_ptr<TagDefinition>> makeInspectionDefinitions()
{
    return {makeTagDefinition("Inspector", "Name of the person who measured the part."),
            makeTagDefinition("Shift", "Production shift the part comes from.", {"Early", "Late", "Night"}),
            makeTagDefinition("Light Booth", "Light used for the visual check beside the measurement.",
                              {"D65", "TL84", "A"}),
            makeTagDefinition("Parts per Lot", "How many parts of a lot are measured.", {}, "3"),
            makeTagDefinition("Remarks", "Anything the inspector noticed.")};
}

// The formula names the store's tolerances use: "dE2000", "dECMC(2:1)"
// (lightness to chroma weight 2:1) and "dE*ab".
struct TolerancePlan
{
    const char* setName;
    const char* description;
    const char* method;
    double limit;
    const char* illuminant;
    const char* observer;
};

std::shared_ptr<ToleranceSet> makeToleranceSet(const TolerancePlan& plan)
{
    auto tolerance = std::make_shared<LabToleranceBase>();
    tolerance->setName(std::string(plan.method) + ' ' + QString::number(plan.limit, 'f', 1).toStdString());
    tolerance->setMethod(plan.method);
    tolerance->setLimit(plan.limit);
    tolerance->setColorimetricCondition(std::make_shared<ColorimetricCondition>(plan.illuminant, plan.observer));

    auto set = std::make_shared<ToleranceSet>();
    set->setName(plan.setName);
    set->setDescription(plan.description);
    set->setTolerances({tolerance});
    return set;
}

const TolerancePlan kInteriorTolerance = {"Automotive Interior", "Acceptance limit for visible interior trim parts.",
                                          "dE2000", 1.0, "D65", "10"};

const std::array<TolerancePlan, 3> kOtherTolerances = {{
    {"Seat Fabric CMC", "Acceptance limit for woven seat and headliner fabrics.", "dECMC(2:1)", 1.2, "D65", "10"},
    {"Chart Check", "Agreement of a measured chart with its published values.", "dE2000", 1.5, "D50", "2"},
    {"Printed Labels", "Acceptance limit for printed warning and information labels.", "dE*ab", 3.0, "D50", "2"},
}};

// Configurations of the simulated instruments, listing every setting of the
// instrument's conditions in their order.
std::shared_ptr<MeasurementConfiguration> makeMeasurementConfiguration(
    const char* name, const char* description, const char* instrumentModel,
    std::initializer_list<std::pair<const char*, const char*>> settings)
{
    auto configuration = std::make_shared<MeasurementConfiguration>();
    configuration->setName(name);
    configuration->setDescription(description);
    configuration->setInstrumentModel(instrumentModel);
    std::vector<std::shared_ptr<Property>> properties;
    for (const auto& [key, value] : settings)
        properties.push_back(std::make_shared<Property>(key, value));
    configuration->setProperties(properties);
    return configuration;
}

std::vector<std::shared_ptr<MeasurementConfiguration>> makeMeasurementConfigurations()
{
    return {makeMeasurementConfiguration(
                "Sphere d/8 D65/10",
                "Sphere geometry, specular included, 12 mm aperture, evaluated for D65 and the 10 degree observer.",
                "simcolorsphere",
                {{"Illuminant", "D65"}, {"Observer", "10"}, {"Specular Component", "Included"},
                 {"Aperture", "12 mm"}, {"UV Filter", "Off"}}),
            makeMeasurementConfiguration(
                "45/0 D65/10 Small Area",
                "45/0 geometry with the 4 mm aperture for narrow trim parts, evaluated for D65 and the 10 degree "
                "observer.",
                "simcolor45", {{"Illuminant", "D65"}, {"Observer", "10"}, {"Aperture", "4 mm"}})};
}

// --- Job templates --------------------------------------------------------

// A checkpoint's area lies inside one flat region of its drawing, painted in
// the colour of the checkpoint's standard.
struct Spot
{
    const char* name;
    QRect area;
    SampleColour colour;
    bool skippable;
};

struct TemplatePlan
{
    const char* name;
    const char* description;
    const char* imageName;
    bool enableRepeat;
    QImage (*draw)(const Palette&);
    std::vector<SampleColour> standards;
    std::array<const char*, 3> tagValues; // Supplier, Part Number, Material
    std::vector<Spot> spots;
    std::size_t coupleFirst; // this spot and the next are measured as the couple "A"
    std::size_t configuration; // index into the sample configurations
};

const std::vector<TemplatePlan>& templatePlans()
{
    static const std::vector<TemplatePlan> plans = {
        {"Door Panel Trim",
         "Colour check of the front left door trim panel before assembly. Armrest and map pocket are "
         "measured as a pair, as they come from different moulds.",
         "door-panel.png",
         false,
         &SampleDrawings::doorPanel,
         {IvoryBeige, GraphiteGrey, OceanBlue},
         {"Hartwell Interior Systems", "DT-4410-LH", "PP-T20"},
         {{"Panel Surface", QRect(260, 350, 45, 35), IvoryBeige, false},
          {"Window Sill", QRect(300, 102, 32, 32), GraphiteGrey, false},
          {"Fabric Insert", QRect(275, 232, 50, 50), OceanBlue, true},
          {"Armrest", QRect(540, 266, 50, 50), GraphiteGrey, false},
          {"Map Pocket", QRect(300, 425, 50, 50), GraphiteGrey, true}},
         3,
         0},
        {"Dashboard Fascia",
         "Colour check of the instrument panel fascia. The left and right decor strips are measured as "
         "a pair to catch shade differences from side to side.",
         "dashboard-fascia.png",
         true,
         &SampleDrawings::dashboard,
         {GraphiteGrey, IvoryBeige, SignalRed},
         {"Kestrel Moulding Ltd", "IP-2208-00", "PC/ABS"},
         {{"Top Pad", QRect(432, 150, 36, 32), GraphiteGrey, false},
          {"Decor Strip Left", QRect(200, 344, 30, 30), SignalRed, false},
          {"Decor Strip Right", QRect(690, 344, 30, 30), SignalRed, false},
          {"Glovebox Lid", QRect(620, 262, 45, 45), IvoryBeige, true}},
         1,
         1},
    };
    return plans;
}

using StandardCopies = std::map<SampleColour, std::shared_ptr<Standard>>;

std::vector<unsigned char> pngBytes(const QImage& image)
{
    QByteArray bytes;
    QBuffer buffer(&bytes);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, "PNG");
    return std::vector<unsigned char>(bytes.cbegin(), bytes.cend());
}

// Copies of the tag definitions, each with the plan's value.
void addTags(QCJobTemplate& jobTemplate, const TemplatePlan& plan, const SampleCatalogue::Samples& samples)
{
    std::vector<std::shared_ptr<TagDefinition>> definitions;
    std::vector<std::shared_ptr<TagValue>> values;
    for (std::size_t i = 0; i < samples.tagDefinitions.size(); ++i) {
        definitions.push_back(ObjectCodec::clone(*samples.tagDefinitions[i]));
        values.push_back(TagValue::forDefinition(*definitions.back(), plan.tagValues[i]));
    }
    jobTemplate.setTagDefinitions(definitions);
    jobTemplate.setTagValues(values);
}

// Copies of the plan's standards; the checkpoints take them from the result.
StandardCopies addStandards(QCJobTemplate& jobTemplate, const TemplatePlan& plan,
                            const SampleCatalogue::Samples& samples)
{
    StandardCopies copies;
    std::vector<std::shared_ptr<Standard>> standards;
    for (SampleColour colour : plan.standards) {
        copies[colour] = ObjectCodec::clone(*samples.standards[colour]);
        standards.push_back(copies[colour]);
    }
    jobTemplate.setStandards(standards);
    return copies;
}

std::shared_ptr<SchematicImage> makeSchematic(const TemplatePlan& plan, const QImage& drawing)
{
    auto schematic = std::make_shared<SchematicImage>();
    schematic->setName(plan.imageName);
    schematic->setOriginalFilename(plan.imageName);
    schematic->setFormat("png");
    schematic->setImageData(pngBytes(drawing));
    return schematic;
}

std::shared_ptr<CheckPoint> makeCheckPoint(const Spot& spot, const QImage& drawing, const StandardCopies& copies)
{
    auto cutOut = std::make_shared<SchematicImage>();
    cutOut->setFormat("PNG");
    cutOut->setImageData(pngBytes(drawing.copy(spot.area)));

    auto checkPoint = std::make_shared<CheckPoint>();
    checkPoint->setName(spot.name);
    checkPoint->setPosition(std::make_shared<Position>(spot.area.x(), spot.area.y()));
    checkPoint->setSize(std::make_shared<Size>(spot.area.width(), spot.area.height()));
    checkPoint->setSchematicImage(cutOut);
    checkPoint->setStandard(copies.at(spot.colour));
    checkPoint->setAutoStandard(false);
    checkPoint->setSkippable(spot.skippable);
    return checkPoint;
}

std::vector<std::shared_ptr<CheckListItem>> makeCheckList(const TemplatePlan& plan, const QImage& drawing,
                                                          const StandardCopies& copies)
{
    std::vector<std::shared_ptr<CheckListItem>> items;
    for (std::size_t i = 0; i < plan.spots.size(); ++i) {
        auto checkPoint = makeCheckPoint(plan.spots[i], drawing, copies);
        if (i != plan.coupleFirst) {
            items.push_back(checkPoint);
            continue;
        }
        auto partner = makeCheckPoint(plan.spots[i + 1], drawing, copies);
        checkPoint->setMatchPoint("<CP1>");
        partner->setMatchPoint("<CP2>");
        auto couple = std::make_shared<CheckPointCouple>();
        couple->setName("A");
        couple->setCheckPoints({checkPoint, partner});
        items.push_back(couple);
        ++i;
    }
    return items;
}

std::shared_ptr<QCJobTemplate> makeTemplate(const TemplatePlan& plan, const SampleCatalogue::Samples& samples)
{
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    jobTemplate->setName(plan.name);
    jobTemplate->setDescription(plan.description);
    jobTemplate->setEnableRepeat(plan.enableRepeat);
    addTags(*jobTemplate, plan, samples);
    const StandardCopies copies = addStandards(*jobTemplate, plan, samples);
    jobTemplate->setSharedToleranceSets({ObjectCodec::clone(*samples.toleranceSet)});
    jobTemplate->setMeasurementConfiguration(ObjectCodec::clone(*samples.configurations.at(plan.configuration)));

    const QImage drawing = plan.draw(samples.colours);
    jobTemplate->setSchematicImage(makeSchematic(plan, drawing));
    jobTemplate->setCheckListItems(makeCheckList(plan, drawing, copies));
    return jobTemplate;
}

} // namespace

SampleCatalogue::Samples SampleCatalogue::samples(const LabToScreen& d65ToScreen, const LabToScreen& d50ToScreen)
{
    Samples samples;
    for (int colour = 0; colour < SampleColourCount; ++colour) {
        samples.standards[colour] = makeStandard(kStandardPlans[colour], d65ToScreen);
        const auto rgb = samples.standards[colour]->displayRGB();
        samples.colours[colour] = QColor(rgb->red(), rgb->green(), rgb->blue());
    }
    samples.chartStandards = SampleChart::standards(d50ToScreen);
    samples.tagDefinitions = {makeTagDefinition("Supplier", "Company that supplies the part."),
                              makeTagDefinition("Part Number", "Drawing number of the part."),
                              makeTagDefinition("Material", "Base material of the measured surface.",
                                                {"PP-T20", "PC/ABS", "ABS", "TPO"})};
    samples.inspectionDefinitions = makeInspectionDefinitions();
    samples.toleranceSet = makeToleranceSet(kInteriorTolerance);
    for (const TolerancePlan& plan : kOtherTolerances)
        samples.otherToleranceSets.push_back(makeToleranceSet(plan));
    samples.configurations = makeMeasurementConfigurations();
    return samples;
}

std::vector<std::shared_ptr<ColorStandardsLibrary>> SampleCatalogue::standardsLibraries(const Samples& samples)
{
    auto interior = std::make_shared<ColorStandardsLibrary>();
    interior->setName("Interior Colours");
    interior->setDescription("Standard colours of the interior trim programme, D65/10.");
    interior->setStandards({samples.standards.begin(), samples.standards.end()});

    auto chart = std::make_shared<ColorStandardsLibrary>();
    chart->setName("Colour Chart 24");
    chart->setDescription("The 24 patches of the colour rendition chart, D50/2.");
    chart->setStandards(samples.chartStandards);

    auto greys = std::make_shared<ColorStandardsLibrary>();
    greys->setName("Chart Grey Scale");
    greys->setDescription("The six neutral patches of the colour rendition chart, D50/2.");
    greys->setStandards({samples.chartStandards.begin() + SampleChart::kFirstGrey, samples.chartStandards.end()});
    return {interior, chart, greys};
}

std::vector<std::shared_ptr<PropertyLibrary>> SampleCatalogue::propertyLibraries(const Samples& samples)
{
    auto part = std::make_shared<PropertyLibrary>();
    part->setName("Part Properties");
    part->setDescription("What a QC job records about the part it checks.");
    part->setProperties(samples.tagDefinitions);

    auto inspection = std::make_shared<PropertyLibrary>();
    inspection->setName("Inspection Properties");
    inspection->setDescription("What a QC job records about how the part was checked.");
    inspection->setProperties(samples.inspectionDefinitions);
    return {part, inspection};
}

std::vector<std::shared_ptr<ToleranceSet>> SampleCatalogue::toleranceSets(const Samples& samples)
{
    std::vector<std::shared_ptr<ToleranceSet>> sets = {samples.toleranceSet};
    sets.insert(sets.end(), samples.otherToleranceSets.begin(), samples.otherToleranceSets.end());
    return sets;
}

std::vector<std::shared_ptr<QCJobTemplate>> SampleCatalogue::jobTemplates(const Samples& samples)
{
    std::vector<std::shared_ptr<QCJobTemplate>> templates;
    for (const TemplatePlan& plan : templatePlans())
        templates.push_back(makeTemplate(plan, samples));
    return templates;
}

} // namespace vemi
