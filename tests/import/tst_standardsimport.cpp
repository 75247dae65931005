#include "tests/common/TestMain.h"
#include "tests/common/ModalAnswer.h"
#include "tests/common/RawConnection.h"
#include "tests/common/TempStore.h"

#include "app/ShellWindow.h"
#include "app/standardsimport/StandardsImport.h"
#include "app/standardsimport/StandardsImportRunner.h"
#include "host/domain/AppearanceValues.h"
#include "host/domain/ColorStandardsLibrary.h"
#include "host/domain/DirEntry.h"
#include "host/domain/LabValue.h"
#include "host/domain/RGBValue.h"
#include "host/domain/Standard.h"
#include "host/store/AddObjectSet.h"
#include "host/store/DirectoryTreeResponse.h"
#include "host/store/ErrorInfo.h"
#include "host/store/GetDirectoryTree.h"
#include "host/store/GetMarloObjects.h"
#include "host/store/GetMarloObjectsResponse.h"

#include <QAction>
#include <QProcess>
#include <QSignalSpy>
#include <QTemporaryDir>

#include <lcms2.h>

#include <cmath>

using namespace vemi;

namespace {

// A CGATS file: keyword lines, the data format and one line per row.
QByteArray cgats(const QByteArray& keywords, const QByteArray& fields, const QList<QByteArray>& rows,
                 int declaredRows = -1)
{
    QByteArray text = "CGATS.17\n" + keywords;
    text += "NUMBER_OF_FIELDS " + QByteArray::number(fields.split(' ').size()) + "\n";
    text += "BEGIN_DATA_FORMAT\n" + fields + "\nEND_DATA_FORMAT\n";
    text += "NUMBER_OF_SETS " + QByteArray::number(declaredRows < 0 ? rows.size() : declaredRows) + "\n";
    text += "BEGIN_DATA\n";
    for (const QByteArray& row : rows)
        text += row + "\n";
    return text + "END_DATA\n";
}

const QByteArray kLabFields = "SAMPLE_ID SAMPLE_NAME LAB_L LAB_A LAB_B";
const QByteArray kD65Keywords = "ILLUMINANT \"D65\"\nOBSERVER \"10\"\n";


std::shared_ptr<DirectoryTreeResponse> tree(TempStore& store, const std::string& type)
{
    return std::dynamic_pointer_cast<DirectoryTreeResponse>(store.run(std::make_shared<GetDirectoryTree>(type)).response);
}

int rowsIn(TempStore& store, const char* table)
{
    return RawConnection(store.path()).scalar(QStringLiteral("SELECT count(*) FROM %1").arg(table)).toInt();
}

std::shared_ptr<LabValue> labOf(const Standard& standard)
{
    const auto appearance = standard.appearanceValues(0);
    return appearance && !appearance->colorValues().empty()
               ? std::dynamic_pointer_cast<LabValue>(appearance->colorValues().front())
               : nullptr;
}

// The screen colour of a Lab value, computed here with Little CMS: Lab to XYZ
// of the illuminant's white, Bradford to D50, then the sRGB profile.
QColor expectedScreenColour(double L, double a, double b, const std::string& illuminant)
{
    cmsCIExyY whiteXyY = illuminant == "D50" ? cmsCIExyY{0.3457, 0.3585, 1.0} : cmsCIExyY{0.3127, 0.3290, 1.0};
    cmsCIEXYZ white;
    cmsxyY2XYZ(&white, &whiteXyY);
    const cmsCIELab lab = {L, a, b};
    cmsCIEXYZ xyz;
    cmsLab2XYZ(&white, &xyz, &lab);
    cmsCIEXYZ adapted;
    cmsAdaptToIlluminant(&adapted, &white, cmsD50_XYZ(), &xyz);
    cmsHPROFILE xyzProfile = cmsCreateXYZProfile();
    cmsHPROFILE srgb = cmsCreate_sRGBProfile();
    cmsHTRANSFORM transform =
        cmsCreateTransform(xyzProfile, TYPE_XYZ_DBL, srgb, TYPE_RGB_8, INTENT_RELATIVE_COLORIMETRIC, 0);
    unsigned char rgb[3] = {};
    cmsDoTransform(transform, &adapted, rgb, 1);
    cmsDeleteTransform(transform);
    cmsCloseProfile(xyzProfile);
    cmsCloseProfile(srgb);
    return QColor(rgb[0], rgb[1], rgb[2]);
}

// Imports the file under its own condition (or the defaults) into the store.
QString importInto(TempStore& store, const QByteArray& file, const QString& fileName = QStringLiteral("colours.txt"))
{
    QString error;
    const auto import = StandardsImport::readBytes(file, fileName, &error);
    if (!import)
        return error;
    const auto set = import->build(import->condition(), QStringLiteral("Imported"), &error);
    if (!set)
        return error;
    const auto answer = store.run(set);
    return answer.error ? answer.error->message() : QString();
}

QString writeFile(const QTemporaryDir& folder, const QString& name, const QByteArray& content)
{
    QFile file(folder.filePath(name));
    if (!file.open(QIODevice::WriteOnly) || file.write(content) != content.size())
        return {};
    return file.fileName();
}

} // namespace

