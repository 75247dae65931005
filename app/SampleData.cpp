#include "SampleData.h"

#include "AppearanceValues.h"
#include "CheckPoint.h"
#include "CheckPointCouple.h"
#include "ColorStandardsLibrary.h"
#include "ColorimetricCondition.h"
#include "CommandDispatcher.h"
#include "CreateFolder.h"
#include "DirectoryTreeResponse.h"
#include "ErrorInfo.h"
#include "FolderResponse.h"
#include "GetDirectoryTree.h"
#include "LabToleranceBase.h"
#include "LabValue.h"
#include "MarloModel.h"
#include "MeasurementConfiguration.h"
#include "ObjectCodec.h"
#include "Position.h"
#include "Property.h"
#include "PropertyLibrary.h"
#include "QCJobTemplate.h"
#include "QtCommand.h"
#include "RGBValue.h"
#include "SchematicImage.h"
#include "Size.h"
#include "Standard.h"
#include "TagDefinition.h"
#include "TagValue.h"
#include "ToleranceSet.h"
#include "UpdateObject.h"
#include "UpdateObjectResponse.h"

#include <QBuffer>
#include <QColor>
#include <QEventLoop>
#include <QImage>
#include <QPainter>
#include <QPainterPath>
#include <QTimer>

#include <lcms2.h>

#include <algorithm>
#include <array>
#include <map>

namespace vemi {

namespace {

// A command that gets no answer in this time means the store's worker is stuck.
constexpr int kAnswerTimeoutMs = 30000;

const char* const kSamplesFolder = "Samples";
const char* const kTemplatesFolder = "Sample Job Templates";

struct SeedFailure
{
    QString message;
};

struct Answer
{
    std::shared_ptr<Response> response;
    QString error;
};

Answer runAndWait(CommandDispatcher& dispatcher, std::shared_ptr<Command> command)
{
    auto wrapper = std::make_shared<QtCommand>(std::move(command));
    Answer answer;
    QEventLoop loop;
    QObject::connect(wrapper.get(), &QtCommand::responseReceived, &loop, [&](std::shared_ptr<Response> response) {
        answer.response = std::move(response);
        loop.quit();
    });
    QObject::connect(wrapper.get(), &QtCommand::errorReceived, &loop, [&](std::shared_ptr<ErrorInfo> error) {
        answer.error = error ? error->message() : QStringLiteral("The object store failed without saying why.");
        loop.quit();
    });
    QTimer::singleShot(kAnswerTimeoutMs, &loop, [&] {
        answer.error = QStringLiteral("The object store did not answer while the sample data was stored.");
        loop.quit();
    });
    dispatcher.dispatch(wrapper);
    loop.exec();
    return answer;
}

// The sample colour standards, in the order of kStandardPlans.
enum SampleColour { IvoryBeige, GraphiteGrey, SignalRed, OceanBlue, LeafGreen, SunYellow, SampleColourCount };

struct StandardPlan
{
    const char* name;
    double L;
    double a;
    double b;
};

const std::array<StandardPlan, SampleColourCount> kStandardPlans = {{
    {"Ivory Beige", 82.6, 2.1, 17.9},
    {"Graphite Grey", 33.4, -0.6, -3.2},
    {"Signal Red", 38.2, 55.6, 33.1},
    {"Ocean Blue", 42.1, -8.3, -31.6},
    {"Leaf Green", 47.6, -36.2, 27.9},
    {"Sun Yellow", 80.4, 8.7, 82.3},
}};

using Palette = std::array<QColor, SampleColourCount>;

// Lab (D65 white) to 8-bit sRGB through Little CMS. Relative colorimetric
// intent maps the Lab white onto the screen white; the 8-bit output clips
// colours outside the sRGB gamut channel by channel.
class LabToScreen
{
public:
    LabToScreen()
    {
        const cmsCIExyY d65 = {0.3127, 0.3290, 1.0};
        cmsHPROFILE lab = cmsCreateLab4Profile(&d65);
        cmsHPROFILE srgb = cmsCreate_sRGBProfile();
        if (lab && srgb)
            m_transform = cmsCreateTransform(lab, TYPE_Lab_DBL, srgb, TYPE_RGB_8, INTENT_RELATIVE_COLORIMETRIC, 0);
        if (lab)
            cmsCloseProfile(lab);
        if (srgb)
            cmsCloseProfile(srgb);
        if (!m_transform)
            throw SeedFailure{QStringLiteral("Cannot compute the display colours of the sample standards: "
                                             "Little CMS could not create the Lab to sRGB transform.")};
    }
    ~LabToScreen() { cmsDeleteTransform(m_transform); }
    LabToScreen(const LabToScreen&) = delete;
    LabToScreen& operator=(const LabToScreen&) = delete;

