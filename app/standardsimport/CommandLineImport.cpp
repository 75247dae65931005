#include "app/standardsimport/CommandLineImport.h"

#include "app/standardsimport/StandardsImport.h"
#include "host/store/AddObjectSet.h"
#include "host/store/CommandSender.h"
#include "host/store/ErrorInfo.h"

namespace vemi {

namespace {

// A large file written to a slow disk may take a while; a store that has not
// answered by then is stuck.
constexpr int kAnswerTimeoutMs = 120000;

int fail(std::FILE* err, const QString& message)
{
    std::fprintf(err, "qchost: %s\n", qPrintable(message));
    return CommandLineImport::kFailed;
}

} // namespace

int CommandLineImport::run(MarloModel& store, const QString& path, const QString& folderName,
                           const QString& condition, std::FILE* out, std::FILE* err)
{
    QString error;
    const auto file = StandardsImport::readFile(path, &error);
    if (!file)
        return fail(err, error);

    StandardsImport::Condition chosen = file->condition();
    if (!file->namesCondition()) {
        if (!condition.isEmpty()) {
            const auto parsed = StandardsImport::parseCondition(condition);
            if (!parsed)
                return fail(err, QStringLiteral("Cannot import \"%1\": --condition %2 is not one of %3.")
                                     .arg(file->fileName(), condition,
                                          StandardsImport::conditionChoices().join(QStringLiteral(", "))));
            chosen = *parsed;
        }
        std::fprintf(out, "\"%s\" names no %s: imported as %s%s.\n", qPrintable(file->fileName()),
                     qPrintable(file->missingConditionParts()), chosen.toString().c_str(),
                     condition.isEmpty() ? " (the default; choose another with --condition)" : "");
    } else if (!condition.isEmpty()) {
        std::fprintf(out, "\"%s\" names its own condition, %s, which is used instead of --condition.\n",
                     qPrintable(file->fileName()), chosen.toString().c_str());
    }

    const auto set = file->build(chosen, folderName, &error);
    if (!set)
        return fail(err, error);
    const CommandSender::Answer answer = CommandSender::sendAndWait(store, std::string(), set, kAnswerTimeoutMs);
    if (answer.error)
        return fail(err, answer.error->message());
    std::fprintf(out, "Imported %d standard%s from \"%s\" into the library \"%s\" in the folder \"%s\".\n",
                 int(file->samples().size()), file->samples().size() == 1 ? "" : "s", qPrintable(file->fileName()), qPrintable(file->libraryName()),
                 qPrintable(folderName));
    for (const QString& note : file->notes())
        std::fprintf(out, "%s\n", qPrintable(note));
    return kImported;
}

} // namespace vemi