class tst_StandardsImport : public QObject
{
    Q_OBJECT

private slots:
    void importsLibrary_data();
    void importsLibrary();
    void repeatedImportsShareTheirFolders();
    void refusesMalformedFile_data();
    void refusesMalformedFile();
    void failedWriteLeavesStoreUntouched();
    void commandLine_data();
    void commandLine();
    void runnerAsksForMissingCondition_data();
    void runnerAsksForMissingCondition();
    void shellMenuImportsChosenFile();
};

void tst_StandardsImport::importsLibrary_data()
{
    QTest::addColumn<QByteArray>("file");
    QTest::addColumn<QString>("library");
    QTest::addColumn<QString>("condition");
    QTest::addColumn<QStringList>("names");
    QTest::addColumn<QList<double>>("lab"); // L, a, b of each standard in turn

    QTest::newRow("Lab only, condition from keywords")
        << cgats("DESCRIPTOR \"Supplier fan deck\"\nILLUMINANT \"D50\"\nOBSERVER \"2\"\n", kLabFields,
                 {"1 Red 42.43 51.05 28.62", "2 \"Dark Blue\" 28.37 15.42 -49.80", "3 White 95.19 -1.03 2.93"})
        << "Supplier fan deck" << "D50/2" << QStringList{"Red", "Dark Blue", "White"}
        << QList<double>{42.43, 51.05, 28.62, 28.37, 15.42, -49.80, 95.19, -1.03, 2.93};
    QTest::newRow("Lab and spectra: the Lab columns count")
        << cgats("MEASUREMENT_CONDITION \"D65/10\"\n", "SAMPLE_NAME LAB_L LAB_A LAB_B SPECTRAL_NM400 SPECTRAL_NM700",
                 {"Green 54.38 -39.72 32.27 0.1 0.1", "Yellow 81.80 2.67 80.41 0.9 0.9"})
        << "colours" << "D65/10" << QStringList{"Green", "Yellow"}
        << QList<double>{54.38, -39.72, 32.27, 81.80, 2.67, 80.41};
    QTest::newRow("spectra only in percent: Lab computed, greys neutral")
        << cgats("WEIGHTING_FUNCTION \"ILLUMINANT, D50\"\nOBSERVER \"2 degree\"\n",
                 "SAMPLE_NAME SPECTRAL_NM380 SPECTRAL_NM480 SPECTRAL_NM580 SPECTRAL_NM680 SPECTRAL_NM730",
                 {"Paper 100 100 100 100 100", "Grey 50 50 50 50 50"})
        << "colours" << "D50/2" << QStringList{"Paper", "Grey"}
        << QList<double>{100.0, 0.0, 0.0, 116.0 * std::cbrt(0.5) - 16.0, 0.0, 0.0};
    QTest::newRow("spectra only as factors, named by SAMPLE_ID")
        << cgats(kD65Keywords, "SAMPLE_ID nm400 nm500 nm600 nm700", {"P1 1 1 1 1", "P2 0.5 0.5 0.5 0.5"})
        << "colours" << "D65/10" << QStringList{"P1", "P2"}
        << QList<double>{100.0, 0.0, 0.0, 116.0 * std::cbrt(0.5) - 16.0, 0.0, 0.0};
    QTest::newRow("no condition in the file: the defaults")
        << cgats("", kLabFields, {"1 Red 42.43 51.05 28.62"}) << "colours" << "D65/10" << QStringList{"Red"}
        << QList<double>{42.43, 51.05, 28.62};
    QTest::newRow("repeated names numbered past names the file has")
        << cgats(kD65Keywords, kLabFields,
                 {"1 Red 40 50 20", "2 Red 41 50 20", "3 \"Red 2\" 42 50 20", "4 Red 43 50 20"})
        << "colours" << "D65/10" << QStringList{"Red", "Red 3", "Red 2", "Red 4"}
        << QList<double>{40, 50, 20, 41, 50, 20, 42, 50, 20, 43, 50, 20};
    QTest::newRow("names outside ASCII, quoted or not (UTF-8)")
        << cgats(kD65Keywords, kLabFields,
                 {"1 Grün 50 -40 30", "2 \"Rouge éclatant\" 40 60 40", "3 赤 45 65 45"})
        << "colours" << "D65/10" << QStringList{"Grün", "Rouge éclatant", "赤"}
        << QList<double>{50, -40, 30, 40, 60, 40, 45, 65, 45};
    QTest::newRow("names outside ASCII (Latin-1)")
        << cgats(kD65Keywords, kLabFields, {"1 Gr\xfcn 50 -40 30"}) << "colours" << "D65/10"
        << QStringList{"Grün"} << QList<double>{50, -40, 30};
}

