#include "host/client/GeneralSettings.h"
#include "host/store/MarloModel.h"
#include "app/PluginCatalog.h"
#include "app/sampledata/SampleData.h"
#include "app/ShellOptions.h"
#include "app/standardsimport/CommandLineImport.h"
#include "host/client/SettingsManager.h"
#include "app/ShellWindow.h"

#include <QApplication>
#include <QTimer>

#include <cstdio>

namespace {

void complain(const QString& message)
{
    std::fprintf(stderr, "qchost: %s\n", qPrintable(message));
}

} // namespace

int main(int argc, char* argv[])
{
    QApplication application(argc, argv);
    QApplication::setOrganizationName(QStringLiteral("Vemi"));
    QApplication::setApplicationName(QStringLiteral("QC Host"));

    const vemi::ShellOptions options = vemi::ShellOptions::parse(QApplication::arguments());
    if (!options.error.isEmpty()) {
        complain(options.error);
        return 1;
    }

    vemi::StoreOptions storeOptions;
    storeOptions.readOnly = options.readOnly;
    vemi::MarloModel store(options.storePath, storeOptions);
    const QString storeError = store.open();
    if (!storeError.isEmpty()) {
        complain(storeError);
        return 2;
    }
    if (!options.importPath.isEmpty())
        return vemi::CommandLineImport::run(store, options.importPath, options.importFolder, options.importCondition,
                                            stdout, stderr);
    QStringList refusedIds;
    const auto otherStores = options.otherStoreFiles(
        vemi::SettingsManager::instance().getGeneralSettings()->dispatcherList(), &refusedIds);
    for (const auto& [id, path] : otherStores)
        store.addStore(id, path);
    for (const QString& id : refusedIds)
        complain(QStringLiteral("Ignored the store id \"%1\": use letters, digits, blanks and dashes.").arg(id));
    if (options.withSamples) {
        const QString seedError = vemi::SampleData::seedIfEmpty(store);
        if (!seedError.isEmpty())
            complain(QStringLiteral("Could not add the sample data: ") + seedError);
    }

    vemi::PluginCatalog catalog;
    catalog.load(options.pluginFolder);
    for (const QString& message : catalog.messages())
        complain(message);
    if (catalog.clients().empty()) {
        complain(QStringLiteral("No client plug-in found in %1.").arg(options.pluginFolder));
        return 3;
    }

    vemi::ShellWindow window(store, catalog.clients());
    window.resize(1400, 900);
    window.show();
    if (!options.screenshotPath.isEmpty()) {
        QTimer::singleShot(1500, &window, [&window, &options]() {
            window.grab().save(options.screenshotPath);
            QApplication::quit();
        });
    }
    return application.exec();
}
