#include "tests/common/ModalAnswer.h"
#include "tests/common/PipeWithDeadline.h"
#include "tests/common/TempStore.h"
#include "tests/common/TestMain.h"

#include "checkpoints/CheckZoneEditor.h"
#include "checkpoints/SchematicGraphicsView.h"
#include "detail/GraphicsZoomView.h"
#include "detail/QCJobTemplateDetailWidget.h"
#include "host/client/GeneralSettings.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/Position.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"
#include "model/QCJobTemplateModel.h"
#include "plugin/PellamSettingsKeys.h"

#include <QAbstractButton>
#include <QBuffer>
#include <QGraphicsEllipseItem>
#include <QGraphicsPixmapItem>
#include <QGraphicsRectItem>
#include <QGraphicsSimpleTextItem>
#include <QLabel>
#include <QMouseEvent>
#include <QRubberBand>
#include <QScrollBar>
#include <QtEndian>

Q_DECLARE_METATYPE(std::shared_ptr<vemi::QCJobTemplate>)

using namespace vemi;

namespace {

const QString kStoredName = QStringLiteral("Stored panel.png");

QByteArray encoded(const QImage& image, const char* format)
{
    QByteArray bytes;
    QBuffer buffer(&bytes);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, format);
    return bytes;
}

QImage filled(QSize size, QColor colour)
{
    QImage image(size, QImage::Format_RGB32);
    image.fill(colour);
    return image;
}

// Every pixel differs from its neighbours, so a cut-out shows where it came from.
QImage distinctPicture(QSize size)
{
    QImage image(size, QImage::Format_RGB32);
    for (int y = 0; y < size.height(); ++y) {
        for (int x = 0; x < size.width(); ++x)
            image.setPixel(x, y, qRgb(x % 256, y % 256, ((x / 256) << 4) | (y / 256)));
    }
    return image;
}

// Decoders ignore what follows the end of a picture: this pads a real
// picture to an exact length.
QByteArray padded(QByteArray bytes, int length)
{
    bytes.append(QByteArray(length - bytes.size(), '\0'));
    return bytes;
}

quint32 crc32(const QByteArray& bytes)
{
    quint32 crc = 0xFFFFFFFFu;
    for (const char c : bytes) {
        crc ^= quint8(c);
        for (int bit = 0; bit < 8; ++bit)
            crc = (crc >> 1) ^ (0xEDB88320u & (0u - (crc & 1u)));
    }
    return ~crc;
}

// A small real PNG whose header declares another size (with a valid checksum).
QByteArray pngDeclaring(int width, int height)
{
    QByteArray png = encoded(filled(QSize(2, 2), Qt::gray), "PNG");
    // Signature (8), IHDR length (4), "IHDR" (4), width (4), height (4).
    qToBigEndian(quint32(width), png.data() + 16);
    qToBigEndian(quint32(height), png.data() + 20);
    qToBigEndian(crc32(png.mid(12, 17)), png.data() + 29);
    return png;
}

// A small real JPEG whose frame header declares another size.
QByteArray jpegDeclaring(int width, int height)
{
    QByteArray jpeg = encoded(filled(QSize(8, 8), Qt::gray), "JPEG");
    const int frame = jpeg.indexOf(QByteArray("\xFF\xC0", 2));
    // Marker (2), length (2), precision (1), height (2), width (2).
    qToBigEndian(quint16(height), jpeg.data() + frame + 5);
    qToBigEndian(quint16(width), jpeg.data() + frame + 7);
    return jpeg;
}

QByteArray bytesOf(const SchematicImage& image)
{
    const auto& data = image.imageData();
    return QByteArray(reinterpret_cast<const char*>(data.data()), int(data.size()));
}

std::shared_ptr<SchematicImage> schematic(const QByteArray& bytes, const std::string& format, const QString& name)
{
    auto image = std::make_shared<SchematicImage>();
    image->setName(name.toStdString());
    image->setFormat(format);
    image->setImageData(std::vector<unsigned char>(bytes.cbegin(), bytes.cend()));
    return image;
}

