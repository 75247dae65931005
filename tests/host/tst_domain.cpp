#include "tests/common/TestMain.h"
#include "tests/common/TestLibrary.h"
#include "host/domain/AppearanceValues.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/CheckPointCouple.h"
#include "host/domain/ColorStandardsLibrary.h"
#include "host/domain/ColorimetricCondition.h"
#include "host/domain/DecodeError.h"
#include "host/domain/DirEntry.h"
#include "host/domain/GlobalDirEntry.h"
#include "host/domain/Header.h"
#include "host/domain/LabToleranceBase.h"
#include "host/domain/LabValue.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/ObjectCodec.h"
#include "host/domain/ObjectRegistry.h"
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
#include "host/domain/Tolerance.h"
#include "host/domain/ToleranceSet.h"

#include <QtTest>

using namespace vemi;

namespace QTest {
template <>
char* toString(const std::string& text)
{
    return qstrdup(text.c_str());
}
} // namespace QTest

namespace {

const std::string kUtf8Text = "Größe ✓";
const std::vector<unsigned char> kImageBytes = {0x89, 'P', 'N', 'G', 0x00, 0xFF, 0x00, 0x0A, 0xFF, 0x7F};

std::shared_ptr<ColorimetricCondition> makeCondition()
{
    return std::make_shared<ColorimetricCondition>("D50", "2");
}

std::shared_ptr<SchematicImage> makeImage(const std::string& name)
{
    auto image = std::make_shared<SchematicImage>();
    image->setName(name);
    image->setOriginalFilename("/home/qc/" + name + ".png");
    image->setFormat("png");
    image->setImageData(kImageBytes);
    return image;
}

std::shared_ptr<TagDefinition> makeTagDefinition()
{
    auto definition = std::make_shared<TagDefinition>();
    definition->setName(kUtf8Text);
    definition->setDescription("Teilegröße");
    definition->setDefaultValue("groß");
    definition->setAllowedValues({"klein", "groß", "✓"});
    return definition;
}

void addTags(NamedObject& object)
{
    const auto definition = makeTagDefinition();
    object.setTagDefinitions({definition});
    object.setTagValues({TagValue::forDefinition(*definition, kUtf8Text)});
}

std::shared_ptr<LabValue> makeLab()
{
    auto lab = std::make_shared<LabValue>(52.25, -3.5, 17.0);
    lab->setColorimetricCondition(makeCondition()->toString());
    return lab;
}

std::shared_ptr<AppearanceValues> makeAppearance()
{
    auto appearance = std::make_shared<AppearanceValues>();
    appearance->setColorValues({makeLab(), makeLab()});
    return appearance;
}

std::shared_ptr<Standard> makeStandard(const std::string& name)
{
    auto standard = std::make_shared<Standard>();
    standard->setName(name);
    standard->setDisplayRGB(std::make_shared<RGBValue>(255, 128, 0));
    standard->setAppearanceValuesList({makeAppearance(), makeAppearance()});
    addTags(*standard);
    return standard;
}

std::shared_ptr<Tolerance> makeTolerance()
{
    auto tolerance = std::make_shared<Tolerance>();
    tolerance->setName("dE76 loose");
    tolerance->setMethod("dE76");
    tolerance->setLimit(2.5);
    return tolerance;
}

std::shared_ptr<LabToleranceBase> makeLabTolerance()
{
    auto tolerance = std::make_shared<LabToleranceBase>();
    tolerance->setName("dE2000 tight");
    tolerance->setLimit(0.75);
    tolerance->setColorimetricCondition(makeCondition());
    return tolerance;
}

std::shared_ptr<ToleranceSet> makeToleranceSet(const std::string& name)
{
    auto set = std::make_shared<ToleranceSet>();
    set->setName(name);
    set->setTolerances({makeLabTolerance(), makeTolerance()});
    return set;
}

std::shared_ptr<MeasurementConfiguration> makeConfiguration()
{
    auto configuration = std::make_shared<MeasurementConfiguration>();
    configuration->setName("M1 D50");
    configuration->setInstrumentModel("Spectro 45/0");
    configuration->setProperties({std::make_shared<Property>("aperture", "8 mm"),
                                  std::make_shared<Property>("Messbedingung", kUtf8Text)});
    return configuration;
}

std::shared_ptr<CheckPoint> makeCheckPoint(const std::string& name, const std::string& matchPoint = {})
{
    auto checkPoint = std::make_shared<CheckPoint>();
    checkPoint->setName(name);
    checkPoint->setPosition(std::make_shared<Position>(12, -3));
    checkPoint->setSize(std::make_shared<Size>(55, 40));
    checkPoint->setSchematicImage(makeImage(name));
    checkPoint->setSkippable(true);
    checkPoint->setMatchPoint(matchPoint);
    return checkPoint;
}

std::shared_ptr<CheckPointCouple> makeCouple(const std::string& name, const std::shared_ptr<CheckPoint>& first,
                                             const std::shared_ptr<CheckPoint>& second)
{
    auto couple = std::make_shared<CheckPointCouple>();
    couple->setName(name);
    couple->setCheckPoints({first, second});
    return couple;
}

std::shared_ptr<QCJobTemplate> makeTemplate()
{
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    jobTemplate->setName("Door panel " + kUtf8Text);
    jobTemplate->setDescription("Front left door, outside");
    addTags(*jobTemplate);

    auto withStandard = makeCheckPoint("Handle");
    withStandard->setStandard(makeStandard("RAL 9010"));
    withStandard->setAutoStandard(false);
    withStandard->setTagDefinitions({makeTagDefinition()});
    jobTemplate->setCheckListItems({withStandard,
                                    makeCouple("A", makeCheckPoint("Mirror", "<CP1>"),
                                               makeCheckPoint("Frame", "<CP2>")),
                                    makeCheckPoint("Sill")});
    jobTemplate->setStandards({makeStandard("RAL 9010"), makeStandard(kUtf8Text)});
    jobTemplate->setSharedToleranceSets({makeToleranceSet("Shared")});
    jobTemplate->setPrivateToleranceSets({makeToleranceSet("Private"), makeToleranceSet("Private 2")});
    jobTemplate->setMeasurementConfiguration(makeConfiguration());
    jobTemplate->setEnableRepeat(true);
    jobTemplate->setSchematicImage(makeImage("door"));
    return jobTemplate;
}

QStringList names(const std::vector<std::shared_ptr<CheckPoint>>& checkPoints)
{
    QStringList result;
    for (const auto& checkPoint : checkPoints)
        result << QString::fromStdString(checkPoint->name());
    return result;
}

QCborMap toMap(const BaseObject& object)
{
    return ObjectCodec::encode(object).toMap();
}

} // namespace

