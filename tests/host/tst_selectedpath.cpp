#include "tests/common/TestMain.h"

#include "host/widgets/SelectedPath.h"

#include <QtTest>

using namespace vemi;

namespace {

std::vector<std::string> toPath(const QStringList& names)
{
    std::vector<std::string> path;
    for (const QString& name : names)
        path.push_back(name.toStdString());
    return path;
}

} // namespace

class tst_SelectedPath : public QObject
{
    Q_OBJECT

private slots:
    void roundTrip_data();
    void roundTrip();
    void readsHandEditedText_data();
    void readsHandEditedText();
};

void tst_SelectedPath::roundTrip_data()
{
    QTest::addColumn<QStringList>("path");
    QTest::addColumn<QString>("text");
    QTest::newRow("top level") << QStringList() << "";
    QTest::newRow("one folder") << QStringList{"Charts"} << "/Charts";
    QTest::newRow("nested folders with blanks") << QStringList{"Charts", "Plant 2"} << "/Charts/Plant 2";
    QTest::newRow("slash inside a name") << QStringList{"A/B", "C"} << "/A\\/B/C";
    QTest::newRow("backslash inside a name") << QStringList{"C:\\Temp"} << "/C:\\\\Temp";
    QTest::newRow("escape before a separator") << QStringList{"x\\", "y"} << "/x\\\\/y";
    QTest::newRow("one empty name differs from the top level") << QStringList{""} << "/";
    QTest::newRow("empty names around a folder") << QStringList{"", "Charts", ""} << "//Charts/";
    QTest::newRow("non-ASCII names") << QStringList{QStringLiteral("Farbmuster Grün"), QStringLiteral("色標準")}
                                     << QStringLiteral("/Farbmuster Grün/色標準");
    QTest::newRow("separators and escapes mixed")
        << QStringList{"\\/\\/", "//", "\\\\"} << "/\\\\\\/\\\\\\//\\/\\//\\\\\\\\";
}

void tst_SelectedPath::roundTrip()
{
    QFETCH(QStringList, path);
    QFETCH(QString, text);

    const std::string written = SelectedPath::pathToString(toPath(path));
    QCOMPARE(QString::fromStdString(written), text);
    QCOMPARE(SelectedPath::pathFromString(written), toPath(path));
}

void tst_SelectedPath::readsHandEditedText_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<QStringList>("path");
    QTest::newRow("missing leading slash") << "Charts/Plant 2" << QStringList{"Charts", "Plant 2"};
    QTest::newRow("backslash before a letter stays") << "/C:\\Temp" << QStringList{"C:\\Temp"};
    QTest::newRow("backslash at the end stays") << "/Charts\\" << QStringList{"Charts\\"};
}

void tst_SelectedPath::readsHandEditedText()
{
    QFETCH(QString, text);
    QFETCH(QStringList, path);

    QCOMPARE(SelectedPath::pathFromString(text.toStdString()), toPath(path));
}

QC_TEST_GUILESS_MAIN(tst_SelectedPath)
#include "tst_selectedpath.moc"
