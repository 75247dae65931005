// Schematic pane benchmarks against plain image decoding.
//
// 1. Choosing a 10 MB PNG or JPEG schematic until it is shown and stored in
//    the template, against one QImageReader decode of the same file.
// 2. Opening a template with 200 checkpoints (a couple among them) and a
//    10 MB schematic, as the browser does (reloadFromModel, then the model's
//    notifyMeasurementConfigLoaded), against decoding the schematic and the
//    200 cut-outs.
// Each result is printed as the ratio of the mean real times (and of the CPU
// times). Choosing starts once the user confirmed the file: the file dialog
// itself is not measured.

#include "detail/QCJobTemplateDetailWidget.h"
#include "host/client/GeneralSettings.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/SchematicImage.h"
#include "host/store/MarloModel.h"
#include "model/QCJobTemplateModel.h"

#include "bench/RecordingReporter.h"

#include "bench/BenchmarkArguments.h"
#include <benchmark/benchmark.h>

#include <QAbstractButton>
#include <QApplication>
#include <QBuffer>
#include <QFile>
#include <QImageReader>
#include <QSettings>
#include <QStandardPaths>
#include <QTemporaryDir>

#include <cmath>
#include <cstdio>
#include <map>
#include <memory>
#include <random>
#include <string>
#include <vector>

namespace {

constexpr qint64 kTargetBytes = 9'800'000;
constexpr int kCheckPoints = 200;
constexpr double kChooseGoal = 1.2;
constexpr double kOpenGoal = 1.5;

// A picture that compresses about as badly as a photograph: noise over soft
// gradients, so that a 10 MB file holds a few megapixels.
QImage noisyPicture(QSize size, std::uint32_t seed)
{
    std::mt19937 generator(seed);
    QImage image(size, QImage::Format_RGB32);
    for (int y = 0; y < size.height(); ++y) {
        auto* line = reinterpret_cast<QRgb*>(image.scanLine(y));
        for (int x = 0; x < size.width(); ++x) {
            const std::uint32_t noise = generator();
            line[x] = qRgb((x / 8 + (noise & 0x3F)) & 0xFF, (y / 8 + ((noise >> 8) & 0x3F)) & 0xFF,
                           ((x + y) / 16 + ((noise >> 16) & 0x3F)) & 0xFF);
        }
    }
    return image;
}

QByteArray encoded(const QImage& image, const char* format, int quality = -1)
{
    QByteArray bytes;
    QBuffer buffer(&bytes);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, format, quality);
    return bytes;
}

// Grows the picture until its file is just under 10 MB.
QByteArray tenMegabytes(const char* format)
{
    QSize size(1600, 1200);
    QByteArray bytes;
    for (int attempt = 0; attempt < 6; ++attempt) {
        bytes = encoded(noisyPicture(size, 7), format, 95);
        const double scale = std::sqrt(double(kTargetBytes) / double(bytes.size()));
        if (bytes.size() <= 10'000'000 && scale < 1.02)
            break;
        size = QSize(int(size.width() * scale * 0.99), int(size.height() * scale * 0.99));
    }
    return bytes;
}

bool writeFile(const QString& path, const QByteArray& bytes)
{
    QFile file(path);
    return file.open(QIODevice::WriteOnly) && file.write(bytes) == bytes.size();
}

// Keeps the mean real time of each benchmark, so that ratios can be printed.

// The editor as the browser holds it: a real store, a model, the widget.
struct Editor
{
    explicit Editor(const QString& storePath)
        : store(storePath)
    {
        store.open();
        model = std::make_shared<QCJobTemplateModel>(store);
        widget = std::make_unique<vemi::QCJobTemplateDetailWidget>(
            store, nullptr, model, std::make_shared<vemi::GeneralSettings>(std::vector<std::string>{""}, "D65", "10"));
        widget->resize(1300, 800);
        widget->show();
    }

    void open(std::shared_ptr<vemi::QCJobTemplate> jobTemplate)
    {
        model->setJobTemplate(std::move(jobTemplate));
        widget->reloadFromModel();
        model->notifyMeasurementConfigLoaded();
    }

    vemi::MarloModel store;
    std::shared_ptr<QCJobTemplateModel> model;
    std::unique_ptr<vemi::QCJobTemplateDetailWidget> widget;
};

void chooseFile(benchmark::State& state, Editor* editor, QString path)
{
    // From the moment the user confirmed the file: the dialog itself is not measured.
    editor->widget->setFileChooser([path](QWidget*, const QString&, const QStringList&) { return QStringList{path}; });
    auto* browse = editor->widget->findChild<QAbstractButton*>("browseSchematicButton");
    const auto stored = editor->model->jobTemplate()->schematicImage();
    for (auto _ : state) {
        browse->click();
        if (!stored || stored->imageData().empty()) {
            state.SkipWithError("the chosen file was not stored");
            break;
        }
        stored->setImageData({});
    }
}

void decodeFile(benchmark::State& state, QString path)
{
    for (auto _ : state) {
        QImageReader reader(path);
        const QImage image = reader.read();
        if (image.isNull()) {
            state.SkipWithError(qPrintable(reader.errorString()));
            break;
        }
        benchmark::DoNotOptimize(image.constBits());
    }
}