void writeFile(const QString& path, const QByteArray& bytes)
{
    QFile file(path);
    QVERIFY(file.open(QIODevice::WriteOnly));
    QCOMPARE(file.write(bytes), qint64(bytes.size()));
}

void moveMouse(QWidget* viewport, QPoint pos)
{
    QMouseEvent move(QEvent::MouseMove, pos, viewport->mapToGlobal(pos), Qt::NoButton, Qt::LeftButton,
                     Qt::NoModifier);
    QApplication::sendEvent(viewport, &move);
}

// Padded above the size below which a stored schematic counts as none.
void addOversizedRows()
{
    QTest::newRow("PNG declaring 60000 x 60000") << padded(pngDeclaring(60000, 60000), 200) << "60000 × 60000";
    QTest::newRow("JPEG declaring 30000 x 30000") << padded(jpegDeclaring(30000, 30000), 400) << "30000 × 30000";
    QTest::newRow("one side over 20000") << padded(pngDeclaring(20001, 8), 200) << "20001 × 8";
    QTest::newRow("over 100 megapixels") << padded(pngDeclaring(10001, 10000), 200) << "10001 × 10000";
}

// Large enough to be shown when stored.
QByteArray storedPicture()
{
    return encoded(distinctPicture(QSize(40, 30)), "PNG");
}

} // namespace

class tst_SchematicPane : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void init();
    void cleanup();

    void storedSchematicIsShownAboveAHundredBytes_data();
    void storedSchematicIsShownAboveAHundredBytes();
    void storedOversizedPictureIsNotDecoded_data();
    void storedOversizedPictureIsNotDecoded();
    void chosenFileIsShownAndStored_data();
    void chosenFileIsShownAndStored();
    void refusedFileKeepsTheStoredSchematic_data();
    void refusedFileKeepsTheStoredSchematic();
    void unreadableChoiceKeepsTheStoredSchematic_data();
    void unreadableChoiceKeepsTheStoredSchematic();
    void fileDialogStartsBesideTheLastChosenFile();
    void clearAsksFirst_data();
    void clearAsksFirst();
    void failedSaveIsShown();
    void overlayColoursAndNumber_data();
    void overlayColoursAndNumber();
    void overlayIsReplacedNotPiledUp();
    void areaIsCutFromTheBand_data();
    void areaIsCutFromTheBand();
    void emptyBandTakesNothing_data();
    void emptyBandTakesNothing();
    void wheelZoomsOnlyWithControl_data();
    void wheelZoomsOnlyWithControl();

private:
    void open(std::shared_ptr<SchematicImage> image);
    void openDistinctPicture();
    void chooseFile(const QString& path);
    // Where no dialog is expected, one that shows is closed after a while
    // (and noted) so that the test fails instead of hanging.
    void closeUnexpectedModal();
    void drag(QPoint from, QPoint to);
    QList<QGraphicsItem*> itemsOfType(int type) const;
    void expectStoredSchematicUnchanged(const QByteArray& bytes);

    std::unique_ptr<TempStore> m_store;
    std::shared_ptr<QCJobTemplateModel> m_model;
    std::shared_ptr<QCJobTemplate> m_template;
    std::unique_ptr<QCJobTemplateDetailWidget> m_widget;
    std::unique_ptr<QSignalSpy> m_modified;
    SchematicGraphicsView* m_view = nullptr;
    CheckZoneEditor* m_editor = nullptr;
    bool m_unexpectedModal = false;
};

void tst_SchematicPane::initTestCase()
{
    qRegisterMetaType<std::shared_ptr<QCJobTemplate>>("std::shared_ptr<vemi::QCJobTemplate>");
}

