// Importing a CGATS file of 5,000 colour standards into a store, against
// Little CMS parsing the same file alone; printed as the ratio of the mean
// real times. The import reads the file with that same parser, checks it,
// converts each sample (display colour included), builds the library and its
// standards and writes them in one store command.

#include "app/standardsimport/StandardsImport.h"
#include "bench/RecordingReporter.h"
#include "host/store/AddObjectSet.h"
#include "host/store/CommandSender.h"
#include "host/store/ErrorInfo.h"
#include "host/store/MarloModel.h"

#include "bench/BenchmarkArguments.h"
#include <benchmark/benchmark.h>
#include <lcms2.h>

#include <QCoreApplication>
#include <QFile>
#include <QTemporaryDir>

#include <cstdio>
#include <memory>
#include <random>

namespace {

constexpr int kSamples = 5000;
constexpr double kRatioGoal = 2.0;
constexpr int kRepetitions = 6;
constexpr double kMinSecondsPerRepetition = 0.5;
constexpr int kAnswerTimeoutMs = 60'000;

const char* const kImportBenchmark = "import_5000_standards_into_store";
const char* const kParseBenchmark = "lcms_parse_same_file";
const char* const kReadBuildBenchmark = "read_check_convert_5000_without_store";

// Lab values as a spectrophotometer exports them: names, ids, two decimals.
QByteArray generatedFile()
{
    std::mt19937 generator(20240601);
    std::uniform_real_distribution<double> lightness(5.0, 95.0);
    std::uniform_real_distribution<double> chroma(-80.0, 80.0);
    QByteArray text = "CGATS.17\nORIGINATOR \"benchmark\"\nILLUMINANT \"D65\"\nOBSERVER \"10\"\n"
                      "NUMBER_OF_FIELDS 5\nBEGIN_DATA_FORMAT\nSAMPLE_ID SAMPLE_NAME LAB_L LAB_A LAB_B\n"
                      "END_DATA_FORMAT\nNUMBER_OF_SETS " + QByteArray::number(kSamples) + "\nBEGIN_DATA\n";
    char row[128];
    for (int i = 1; i <= kSamples; ++i) {
        std::snprintf(row, sizeof row, "%d \"Colour %d\" %.2f %.2f %.2f\n", i, i, lightness(generator),
                      chroma(generator), chroma(generator));
        text += row;
    }
    return text + "END_DATA\n";
}

void lcmsParse(benchmark::State& state, QString path)
{
    const QByteArray file = QFile::encodeName(path);
    for (auto _ : state) {
        cmsHANDLE handle = cmsIT8LoadFromFile(nullptr, file.constData());
        if (!handle || cmsIT8GetPropertyDbl(handle, "NUMBER_OF_SETS") != kSamples) {
            state.SkipWithError("Little CMS could not read the file");
            break;
        }
        benchmark::DoNotOptimize(cmsIT8GetDataRowCol(handle, kSamples - 1, 4));
        cmsIT8Free(handle);
    }
}

// The import up to the store command: what runs before the store's worker
// takes over, to tell the import's own cost from the store's.
void readAndBuild(benchmark::State& state, QString path)
{
    for (auto _ : state) {
        QString error;
        const auto file = vemi::StandardsImport::readFile(path, &error);
        const auto set = file ? file->build(file->condition(), QStringLiteral("Imported"), &error) : nullptr;
        if (!set) {
            state.SkipWithError(qPrintable(error));
            break;
        }
        benchmark::DoNotOptimize(set->objectCount());
    }
}

// Each round imports into a new store, so that no round writes into a file
// the rounds before it have grown.
void importIntoStore(benchmark::State& state, QString path, QString storeFolder)
{
    int round = 0;
    for (auto _ : state) {
        state.PauseTiming();
        auto store = std::make_unique<vemi::MarloModel>(storeFolder + QStringLiteral("/store%1.sqlite").arg(round++));
        const QString opened = store->open();
        state.ResumeTiming();
        if (!opened.isEmpty()) {
            state.SkipWithError(qPrintable(opened));
            break;
        }
        QString error;
        const auto file = vemi::StandardsImport::readFile(path, &error);
        const auto set = file ? file->build(file->condition(), QStringLiteral("Imported"), &error) : nullptr;
        const auto answer = set ? vemi::CommandSender::sendAndWait(*store, std::string(), set, kAnswerTimeoutMs)
                                : vemi::CommandSender::Answer{};
        if (!set || answer.error) {
            state.SkipWithError(qPrintable(answer.error ? answer.error->message() : error));
            break;
        }
        state.PauseTiming();
        store.reset();
        state.ResumeTiming();
    }
}

} // namespace

int main(int argc, char** argv)
{
    BenchmarkArguments arguments(argc, argv);
    if (!arguments.initialize())
        return 1;
    QCoreApplication app(arguments.count(), arguments.values());

    QTemporaryDir folder;
    QFile file(folder.filePath(QStringLiteral("standards.txt")));
    if (!folder.isValid() || !file.open(QIODevice::WriteOnly) || file.write(generatedFile()) < 0) {
        std::fprintf(stderr, "cannot write the generated file in %s\n", qPrintable(folder.path()));
        return 1;
    }
    file.close();

    for (benchmark::internal::Benchmark* registered :
         {benchmark::RegisterBenchmark(kImportBenchmark, importIntoStore, file.fileName(), folder.path()),
          benchmark::RegisterBenchmark(kReadBuildBenchmark, readAndBuild, file.fileName()),
          benchmark::RegisterBenchmark(kParseBenchmark, lcmsParse, file.fileName())}) {
        registered->Unit(benchmark::kMillisecond)
            ->UseRealTime()
            ->Repetitions(kRepetitions)
            ->MinTime(kMinSecondsPerRepetition);
    }

    RecordingReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    const double importTime = reporter.meanRealTime(kImportBenchmark);
    const double parseTime = reporter.meanRealTime(kParseBenchmark);
    const double readBuildTime = reporter.meanRealTime(kReadBuildBenchmark);
    if (importTime > 0.0 && parseTime > 0.0)
        std::printf("import of %d standards / Little CMS parse alone: ratio %.2f (goal <= %.2f)\n", kSamples,
                    importTime / parseTime, kRatioGoal);
    else
        std::printf("import / Little CMS parse: not measured (filtered out or failed)\n");
    if (readBuildTime > 0.0 && parseTime > 0.0)
        std::printf("  of which read, check and convert (no store) / Little CMS parse alone: ratio %.2f\n",
                    readBuildTime / parseTime);
    benchmark::Shutdown();
    return 0;
}
