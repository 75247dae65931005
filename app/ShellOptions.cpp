#include "app/ShellOptions.h"

#include "app/standardsimport/StandardsImport.h"
#include "host/store/MarloModel.h"
#include "host/store/StoreDialect.h"

#include <QCommandLineParser>
#include <QCoreApplication>
#include <QFileInfo>
#include <QRegularExpression>

namespace vemi {

ShellOptions ShellOptions::parse(const QStringList& arguments)
{
    QCommandLineParser parser;
    parser.setApplicationDescription(QStringLiteral("Host shell of the QC job template editor."));
    parser.addHelpOption();
    const QCommandLineOption store(QStringLiteral("store"), QStringLiteral("Use the store file <store>, or the database of a postgresql://user@host:port/dbname address."),
                                   QStringLiteral("store"));
    const QCommandLineOption plugins(QStringLiteral("plugins"),
                                     QStringLiteral("Load the client plug-ins of folder <folder>."),
                                     QStringLiteral("folder"));
    const QCommandLineOption readOnly(QStringLiteral("read-only"), QStringLiteral("Open the store read-only."));
    const QCommandLineOption noSamples(QStringLiteral("no-samples"),
                                       QStringLiteral("Do not fill an empty store with samples."));
    const QCommandLineOption screenshot(QStringLiteral("screenshot"),
                                        QStringLiteral("Save a picture of the window to <png> and quit."),
                                        QStringLiteral("png"));
    const QCommandLineOption importStandards(
        QStringLiteral("import-standards"),
        QStringLiteral("Import the colour standards of the CGATS file <file> into the store as a library, then quit"
                       " (exit code 0 on success, 2 on failure)."),
        QStringLiteral("file"));
    const QCommandLineOption folder(QStringLiteral("folder"),
                                    QStringLiteral("With --import-standards: file the library in <name> (default:"
                                                   " Imported)."),
                                    QStringLiteral("name"), QString::fromLatin1(StandardsImport::kDefaultFolder));
    const QCommandLineOption condition(QStringLiteral("condition"),
                                       QStringLiteral("With --import-standards: the illuminant/observer for a file"
                                                      " that names none (default: D65/10)."),
                                       QStringLiteral("condition"));
    parser.addOptions({store, plugins, readOnly, noSamples, screenshot, importStandards, folder, condition});

    ShellOptions options;
    if (!parser.parse(arguments)) {
        options.error = parser.errorText();
        return options;
    }
    if (parser.isSet(QStringLiteral("help"))) {
        options.error = parser.helpText();
        return options;
    }
    options.storePath = parser.isSet(store) ? parser.value(store) : MarloModel::standardStorePath();
    options.pluginFolder = parser.isSet(plugins) ? parser.value(plugins)
                                                 : QCoreApplication::applicationDirPath() + QStringLiteral("/../plugins");
    options.readOnly = parser.isSet(readOnly);
    options.withSamples = !parser.isSet(noSamples) && !options.readOnly;
    options.screenshotPath = parser.value(screenshot);
    options.importPath = parser.value(importStandards);
    options.importFolder = parser.value(folder);
    options.importCondition = parser.value(condition);
    if (options.importPath.isEmpty() && (parser.isSet(folder) || parser.isSet(condition)))
        options.error = QStringLiteral("--folder and --condition go with --import-standards.");
    return options;
}

std::map<std::string, QString> ShellOptions::otherStoreFiles(const std::vector<std::string>& dispatcherIds,
                                                             QStringList* refused) const
{
    static const QRegularExpression plainName(QStringLiteral("^\\w[\\w -]*$"));
    const QString folder = QFileInfo(storePath).absolutePath();
    std::map<std::string, QString> files;
    for (const std::string& id : dispatcherIds) {
        const QString name = QString::fromStdString(id);
        if (id == MarloModel::defaultDispatcherId() || id.empty())
            continue;
        if (StoreDialect::isServerLocation(name))
            files[id] = name;
        else if (plainName.match(name).hasMatch())
            files[id] = folder + QLatin1Char('/') + name + QStringLiteral(".sqlite");
        else if (refused)
            *refused << name;
    }
    return files;
}

} // namespace vemi