void tst_SchematicPane::init()
{
    QSettings().clear();
    m_store = std::make_unique<TempStore>();
    m_model = std::make_shared<QCJobTemplateModel>(m_store->model());
    auto settings = std::make_shared<GeneralSettings>(std::vector<std::string>{""}, "D65", "10");
    m_widget = std::make_unique<QCJobTemplateDetailWidget>(m_store->model(), nullptr, m_model, settings);
    m_widget->resize(1300, 800);
    m_modified = std::make_unique<QSignalSpy>(m_widget.get(), &QCJobTemplateDetailWidget::sgJobTemplateWasModified);
    m_view = m_widget->findChild<SchematicGraphicsView*>("schematicGraphicsView");
    m_editor = m_widget->findChild<CheckZoneEditor*>("checkZoneEditor");
    QVERIFY(m_view && m_editor);
    m_template = std::make_shared<QCJobTemplate>();
    m_template->setName("Door panel");
}

void tst_SchematicPane::cleanup()
{
    m_modified.reset();
    m_widget.reset();
    m_model.reset();
    m_template.reset();
    m_store.reset();
}

void tst_SchematicPane::open(std::shared_ptr<SchematicImage> image)
{
    m_template->setSchematicImage(std::move(image));
    m_model->setJobTemplate(m_template);
    m_widget->reloadFromModel();
}

void tst_SchematicPane::openDistinctPicture()
{
    open(schematic(encoded(distinctPicture(QSize(1200, 900)), "PNG"), "png", kStoredName));
    m_widget->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_widget.get()));
}

void tst_SchematicPane::chooseFile(const QString& path)
{
    m_widget->setFileChooser([path](QWidget*, const QString&, const QStringList&) { return QStringList{path}; });
}

void tst_SchematicPane::closeUnexpectedModal()
{
    m_unexpectedModal = false;
    QTimer::singleShot(5000, m_widget.get(), [this] {
        if (QWidget* modal = QApplication::activeModalWidget()) {
            m_unexpectedModal = true;
            modal->close();
        }
    });
}

void tst_SchematicPane::drag(QPoint from, QPoint to)
{
    QTest::mousePress(m_view->viewport(), Qt::LeftButton, Qt::NoModifier, from);
    moveMouse(m_view->viewport(), to);
    QTest::mouseRelease(m_view->viewport(), Qt::LeftButton, Qt::NoModifier, to);
}

QList<QGraphicsItem*> tst_SchematicPane::itemsOfType(int type) const
{
    QList<QGraphicsItem*> result;
    for (QGraphicsItem* item : m_view->scene()->items()) {
        if (item->type() == type)
            result << item;
    }
    return result;
}

void tst_SchematicPane::expectStoredSchematicUnchanged(const QByteArray& bytes)
{
    const auto stored = m_template->schematicImage();
    QCOMPARE(bytesOf(*stored), bytes);
    QCOMPARE(QString::fromStdString(stored->name()), kStoredName);
    QCOMPARE(itemsOfType(QGraphicsPixmapItem::Type).size(), 1);
    QCOMPARE(m_modified->count(), 0);
}

void tst_SchematicPane::storedSchematicIsShownAboveAHundredBytes_data()
{
    QTest::addColumn<int>("length");
    QTest::addColumn<QByteArray>("format");
    QTest::addColumn<bool>("shown");
    QTest::newRow("100 bytes count as no picture") << 100 << QByteArray("png") << false;
    QTest::newRow("101 bytes are decoded") << 101 << QByteArray("png") << true;
    // A path without a dot gave the whole path as format; the content decides.
    QTest::newRow("unknown stored format") << 101 << QByteArray("panel") << true;
}

void tst_SchematicPane::storedSchematicIsShownAboveAHundredBytes()
{
    QFETCH(int, length);
    QFETCH(QByteArray, format);
    QFETCH(bool, shown);
    const QByteArray png = encoded(filled(QSize(3, 2), Qt::blue), "PNG");
    QVERIFY2(png.size() < 100, "the picture must fit below the threshold");

    open(schematic(padded(png, length), format.toStdString(), kStoredName));

    const auto pixmaps = itemsOfType(QGraphicsPixmapItem::Type);
    QCOMPARE(pixmaps.size(), shown ? 1 : 0);
    if (shown)
        QCOMPARE(static_cast<QGraphicsPixmapItem*>(pixmaps.first())->pixmap().size(), QSize(3, 2));
    QCOMPARE(m_widget->findChild<QAbstractButton*>("clearSchematicButton")->isEnabled(), shown);
    QCOMPARE(m_widget->findChild<QLabel*>("schematicNameLabel")->text(), kStoredName);
}

