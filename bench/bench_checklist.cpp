// Check list editor benchmark: rebuilding the rows of a template with 800
// checkpoints against one with 200, in the same run. Every eighth pair of
// checkpoints is a couple and every checkpoint has a cut-out picture, as in a
// template that is in use. Linear work gives a ratio near 4.

#include "checkpoints/CheckZoneEditor.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/CheckPointCouple.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/Position.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"
#include "host/store/MarloModel.h"
#include "model/QCJobTemplateModel.h"

#include "bench/RecordingReporter.h"

#include "bench/BenchmarkArguments.h"
#include <benchmark/benchmark.h>

#include <QApplication>
#include <QBuffer>
#include <QImage>
#include <QTemporaryDir>

#include <cstdio>
#include <map>
#include <memory>
#include <string>
#include <vector>

namespace {

constexpr double kRatioGoal = 4.4;
constexpr int kRepetitions = 5;
constexpr int kEventRounds = 4;
constexpr double kMinSecondsPerRepetition = 0.5;
const char* const kSmall = "checklist_rebuild_200";
const char* const kLarge = "checklist_rebuild_800";

std::vector<unsigned char> cutOut(int seed)
{
    QImage image(40, 40, QImage::Format_RGB32);
    image.fill(QColor::fromHsv(seed * 37 % 360, 200, 220));
    QByteArray bytes;
    QBuffer buffer(&bytes);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, "PNG");
    return std::vector<unsigned char>(bytes.begin(), bytes.end());
}

std::shared_ptr<vemi::CheckPoint> checkPoint(int number)
{
    auto point = std::make_shared<vemi::CheckPoint>();
    point->setName("Checkpoint " + std::to_string(number + 1));
    point->schematicImage()->setImageData(cutOut(number));
    point->setPosition(std::make_shared<vemi::Position>(number % 50 * 20, number / 50 * 20));
    point->setSize(std::make_shared<vemi::Size>(40, 40));
    return point;
}

std::shared_ptr<vemi::QCJobTemplate> templateWith(int checkPoints)
{
    std::vector<std::shared_ptr<vemi::CheckListItem>> items;
    int couples = 0;
    for (int number = 0; number < checkPoints;) {
        if (number % 16 == 0 && number + 1 < checkPoints) {
            auto couple = std::make_shared<vemi::CheckPointCouple>();
            couple->setName(std::string(1, char('A' + couples++ % 26)));
            couple->setCheckPoints({checkPoint(number), checkPoint(number + 1)});
            items.push_back(couple);
            number += 2;
        } else {
            items.push_back(checkPoint(number++));
        }
    }
    auto jobTemplate = std::make_shared<vemi::QCJobTemplate>();
    jobTemplate->setCheckListItems(items);
    jobTemplate->setMeasurementConfiguration(std::make_shared<vemi::MeasurementConfiguration>());
    return jobTemplate;
}

struct Fixture
{
    std::shared_ptr<QCJobTemplateModel> model;
    CheckZoneEditor* editor;
    std::map<std::string, std::shared_ptr<vemi::QCJobTemplate>> templates;
};

// The list is shown, as in the application, and its pending layout and the
// events that follow run within the measured time: that is what the user
// waits for before the next action.
void rebuild(benchmark::State& state, Fixture* fixture, std::string name)
{
    fixture->model->setJobTemplate(fixture->templates.at(name));
    for (auto _ : state) {
        fixture->editor->onMeasurementConfigLoaded();
        // Until the list is laid out and idle: events that the delivery of
        // others posts need further rounds.
        for (int round = 0; round < kEventRounds; ++round) {
            QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
            QCoreApplication::processEvents();
        }
    }
}


} // namespace

int main(int argc, char** argv)
{
    if (!qEnvironmentVariableIsSet("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    BenchmarkArguments arguments(argc, argv);
    if (!arguments.initialize())
        return 1;
    QApplication app(arguments.count(), arguments.values());

    QTemporaryDir folder;
    vemi::MarloModel store(folder.filePath(QStringLiteral("store.sqlite")));
    const QString openError = store.open();
    if (!openError.isEmpty()) {
        std::fprintf(stderr, "%s\n", qPrintable(openError));
        return 1;
    }
    Fixture fixture;
    fixture.model = std::make_shared<QCJobTemplateModel>(store);
    CheckZoneEditor editor;
    editor.init(store, fixture.model);
    editor.resize(480, 700);
    editor.show();
    fixture.editor = &editor;
    fixture.templates = {{kSmall, templateWith(200)}, {kLarge, templateWith(800)}};

    for (const char* name : {kSmall, kLarge}) {
        benchmark::RegisterBenchmark(name, rebuild, &fixture, std::string(name))
            ->Unit(benchmark::kMillisecond)
            ->UseRealTime()
            ->Repetitions(kRepetitions)
            ->MinTime(kMinSecondsPerRepetition);
    }
    RecordingReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    std::fflush(stdout);

    const double small = reporter.meanRealTime(kSmall);
    const double large = reporter.meanRealTime(kLarge);
    if (small > 0.0 && large > 0.0)
        std::printf("check list rebuild 800 / 200 checkpoints: ratio %.2f (goal <= %.1f)\n", large / small,
                    kRatioGoal);
    else
        std::printf("check list rebuild 800 / 200 checkpoints: not measured (filtered out or failed)\n");
    benchmark::Shutdown();
    return 0;
}