class tst_Domain : public QObject
{
    Q_OBJECT

private slots:
    void populatedTemplateKeepsItsValues();
    void everyClassSurvivesRoundTrip_data();
    void everyClassSurvivesRoundTrip();
    void checkZoneIndex_data();
    void checkZoneIndex();
    void appearanceValuesPastTheEndAreNull();
    void librariesStoreMemberIdsOnly_data();
    void librariesStoreMemberIdsOnly();
    void malformedBytesThrow_data();
    void malformedBytesThrow();
    void snapshotIsUnaffectedByLaterEdits();
    void cloneSharesImageBytes();
};

// The bytes of every class survive a round trip (below); this shows that the
// values themselves are written, not only read back as they were written.
void tst_Domain::populatedTemplateKeepsItsValues()
{
    const auto original = makeTemplate();
    const auto decoded = std::dynamic_pointer_cast<QCJobTemplate>(ObjectCodec::deserialize(ObjectCodec::serialize(*original)));
    QVERIFY(decoded);
    QCOMPARE(decoded->name(), original->name());
    QCOMPARE(decoded->enableRepeat(), true);
    QCOMPARE(decoded->checkListItems().size(), std::size_t(3));
    QVERIFY(std::dynamic_pointer_cast<CheckPointCouple>(decoded->checkListItems()[1]));

    const auto originalPoints = original->checkPoints();
    const auto decodedPoints = decoded->checkPoints();
    QCOMPARE(names(decodedPoints), names(originalPoints));
    for (std::size_t i = 0; i < decodedPoints.size(); ++i) {
        QCOMPARE(decodedPoints[i]->id(), originalPoints[i]->id());
        QCOMPARE(decodedPoints[i]->schematicImage()->imageData(), kImageBytes);
    }
    QCOMPARE(decodedPoints[1]->matchPoint(), std::string("<CP1>"));
    QCOMPARE(decodedPoints[0]->standard()->id(), originalPoints[0]->standard()->id());
    QVERIFY(!decodedPoints[3]->standard());

    QCOMPARE(decoded->schematicImage()->imageData(), kImageBytes);
    QCOMPARE(decoded->standards()[1]->name(), kUtf8Text);
    QCOMPARE(decoded->tagValues()[0]->value(), kUtf8Text);
    QCOMPARE(decoded->tagValues()[0]->definitionId(), decoded->tagDefinitions()[0]->id());
    QCOMPARE(decoded->measurementConfiguration()->properties()[1]->value(), kUtf8Text);
    const auto lab = std::dynamic_pointer_cast<LabValue>(decoded->standards()[0]->appearanceValues(0)->colorValues()[0]);
    QVERIFY(lab);
    QCOMPARE(lab->colorimetricCondition(), std::string("D50/2"));
    const auto labTolerance = std::dynamic_pointer_cast<LabToleranceBase>(decoded->privateToleranceSets()[1]->tolerances()[0]);
    QVERIFY(labTolerance);
    QVERIFY(*labTolerance->colorimetricCondition() == *makeCondition());
    QVERIFY(!std::dynamic_pointer_cast<LabToleranceBase>(decoded->sharedToleranceSets()[0]->tolerances()[1]));
}