void tst_SchematicPane::storedOversizedPictureIsNotDecoded_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QString>("size");
    addOversizedRows();
}

// Opening such a template must not stop on a dialog: the pane says why it is empty.
void tst_SchematicPane::storedOversizedPictureIsNotDecoded()
{
    QFETCH(QByteArray, bytes);
    QFETCH(QString, size);

    open(schematic(bytes, size.startsWith("30000") ? "jpg" : "png", kStoredName));

    QVERIFY(itemsOfType(QGraphicsPixmapItem::Type).isEmpty());
    const auto notices = itemsOfType(QGraphicsSimpleTextItem::Type);
    QCOMPARE(notices.size(), 1);
    const QString text = static_cast<QGraphicsSimpleTextItem*>(notices.first())->text();
    QVERIFY2(text.contains(size) && text.contains(kStoredName), qPrintable(text));
    // The user can still clear the broken picture.
    QVERIFY(m_widget->findChild<QAbstractButton*>("clearSchematicButton")->isEnabled());
}

void tst_SchematicPane::chosenFileIsShownAndStored_data()
{
    QTest::addColumn<QString>("fileName");
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QSize>("pictureSize");
    const QByteArray small = encoded(filled(QSize(40, 30), Qt::red), "PNG");
    QTest::newRow("exactly 10,000,000 bytes") << "limit.png" << padded(small, 10'000'000) << QSize(40, 30);
    QTest::newRow("20000 pixels wide") << "wide.png" << encoded(filled(QSize(20000, 2), Qt::red), "PNG")
                                       << QSize(20000, 2);
    QTest::newRow("content decides, not the name") << "really a png.jpg" << small << QSize(40, 30);
    QTest::newRow("JPEG") << "panel.JPG" << encoded(filled(QSize(16, 8), Qt::red), "JPEG") << QSize(16, 8);
}

void tst_SchematicPane::chosenFileIsShownAndStored()
{
    QFETCH(QString, fileName);
    QFETCH(QByteArray, bytes);
    QFETCH(QSize, pictureSize);
    open(schematic(storedPicture(), "png", kStoredName));
    const QString path = m_store->folder() + '/' + fileName;
    writeFile(path, bytes);
    chooseFile(path);

    closeUnexpectedModal();
    m_widget->findChild<QAbstractButton*>("browseSchematicButton")->click();

    QVERIFY(!m_unexpectedModal);

    const auto stored = m_template->schematicImage();
    QCOMPARE(bytesOf(*stored), bytes);
    QCOMPARE(QString::fromStdString(stored->name()), fileName);
    const auto pixmaps = itemsOfType(QGraphicsPixmapItem::Type);
    QCOMPARE(pixmaps.size(), 1);
    QCOMPARE(static_cast<QGraphicsPixmapItem*>(pixmaps.first())->pixmap().size(), pictureSize);
    QCOMPARE(m_widget->findChild<QLabel*>("schematicNameLabel")->text(), fileName);
    QCOMPARE(m_modified->count(), 1);
    QCOMPARE(QSettings().value(PellamKeys::SchematicImagePath).toString(), path);
}

void tst_SchematicPane::refusedFileKeepsTheStoredSchematic_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QString>("size");
    addOversizedRows();
    QTest::newRow("10,000,001 bytes") << padded(encoded(filled(QSize(4, 4), Qt::red), "PNG"), 10'000'001)
                                      << QString();
    QTest::newRow("not a picture") << QByteArray("just some text, not a picture").repeated(10) << QString();
    QTest::newRow("empty file") << QByteArray() << QString();
}

