#include "tests/common/TestMain.h"
#include "tests/common/PipeWithDeadline.h"
#include "tests/common/RecordingDispatcher.h"
#include "tests/common/TempStore.h"

#include "host/domain/CheckPoint.h"
#include "host/domain/Position.h"
#include "host/domain/QCJobTemplate.h"
#include "model/QCJobTemplateModel.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"
#include "host/store/UpdateObject.h"

#include <QtTest>


using namespace vemi;

namespace {

QByteArray bytesOf(const SchematicImage& image)
{
    const auto& data = image.imageData();
    return QByteArray(reinterpret_cast<const char*>(data.data()), int(data.size()));
}

// Not an image on purpose: the model stores the file's bytes without decoding.
QByteArray sampleBytes()
{
    QByteArray bytes("\xFF\xD8\xFF\xE0 stand-in schematic\r\n\0\x01\x02", 26);
    return bytes.repeated(40);
}

void writeFile(const QString& path, const QByteArray& bytes)
{
    QFile file(path);
    QVERIFY(file.open(QIODevice::WriteOnly));
    QCOMPARE(file.write(bytes), qint64(bytes.size()));
}

QPixmap checkeredArea(int width, int height)
{
    QImage image(width, height, QImage::Format_RGB32);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x)
            image.setPixel(x, y, (x + y) % 2 ? qRgb(200, 30, 40) : qRgb(10, 90, 220));
    }
    return QPixmap::fromImage(image);
}

} // namespace

class tst_SchematicImages : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void loadKeepsBytesAndTakesFormatFromPath_data();
    void loadKeepsBytesAndTakesFormatFromPath();
    void failedLoadKeepsStoredPicture_data();
    void failedLoadKeepsStoredPicture();
    void clearEmptiesDataAndSavesAtOnce();
    void failedSaveOfClearedPictureIsReported();
    void checkPointAreaIsStoredAsPng();
    void emptyAreaChangesNothing();

private:
    std::unique_ptr<TempStore> m_store;
    std::shared_ptr<RecordingDispatcher> m_recorder;
    std::unique_ptr<QCJobTemplateModel> m_model;
    std::shared_ptr<QCJobTemplate> m_template;
};

void tst_SchematicImages::init()
{
    m_store = std::make_unique<TempStore>();
    m_recorder = std::make_shared<RecordingDispatcher>();
    m_store->model().setCommandDispatcher("", m_recorder);
    m_model = std::make_unique<QCJobTemplateModel>(m_store->model());
    m_template = std::make_shared<QCJobTemplate>();
    m_model->setJobTemplate(m_template);
    m_recorder->clear();
}

void tst_SchematicImages::cleanup()
{
    m_model.reset();
    m_template.reset();
    m_recorder.reset();
    m_store.reset();
}

void tst_SchematicImages::loadKeepsBytesAndTakesFormatFromPath_data()
{
    QTest::addColumn<QString>("relativePath");
    QTest::addColumn<QString>("format");
    QTest::newRow("last of several dots, case kept") << "part.rev.JPG" << "JPG";
    QTest::newRow("no dot gives the whole path") << "schematic" << "schematic";
    QTest::newRow("dot in a folder name only") << "v1.2/schematic" << "2/schematic";
}

void tst_SchematicImages::loadKeepsBytesAndTakesFormatFromPath()
{
    QFETCH(QString, relativePath);
    QFETCH(QString, format);
    // Relative paths, so that the temporary folder's own name cannot add a dot.
    const QString previousFolder = QDir::currentPath();
    QDir::setCurrent(m_store->folder());
    QDir().mkpath(QFileInfo(relativePath).path());
    writeFile(relativePath, sampleBytes());
    QSignalSpy savable(m_model.get(), &QCJobTemplateModel::sgSetTemplateSavable);

    QString error;
    const bool loaded = m_model->loadSchematicImage("Door panel.jpg", relativePath, &error);
    QDir::setCurrent(previousFolder);

    QVERIFY2(loaded, qPrintable(error));
    const auto& image = *m_template->schematicImage();
    QCOMPARE(bytesOf(image), sampleBytes());
    QCOMPARE(QString::fromStdString(image.format()), format);
    QCOMPARE(image.name(), std::string("Door panel.jpg"));
    QCOMPARE(QString::fromStdString(image.originalFilename()), relativePath);
    QCOMPARE(savable.count(), 0);
    QVERIFY(m_recorder->commands().empty());
}

void tst_SchematicImages::failedLoadKeepsStoredPicture_data()
{
    QTest::addColumn<QString>("fileName");
    QTest::addColumn<QString>("cause");
    QTest::newRow("missing file") << "missing.png" << "No such file";
    QTest::newRow("folder") << "folder.png" << "directory";
    QTest::newRow("empty file") << "empty.png" << "empty";
    QTest::newRow("larger than the limit") << "large.png" << "larger than 10000000 bytes";
    QTest::newRow("named pipe") << "pipe.png" << "not a regular file";
    QTest::newRow("endless device") << "/dev/zero" << "not a regular file";
}