void tst_Domain::everyClassSurvivesRoundTrip_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QString>("type");
    QTest::addColumn<QString>("id");

    // Every field holds a value other than its default, so a field that is
    // written but not read back changes the re-encoded bytes.
    auto add = [](const std::shared_ptr<BaseObject>& object) {
        const QString type = QString::fromStdString(object->objectTypeId());
        QTest::newRow(qPrintable(type)) << ObjectCodec::serialize(*object) << type
                                        << QString::fromStdString(object->id());
    };

    add(makeTemplate());
    add(makeCheckPoint("Handle", "<CP2>"));
    add(makeCouple("B", makeCheckPoint("left"), makeCheckPoint("right")));
    add(makeImage("door"));
    add(std::make_shared<Position>(-7, 300));
    add(std::make_shared<Size>(1920, 1080));
    add(std::make_shared<RGBValue>(1, 2, 3));
    add(makeCondition());
    add(makeLab());
    add(makeAppearance());
    add(makeStandard(kUtf8Text));
    add(makeTagDefinition());
    auto numberDefinition = makeTagDefinition();
    numberDefinition->setAllowedValues({});
    numberDefinition->setValueKind(TagDefinition::ValueKind::Number);
    QTest::newRow("vemi.TagDefinition for numbers") << ObjectCodec::serialize(*numberDefinition)
                                                    << QString::fromStdString(TagDefinition::typeId())
                                                    << QString::fromStdString(numberDefinition->id());
    add(TagValue::forDefinition(*makeTagDefinition(), kUtf8Text));
    add(makeTolerance());
    add(makeLabTolerance());
    add(makeToleranceSet("Shared"));
    add(std::make_shared<Property>("illumination", "M2"));
    add(makeConfiguration());

    auto library = std::make_shared<ColorStandardsLibrary>();
    library->setName("RAL classic");
    library->setStandards({makeStandard("RAL 1000"), makeStandard("RAL 1001")});
    addTags(*library);
    add(library);

    auto properties = std::make_shared<PropertyLibrary>();
    properties->setName("Parts");
    properties->setProperties({makeTagDefinition()});
    add(properties);

    auto entry = std::make_shared<DirEntry>();
    entry->header()->setName(kUtf8Text);
    entry->setEntryObjectId(QUuid::createUuid().toString(QUuid::WithoutBraces).toStdString());
    entry->setEntryObjectType(QCJobTemplate::typeId());
    entry->setFolderId(QUuid::createUuid().toString(QUuid::WithoutBraces).toStdString());
    add(entry);

    auto globalEntry = std::make_shared<GlobalDirEntry>();
    globalEntry->header()->setName("Door panel");
    globalEntry->setEntryObjectId("entry");
    globalEntry->setEntryObjectType(Standard::typeId());
    globalEntry->setFolderId("folder");
    globalEntry->setDispatcherId("plant-2");
    add(globalEntry);
}

void tst_Domain::everyClassSurvivesRoundTrip()
{
    QFETCH(QByteArray, bytes);
    QFETCH(QString, type);
    QFETCH(QString, id);

    QVERIFY(ObjectRegistry::knows(type.toStdString()));
    const auto decoded = ObjectCodec::deserialize(bytes);
    QCOMPARE(QString::fromStdString(decoded->objectTypeId()), type);
    QCOMPARE(QString::fromStdString(decoded->id()), id);
    QCOMPARE(ObjectCodec::serialize(*decoded), bytes);
}

void tst_Domain::checkZoneIndex_data()
{
    QTest::addColumn<QString>("name");
    QTest::addColumn<int>("index");

    QTest::newRow("single checkpoint before a couple") << "single" << 0;
    QTest::newRow("first member of a couple") << "first" << 1;
    QTest::newRow("second member counts the couple twice") << "second" << 2;
    QTest::newRow("single checkpoint after a couple") << "last" << 3;
    QTest::newRow("checkpoint with an equal name outside the list") << "stranger" << -1;
    QTest::newRow("empty handle") << "" << -1;
}

