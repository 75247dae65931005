// Object store benchmarks on a PostgreSQL server that the program starts
// itself (a throw-away server in a temporary folder, Unix socket only).
//
// 1. Saving and fetching a job template that carries a 10 MB schematic,
//    against writing and reading the same bytes as one bytea with plain
//    QPSQL statements; printed as the ratio of the mean real times.
// 2. Reading the directory tree of 5,000 entries, PostgreSQL against SQLite.
// 3. Four writer programs saving at once against one writer program doing
//    the same share of saves: the ratio of the wall times.

#include "host/domain/QCJobTemplate.h"
#include "host/domain/SchematicImage.h"
#include "host/store/CommandSender.h"
#include "host/store/CreateFolder.h"
#include "host/store/ErrorInfo.h"
#include "host/store/FolderResponse.h"
#include "host/store/GetDirectoryTree.h"
#include "host/store/DirectoryTreeResponse.h"
#include "host/store/GetMarloObject.h"
#include "host/store/GetMarloObjectResponse.h"
#include "host/store/MarloModel.h"
#include "host/store/PostgresDialect.h"
#include "host/store/UpdateObject.h"
#include "tests/common/TestPostgresServer.h"

#include <benchmark/benchmark.h>

#include <QCoreApplication>
#include <QElapsedTimer>
#include <QProcess>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QTemporaryDir>

#include <cstdio>
#include <algorithm>
#include <map>
#include <random>

