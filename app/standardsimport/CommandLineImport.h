#pragma once

#include <QString>

#include <cstdio>

namespace vemi {

class MarloModel;

// The shell's --import-standards: imports one CGATS file into the store and
// says on out what it did, on err why it did not.
class CommandLineImport
{
public:
    static constexpr int kImported = 0;
    static constexpr int kFailed = 2;

    // condition: "D50/2" and the like, used when the file names none; empty
    // for the default, D65/10. Returns the shell's exit code. Blocks until the
    // store has answered: for the command line only, never for a window.
    static int run(MarloModel& store, const QString& path, const QString& folderName, const QString& condition,
                   std::FILE* out, std::FILE* err);
};

} // namespace vemi
