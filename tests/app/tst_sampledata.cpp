#include "tests/common/TestMain.h"
#include "app/sampledata/SampleData.h"
#include "tests/common/RawConnection.h"
#include "tests/common/TempStore.h"

#include "host/domain/AppearanceValues.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/CheckPointCouple.h"
#include "host/domain/ColorStandardsLibrary.h"
#include "host/domain/ColorimetricCondition.h"
#include "host/store/CommandSender.h"
#include "host/store/CreateFolder.h"
#include "host/domain/DirEntry.h"
#include "host/store/DirectoryTreeResponse.h"
#include "host/store/ErrorInfo.h"
#include "host/store/FillEmptyStore.h"
#include "host/store/FillEmptyStoreResponse.h"
#include "host/store/GetDirectoryTree.h"
#include "host/store/GetMarloObjects.h"
#include "host/store/GetMarloObjectsResponse.h"
#include "host/domain/LabToleranceBase.h"
#include "host/domain/LabValue.h"
#include "host/client/BaseSetting.h"
#include "host/client/SettingsGroup.h"
#include "host/client/SettingsList.h"
#include "host/client/SettingsSection.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/Property.h"
#include "host/instruments/Instrument.h"
#include "host/instruments/InstrumentManager.h"
#include "host/instruments/MeasurementConditions.h"
#include "host/domain/Position.h"
#include "host/domain/PropertyLibrary.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/RGBValue.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/domain/ToleranceSet.h"

#include <QImage>
#include <QtTest>

#include <set>

using namespace vemi;

namespace {

std::shared_ptr<DirectoryTreeResponse> tree(TempStore& store, const std::string& type)
{
    return std::dynamic_pointer_cast<DirectoryTreeResponse>(store.run(std::make_shared<GetDirectoryTree>(type)).response);
}


// Rows of the store's tables, read behind the store's back: also objects that no entry files.
struct Rows
{
    int folders = -1;
    int objects = -1;
    int entries = -1;
    bool operator==(const Rows& other) const
    {
        return folders == other.folders && objects == other.objects && entries == other.entries;
    }
};

Rows rowsOf(const QString& path)
{
    RawConnection raw(path);
    return {raw.scalar("SELECT count(*) FROM folders").toInt(), raw.scalar("SELECT count(*) FROM objects").toInt(),
            raw.scalar("SELECT count(*) FROM dir_entries").toInt()};
}

QString describe(const Rows& rows)
{
    return QStringLiteral("%1 folders, %2 objects, %3 entries").arg(rows.folders).arg(rows.objects).arg(rows.entries);
}

template <class T>
std::shared_ptr<T> fetchNamed(TempStore& store, const QString& name, int depth = 1)
{
    for (const auto& object : store.fetchAll<T>(depth)) {
        if (object && object->name() == name.toStdString())
            return object;
    }
    return nullptr;
}

std::shared_ptr<LabValue> firstLab(const Standard& standard)
{
    const auto appearance = standard.appearanceValues(0);
    if (!appearance || appearance->colorValues().empty())
        return nullptr;
    return std::dynamic_pointer_cast<LabValue>(appearance->colorValues().front());
}

std::shared_ptr<LabToleranceBase> firstLabTolerance(const ToleranceSet& set)
{
    return set.tolerances().empty() ? nullptr : std::dynamic_pointer_cast<LabToleranceBase>(set.tolerances().front());
}

std::shared_ptr<FillEmptyStore> sampleSet()
{
    QString error;
    auto set = SampleData::buildSet(&error);
    if (!set)
        qWarning("%s", qPrintable(error));
    return set;
}

QImage decode(const std::shared_ptr<SchematicImage>& image)
{
    if (!image)
        return {};
    const auto& data = image->imageData();
    QImage decoded;
    decoded.loadFromData(data.data(), int(data.size()), image->format().c_str());
    return decoded.convertToFormat(QImage::Format_RGB32);
}

} // namespace