void tst_SchematicPane::refusedFileKeepsTheStoredSchematic()
{
    QFETCH(QByteArray, bytes);
    QFETCH(QString, size);
    const QByteArray storedBytes = storedPicture();
    open(schematic(storedBytes, "png", kStoredName));
    const QString path = m_store->folder() + QStringLiteral("/chosen.png");
    writeFile(path, bytes);
    chooseFile(path);

    QString text;
    ModalAnswer::clickInNextMessageBox(QMessageBox::Ok, &text);
    m_widget->findChild<QAbstractButton*>("browseSchematicButton")->click();

    if (bytes.size() > 10'000'000)
        QCOMPARE(text, QStringLiteral(" Cannot load chosen.png. Please limit image size to no more than 10 MB."));
    else if (!size.isEmpty())
        QVERIFY2(text.startsWith("Cannot load chosen.png.") && text.contains(size), qPrintable(text));
    else
        QCOMPARE(text, QStringLiteral("Cannot load %1.").arg(path));
    expectStoredSchematicUnchanged(storedBytes);
}

void tst_SchematicPane::unreadableChoiceKeepsTheStoredSchematic_data()
{
    QTest::addColumn<QString>("kind");
    QTest::newRow("named pipe") << "pipe";
    QTest::newRow("endless device") << "/dev/zero";
    QTest::newRow("folder") << "folder";
    QTest::newRow("file removed after choosing") << "missing";
}

// The picture shown and the one stored stay; the user hears which file failed.
void tst_SchematicPane::unreadableChoiceKeepsTheStoredSchematic()
{
    QFETCH(QString, kind);
    const QByteArray storedBytes = storedPicture();
    open(schematic(storedBytes, "png", kStoredName));
    QString path = m_store->folder() + QStringLiteral("/schematic.png");
    std::unique_ptr<PipeWithDeadline> pipe;
    if (kind == "pipe") {
        pipe = std::make_unique<PipeWithDeadline>(path);
        QVERIFY(pipe->isValid());
    } else if (kind == "folder") {
        QVERIFY(QDir().mkpath(path));
    } else if (kind.startsWith('/')) {
        path = kind;
    }
    chooseFile(path);

    QString text;
    ModalAnswer::clickInNextMessageBox(QMessageBox::Ok, &text);
    m_widget->findChild<QAbstractButton*>("browseSchematicButton")->click();

    if (pipe)
        QVERIFY2(!pipe->readerWasStuck(), "the editor waited for a writer on the pipe");
    QCOMPARE(text, QStringLiteral("Cannot load %1.").arg(path));
    QCOMPARE(m_view->toolTip(), QStringLiteral("Select an image for Job Schematic."));
    expectStoredSchematicUnchanged(storedBytes);
}

void tst_SchematicPane::fileDialogStartsBesideTheLastChosenFile()
{
    open(nullptr);
    const QString path = m_store->folder() + QStringLiteral("/panel.png");
    writeFile(path, encoded(filled(QSize(6, 6), Qt::red), "PNG"));
    QStringList directories;
    QStringList filters;
    QStringList answer;
    QWidget* dialogParent = nullptr;
    m_widget->setFileChooser([&](QWidget* parent, const QString& startFolder, const QStringList& nameFilters) {
        dialogParent = parent;
        directories << startFolder;
        filters = nameFilters;
        return answer;
    });
    auto* browse = m_widget->findChild<QAbstractButton*>("browseSchematicButton");

    browse->click(); // cancelled
    answer = QStringList{path, m_store->folder() + QStringLiteral("/other.png")};
    browse->click();
    browse->click();

    const QString desktop = QStandardPaths::standardLocations(QStandardPaths::DesktopLocation).value(0);
    QCOMPARE(directories, (QStringList{desktop, desktop, QDir(m_store->folder()).absolutePath()}));
    QCOMPARE(filters, (QStringList{"Image files (*.jpg *.jpeg *.png *.gif)", "All files (*.*)"}));
    QCOMPARE(dialogParent, static_cast<QWidget*>(m_widget.get()));
    QCOMPARE(QSettings().value(PellamKeys::SchematicImagePath).toString(), path);
}