void tst_StandardsImport::importsLibrary()
{
    QFETCH(QByteArray, file);
    QFETCH(QString, library);
    QFETCH(QString, condition);
    QFETCH(QStringList, names);
    QFETCH(QList<double>, lab);

    TempStore store;
    QCOMPARE(importInto(store, file), QString());
    const auto libraries = store.fetchAll<ColorStandardsLibrary>(2);
    QCOMPARE(libraries.size(), size_t(1));
    QCOMPARE(QString::fromStdString(libraries[0]->name()), library);
    const auto standards = libraries[0]->standards();
    QStringList storedNames;
    for (const auto& standard : standards)
        storedNames << QString::fromStdString(standard->name());
    QCOMPARE(storedNames, names);
    for (size_t i = 0; i < standards.size(); ++i) {
        const auto value = labOf(*standards[i]);
        QVERIFY(value);
        const double L = lab[int(3 * i)], a = lab[int(3 * i + 1)], b = lab[int(3 * i + 2)];
        const QString where = QStringLiteral("%1: stored %2 %3 %4").arg(names[int(i)]).arg(value->L()).arg(value->a()).arg(value->b());
        QVERIFY2(std::abs(value->L() - L) < 0.01 && std::abs(value->a() - a) < 0.01 && std::abs(value->b() - b) < 0.01,
                 qPrintable(where));
        QCOMPARE(QString::fromStdString(value->colorimetricCondition()), condition);
        const auto rgb = standards[i]->displayRGB();
        QVERIFY(rgb);
        const QColor expected = expectedScreenColour(L, a, b, condition.section('/', 0, 0).toStdString());
        QCOMPARE(QColor(rgb->red(), rgb->green(), rgb->blue()), expected);
    }
}

void tst_StandardsImport::repeatedImportsShareTheirFolders()
{
    TempStore store;
    const QByteArray file = cgats(kD65Keywords, kLabFields, {"1 Red 42 51 28", "2 Blue 28 15 -49"});
    QCOMPARE(importInto(store, file, "fan deck.txt"), QString());
    QCOMPARE(importInto(store, file, "fan deck.txt"), QString());

    const auto libraries = tree(store, ColorStandardsLibrary::typeId());
    QCOMPARE(libraries->folders().size(), size_t(1));
    QCOMPARE(libraries->folders()[0].name, std::string("Imported"));
    QCOMPARE(libraries->entries().size(), size_t(2));
    for (const auto& entry : libraries->entries())
        QCOMPARE(entry->folderId(), libraries->folders()[0].id);
    // Imported/fan deck in the standards tree holds both imports' standards.
    const auto standards = tree(store, Standard::typeId());
    QCOMPARE(standards->folders().size(), size_t(2));
    const auto named = [&](const std::string& name) {
        for (const DirFolder& folder : standards->folders())
            if (folder.name == name)
                return folder;
        return DirFolder{};
    };
    QCOMPARE(named("fan deck").parentId, named("Imported").id);
    QCOMPARE(standards->entries().size(), size_t(4));
    for (const auto& entry : standards->entries())
        QCOMPARE(entry->folderId(), named("fan deck").id);
}