class tst_SampleData : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void fillsEachTreeInItsFolders_data();
    void fillsEachTreeInItsFolders();
    void templatesAreComplete_data();
    void templatesAreComplete();
    void configurationsFitTheirInstruments();
    void librariesResolveTheirMembers_data();
    void librariesResolveTheirMembers();
    void displayColoursFollowLab_data();
    void displayColoursFollowLab();
    void conditionsOfStandardAndTolerance_data();
    void conditionsOfStandardAndTolerance();
    void secondRunAddsNothing();
    void storeWithAnythingIsLeftAlone_data();
    void storeWithAnythingIsLeftAlone();
    void shellsSeedingAtOnceWriteOneSet_data();
    void shellsSeedingAtOnceWriteOneSet();
    void failureHalfWayLeavesStoreEmpty_data();
    void failureHalfWayLeavesStoreEmpty();

private:
    std::unique_ptr<TempStore> m_seeded;
};

void tst_SampleData::initTestCase()
{
    m_seeded = std::make_unique<TempStore>();
    QCOMPARE(SampleData::seedIfEmpty(m_seeded->model()), QString());
}

void tst_SampleData::fillsEachTreeInItsFolders_data()
{
    QTest::addColumn<QString>("type");
    QTest::addColumn<QStringList>("folders");
    QTest::addColumn<int>("entries");
    QTest::newRow("job templates") << QString::fromStdString(QCJobTemplate::typeId())
                                   << QStringList{"Sample Job Templates"} << 2;
    QTest::newRow("interior and chart standards stored apart from their libraries")
        << QString::fromStdString(Standard::typeId()) << QStringList{"Samples", "Colour Chart"} << 6 + 24;
    QTest::newRow("standards libraries")
        << QString::fromStdString(ColorStandardsLibrary::typeId()) << QStringList{"Samples"} << 3;
    QTest::newRow("tag definitions stored apart from their libraries")
        << QString::fromStdString(TagDefinition::typeId()) << QStringList{"Samples"} << 3 + 5;
    QTest::newRow("property libraries") << QString::fromStdString(PropertyLibrary::typeId()) << QStringList{"Samples"}
                                        << 2;
    QTest::newRow("tolerance sets") << QString::fromStdString(ToleranceSet::typeId()) << QStringList{"Samples"} << 4;
    QTest::newRow("measurement configurations")
        << QString::fromStdString(MeasurementConfiguration::typeId()) << QStringList{"Samples"} << 2;
}

void tst_SampleData::fillsEachTreeInItsFolders()
{
    QFETCH(QString, type);
    QFETCH(QStringList, folders);
    QFETCH(int, entries);

    auto response = tree(*m_seeded, type.toStdString());
    QVERIFY(response);
    QStringList names;
    std::set<std::string> folderIds;
    for (const auto& folder : response->folders()) {
        names << QString::fromStdString(folder.name);
        folderIds.insert(folder.id);
    }
    names.sort();
    folders.sort();
    QCOMPARE(names, folders);
    QCOMPARE(int(response->entries().size()), entries);
    for (const auto& entry : response->entries())
        QVERIFY(folderIds.count(entry->folderId()));
}

void tst_SampleData::templatesAreComplete_data()
{
    QTest::addColumn<QString>("name");
    QTest::newRow("door panel") << "Door Panel Trim";
    QTest::newRow("dashboard") << "Dashboard Fascia";
}