void tst_SchematicPane::clearAsksFirst_data()
{
    QTest::addColumn<int>("answer");
    QTest::newRow("yes clears") << int(QMessageBox::Yes);
    QTest::newRow("no keeps") << int(QMessageBox::No);
}

void tst_SchematicPane::clearAsksFirst()
{
    QFETCH(int, answer);
    const QByteArray storedBytes = storedPicture();
    open(schematic(storedBytes, "png", kStoredName));
    const bool cleared = answer == QMessageBox::Yes;

    QString text;
    ModalAnswer::clickInNextMessageBox(QMessageBox::StandardButton(answer), &text);
    m_widget->findChild<QAbstractButton*>("clearSchematicButton")->click();

    QCOMPARE(text, QStringLiteral("Are you sure you want to clear the schematic image?"));
    QCOMPARE(bytesOf(*m_template->schematicImage()), cleared ? QByteArray() : storedBytes);
    QCOMPARE(QString::fromStdString(m_template->schematicImage()->name()), kStoredName);
    QCOMPARE(itemsOfType(QGraphicsPixmapItem::Type).size(), cleared ? 0 : 1);
    QCOMPARE(m_widget->findChild<QLabel*>("schematicNameLabel")->text(), cleared ? QString() : kStoredName);
    QCOMPARE(m_modified->count(), cleared ? 1 : 0);
}

void tst_SchematicPane::failedSaveIsShown()
{
    open(nullptr);
    QString text;
    ModalAnswer::clickInNextMessageBox(QMessageBox::Ok, &text);
    emit m_model->sgTemplateSaveFailed(QStringLiteral("database is read-only: /tmp/store.sqlite"));
    QVERIFY2(text.contains("database is read-only: /tmp/store.sqlite"), qPrintable(text));
}

void tst_SchematicPane::overlayColoursAndNumber_data()
{
    QTest::addColumn<int>("ordinal");
    QTest::addColumn<QColor>("circle");
    QTest::addColumn<QColor>("number");
    QTest::newRow("single checkpoint") << 0 << QColor(Qt::red) << QColor(Qt::white);
    QTest::newRow("couple 1") << 1 << QColor(Qt::green) << QColor(Qt::black);
    QTest::newRow("couple 2") << 2 << QColor(Qt::blue) << QColor(Qt::white);
    QTest::newRow("couple 3") << 3 << QColor(Qt::cyan) << QColor(Qt::black);
    QTest::newRow("couple 4") << 4 << QColor(Qt::magenta) << QColor(Qt::black);
    QTest::newRow("couple 5") << 5 << QColor(Qt::yellow) << QColor(Qt::black);
    QTest::newRow("couple 6") << 6 << QColor(Qt::darkRed) << QColor(Qt::white);
    QTest::newRow("couple 11") << 11 << QColor(Qt::darkYellow) << QColor(Qt::white);
    QTest::newRow("couple 12 starts again") << 12 << QColor(Qt::red) << QColor(Qt::white);
    QTest::newRow("couple 13 like couple 1") << 13 << QColor(Qt::green) << QColor(Qt::black);
}

