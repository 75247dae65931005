#pragma once

#include <QString>
#include <QStringList>

namespace vemi {

// The shell's command line.
struct ShellOptions
{
    QString storePath;
    QString pluginFolder;
    bool readOnly = false;
    bool withSamples = true;
    QString screenshotPath; // when set: save a picture of the window and quit
    QString error;          // why the command line was refused

    static ShellOptions parse(const QStringList& arguments);
};

} // namespace vemi