void tst_StandardsImport::refusesMalformedFile_data()
{
    QTest::addColumn<QByteArray>("file");
    QTest::addColumn<QStringList>("message"); // besides the file's name

    QTest::newRow("a letter, not CGATS") << QByteArray("Dear supplier,\nplease find our colours below.\n")
                                         << QStringList{"not a CGATS file"};
    QTest::newRow("a picture") << QByteArray("\x89PNG\r\n\x1a\n\0\0\0\rIHDR", 16) << QStringList{"not a text file"};
    QTest::newRow("no Lab and no spectral data")
        << cgats("", "SAMPLE_ID RGB_R RGB_G RGB_B", {"1 255 0 0"}) << QStringList{"no Lab data", "no spectral data"};
    QTest::newRow("only some Lab columns")
        << cgats("", "SAMPLE_ID LAB_L LAB_A", {"1 50 20"}) << QStringList{"LAB_L, LAB_A and LAB_B"};
    QTest::newRow("a row with too few fields")
        << cgats("", kLabFields, {"1 Red 42 51 28", "2 Blue 28 15", "3 White 95 -1 2"})
        << QStringList{"line 9", "4 values", "5 fields"};
    // One value short, then one too many: Little CMS alone would shift the values in between.
    QTest::newRow("a short row made up by a long one")
        << cgats("", kLabFields, {"1 Red 42 51", "2 Blue 28 15 -49 28"}) << QStringList{"line 8", "4 values"};
    QTest::newRow("a value that is not a number")
        << cgats("", kLabFields, {"1 Red 42 51 28", "2 Blue 28 abc -49"})
        << QStringList{"sample 2", "\"Blue\"", "line 9", "LAB_A", "\"abc\"", "not a number"};
    QTest::newRow("more rows than NUMBER_OF_SETS")
        << cgats("", kLabFields, {"1 Red 42 51 28", "2 Blue 28 15 -49"}, 1)
        << QStringList{"line 6", "NUMBER_OF_SETS is 1", "2 rows"};
    QTest::newRow("fewer rows than NUMBER_OF_SETS")
        << cgats("", kLabFields, {"1 Red 42 51 28"}, 3) << QStringList{"NUMBER_OF_SETS is 3", "1 rows"};
    QTest::newRow("an illuminant without tables")
        << cgats("ILLUMINANT \"D93\"\n", kLabFields, {"1 Red 42 51 28"}) << QStringList{"ILLUMINANT", "D93"};
    QTest::newRow("a string left open")
        << cgats("", kLabFields, {"1 \"Red 42 51 28"}) << QStringList{"line 8", "2 values"};
    QTest::newRow("more fields than NUMBER_OF_FIELDS (Little CMS's own check)")
        << cgats("", kLabFields, {"1 Red 42 51 28"}).replace("NUMBER_OF_FIELDS 5", "NUMBER_OF_FIELDS 3")
        << QStringList{"line 4", "More than NUMBER_OF_FIELDS fields"};
}

void tst_StandardsImport::refusesMalformedFile()
{
    QFETCH(QByteArray, file);
    QFETCH(QStringList, message);
    QString error;
    QVERIFY(!StandardsImport::readBytes(file, QStringLiteral("bad.txt"), &error));
    QVERIFY2(error.startsWith(QStringLiteral("Cannot import \"bad.txt\": ")), qPrintable(error));
    for (const QString& part : message)
        QVERIFY2(error.contains(part), qPrintable(error));
}

