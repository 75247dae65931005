#pragma once

#include <QString>
#include <QStringList>

#include <map>
#include <string>
#include <vector>

namespace vemi {

// The shell's command line.
struct ShellOptions
{
    QString storePath;
    QString pluginFolder;
    bool readOnly = false;
    bool withSamples = true;
    QString screenshotPath; // when set: save a picture of the window and quit
    QString importPath;     // when set: import these standards and quit, showing no window
    QString importFolder;   // the folder the import files into
    QString importCondition; // used when the imported file names no condition; empty: the default
    QString error;          // why the command line was refused

    static ShellOptions parse(const QStringList& arguments);

    // The files of the stores the user browses besides the default one: one
    // per dispatcher id, beside the default store. Ids that are not plain
    // names (letters, digits, blanks, dashes) are refused, so that no id can
    // point outside that folder. An id that is a postgresql:// address names
    // a database on that server.
    std::map<std::string, QString> otherStoreFiles(const std::vector<std::string>& dispatcherIds,
                                                   QStringList* refused) const;
};

} // namespace vemi
