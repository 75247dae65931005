#include "plugin/PellamApp.h"

#include "host/widgets/ImageRepository.h"
#include "plugin/PellamAppWidget.h"
#include "plugin/PellamSettings.h"
#include "host/client/SettingsManager.h"
#include "host/client/Version.h"

#include <QIcon>

namespace vemi {

namespace {

// Built once, on first use, and shared by every caller.
const QString& title()
{
    static const QString text = QStringLiteral("QC Job Template Editor");
    return text;
}

const Version& pellamVersion()
{
    static const Version value(1, 3, 0, static_cast<Version::Type>(4));
    return value;
}

} // namespace

PellamApp::PellamApp()
    : QObject(nullptr)
{
    const QIcon icon(QStringLiteral(":/Images/Images/AppIcon-QCTemplate.png"));
    ImageRepository::instance().registerAppIcon(clientTitle().toStdString(), icon, icon, icon, icon);
    m_settings = std::make_shared<PellamSettings>(clientTitle());
}

PellamApp::~PellamApp() = default;

QString PellamApp::clientTitle() const
{
    return title();
}

void PellamApp::clientNotification(const QString&)
{
}

AppWidget* PellamApp::createAppWidget(MarloModel& store, QWidget* parent)
{
    return new PellamAppWidget(m_settings, SettingsManager::instance().getGeneralSettings(), store, parent);
}

int PellamApp::clientGroup() const
{
    return 2;
}

int PellamApp::clientPosition() const
{
    return 3;
}

QString PellamApp::styleSheetName() const
{
    return QStringLiteral("Pellam.stylesheet");
}

std::vector<QString> PellamApp::clientIdentifiers() const
{
    return {QStringLiteral("Pellam")};
}

const Version& PellamApp::version() const
{
    return pellamVersion();
}

} // namespace vemi
