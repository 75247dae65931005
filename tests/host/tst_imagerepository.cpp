#include "tests/common/TestMain.h"

#include "host/domain/ObjectRegistry.h"
#include "host/domain/Standard.h"
#include "host/domain/Tolerance.h"
#include "host/widgets/ImageRepository.h"

using vemi::ImageRepository;

class tst_ImageRepository : public QObject
{
    Q_OBJECT

private slots:
    void everyTypeHasAnIcon_data();
    void everyTypeHasAnIcon();
    void typesShareOrOwnTheirDrawing_data();
    void typesShareOrOwnTheirDrawing();
};

namespace {

QImage imageOf(const QIcon& icon)
{
    return icon.pixmap(16, 16).toImage().convertToFormat(QImage::Format_ARGB32);
}

} // namespace

void tst_ImageRepository::everyTypeHasAnIcon_data()
{
    QTest::addColumn<QString>("typeId");
    QTest::addColumn<int>("brightness");

    for (const std::string& typeId : vemi::ObjectRegistry::typeIds()) {
        QTest::addRow("%s on a light background", typeId.c_str()) << QString::fromStdString(typeId) << 0;
        QTest::addRow("%s on a dark background", typeId.c_str()) << QString::fromStdString(typeId) << 1;
    }
    QTest::newRow("unknown type") << "vemi.NoSuchType" << 0;
    QTest::newRow("empty type id") << "" << 1;
}

void tst_ImageRepository::everyTypeHasAnIcon()
{
    QFETCH(QString, typeId);
    QFETCH(int, brightness);

    const QIcon icon = ImageRepository::instance().iconForType(typeId.toStdString(), brightness);
    const QImage image = imageOf(icon);
    // A drawing, not a transparent square: some pixel is opaque.
    bool anyOpaque = false;
    for (int y = 0; y < image.height() && !anyOpaque; ++y)
        for (int x = 0; x < image.width() && !anyOpaque; ++x)
            anyOpaque = qAlpha(image.pixel(x, y)) == 255;
    QVERIFY(anyOpaque);
}

void tst_ImageRepository::typesShareOrOwnTheirDrawing_data()
{
    QTest::addColumn<QString>("first");
    QTest::addColumn<QString>("second");
    QTest::addColumn<bool>("same");

    QTest::newRow("a Lab tolerance looks like a tolerance") << "vemi.LabToleranceBase" << "vemi.Tolerance" << true;
    QTest::newRow("a tag value looks like its definition") << "vemi.TagValue" << "vemi.TagDefinition" << true;
    QTest::newRow("an unknown type looks generic") << "vemi.NoSuchType" << "vemi.Position" << true;
    QTest::newRow("a tolerance differs from its set") << "vemi.Tolerance" << "vemi.ToleranceSet" << false;
    QTest::newRow("a standard differs from the generic icon") << "vemi.Standard" << "vemi.NoSuchType" << false;
    QTest::newRow("a template differs from a standard") << "vemi.QCJobTemplate" << "vemi.Standard" << false;
}

void tst_ImageRepository::typesShareOrOwnTheirDrawing()
{
    QFETCH(QString, first);
    QFETCH(QString, second);
    QFETCH(bool, same);

    const ImageRepository& images = ImageRepository::instance();
    QCOMPARE(imageOf(images.iconForType(first.toStdString())) == imageOf(images.iconForType(second.toStdString())),
             same);
}

QC_TEST_MAIN(tst_ImageRepository)
#include "tst_imagerepository.moc"