    QColor convert(double L, double a, double b) const
    {
        cmsCIELab lab = {std::clamp(L, 0.0, 100.0), std::clamp(a, -128.0, 127.0), std::clamp(b, -128.0, 127.0)};
        std::array<unsigned char, 3> rgb = {};
        cmsDoTransform(m_transform, &lab, rgb.data(), 1);
        return QColor(rgb[0], rgb[1], rgb[2]);
    }

private:
    cmsHTRANSFORM m_transform = nullptr;
};

std::shared_ptr<Standard> makeStandard(const StandardPlan& plan, const LabToScreen& toScreen)
{
    auto lab = std::make_shared<LabValue>(plan.L, plan.a, plan.b);
    lab->setColorimetricCondition(ColorimetricCondition().toString());
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

std::shared_ptr<TagDefinition> makeTagDefinition(const char* name, const char* description,
                                                 const std::vector<std::string>& allowedValues = {})
{
    auto definition = std::make_shared<TagDefinition>();
    definition->setName(name);
    definition->setDescription(description);
    definition->setAllowedValues(allowedValues);
    if (!allowedValues.empty())
        definition->setDefaultValue(allowedValues.front());
    return definition;
}

std::shared_ptr<ToleranceSet> makeToleranceSet()
{
    auto tolerance = std::make_shared<LabToleranceBase>();
    tolerance->setName("dE2000 1.0");
    tolerance->setMethod("dE2000");
    tolerance->setLimit(1.0);
    tolerance->setColorimetricCondition(std::make_shared<ColorimetricCondition>("D65", "10"));

    auto set = std::make_shared<ToleranceSet>();
    set->setName("Automotive Interior");
    set->setDescription("Acceptance limit for visible interior trim parts.");
    set->setTolerances({tolerance});
    return set;
}

std::shared_ptr<MeasurementConfiguration> makeMeasurementConfiguration()
{
    auto configuration = std::make_shared<MeasurementConfiguration>();
    configuration->setName("Sphere d/8 D65/10");
    configuration->setDescription("Sphere geometry, large area view, evaluated for D65 and the 10 degree observer.");
    configuration->setInstrumentModel("Simulated Sphere Spectrophotometer");
    configuration->setProperties({std::make_shared<Property>("Illuminant", "D65"),
                                  std::make_shared<Property>("Observer", "10"),
                                  std::make_shared<Property>("Aperture", "LAV")});
    return configuration;
}

// --- Schematic drawings ---------------------------------------------------

const QSize kCanvasSize(900, 560);
const QColor kBackground(0xf4, 0xf5, 0xf7);
const QColor kOutline(0x2b, 0x2f, 0x36);

QImage blankCanvas()
{
    QImage image(kCanvasSize, QImage::Format_RGB32);
    image.fill(kBackground);
    return image;
}

void drawShape(QPainter& painter, const QPainterPath& shape, const QColor& fill, qreal penWidth = 2.5)
{
    painter.setPen(QPen(kOutline, penWidth, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    painter.setBrush(fill);
    painter.drawPath(shape);
}

QPainterPath roundedRect(qreal x, qreal y, qreal width, qreal height, qreal radius)
{
    QPainterPath path;
    path.addRoundedRect(x, y, width, height, radius, radius);
    return path;
}

void drawSlats(QPainter& painter, const QRectF& vent, const QColor& colour)
{
    painter.setPen(QPen(colour, 3, Qt::SolidLine, Qt::RoundCap));
    for (qreal y = vent.top() + 12; y < vent.bottom() - 6; y += 11)
        painter.drawLine(QPointF(vent.left() + 8, y), QPointF(vent.right() - 8, y));
}

// A front door trim panel seen from inside the car, its front edge on the left.
QImage drawDoorPanel(const Palette& colours)
{
    QImage image = blankCanvas();
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);

    QPainterPath card;
    card.moveTo(120, 80);
    card.lineTo(800, 80);
    card.quadTo(840, 80, 840, 120);
    card.lineTo(840, 470);
    card.quadTo(840, 510, 800, 510);
    card.lineTo(240, 510);
    card.cubicTo(150, 510, 70, 440, 60, 330);
    card.lineTo(60, 140);
    card.quadTo(60, 80, 120, 80);
    painter.fillPath(card.translated(6, 8), QColor(0, 0, 0, 28));
    drawShape(painter, card, colours[IvoryBeige], 3);

    const QColor grey = colours[GraphiteGrey];
    drawShape(painter, roundedRect(76, 94, 750, 48, 16), grey);

    drawShape(painter, roundedRect(150, 175, 300, 165, 24), colours[OceanBlue]);
    painter.setPen(QPen(colours[OceanBlue].lighter(150), 1.5, Qt::DashLine));
    painter.setBrush(Qt::NoBrush);
    painter.drawRoundedRect(QRectF(160, 185, 280, 145), 18, 18);

    drawShape(painter, roundedRect(520, 175, 140, 55, 20), grey);
    drawShape(painter, roundedRect(545, 195, 90, 16, 8), grey.darker(140), 1.5);

    drawShape(painter, roundedRect(470, 255, 340, 75, 32), grey);
    painter.setPen(QPen(kOutline, 1.5));
    painter.setBrush(grey.darker(125));
    painter.drawEllipse(QRectF(705, 272, 80, 40));

    QPainterPath pocket;
    pocket.moveTo(160, 395);
    pocket.lineTo(640, 395);
    pocket.quadTo(660, 395, 660, 415);
    pocket.lineTo(660, 470);
    pocket.quadTo(660, 485, 645, 485);
    pocket.lineTo(200, 485);
    pocket.quadTo(170, 485, 160, 460);
    pocket.closeSubpath();
    drawShape(painter, pocket, grey);
    painter.setPen(QPen(grey.darker(160), 3, Qt::SolidLine, Qt::RoundCap));
    painter.drawLine(QPointF(178, 412), QPointF(642, 412));

    const QPointF speaker(745, 420);
    QPainterPath grille;
    grille.addEllipse(speaker, 55, 55);
    drawShape(painter, grille, grey);
    painter.setPen(Qt::NoPen);
    painter.setBrush(grey.darker(160));
    for (int dy = -40; dy <= 40; dy += 10) {
        for (int dx = -40; dx <= 40; dx += 10) {
            if (dx * dx + dy * dy <= 42 * 42)
                painter.drawEllipse(speaker + QPointF(dx, dy), 2.6, 2.6);
        }
    }

    painter.setPen(QPen(kOutline, 1.5));
    painter.setBrush(colours[IvoryBeige].darker(112));
    painter.drawEllipse(QPointF(100, 210), 7, 7);
    painter.drawEllipse(QPointF(100, 300), 7, 7);
    return image;
}

// An instrument panel fascia seen from the driver's seat.
QImage drawDashboard(const Palette& colours)
{
    QImage image = blankCanvas();
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);

    QPainterPath fascia;
    fascia.moveTo(40, 210);
    fascia.cubicTo(130, 120, 770, 120, 860, 210);
    fascia.lineTo(860, 430);
    fascia.quadTo(860, 460, 830, 460);
    fascia.lineTo(70, 460);
    fascia.quadTo(40, 460, 40, 430);
    fascia.closeSubpath();
    painter.fillPath(fascia.translated(6, 8), QColor(0, 0, 0, 28));
    drawShape(painter, fascia, colours[IvoryBeige], 3);

    const QColor grey = colours[GraphiteGrey];
    QPainterPath topPad;
    topPad.moveTo(40, 210);
    topPad.cubicTo(130, 120, 770, 120, 860, 210);
    topPad.lineTo(860, 245);
    topPad.cubicTo(770, 170, 130, 170, 40, 245);
    topPad.closeSubpath();
    drawShape(painter, topPad, grey);

    QPainterPath hood;
    hood.moveTo(120, 330);
    hood.lineTo(120, 268);
    hood.cubicTo(140, 205, 340, 205, 360, 268);
    hood.lineTo(360, 330);
    hood.closeSubpath();
    drawShape(painter, hood, grey);
    for (const QPointF& centre : {QPointF(190, 290), QPointF(290, 290)}) {
        painter.setPen(QPen(kOutline, 2));
        painter.setBrush(grey.darker(170));
        painter.drawEllipse(centre, 34, 34);
        painter.setPen(QPen(colours[SignalRed], 3, Qt::SolidLine, Qt::RoundCap));
        painter.drawLine(centre, centre + QPointF(-18, -16));
    }

    for (const QRectF& vent : {QRectF(62, 250, 48, 66), QRectF(395, 240, 50, 70), QRectF(455, 240, 50, 70),
                               QRectF(790, 250, 48, 66)}) {
        drawShape(painter, roundedRect(vent.x(), vent.y(), vent.width(), vent.height(), 10), grey);
        drawSlats(painter, vent, grey.darker(160));
    }
    drawShape(painter, roundedRect(392, 322, 116, 70, 8), QColor(0x1f, 0x23, 0x28));

    drawShape(painter, roundedRect(560, 245, 215, 80, 14), colours[IvoryBeige]);
    drawShape(painter, roundedRect(735, 276, 26, 14, 5), grey, 1.5);

    drawShape(painter, roundedRect(60, 340, 320, 38, 10), colours[SignalRed]);
    drawShape(painter, roundedRect(520, 340, 320, 38, 10), colours[SignalRed]);

    QPainterPath column;
    column.moveTo(180, 460);
    column.cubicTo(185, 405, 295, 405, 300, 460);
    drawShape(painter, column, kBackground);
    return image;
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
};

const std::vector<TemplatePlan>& templatePlans()
{
    static const std::vector<TemplatePlan> plans = {
        {"Door Panel Trim",
         "Colour check of the front left door trim panel before assembly. Armrest and map pocket are "
         "measured as a pair, as they come from different moulds.",
         "door-panel.png",
         false,
         drawDoorPanel,
         {IvoryBeige, GraphiteGrey, OceanBlue},
         {"Hartwell Interior Systems", "DT-4410-LH", "PP-T20"},
         {{"Panel Surface", QRect(260, 350, 45, 35), IvoryBeige, false},
          {"Window Sill", QRect(300, 102, 32, 32), GraphiteGrey, false},
          {"Fabric Insert", QRect(275, 232, 50, 50), OceanBlue, true},
          {"Armrest", QRect(540, 266, 50, 50), GraphiteGrey, false},
          {"Map Pocket", QRect(300, 425, 50, 50), GraphiteGrey, true}},
         3},
        {"Dashboard Fascia",
         "Colour check of the instrument panel fascia. The left and right decor strips are measured as "
         "a pair to catch shade differences from side to side.",
         "dashboard-fascia.png",
         true,
         drawDashboard,
         {GraphiteGrey, IvoryBeige, SignalRed},
         {"Kestrel Moulding Ltd", "IP-2208-00", "PC/ABS"},
         {{"Top Pad", QRect(432, 150, 36, 32), GraphiteGrey, false},
          {"Decor Strip Left", QRect(200, 344, 30, 30), SignalRed, false},
          {"Decor Strip Right", QRect(690, 344, 30, 30), SignalRed, false},
          {"Glovebox Lid", QRect(620, 262, 45, 45), IvoryBeige, true}},
         1},
    };
    return plans;
}

std::vector<unsigned char> pngBytes(const QImage& image)
{
    QByteArray bytes;
    QBuffer buffer(&bytes);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, "PNG");
    return std::vector<unsigned char>(bytes.cbegin(), bytes.cend());
}

// The objects stored on their own that the templates take copies of.
struct SampleSet
{
    std::array<std::shared_ptr<Standard>, SampleColourCount> standards;
    Palette colours;
    std::vector<std::shared_ptr<TagDefinition>> tagDefinitions; // Supplier, Part Number, Material
    std::shared_ptr<ToleranceSet> toleranceSet;
    std::shared_ptr<MeasurementConfiguration> configuration;
};

std::shared_ptr<CheckPoint> makeCheckPoint(const Spot& spot, const QImage& drawing,
                                           const std::shared_ptr<Standard>& standard)
{
    auto cutOut = std::make_shared<SchematicImage>();
    cutOut->setFormat("PNG");
    cutOut->setImageData(pngBytes(drawing.copy(spot.area)));

    auto checkPoint = std::make_shared<CheckPoint>();
    checkPoint->setName(spot.name);
    checkPoint->setPosition(std::make_shared<Position>(spot.area.x(), spot.area.y()));
    checkPoint->setSize(std::make_shared<Size>(spot.area.width(), spot.area.height()));
    checkPoint->setSchematicImage(cutOut);
    checkPoint->setStandard(standard);
    checkPoint->setAutoStandard(false);
    checkPoint->setSkippable(spot.skippable);
    return checkPoint;
}

// Templates are self-contained: they hold copies (same ids) of the stored
// objects, never the stored objects themselves.
std::shared_ptr<QCJobTemplate> makeTemplate(const TemplatePlan& plan, const SampleSet& samples)
{
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    jobTemplate->setName(plan.name);
    jobTemplate->setDescription(plan.description);
    jobTemplate->setEnableRepeat(plan.enableRepeat);

    std::vector<std::shared_ptr<TagDefinition>> definitions;
    std::vector<std::shared_ptr<TagValue>> values;
    for (std::size_t i = 0; i < samples.tagDefinitions.size(); ++i) {
        definitions.push_back(ObjectCodec::clone(*samples.tagDefinitions[i]));
        values.push_back(TagValue::forDefinition(*definitions.back(), plan.tagValues[i]));
    }
    jobTemplate->setTagDefinitions(definitions);
    jobTemplate->setTagValues(values);

    std::map<SampleColour, std::shared_ptr<Standard>> copies;
    std::vector<std::shared_ptr<Standard>> standards;
    for (SampleColour colour : plan.standards) {
        copies[colour] = ObjectCodec::clone(*samples.standards[colour]);
        standards.push_back(copies[colour]);
    }
    jobTemplate->setStandards(standards);
    jobTemplate->setSharedToleranceSets({ObjectCodec::clone(*samples.toleranceSet)});
    jobTemplate->setMeasurementConfiguration(ObjectCodec::clone(*samples.configuration));

    const QImage drawing = plan.draw(samples.colours);
    auto schematic = std::make_shared<SchematicImage>();
    schematic->setName(plan.imageName);
    schematic->setOriginalFilename(plan.imageName);
    schematic->setFormat("png");
    schematic->setImageData(pngBytes(drawing));
    jobTemplate->setSchematicImage(schematic);

    std::vector<std::shared_ptr<CheckListItem>> items;
    for (std::size_t i = 0; i < plan.spots.size(); ++i) {
        auto checkPoint = makeCheckPoint(plan.spots[i], drawing, copies.at(plan.spots[i].colour));
        if (i != plan.coupleFirst) {
            items.push_back(checkPoint);
            continue;
        }
        auto partner = makeCheckPoint(plan.spots[i + 1], drawing, copies.at(plan.spots[i + 1].colour));
        checkPoint->setMatchPoint("<CP1>");
        partner->setMatchPoint("<CP2>");
        auto couple = std::make_shared<CheckPointCouple>();
        couple->setName("A");
        couple->setCheckPoints({checkPoint, partner});
        items.push_back(couple);
        ++i;
    }
    jobTemplate->setCheckListItems(items);
    return jobTemplate;
}

// --- Storing --------------------------------------------------------------

class Seeder
{
public:
    explicit Seeder(CommandDispatcher& dispatcher) : m_dispatcher(dispatcher) {}