std::shared_ptr<vemi::QCJobTemplate> templateWithCheckPoints(QCJobTemplateModel& model, const QByteArray& png)
{
    auto jobTemplate = std::make_shared<vemi::QCJobTemplate>();
    jobTemplate->setName("Dashboard");
    auto schematic = std::make_shared<vemi::SchematicImage>();
    schematic->setName("dashboard.png");
    schematic->setFormat("png");
    schematic->setImageData(std::vector<unsigned char>(png.cbegin(), png.cend()));
    jobTemplate->setSchematicImage(schematic);
    jobTemplate->setMeasurementConfiguration(std::make_shared<vemi::MeasurementConfiguration>());
    model.setJobTemplate(jobTemplate);
    for (int i = 0; i < kCheckPoints; ++i)
        model.addCheckPoint(QStringLiteral("Zone %1").arg(i + 1));
    model.coupleCheckPoints(10, 11, "A");
    for (int i = 0; i < kCheckPoints; ++i) {
        const QImage area = noisyPicture(QSize(55, 55), std::uint32_t(i));
        model.setCheckPointImage(i, QPixmap::fromImage(area), QRect((i % 20) * 60, (i / 20) * 60, 55, 55));
    }
    return jobTemplate;
}

void openTemplate(benchmark::State& state, Editor* editor, std::shared_ptr<vemi::QCJobTemplate> jobTemplate)
{
    editor->model->setJobTemplate(jobTemplate);
    for (auto _ : state) {
        editor->widget->reloadFromModel();
        editor->model->notifyMeasurementConfigLoaded();
    }
}

void decodeTemplatePictures(benchmark::State& state, std::shared_ptr<vemi::QCJobTemplate> jobTemplate)
{
    const auto decode = [](const std::vector<unsigned char>& bytes, const char* format) {
        QImage image;
        image.loadFromData(bytes.data(), int(bytes.size()), format);
        return image;
    };
    for (auto _ : state) {
        const QImage schematic = decode(jobTemplate->schematicImage()->imageData(), "png");
        benchmark::DoNotOptimize(schematic.constBits());
        for (const auto& checkPoint : jobTemplate->checkPoints()) {
            const QImage area = decode(checkPoint->schematicImage()->imageData(), "PNG");
            benchmark::DoNotOptimize(area.constBits());
        }
    }
}

void printRatio(const RecordingReporter& reporter, const char* what, const std::string& measured,
                const std::string& baseline, double goal)
{
    const double a = reporter.meanRealTime(measured);
    const double b = reporter.meanRealTime(baseline);
    if (a < 0 || b <= 0) {
        std::printf("%s: not measured\n", what);
        return;
    }
    // On a busy machine the real times stretch with the load; the CPU times
    // show what the code itself costs.
    std::printf("%s: %.2f (goal <= %.1f; CPU time ratio %.2f)\n", what, a / b, goal,
                reporter.meanCpuTime(measured) / reporter.meanCpuTime(baseline));
}

} // namespace

int main(int argc, char** argv)
{
    BenchmarkArguments arguments(argc, argv);
    if (!arguments.initialize())
        return 1;

    if (!qEnvironmentVariableIsSet("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QStandardPaths::setTestModeEnabled(true);
    QTemporaryDir folder;
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, folder.path());
    QApplication app(arguments.count(), arguments.values());

    const QByteArray png = tenMegabytes("PNG");
    const QByteArray jpeg = tenMegabytes("JPEG");
    const QString pngPath = folder.filePath("schematic.png");
    const QString jpegPath = folder.filePath("schematic.jpg");
    if (!writeFile(pngPath, png) || !writeFile(jpegPath, jpeg)) {
        std::fprintf(stderr, "cannot write the schematic files in %s\n", qPrintable(folder.path()));
        return 1;
    }
    std::printf("schematic files: PNG %d bytes (%dx%d), JPEG %d bytes (%dx%d)\n", png.size(),
                QImageReader(pngPath).size().width(), QImageReader(pngPath).size().height(), jpeg.size(),
                QImageReader(jpegPath).size().width(), QImageReader(jpegPath).size().height());

    Editor chooser(folder.filePath("choose.sqlite"));
    auto empty = std::make_shared<vemi::QCJobTemplate>();
    empty->setName("Empty");
    empty->setSchematicImage(std::make_shared<vemi::SchematicImage>());
    chooser.open(empty);
    Editor opener(folder.filePath("open.sqlite"));
    const auto big = templateWithCheckPoints(*opener.model, png);

    benchmark::RegisterBenchmark("choose_png_until_shown", chooseFile, &chooser, pngPath)->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark("decode_png_once", decodeFile, pngPath)->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark("choose_jpeg_until_shown", chooseFile, &chooser, jpegPath)
        ->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark("decode_jpeg_once", decodeFile, jpegPath)->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark("open_template_200_checkpoints", openTemplate, &opener, big)
        ->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark("decode_schematic_and_200_cutouts", decodeTemplatePictures, big)
        ->Unit(benchmark::kMillisecond);

    RecordingReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    benchmark::Shutdown();

    printRatio(reporter, "choosing a 10 MB PNG until shown and stored / one decode", "choose_png_until_shown",
               "decode_png_once", kChooseGoal);
    printRatio(reporter, "choosing a 10 MB JPEG until shown and stored / one decode", "choose_jpeg_until_shown",
               "decode_jpeg_once", kChooseGoal);
    printRatio(reporter, "opening a template with 200 checkpoints / decoding its pictures",
               "open_template_200_checkpoints", "decode_schematic_and_200_cutouts", kOpenGoal);
    return 0;
}