void tst_SchematicPane::overlayColoursAndNumber()
{
    QFETCH(int, ordinal);
    QFETCH(QColor, circle);
    QFETCH(QColor, number);
    open(schematic(encoded(filled(QSize(300, 200), Qt::gray), "PNG"), "png", kStoredName));
    const QRect area(120, 85, 40, 30);

    emit m_editor->sgAddCheckpointToSchematic(6, ordinal, area);

    const auto rects = itemsOfType(QGraphicsRectItem::Type);
    const auto discs = itemsOfType(QGraphicsEllipseItem::Type);
    const auto numbers = itemsOfType(QGraphicsSimpleTextItem::Type);
    QCOMPARE(rects.size(), 1);
    QCOMPARE(discs.size(), 1);
    QCOMPARE(numbers.size(), 1);
    QCOMPARE(static_cast<QGraphicsRectItem*>(rects.first())->rect(), QRectF(area));
    const auto* disc = static_cast<QGraphicsEllipseItem*>(discs.first());
    QCOMPARE(disc->rect(), QRectF(111, 76, 20, 20));
    QCOMPARE(disc->brush().color(), circle);
    QCOMPARE(disc->pen().color(), number);
    const auto* label = static_cast<QGraphicsSimpleTextItem*>(numbers.first());
    QCOMPARE(label->text(), QStringLiteral("7"));
    QCOMPARE(label->brush().color(), number);
    QCOMPARE(label->pos(), QPointF(118, 79));
    // Drawn over the picture.
    QVERIFY(disc->isVisible());
    QVERIFY(m_view->scene()->items(QPointF(121, 86)).first() == label);
}

// Each publication of the check list first empties the overlay; showing
// another picture empties it too.
void tst_SchematicPane::overlayIsReplacedNotPiledUp()
{
    open(schematic(encoded(filled(QSize(300, 200), Qt::gray), "PNG"), "png", kStoredName));
    for (int round = 0; round < 2; ++round) {
        emit m_editor->sgRefreshCheckPointLayer();
        emit m_editor->sgAddCheckpointToSchematic(0, 0, QRect(10, 10, 20, 20));
        emit m_editor->sgAddCheckpointToSchematic(1, 1, QRect(60, 10, 20, 20));
        // A checkpoint without an area has no place on the picture.
        emit m_editor->sgAddCheckpointToSchematic(2, 1, QRect(0, 0, 0, 0));
    }
    QCOMPARE(itemsOfType(QGraphicsEllipseItem::Type).size(), 2);

    m_widget->reloadFromModel();

    QCOMPARE(itemsOfType(QGraphicsEllipseItem::Type).size(), 0);
    QCOMPARE(itemsOfType(QGraphicsPixmapItem::Type).size(), 1);
    emit m_editor->sgAddCheckpointToSchematic(0, 0, QRect(10, 10, 20, 20));
    QCOMPARE(itemsOfType(QGraphicsEllipseItem::Type).size(), 1);
}

void tst_SchematicPane::areaIsCutFromTheBand_data()
{
    QTest::addColumn<QPoint>("from");
    QTest::addColumn<QPoint>("to");
    QTest::addColumn<QSize>("size");
    QTest::newRow("drag longer than the band") << QPoint(10, 10) << QPoint(200, 150) << QSize(55, 55);
    QTest::newRow("small drag") << QPoint(30, 40) << QPoint(70, 65) << QSize(41, 26);
    QTest::newRow("drag up and left") << QPoint(140, 100) << QPoint(60, 70) << QSize(55, 31);
}

void tst_SchematicPane::areaIsCutFromTheBand()
{
    QFETCH(QPoint, from);
    QFETCH(QPoint, to);
    QFETCH(QSize, size);
    openDistinctPicture();
    m_model->addCheckPoint("Handle");
    m_model->addCheckPoint("Trim");
    m_modified->clear();
    QSignalSpy savable(m_model.get(), &QCJobTemplateModel::sgSetTemplateSavable);
    drag(from, to);
    const QRect band(m_view->bandTopLeft(), m_view->bandSize());
    QCOMPARE(band.size(), size);
    // What the user sees inside the band, without the band itself.
    auto* rubberBand = m_view->findChild<QRubberBand*>();
    rubberBand->hide();
    const QImage seen = m_view->grab().toImage().copy(band).convertToFormat(QImage::Format_RGB32);
    rubberBand->show();
    const QPointF scenePos = m_view->mapToScene(band.topLeft());

    emit m_editor->sgGrabRubberBandedArea(1);

    const auto checkPoint = m_model->checkPointAt(1);
    QImage stored;
    QVERIFY(stored.loadFromData(bytesOf(*checkPoint->schematicImage()), "PNG"));
    QCOMPARE(checkPoint->schematicImage()->format(), std::string("PNG"));
    QCOMPARE(stored.convertToFormat(QImage::Format_RGB32), seen);
    QCOMPARE(QSize(checkPoint->size()->width(), checkPoint->size()->height()), size);
    QCOMPARE(QPoint(checkPoint->position()->x(), checkPoint->position()->y()),
             QPoint(int(scenePos.x()), int(scenePos.y())));
    QVERIFY(bytesOf(*m_model->checkPointAt(0)->schematicImage()).isEmpty());
    QCOMPARE(savable.count(), 1);
    QCOMPARE(m_modified->count(), 1);
    // Ready for the next area.
    QVERIFY(rubberBand->isVisible());
    QVERIFY(m_view->bandSize().isEmpty());
}