void tst_Domain::checkZoneIndex()
{
    QFETCH(QString, name);
    QFETCH(int, index);

    const auto first = makeCheckPoint("first");
    const auto second = makeCheckPoint("second");
    QCJobTemplate jobTemplate;
    jobTemplate.setCheckListItems(
        {makeCheckPoint("single"), makeCouple("A", first, second), makeCheckPoint("last")});
    QCOMPARE(names(jobTemplate.checkPoints()), QStringList({"single", "first", "second", "last"}));

    std::shared_ptr<CheckPoint> wanted;
    for (const auto& checkPoint : jobTemplate.checkPoints()) {
        if (QString::fromStdString(checkPoint->name()) == name)
            wanted = checkPoint;
    }
    // Looked up by identity: a copy with the same id and name is not in the list.
    if (name == "stranger")
        wanted = ObjectCodec::clone(*first);

    QCOMPARE(int(jobTemplate.checkZoneIndex(wanted)), index);
}

void tst_Domain::appearanceValuesPastTheEndAreNull()
{
    const auto standard = makeStandard("RAL 9010");
    QCOMPARE(standard->appearanceValues(1), standard->appearanceValuesList()[1]);
    QVERIFY(!standard->appearanceValues(2));
}

void tst_Domain::librariesStoreMemberIdsOnly_data()
{
    QTest::addColumn<QString>("kind");
    QTest::newRow("colour standards library") << "standards";
    QTest::newRow("property library") << "properties";
}

void tst_Domain::librariesStoreMemberIdsOnly()
{
    QFETCH(QString, kind);
    const TestLibrary libraryCase = TestLibrary::make(kind);
    const auto& members = libraryCase.members;

    std::vector<std::string> ids;
    for (const auto& member : members)
        ids.push_back(member->id());
    QCOMPARE(libraryCase.library->referencedIds(), ids);

    const QByteArray bytes = ObjectCodec::serialize(*libraryCase.library);
    const QCborArray stored = QCborValue::fromCbor(bytes).toMap().value(libraryCase.idsField).toArray();
    QCOMPARE(stored.size(), qsizetype(ids.size()));
    for (int i = 0; i < stored.size(); ++i)
        QCOMPARE(stored.at(i).toString().toStdString(), ids[std::size_t(i)]);
    for (const auto& member : members)
        QVERIFY2(!bytes.contains(QByteArray::fromStdString(member->name())), member->name().c_str());

    const auto decoded = ObjectCodec::deserialize(bytes);
    QCOMPARE(decoded->referencedIds(), ids);
    auto standIns = TestLibrary::membersOf(*decoded);
    QCOMPARE(standIns.size(), members.size());
    for (const auto& standIn : standIns)
        QVERIFY(standIn->name().empty());

    // The first member is found, the second is unknown, the third resolves to
    // an object of another type; only the first is replaced.
    std::vector<std::string> asked;
    decoded->resolveReferences([&](const std::string& id) -> std::shared_ptr<BaseObject> {
        asked.push_back(id);
        if (id == ids[0])
            return members[0];
        if (id == ids[2])
            return makeCondition();
        return {};
    });
    QCOMPARE(asked, ids);
    const auto resolved = TestLibrary::membersOf(*decoded);
    QCOMPARE(resolved[0], members[0]);
    QCOMPARE(resolved[1], standIns[1]);
    QCOMPARE(resolved[2], standIns[2]);
    QCOMPARE(resolved[2]->id(), ids[2]);
}