void tst_SchematicImages::failedLoadKeepsStoredPicture()
{
    QFETCH(QString, fileName);
    QFETCH(QString, cause);
    const QDir folder(m_store->folder());
    folder.mkdir("folder.png");
    writeFile(folder.filePath("empty.png"), QByteArray());
    const QString goodPath = folder.filePath("good.jpg");
    writeFile(goodPath, sampleBytes());
    QVERIFY(m_model->loadSchematicImage("good.jpg", goodPath));

    writeFile(folder.filePath("large.png"), QByteArray(10'000'001, 'x'));
    // Should the model open the pipe, the watchdog ends the wait and the row fails.
    PipeWithDeadline pipe(folder.filePath("pipe.png"));
    QVERIFY(pipe.isValid());

    const QString path = fileName.startsWith('/') ? fileName : folder.filePath(fileName);
    QString error;
    QVERIFY(!m_model->loadSchematicImage(fileName, path, &error));
    QVERIFY(!pipe.readerWasStuck());

    QVERIFY2(error.contains(path) && error.contains(cause, Qt::CaseInsensitive), qPrintable(error));
    const auto& image = *m_template->schematicImage();
    QCOMPARE(bytesOf(image), sampleBytes());
    QCOMPARE(image.format(), std::string("jpg"));
    QCOMPARE(image.name(), std::string("good.jpg"));
    QCOMPARE(image.originalFilename(), goodPath.toStdString());
}

void tst_SchematicImages::clearEmptiesDataAndSavesAtOnce()
{
    const auto image = m_template->schematicImage();
    image->setName("Door panel");
    image->setFormat("JPG");
    image->setImageData({1, 2, 3});

    m_model->clearSchematicImage();

    QVERIFY(image->imageData().empty());
    QCOMPARE(image->name(), std::string("Door panel"));
    QCOMPARE(image->format(), std::string("JPG"));
    const auto updates = m_recorder->commandsOf<UpdateObject>();
    QCOMPARE(m_recorder->commands().size(), size_t(1));
    QCOMPARE(updates.size(), size_t(1));
    QCOMPARE(updates.front()->object().get(), static_cast<BaseObject*>(m_template.get()));
}

void tst_SchematicImages::failedSaveOfClearedPictureIsReported()
{
    TempStore store;
    store.reopenReadOnly();
    QCJobTemplateModel model(store.model());
    model.setJobTemplate(m_template);
    QSignalSpy failed(&model, &QCJobTemplateModel::sgTemplateSaveFailed);

    model.clearSchematicImage();

    QVERIFY(failed.wait());
    QCOMPARE(failed.count(), 1);
    const QString message = failed.front().front().toString();
    QVERIFY2(message.contains(QStringLiteral("read-only")), qPrintable(message));
}

void tst_SchematicImages::checkPointAreaIsStoredAsPng()
{
    m_model->addCheckPoint("P0");
    const auto checkPoint = m_model->addCheckPoint("P1");
    const auto image = checkPoint->schematicImage();
    image->setName("kept name");
    image->setOriginalFilename("kept.png");
    const auto oldPosition = checkPoint->position();
    const auto area = checkeredArea(40, 30);
    QSignalSpy savable(m_model.get(), &QCJobTemplateModel::sgSetTemplateSavable);

    QVERIFY(m_model->setCheckPointImage(1, area, QRect(120, 85, 40, 30)));

    QCOMPARE(savable.count(), 1);
    QCOMPARE(checkPoint->schematicImage(), image);
    QCOMPARE(image->format(), std::string("PNG"));
    QCOMPARE(image->name(), std::string("kept name"));
    QCOMPARE(image->originalFilename(), std::string("kept.png"));
    QVERIFY(bytesOf(*image).startsWith("\x89PNG"));
    const QImage decoded = QImage::fromData(bytesOf(*image), "PNG");
    QCOMPARE(decoded.convertToFormat(QImage::Format_RGB32), area.toImage().convertToFormat(QImage::Format_RGB32));
    QVERIFY(checkPoint->position() != oldPosition);
    QCOMPARE(checkPoint->position()->x(), 120);
    QCOMPARE(checkPoint->position()->y(), 85);
    QCOMPARE(checkPoint->size()->width(), 40);
    QCOMPARE(checkPoint->size()->height(), 30);
}

void tst_SchematicImages::emptyAreaChangesNothing()
{
    const auto checkPoint = m_model->addCheckPoint("P0");
    checkPoint->schematicImage()->setImageData({7, 7, 7});
    const auto position = checkPoint->position();
    QSignalSpy savable(m_model.get(), &QCJobTemplateModel::sgSetTemplateSavable);

    QVERIFY(!m_model->setCheckPointImage(0, QPixmap(), QRect(5, 5, 0, 0)));

    QCOMPARE(checkPoint->schematicImage()->imageData(), std::vector<unsigned char>({7, 7, 7}));
    QCOMPARE(checkPoint->position(), position);
    QCOMPARE(savable.count(), 0);
}

QC_TEST_MAIN(tst_SchematicImages)
#include "tst_schematicimages.moc"