void tst_SchematicPane::emptyBandTakesNothing_data()
{
    QTest::addColumn<bool>("takeOneFirst");
    QTest::newRow("press without a drag") << false;
    QTest::newRow("again after an area was taken") << true;
}

void tst_SchematicPane::emptyBandTakesNothing()
{
    QFETCH(bool, takeOneFirst);
    openDistinctPicture();
    m_model->addCheckPoint("Handle");
    m_model->addCheckPoint("Trim");
    if (takeOneFirst) {
        drag(QPoint(20, 20), QPoint(50, 50));
        emit m_editor->sgGrabRubberBandedArea(0);
        QVERIFY(!bytesOf(*m_model->checkPointAt(0)->schematicImage()).isEmpty());
    } else {
        QTest::mousePress(m_view->viewport(), Qt::LeftButton, Qt::NoModifier, QPoint(100, 80));
        QTest::mouseRelease(m_view->viewport(), Qt::LeftButton, Qt::NoModifier, QPoint(100, 80));
    }
    QSignalSpy savable(m_model.get(), &QCJobTemplateModel::sgSetTemplateSavable);

    emit m_editor->sgGrabRubberBandedArea(1);

    QVERIFY(bytesOf(*m_model->checkPointAt(1)->schematicImage()).isEmpty());
    QCOMPARE(m_model->checkPointAt(1)->size()->width(), 0);
    QCOMPARE(savable.count(), 0);
}

void tst_SchematicPane::wheelZoomsOnlyWithControl_data()
{
    QTest::addColumn<int>("modifiers");
    QTest::addColumn<bool>("zooms");
    QTest::newRow("control zooms") << int(Qt::ControlModifier) << true;
    QTest::newRow("control and shift scroll") << int(Qt::ControlModifier | Qt::ShiftModifier) << false;
    QTest::newRow("no modifier scrolls") << int(Qt::NoModifier) << false;
}

void tst_SchematicPane::wheelZoomsOnlyWithControl()
{
    QFETCH(int, modifiers);
    QFETCH(bool, zooms);
    openDistinctPicture();
    auto* zoom = m_view->findChild<GraphicsZoomView*>();
    QVERIFY(zoom);
    QSignalSpy zoomed(zoom, &GraphicsZoomView::zoomed);
    QScrollBar* scroll = m_view->verticalScrollBar();
    QVERIFY2(scroll->maximum() > 0, "the picture must be taller than the view");
    const int before = scroll->value();
    const QPoint pos(200, 200);
    const QPoint delta(0, before == scroll->maximum() ? 120 : -120);
    QWheelEvent wheel(pos, m_view->viewport()->mapToGlobal(pos), QPoint(), delta, Qt::NoButton,
                      Qt::KeyboardModifiers(modifiers), Qt::NoScrollPhase, false);

    QApplication::sendEvent(m_view->viewport(), &wheel);

    QCOMPARE(zoomed.count(), zooms ? 1 : 0);
    // The pane's zoom factor base is 1: a zoom step keeps the scale.
    QCOMPARE(m_view->transform(), QTransform());
    if (!zooms)
        QVERIFY(scroll->value() != before);
}

QC_TEST_MAIN(tst_SchematicPane)
#include "tst_schematicpane.moc"