    bool templateTreeIsEmpty()
    {
        auto tree = run<DirectoryTreeResponse>(std::make_shared<GetDirectoryTree>(QCJobTemplate::typeId()));
        return tree->folders().empty() && tree->entries().empty();
    }

    void seed()
    {
        const LabToScreen toScreen;
        SampleSet samples;
        for (int colour = 0; colour < SampleColourCount; ++colour) {
            samples.standards[colour] = makeStandard(kStandardPlans[colour], toScreen);
            const auto rgb = samples.standards[colour]->displayRGB();
            samples.colours[colour] = QColor(rgb->red(), rgb->green(), rgb->blue());
        }
        const std::string standardsFolder = topFolder(Standard::typeId(), kSamplesFolder);
        for (const auto& standard : samples.standards)
            store(standard, standardsFolder);
        auto library = std::make_shared<ColorStandardsLibrary>();
        library->setName("Interior Colours");
        library->setDescription("Standard colours of the interior trim programme.");
        library->setStandards({samples.standards.begin(), samples.standards.end()});
        store(library, topFolder(ColorStandardsLibrary::typeId(), kSamplesFolder));

        samples.tagDefinitions = {makeTagDefinition("Supplier", "Company that supplies the part."),
                                  makeTagDefinition("Part Number", "Drawing number of the part."),
                                  makeTagDefinition("Material", "Base material of the measured surface.",
                                                    {"PP-T20", "PC/ABS", "ABS", "TPO"})};
        const std::string definitionsFolder = topFolder(TagDefinition::typeId(), kSamplesFolder);
        for (const auto& definition : samples.tagDefinitions)
            store(definition, definitionsFolder);
        auto properties = std::make_shared<PropertyLibrary>();
        properties->setName("Part Properties");
        properties->setDescription("What a QC job records about the part it checks.");
        properties->setProperties(samples.tagDefinitions);
        store(properties, topFolder(PropertyLibrary::typeId(), kSamplesFolder));

        samples.toleranceSet = makeToleranceSet();
        store(samples.toleranceSet, topFolder(ToleranceSet::typeId(), kSamplesFolder));
        samples.configuration = makeMeasurementConfiguration();
        store(samples.configuration, topFolder(MeasurementConfiguration::typeId(), kSamplesFolder));

        // Templates last: a template tree that is not empty means seeding is done.
        const std::string templatesFolder = topFolder(QCJobTemplate::typeId(), kTemplatesFolder);
        for (const TemplatePlan& plan : templatePlans())
            store(makeTemplate(plan, samples), templatesFolder);
    }

private:
    template <class R>
    std::shared_ptr<R> run(std::shared_ptr<Command> command)
    {
        const std::string description = command->description();
        Answer answer = runAndWait(m_dispatcher, std::move(command));
        if (!answer.error.isEmpty())
            throw SeedFailure{answer.error};
        auto response = std::dynamic_pointer_cast<R>(answer.response);
        if (!response)
            throw SeedFailure{QStringLiteral("Cannot %1: the object store gave an unexpected answer.")
                                  .arg(QString::fromStdString(description))};
        return response;
    }