namespace {

constexpr std::size_t kSchematicBytes = 10'000'000;
constexpr double kRatioGoal = 1.50;
constexpr int kAnswerTimeoutMs = 120'000;
constexpr int kTreeEntries = 5000;
constexpr int kTreeFolders = 50;
constexpr int kWriters = 4;
constexpr int kSavesPerWriter = 40;
constexpr int kRepetitions = 4;

const char* const kStoreBenchmark = "postgres_store_save_fetch_10MB";
const char* const kRawBenchmark = "raw_qpsql_bytea_write_read_10MB";
const char* const kServerTree = "postgres_directory_tree_5000";
const char* const kFileTree = "sqlite_directory_tree_5000";

std::vector<unsigned char> incompressibleBytes(std::size_t size, std::uint64_t seed)
{
    std::mt19937_64 generator(seed);
    std::vector<unsigned char> bytes(size);
    for (std::size_t i = 0; i < size; ++i)
        bytes[i] = static_cast<unsigned char>(generator());
    return bytes;
}

std::shared_ptr<vemi::QCJobTemplate> templateNamed(const std::string& name, std::vector<unsigned char> image = {})
{
    auto jobTemplate = std::make_shared<vemi::QCJobTemplate>();
    jobTemplate->setName(name);
    auto schematic = std::make_shared<vemi::SchematicImage>();
    schematic->setFormat("png");
    schematic->setImageData(std::move(image));
    jobTemplate->setSchematicImage(schematic);
    return jobTemplate;
}

vemi::CommandSender::Answer run(vemi::MarloModel& model, std::shared_ptr<vemi::Command> command)
{
    return vemi::CommandSender::sendAndWait(model, std::string(), std::move(command), kAnswerTimeoutMs);
}

bool save(vemi::MarloModel& model, const std::shared_ptr<vemi::BaseObject>& object, const std::string* folder = nullptr)
{
    auto update = std::make_shared<vemi::UpdateObject>();
    update->setObject(object);
    if (folder)
        update->setFolderId(*folder);
    const auto answer = run(model, update);
    if (answer.error)
        std::fprintf(stderr, "%s\n", qPrintable(answer.error->message()));
    return !answer.error;
}

// Prints as the console reporter does and keeps the mean real time of each benchmark.
class RecordingReporter : public benchmark::ConsoleReporter
{
public:
    void ReportRuns(const std::vector<Run>& runs) override
    {
        ConsoleReporter::ReportRuns(runs);
        for (const Run& run : runs) {
            if (run.run_type != Run::RT_Iteration || run.error_occurred)
                continue;
            auto& [sum, count] = m_totals[run.run_name.function_name];
            sum += run.GetAdjustedRealTime();
            ++count;
        }
    }
    double mean(const std::string& name) const
    {
        const auto found = m_totals.find(name);
        return found == m_totals.end() ? -1.0 : found->second.first / found->second.second;
    }
    void printRatio(const char* what, const char* measured, const char* baseline, const QString& goal) const
    {
        const double a = mean(measured);
        const double b = mean(baseline);
        if (a > 0 && b > 0)
            std::printf("%s: ratio %.2f%s\n", what, a / b, qPrintable(goal));
        else
            std::printf("%s: not measured (filtered out or failed)\n", what);
    }

private:
    std::map<std::string, std::pair<double, int>> m_totals;
};

void storeSaveAndFetch(benchmark::State& state, vemi::MarloModel* model,
                       std::array<std::shared_ptr<vemi::QCJobTemplate>, 2> versions)
{
    std::size_t round = 0;
    for (auto _ : state) {
        // Two versions of one template, each saved from the revision the other wrote.
        const auto& next = versions[round++ % 2];
        next->setStoredRevision(std::max(versions[0]->storedRevision(), versions[1]->storedRevision()));
        if (!save(*model, next)) {
            state.SkipWithError("the save failed");
            break;
        }
        auto get = std::make_shared<vemi::GetMarloObject>();
        get->setType(vemi::QCJobTemplate::typeId());
        get->setId(next->id());
        const auto response = std::dynamic_pointer_cast<vemi::GetMarloObjectResponse>(run(*model, get).response);
        if (!response || !response->object()) {
            state.SkipWithError("the fetch failed");
            break;
        }
        benchmark::DoNotOptimize(response->object().get());
    }
}

void rawByteaWriteAndRead(benchmark::State& state, const QString* connection,
                          std::array<QByteArray, 2> payloads)
{
    QSqlDatabase database = QSqlDatabase::database(*connection);
    QSqlQuery write(database);
    write.prepare(QStringLiteral("INSERT INTO blobs(id, data) VALUES('blob', ?)"
                                 " ON CONFLICT(id) DO UPDATE SET data = excluded.data"));
    QSqlQuery read(database);
    read.prepare(QStringLiteral("SELECT data FROM blobs WHERE id = 'blob'"));
    std::size_t round = 0;
    for (auto _ : state) {
        write.addBindValue(payloads[round++ % 2]);
        if (!write.exec() || !read.exec() || !read.next() || read.value(0).toByteArray().size() != int(kSchematicBytes)) {
            state.SkipWithError("raw QPSQL write or read failed");
            break;
        }
        read.finish();
    }
}

void directoryTree(benchmark::State& state, vemi::MarloModel* model)
{
    for (auto _ : state) {
        const auto tree = std::dynamic_pointer_cast<vemi::DirectoryTreeResponse>(
            run(*model, std::make_shared<vemi::GetDirectoryTree>(vemi::QCJobTemplate::typeId())).response);
        if (!tree || tree->entries().size() != size_t(kTreeEntries)) {
            state.SkipWithError("the tree was not read whole");
            break;
        }
    }
}

bool fillTree(vemi::MarloModel& model)
{
    std::vector<std::string> folders;
    for (int i = 0; i < kTreeFolders; ++i) {
        const auto answer = run(model, std::make_shared<vemi::CreateFolder>(vemi::QCJobTemplate::typeId(), std::string(),
                                                                            "Folder " + std::to_string(i)));
        const auto folder = std::dynamic_pointer_cast<vemi::FolderResponse>(answer.response);
        if (!folder)
            return false;
        folders.push_back(folder->folder().id);
    }
    for (int i = 0; i < kTreeEntries; ++i) {
        if (!save(model, templateNamed("Template " + std::to_string(i)), &folders[size_t(i % kTreeFolders)]))
            return false;
    }
    return true;
}

// One writer program: saves its share of new templates, then ends.
int runWriter(const QString& address, int saves)
{
    vemi::MarloModel model(address);
    if (!model.open().isEmpty())
        return 1;
    const std::vector<unsigned char> image = incompressibleBytes(100'000, 7);
    for (int i = 0; i < saves; ++i) {
        if (!save(model, templateNamed("Writer template " + std::to_string(i), image)))
            return 1;
    }
    return 0;
}

// Wall time of writers programs, each saving savesEach templates at once.
double writersSeconds(const QString& address, int writers, int savesEach)
{
    std::vector<std::unique_ptr<QProcess>> programs;
    QElapsedTimer clock;
    clock.start();
    for (int i = 0; i < writers; ++i) {
        programs.push_back(std::make_unique<QProcess>());
        programs.back()->start(QCoreApplication::applicationFilePath(),
                               {QStringLiteral("--writer"), address, QString::number(savesEach)});
    }
    for (auto& program : programs) {
        if (!program->waitForFinished(kAnswerTimeoutMs) || program->exitCode() != 0)
            return -1.0;
    }
    return double(clock.nsecsElapsed()) / 1e9;
}

void reportWriters(TestPostgresServer& server)
{
    const QString address = server.createDatabase();
    vemi::MarloModel schema(address);
    schema.open();
    std::vector<double> one;
    std::vector<double> four;
    for (int i = 0; i < kRepetitions; ++i) {
        one.push_back(writersSeconds(address, 1, kSavesPerWriter * kWriters));
        four.push_back(writersSeconds(address, kWriters, kSavesPerWriter));
    }
    std::sort(one.begin(), one.end());
    std::sort(four.begin(), four.end());
    if (one.front() <= 0 || four.front() <= 0) {
        std::printf("four writers / one writer: not measured (a writer failed)\n");
        return;
    }
    std::printf("four writer programs / one writer program, %d saves in all: time ratio %.2f"
                " (below 1.00 saving at once gains, above it the writers hold each other up;"
                " median %.2f s against %.2f s)\n",
                kSavesPerWriter * kWriters, four[four.size() / 2] / one[one.size() / 2], four[four.size() / 2],
                one[one.size() / 2]);
}

} // namespace

int main(int argc, char** argv)
{
    if (argc == 4 && std::string(argv[1]) == "--writer") {
        QCoreApplication app(argc, argv);
        return runWriter(QString::fromLocal8Bit(argv[2]), std::atoi(argv[3]));
    }
    benchmark::Initialize(&argc, argv);
    QCoreApplication app(argc, argv);
    TestPostgresServer* server = TestPostgresServer::shared();
    if (!server) {
        std::printf("PostgreSQL benchmarks not run: %s\n", qPrintable(TestPostgresServer::skipReason()));
        return 0;
    }

    vemi::MarloModel serverStore(server->createDatabase());
    QTemporaryDir folder;
    vemi::MarloModel fileStore(folder.filePath(QStringLiteral("store.sqlite")));
    const QString rawConnection = QStringLiteral("raw");
    {
        QSqlDatabase raw = QSqlDatabase::addDatabase(QStringLiteral("QPSQL"), rawConnection);
        vemi::PostgresDialect::applyAddress(raw, server->createDatabase());
        if (!raw.open() || !serverStore.open().isEmpty() || !fileStore.open().isEmpty()
            || !QSqlQuery(raw).exec(QStringLiteral("CREATE TABLE blobs(id TEXT PRIMARY KEY, data BYTEA)"))) {
            std::fprintf(stderr, "cannot set up the stores\n");
            return 1;
        }
    }
    const std::vector<unsigned char> first = incompressibleBytes(kSchematicBytes, 1);
    const std::vector<unsigned char> second = incompressibleBytes(kSchematicBytes, 2);
    auto one = templateNamed("Benchmark template", first);
    auto other = templateNamed("Benchmark template", second);
    other->setId(one->id());
    const std::array<QByteArray, 2> payloads = {
        QByteArray(reinterpret_cast<const char*>(first.data()), int(first.size())),
        QByteArray(reinterpret_cast<const char*>(second.data()), int(second.size()))};
    if (!fillTree(serverStore) || !fillTree(fileStore)) {
        std::fprintf(stderr, "cannot fill the directory trees\n");
        return 1;
    }

    for (benchmark::internal::Benchmark* registered :
         {benchmark::RegisterBenchmark(kStoreBenchmark, storeSaveAndFetch, &serverStore,
                                       std::array<std::shared_ptr<vemi::QCJobTemplate>, 2>{one, other}),
          benchmark::RegisterBenchmark(kRawBenchmark, rawByteaWriteAndRead, &rawConnection, payloads),
          benchmark::RegisterBenchmark(kServerTree, directoryTree, &serverStore),
          benchmark::RegisterBenchmark(kFileTree, directoryTree, &fileStore)})
        registered->Unit(benchmark::kMillisecond)->UseRealTime()->Repetitions(kRepetitions)->MinTime(0.5);

    RecordingReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    std::fflush(stdout);
    reporter.printRatio("PostgreSQL store save+fetch / raw QPSQL bytea", kStoreBenchmark, kRawBenchmark,
                        QStringLiteral(" (goal <= %1)").arg(kRatioGoal, 0, 'f', 2));
    reporter.printRatio("directory tree of 5,000 entries, PostgreSQL / SQLite", kServerTree, kFileTree, QString());
    reportWriters(*server);
    QSqlDatabase::removeDatabase(rawConnection);
    benchmark::Shutdown();
    return 0;
}