void tst_SampleData::templatesAreComplete()
{
    QFETCH(QString, name);

    std::shared_ptr<QCJobTemplate> jobTemplate;
    for (const auto& candidate : m_seeded->fetchAll<QCJobTemplate>()) {
        if (candidate && candidate->name() == name.toStdString())
            jobTemplate = candidate;
    }
    QVERIFY(jobTemplate);
    QVERIFY(jobTemplate->measurementConfiguration());
    QCOMPARE(int(jobTemplate->sharedToleranceSets().size()), 1);

    // Tag values must name the template's own copies of the definitions.
    std::set<std::string> definitionIds;
    for (const auto& definition : jobTemplate->tagDefinitions())
        definitionIds.insert(definition->id());
    QCOMPARE(int(definitionIds.size()), 3);
    QCOMPARE(int(jobTemplate->tagValues().size()), 3);
    for (const auto& value : jobTemplate->tagValues()) {
        QVERIFY(definitionIds.count(value->definitionId()));
        QVERIFY(!value->value().empty());
    }

    // The template's standards are copies of stored standards, not new objects.
    std::set<std::string> storedStandardIds;
    for (const auto& standard : m_seeded->fetchAll<Standard>())
        storedStandardIds.insert(standard->id());
    std::map<std::string, std::shared_ptr<Standard>> standards;
    for (const auto& standard : jobTemplate->standards()) {
        QVERIFY(storedStandardIds.count(standard->id()));
        standards[standard->id()] = standard;
    }

    const QImage schematic = decode(jobTemplate->schematicImage());
    QVERIFY(!schematic.isNull());
    QVERIFY(schematic.width() >= 800 && schematic.height() >= 500);

    const auto checkPoints = jobTemplate->checkPoints();
    QVERIFY(checkPoints.size() >= 3 && checkPoints.size() <= 5);
    for (const auto& checkPoint : checkPoints) {
        const QString label = QString::fromStdString(checkPoint->name());
        QVERIFY2(!checkPoint->autoStandard(), qPrintable(label));
        QVERIFY2(checkPoint->standard() && standards.count(checkPoint->standard()->id()), qPrintable(label));

        const QRect area(checkPoint->position()->x(), checkPoint->position()->y(), checkPoint->size()->width(),
                         checkPoint->size()->height());
        QVERIFY2(area.width() > 0 && area.width() <= 55 && area.height() > 0 && area.height() <= 55,
                 qPrintable(label));
        QVERIFY2(schematic.rect().contains(area), qPrintable(label));

        QCOMPARE(checkPoint->schematicImage()->format(), std::string("PNG"));
        const QImage cutOut = decode(checkPoint->schematicImage());
        QVERIFY2(cutOut == schematic.copy(area), qPrintable(label));

        // The area lies on a region painted in the colour of its standard.
        const auto rgb = standards.at(checkPoint->standard()->id())->displayRGB();
        QCOMPARE(QColor(cutOut.pixel(cutOut.rect().center())), QColor(rgb->red(), rgb->green(), rgb->blue()));
    }

    int couples = 0;
    for (const auto& item : jobTemplate->checkListItems()) {
        auto couple = std::dynamic_pointer_cast<CheckPointCouple>(item);
        if (!couple)
            continue;
        ++couples;
        QCOMPARE(couple->name(), std::string("A"));
        QCOMPARE(int(couple->checkPoints().size()), 2);
        QCOMPARE(couple->checkPoints()[0]->matchPoint(), std::string("<CP1>"));
        QCOMPARE(couple->checkPoints()[1]->matchPoint(), std::string("<CP2>"));
    }
    QCOMPARE(couples, 1);
}

// The dialog lists the stored configurations and edits them with their
// instrument's conditions: each must name an installed driver and list every
// setting of it, in the instrument's order, with a value it offers.
void tst_SampleData::configurationsFitTheirInstruments()
{
    const auto configurations = m_seeded->fetchAll<MeasurementConfiguration>();
    std::set<std::string> storedIds;
    std::set<std::string> models;
    for (const auto& configuration : configurations) {
        storedIds.insert(configuration->id());
        models.insert(configuration->instrumentModel());
        const auto instrument =
            InstrumentManager::instance()->instrument(QString::fromStdString(configuration->instrumentModel()));
        QVERIFY2(instrument, configuration->name().c_str());
        const auto conditions = instrument->measurementConditions();
        QStringList keys;
        for (const auto& property : configuration->properties()) {
            keys << QString::fromStdString(property->key());
            QVERIFY(conditions->allowedValues(keys.last()).contains(QString::fromStdString(property->value())));
        }
        QStringList settings;
        for (const auto& group : conditions->settings()->groups())
            for (const auto& section : group->sections())
                for (const auto& setting : section->settings())
                    settings << QString::fromStdString(setting->name());
        QCOMPARE(keys, settings);
    }
    QCOMPARE(int(models.size()), 2);
    // Each template carries a copy of a stored configuration, under its id.
    for (const auto& jobTemplate : m_seeded->fetchAll<QCJobTemplate>())
        QVERIFY(storedIds.count(jobTemplate->measurementConfiguration()->id()));
}