// The library and its standards are one write: when any of it fails, the
// folders and standards written before it are rolled back.
void tst_StandardsImport::failedWriteLeavesStoreUntouched()
{
    TempStore store;
    auto existing = std::make_shared<Standard>();
    existing->setName("Already stored");
    QVERIFY(store.save(existing));
    const int objects = rowsIn(store, "objects");

    QString error;
    const auto import =
        StandardsImport::readBytes(cgats(kD65Keywords, kLabFields, {"1 Red 42 51 28"}), "clash.txt", &error);
    QVERIFY(import);
    const auto set = import->build(import->condition(), "Imported", &error);
    QVERIFY(set);
    set->addObject(*existing, AddObjectSet::kTopLevel); // its id is taken: the last write fails
    QVERIFY(store.run(set).error);
    QCOMPARE(rowsIn(store, "objects"), objects);
    QCOMPARE(rowsIn(store, "folders"), 0);
}

void tst_StandardsImport::commandLine_data()
{
    QTest::addColumn<QByteArray>("file");
    QTest::addColumn<QStringList>("options");
    QTest::addColumn<int>("exitCode");
    QTest::addColumn<QString>("said"); // on stdout for 0, on stderr otherwise
    QTest::addColumn<QString>("condition"); // of the stored Lab values; empty: nothing stored

    const QByteArray plain = cgats("", kLabFields, {"1 Red 42 51 28", "2 Blue 28 15 -49"});
    QTest::newRow("no condition: the defaults, said") << plain << QStringList() << 0 << "imported as D65/10"
                                                      << "D65/10";
    QTest::newRow("no condition: --condition") << plain << QStringList{"--condition", "D50/2"} << 0
                                               << "imported as D50/2" << "D50/2";
    QTest::newRow("the file's condition over --condition")
        << cgats("ILLUMINANT \"A\"\nOBSERVER \"10\"\n", kLabFields, {"1 Red 42 51 28"})
        << QStringList{"--condition", "D50/2"} << 0 << "A/10" << "A/10";
    QTest::newRow("into another folder") << plain << QStringList{"--folder", "Suppliers"} << 0
                                         << "in the folder \"Suppliers\"" << "D65/10";
    QTest::newRow("malformed file") << cgats("", kLabFields, {"1 Red 42 51 28", "2 Blue 28 15"}) << QStringList()
                                    << 2 << "line 9" << "";
    QTest::newRow("unknown --condition") << plain << QStringList{"--condition", "D65/7"} << 2 << "--condition D65/7"
                                         << "";
}

void tst_StandardsImport::commandLine()
{
    QFETCH(QByteArray, file);
    QFETCH(QStringList, options);
    QFETCH(int, exitCode);
    QFETCH(QString, said);
    QFETCH(QString, condition);

    QTemporaryDir folder;
    const QString path = writeFile(folder, QStringLiteral("colours.cgats"), file);
    QVERIFY(!path.isEmpty());
    TempStore store;
    QProcess shell;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.insert(QStringLiteral("QT_QPA_PLATFORM"), QStringLiteral("offscreen"));
    shell.setProcessEnvironment(environment);
    shell.start(QStringLiteral(QCHOST), QStringList{"--store", store.path(), "--import-standards", path} + options);
    QVERIFY(shell.waitForFinished(60000));
    const QString out = QString::fromUtf8(shell.readAllStandardOutput());
    const QString err = QString::fromUtf8(shell.readAllStandardError());
    QCOMPARE(shell.exitCode(), exitCode);
    QVERIFY2((exitCode == 0 ? out : err).contains(said), qPrintable(out + err));
    if (exitCode != 0)
        QVERIFY2(err.contains(QStringLiteral("\"colours.cgats\"")), qPrintable(err));

    const auto standards = store.fetchAll<Standard>();
    if (condition.isEmpty()) {
        QCOMPARE(rowsIn(store, "objects"), 0);
        QCOMPARE(rowsIn(store, "folders"), 0);
        return;
    }
    QVERIFY(!standards.empty());
    for (const auto& standard : standards)
        QCOMPARE(QString::fromStdString(labOf(*standard)->colorimetricCondition()), condition);
}