    // The top-level folder of that name, created when it is missing: other
    // trees than the template tree may already hold a folder of it.
    std::string topFolder(const std::string& objectType, const std::string& name)
    {
        auto tree = run<DirectoryTreeResponse>(std::make_shared<GetDirectoryTree>(objectType));
        for (const DirFolder& folder : tree->folders()) {
            if (folder.parentId.empty() && folder.name == name)
                return folder.id;
        }
        return run<FolderResponse>(std::make_shared<CreateFolder>(objectType, std::string(), name))->folder().id;
    }

    void store(const std::shared_ptr<BaseObject>& object, const std::string& folderId)
    {
        auto command = std::make_shared<UpdateObject>();
        command->setObject(object);
        command->setFolderId(folderId);
        run<UpdateObjectResponse>(command);
    }

    CommandDispatcher& m_dispatcher;
};

} // namespace

QString SampleData::seedIfEmpty(MarloModel& store)
{
    auto dispatcher = store.commandDispatcher("");
    if (!dispatcher)
        return QStringLiteral("Cannot store the sample data: there is no default object store.");
    try {
        Seeder seeder(*dispatcher);
        if (seeder.templateTreeIsEmpty())
            seeder.seed();
    } catch (const SeedFailure& failure) {
        return failure.message;
    }
    return {};
}

} // namespace vemi