void tst_SampleData::librariesResolveTheirMembers_data()
{
    const QStringList greys{"White 9.5", "Neutral 8", "Neutral 6.5", "Neutral 5", "Neutral 3.5", "Black 2"};
    QTest::addColumn<bool>("standardsLibrary");
    QTest::addColumn<QString>("library");
    QTest::addColumn<QStringList>("members");
    QTest::newRow("interior colours") << true << "Interior Colours"
                                      << QStringList{"Ivory Beige", "Graphite Grey", "Signal Red", "Ocean Blue",
                                                     "Leaf Green", "Sun Yellow"};
    QTest::newRow("whole chart in reading order")
        << true << "Colour Chart 24"
        << QStringList{"Dark Skin",     "Light Skin",    "Blue Sky", "Foliage", "Blue Flower", "Bluish Green",
                       "Orange",        "Purplish Blue", "Moderate Red", "Purple", "Yellow Green",
                       "Orange Yellow", "Blue",          "Green",    "Red",     "Yellow",      "Magenta",
                       "Cyan"} + greys;
    QTest::newRow("chart grey scale sharing the chart's standards") << true << "Chart Grey Scale" << greys;
    QTest::newRow("part properties") << false << "Part Properties" << QStringList{"Supplier", "Part Number", "Material"};
    QTest::newRow("inspection properties")
        << false << "Inspection Properties"
        << QStringList{"Inspector", "Shift", "Light Booth", "Parts per Lot", "Remarks"};
}

void tst_SampleData::librariesResolveTheirMembers()
{
    QFETCH(bool, standardsLibrary);
    QFETCH(QString, library);
    QFETCH(QStringList, members);

    // Names come only from the stored members: an unresolved stand-in has none.
    QStringList names;
    if (standardsLibrary) {
        const auto standards = fetchNamed<ColorStandardsLibrary>(*m_seeded, library, 2);
        QVERIFY(standards);
        for (const auto& standard : standards->standards()) {
            names << QString::fromStdString(standard->name());
            // A resolved member brings its colour along, as the editor's list shows it.
            QVERIFY2(standard->displayRGB() && firstLab(*standard), qPrintable(names.last()));
        }
    } else {
        const auto properties = fetchNamed<PropertyLibrary>(*m_seeded, library, 2);
        QVERIFY(properties);
        for (const auto& definition : properties->properties())
            names << QString::fromStdString(definition->name());
    }
    QCOMPARE(names, members);
}

void tst_SampleData::displayColoursFollowLab_data()
{
    // Expected values worked out by hand: the Lab values taken relative to their white
    // and carried to the sRGB white with the Bradford transform, which is what a
    // relative colorimetric rendering does; 8-bit channels clip out-of-gamut colours.
    // Reading the Lab values under the wrong white moves most of these rows by more
    // than the tolerance (the mid blue's red channel by 39).
    QTest::addColumn<QString>("name");
    QTest::addColumn<QString>("condition");
    QTest::addColumn<QColor>("expected");
    QTest::newRow("light warm beige") << "Ivory Beige" << "D65/10" << QColor(223, 203, 172);
    QTest::newRow("dark neutral grey") << "Graphite Grey" << "D65/10" << QColor(75, 79, 84);
    QTest::newRow("saturated red") << "Signal Red" << "D65/10" << QColor(174, 32, 40);
    QTest::newRow("mid blue, red channel nearly clipped") << "Ocean Blue" << "D65/10" << QColor(4, 106, 151);
    QTest::newRow("mid green") << "Leaf Green" << "D65/10" << QColor(57, 127, 64);
    QTest::newRow("yellow at the gamut edge") << "Sun Yellow" << "D65/10" << QColor(250, 190, 1);
    QTest::newRow("chart skin tone") << "Dark Skin" << "D50/2" << QColor(116, 79, 65);
    QTest::newRow("chart orange") << "Orange" << "D50/2" << QColor(224, 124, 48);
    QTest::newRow("chart blue") << "Blue" << "D50/2" << QColor(40, 62, 145);
    QTest::newRow("chart cyan, red channel clipped") << "Cyan" << "D50/2" << QColor(0, 133, 165);
    QTest::newRow("chart white, slightly yellowish") << "White 9.5" << "D50/2" << QColor(241, 242, 235);
    QTest::newRow("chart mid grey") << "Neutral 5" << "D50/2" << QColor(121, 121, 121);
}