void tst_Domain::malformedBytesThrow_data()
{
    QTest::addColumn<QByteArray>("bytes");

    auto fieldMap = [](const BaseObject& object, const QString& key, const QCborValue& value) {
        QCborMap map = toMap(object);
        map.insert(key, value);
        return map;
    };
    auto withField = [&](const BaseObject& object, const QString& key, const QCborValue& value) {
        return fieldMap(object, key, value).toCborValue().toCbor();
    };
    const auto jobTemplate = makeTemplate();
    const QByteArray templateBytes = ObjectCodec::serialize(*jobTemplate);

    QTest::newRow("bytes that are not CBOR") << QByteArray("\xff\xfe\x00 not cbor", 13);
    QTest::newRow("truncated template") << templateBytes.left(templateBytes.size() / 2);
    QTest::newRow("template missing its last byte") << templateBytes.chopped(1);
    QTest::newRow("top level is not a map") << QCborValue(42).toCbor();
    QTest::newRow("top level is null") << QCborValue(QCborValue::Null).toCbor();

    QCborMap unknown = toMap(Position(1, 2));
    unknown.insert(QStringLiteral("type"), QStringLiteral("vemi.NoSuchType"));
    QTest::newRow("unknown type id") << unknown.toCborValue().toCbor();
    QCborMap untyped = toMap(Position(1, 2));
    untyped.remove(QStringLiteral("type"));
    QTest::newRow("missing type id") << untyped.toCborValue().toCbor();

    QTest::newRow("tag definition of an unknown value kind")
        << withField(*makeTagDefinition(), "valueKind", QStringLiteral("colour"));
    QTest::newRow("check list holding a standard")
        << withField(*jobTemplate, "checkListItems", QCborArray{ObjectCodec::encode(*makeStandard("S"))});
    QTest::newRow("check list holding a number")
        << withField(*jobTemplate, "checkListItems", QCborArray{7});
    QTest::newRow("check list that is a map")
        << withField(*jobTemplate, "checkListItems", ObjectCodec::encode(*makeCheckPoint("P")));
    QTest::newRow("schematic image holding a position")
        << withField(*jobTemplate, "schematicImage", ObjectCodec::encode(Position()));
    QTest::newRow("measurement configuration holding text")
        << withField(*jobTemplate, "measurementConfiguration", QStringLiteral("M1"));
    QTest::newRow("repeat flag holding text") << withField(*jobTemplate, "enableRepeat", QStringLiteral("yes"));
    QTest::newRow("name holding an integer") << withField(*jobTemplate, "name", 12);
    QTest::newRow("couple member of the wrong type")
        << withField(*makeCouple("A", makeCheckPoint("1"), makeCheckPoint("2")), "checkPoints",
                     QCborArray{ObjectCodec::encode(Size())});
    QTest::newRow("property key holding an integer") << withField(Property("k", "v"), "key", 42);
    QTest::newRow("image data holding text") << withField(*makeImage("i"), "imageData", QStringLiteral("AAE="));
    QTest::newRow("coordinate holding text") << withField(Position(), "x", QStringLiteral("3"));
    QTest::newRow("lab value holding text") << withField(*makeLab(), "L", QStringLiteral("50"));
    QTest::newRow("allowed values holding a number") << withField(*makeTagDefinition(), "allowedValues", QCborArray{1});
    QTest::newRow("library ids holding an object")
        << withField(ColorStandardsLibrary(), "standardIds", QCborArray{ObjectCodec::encode(*makeStandard("S"))});
    QTest::newRow("nested tag value with a wrong field")
        << withField(*jobTemplate, "tagValues", QCborArray{fieldMap(TagValue(), "value", 1.5)});
    // Must fail cleanly rather than exhaust the stack.
    QTest::newRow("arrays nested a thousand deep") << QByteArray(1000, '\x81') + QByteArray(1, '\x00');
    QTest::newRow("byte string declaring a gigabyte") << QByteArray::fromHex("5b0000000040000000616263");
    QTest::newRow("image data holding a foreign tagged value")
        << withField(*makeImage("i"), "imageData", QCborValue(QCborTag(0x51434A42), 0));
}

void tst_Domain::malformedBytesThrow()
{
    QFETCH(QByteArray, bytes);
    QVERIFY_EXCEPTION_THROWN(ObjectCodec::deserialize(bytes), DecodeError);
}

void tst_Domain::snapshotIsUnaffectedByLaterEdits()
{
    auto jobTemplate = makeTemplate();
    const QByteArray expected = ObjectCodec::serialize(*jobTemplate);
    const ObjectSnapshot snapshot = ObjectCodec::snapshot(*jobTemplate);

    jobTemplate->schematicImage()->setImageData({1, 2, 3});
    jobTemplate->setName("Edited after the snapshot");
    jobTemplate->setCheckListItems({});

    QCOMPARE(snapshot.toCbor(), expected);
}

void tst_Domain::cloneSharesImageBytes()
{
    auto jobTemplate = makeTemplate();
    const auto copy = ObjectCodec::clone(*jobTemplate);
    QVERIFY(copy && copy.get() != jobTemplate.get());
    QCOMPARE(copy->schematicImage()->sharedImageData(), jobTemplate->schematicImage()->sharedImageData());
    QCOMPARE(ObjectCodec::serialize(*copy), ObjectCodec::serialize(*jobTemplate));

    // Replacing the bytes of one leaves the other as it was.
    copy->schematicImage()->setImageData({9});
    QCOMPARE(jobTemplate->schematicImage()->imageData(), kImageBytes);
}

QTEST_APPLESS_MAIN(tst_Domain)

#include "tst_domain.moc"