void tst_StandardsImport::runnerAsksForMissingCondition_data()
{
    QTest::addColumn<QByteArray>("file");
    QTest::addColumn<QString>("answer"); // empty: the user cancels
    QTest::addColumn<int>("questions");
    QTest::addColumn<QString>("condition"); // stored; empty: nothing stored

    const QByteArray plain = cgats("", kLabFields, {"1 Red 42 51 28"});
    QTest::newRow("asked, answered") << plain << "D50/2" << 1 << "D50/2";
    QTest::newRow("asked, cancelled") << plain << "" << 1 << "";
    QTest::newRow("the file names it: not asked") << cgats(kD65Keywords, kLabFields, {"1 Red 42 51 28"}) << "A/2" << 0
                                                  << "D65/10";
    QTest::newRow("malformed: not asked") << cgats("", kLabFields, {"1 Red 42 51"}) << "D50/2" << 0 << "";
}

void tst_StandardsImport::runnerAsksForMissingCondition()
{
    QFETCH(QByteArray, file);
    QFETCH(QString, answer);
    QFETCH(int, questions);
    QFETCH(QString, condition);

    QTemporaryDir folder;
    const QString path = writeFile(folder, QStringLiteral("colours.txt"), file);
    TempStore store;
    QWidget window;
    StandardsImportRunner runner(store.model(), &window);
    int asked = 0;
    runner.setConditionAsker([&](QWidget*, const StandardsImport&) {
        ++asked;
        return answer.isEmpty() ? std::nullopt : StandardsImport::parseCondition(answer);
    });
    QSignalSpy finished(&runner, &StandardsImportRunner::finished);
    QVERIFY(runner.start(path, QStringLiteral("Imported")));
    QVERIFY(!runner.start(path, QStringLiteral("Imported"))); // one at a time
    QVERIFY(finished.wait(20000));
    QCOMPARE(asked, questions);
    const bool imported = finished.first().at(0).toBool();
    const QString message = finished.first().at(1).toString();
    QCOMPARE(imported, !condition.isEmpty());
    QVERIFY2(message.contains(QStringLiteral("\"colours.txt\"")), qPrintable(message));
    if (imported)
        QCOMPARE(message, QStringLiteral("Imported 1 standard from \"colours.txt\" into the library \"colours\" in the"
                                         " folder \"Imported\"."));
    QVERIFY(!runner.isRunning());
    if (condition.isEmpty()) {
        QCOMPARE(rowsIn(store, "objects"), 0);
        return;
    }
    const auto standards = store.fetchAll<Standard>();
    QCOMPARE(standards.size(), size_t(1));
    QCOMPARE(QString::fromStdString(labOf(*standards[0])->colorimetricCondition()), condition);
}

// Tools → Import Standards…: the file dialog, the import, the closing message.
void tst_StandardsImport::shellMenuImportsChosenFile()
{
    QTemporaryDir folder;
    const QString path = writeFile(folder, QStringLiteral("deck.it8"),
                                   cgats(kD65Keywords, kLabFields, {"1 Red 42 51 28", "2 Blue 28 15 -49"}));
    TempStore store;
    ShellWindow window(store.model(), {});
    window.show();
    QVERIFY(window.importStandardsAction());
    QCOMPARE(window.importStandardsAction()->text(), QStringLiteral("&Import Standards…"));

    QString filter;
    window.setImportFileChooser([&](QWidget*, const QString&, const QString& nameFilter) {
        filter = nameFilter;
        return path;
    });
    QString report;
    ModalAnswer::clickInNextMessageBox(QMessageBox::Ok, &report);
    QSignalSpy finished(window.importRunner(), &StandardsImportRunner::finished);
    window.importStandardsAction()->trigger();
    QTRY_VERIFY_WITH_TIMEOUT(!report.isEmpty(), 20000);
    QCOMPARE(filter, QStringLiteral("CGATS files (*.txt *.cgats *.it8);;All files (*)"));
    QVERIFY2(report.contains(QStringLiteral("Imported 2 standards from \"deck.it8\"")), qPrintable(report));
    QCOMPARE(finished.size(), 1);
    QVERIFY(window.importStandardsAction()->isEnabled());
    QCOMPARE(store.fetchAll<Standard>().size(), size_t(2));
}

QC_TEST_MAIN(tst_StandardsImport)
#include "tst_standardsimport.moc"