void tst_SampleData::displayColoursFollowLab()
{
    QFETCH(QString, name);
    QFETCH(QString, condition);
    QFETCH(QColor, expected);

    const auto standard = fetchNamed<Standard>(*m_seeded, name);
    QVERIFY(standard);
    const auto lab = firstLab(*standard);
    QVERIFY(lab);
    QCOMPARE(QString::fromStdString(lab->colorimetricCondition()), condition);

    const auto rgb = standard->displayRGB();
    QVERIFY(rgb);
    const QColor actual(rgb->red(), rgb->green(), rgb->blue());
    const int tolerance = 2;
    QVERIFY2(qAbs(actual.red() - expected.red()) <= tolerance && qAbs(actual.green() - expected.green()) <= tolerance
                 && qAbs(actual.blue() - expected.blue()) <= tolerance,
             qPrintable(QStringLiteral("%1 shows as %2").arg(name, actual.name())));
}

// The pairs a user tries in the editor: a template's standards and a tolerance
// set to add. The editor compares the two strings byte for byte.
void tst_SampleData::conditionsOfStandardAndTolerance_data()
{
    QTest::addColumn<QString>("jobTemplate");
    QTest::addColumn<QString>("library");
    QTest::addColumn<QString>("set");
    QTest::addColumn<bool>("equal");
    QTest::newRow("door panel standards accept the interior tolerance")
        << "Door Panel Trim" << QString() << "Automotive Interior" << true;
    QTest::newRow("dashboard standards accept the fabric tolerance")
        << "Dashboard Fascia" << QString() << "Seat Fabric CMC" << true;
    QTest::newRow("door panel standards refuse the label tolerance")
        << "Door Panel Trim" << QString() << "Printed Labels" << false;
    QTest::newRow("dashboard standards refuse the chart tolerance")
        << "Dashboard Fascia" << QString() << "Chart Check" << false;
    QTest::newRow("chart standards accept the chart tolerance") << QString() << "Colour Chart 24" << "Chart Check" << true;
    QTest::newRow("chart greys refuse the interior tolerance")
        << QString() << "Chart Grey Scale" << "Automotive Interior" << false;
}

void tst_SampleData::conditionsOfStandardAndTolerance()
{
    QFETCH(QString, jobTemplate);
    QFETCH(QString, library);
    QFETCH(QString, set);
    QFETCH(bool, equal);

    std::vector<std::shared_ptr<Standard>> standards;
    if (!jobTemplate.isEmpty()) {
        const auto stored = fetchNamed<QCJobTemplate>(*m_seeded, jobTemplate);
        QVERIFY(stored);
        standards = stored->standards();
    } else {
        const auto stored = fetchNamed<ColorStandardsLibrary>(*m_seeded, library, 2);
        QVERIFY(stored);
        standards = stored->standards();
    }
    // Without standards every tolerance passes, and the row would prove nothing.
    QVERIFY(!standards.empty());
    const auto tolerances = fetchNamed<ToleranceSet>(*m_seeded, set);
    QVERIFY(tolerances);
    const auto tolerance = firstLabTolerance(*tolerances);
    QVERIFY(tolerance && tolerance->colorimetricCondition());
    const std::string toleranceCondition = tolerance->colorimetricCondition()->toString();

    for (const auto& standard : standards) {
        const auto lab = firstLab(*standard);
        QVERIFY2(lab, standard->name().c_str());
        QVERIFY2((lab->colorimetricCondition() == toleranceCondition) == equal,
                 qPrintable(QStringLiteral("%1 uses %2, the tolerance %3")
                                .arg(QString::fromStdString(standard->name()),
                                     QString::fromStdString(lab->colorimetricCondition()),
                                     QString::fromStdString(toleranceCondition))));
    }
}

void tst_SampleData::secondRunAddsNothing()
{
    const Rows before = rowsOf(m_seeded->path());
    QVERIFY(before.objects > 0);
    QCOMPARE(SampleData::seedIfEmpty(m_seeded->model()), QString());
    QVERIFY2(rowsOf(m_seeded->path()) == before, qPrintable(describe(rowsOf(m_seeded->path()))));
}

void tst_SampleData::storeWithAnythingIsLeftAlone_data()
{
    QTest::addColumn<QString>("content");
    QTest::newRow("a template at the top level") << "template";
    QTest::newRow("only an empty template folder") << "template folder";
    QTest::newRow("only a folder in another tree") << "standards folder";
    QTest::newRow("only an object that no folder files") << "unfiled standard";
}

void tst_SampleData::storeWithAnythingIsLeftAlone()
{
    QFETCH(QString, content);

    TempStore store;
    if (content == "template folder" || content == "standards folder") {
        const std::string type = content == "template folder" ? QCJobTemplate::typeId() : Standard::typeId();
        QVERIFY(store.run(std::make_shared<CreateFolder>(type, "", "Mine")).response);
    } else if (content == "template") {
        auto jobTemplate = std::make_shared<QCJobTemplate>();
        jobTemplate->setName("Bumper");
        const std::string topLevel;
        QVERIFY(store.save(jobTemplate, &topLevel));
    } else {
        auto standard = std::make_shared<Standard>();
        standard->setName("Loose");
        QVERIFY(store.save(standard));
    }
    const Rows before = rowsOf(store.path());

    QCOMPARE(SampleData::seedIfEmpty(store.model()), QString());
    QVERIFY2(rowsOf(store.path()) == before, qPrintable(describe(rowsOf(store.path()))));
}

// Two shells started together on a new store: each has its own connection
// (and worker), and the second sends while the first one's set is in flight.
void tst_SampleData::shellsSeedingAtOnceWriteOneSet_data()
{
    QTest::addColumn<bool>("twoShells");
    QTest::newRow("two shells on one new store file") << true;
    QTest::newRow("one shell sending the set twice") << false;
}

void tst_SampleData::shellsSeedingAtOnceWriteOneSet()
{
    QFETCH(bool, twoShells);

    TempStore store;
    MarloModel otherShell(store.path());
    QCOMPARE(otherShell.open(), QString());
    MarloModel& second = twoShells ? otherShell : store.model();

    const auto first = sampleSet();
    const auto again = sampleSet();
    QVERIFY(first && again);
    QObject context;
    int answers = 0;
    int written = 0;
    QStringList errors;
    const auto onResponse = [&](const std::shared_ptr<Response>& response) {
        ++answers;
        const auto filled = std::dynamic_pointer_cast<FillEmptyStoreResponse>(response);
        written += filled && filled->written();
    };
    const auto onError = [&](const std::shared_ptr<ErrorInfo>& error) {
        ++answers;
        errors << error->message();
    };
    CommandSender::send(store.model(), "", first, &context, onResponse, onError);
    CommandSender::send(second, "", again, &context, onResponse, onError);
    QTRY_COMPARE_WITH_TIMEOUT(answers, 2, 30000);
    QVERIFY2(errors.isEmpty(), qPrintable(errors.join('\n')));
    QCOMPARE(written, 1);
    QVERIFY2(rowsOf(store.path()) == rowsOf(m_seeded->path()), qPrintable(describe(rowsOf(store.path()))));
}

void tst_SampleData::failureHalfWayLeavesStoreEmpty_data()
{
    QTest::addColumn<QString>("failure");
    QTest::addColumn<QString>("messagePart");
    QTest::newRow("read-only store") << "read-only" << "read-only";
    QTest::newRow("a folder name twice, after the first folders") << "folder twice" << "already exists";
    QTest::newRow("an object filed in no folder of the set, after all the others")
        << "missing folder" << "no longer exists";
}

void tst_SampleData::failureHalfWayLeavesStoreEmpty()
{
    QFETCH(QString, failure);
    QFETCH(QString, messagePart);

    TempStore store;
    QString message;
    if (failure == "read-only") {
        store.reopenReadOnly();
        message = SampleData::seedIfEmpty(store.model());
    } else {
        const auto set = sampleSet();
        QVERIFY(set);
        if (failure == "folder twice") {
            set->addFolder(Standard::typeId(), "", "Samples");
        } else {
            auto standard = std::make_shared<Standard>();
            standard->setName("Stray");
            set->addObject(standard, "a folder nobody created");
        }
        const TempStore::Answer answer = store.run(set);
        QVERIFY(!answer.response);
        QVERIFY(answer.error);
        message = answer.error->message();
    }
    QVERIFY2(message.contains(messagePart) && message.contains("sample data"), qPrintable(message));
    const Rows rows = rowsOf(store.path());
    QVERIFY2(rows == (Rows{0, 0, 0}), qPrintable(describe(rows)));
}

QC_TEST_MAIN(tst_SampleData)

#include "tst_sampledata.moc"
