#include "host/instruments/InstrumentManager.h"

#include "host/instruments/Instrument.h"
#include "host/instruments/InstrumentDriverInfo.h"
#include "host/instruments/MeasurementConditions.h"

namespace vemi {

namespace {

const QStringList kIlluminants{"D65", "D50", "A", "C", "F2", "F7", "F11"};
const QStringList kObservers{"2", "10"};

// A 45°/0° instrument with two apertures.
std::shared_ptr<MeasurementConditions> directionalConditions()
{
    auto conditions = std::make_shared<MeasurementConditions>("SimColor 45/0");
    conditions->addSetting("Illuminant", "D65", kIlluminants);
    conditions->addSetting("Observer", "10", kObservers);
    conditions->addSetting("Aperture", "8 mm", {"4 mm", "8 mm"});
    return conditions;
}

// A sphere instrument that can include or exclude the specular reflection.
std::shared_ptr<MeasurementConditions> sphereConditions()
{
    auto conditions = std::make_shared<MeasurementConditions>("SimColor Sphere d/8");
    conditions->addSetting("Illuminant", "D65", kIlluminants);
    conditions->addSetting("Observer", "10", kObservers);
    conditions->addSetting("Specular Component", "Included", {"Included", "Excluded"});
    conditions->addSetting("Aperture", "12 mm", {"6 mm", "12 mm"});
    conditions->addSetting("UV Filter", "Off", {"Off", "UV cut 400 nm"});
    return conditions;
}

} // namespace

InstrumentManager* InstrumentManager::instance()
{
    static InstrumentManager* manager = new InstrumentManager;
    return manager;
}

InstrumentManager::InstrumentManager()
{
    qRegisterMetaType<std::shared_ptr<vemi::Instrument>>("std::shared_ptr<vemi::Instrument>");
    m_drivers = {
        std::make_shared<InstrumentDriverInfo>(tr("SimColor 45/0 (simulated)"), QStringLiteral("simcolor45")),
        std::make_shared<InstrumentDriverInfo>(tr("SimColor Sphere d/8 (simulated)"), QStringLiteral("simcolorsphere")),
        std::make_shared<InstrumentDriverInfo>(tr("SimGloss 60 (simulated)"), QStringLiteral("simgloss60")),
    };
    // The gloss meter's driver is listed but not installed.
    m_installed[QStringLiteral("simcolor45")] = std::make_shared<Instrument>("SimColor 45/0", directionalConditions);
    m_installed[QStringLiteral("simcolorsphere")] = std::make_shared<Instrument>("SimColor Sphere d/8", sphereConditions);
}

std::vector<std::shared_ptr<InstrumentDriverInfo>> InstrumentManager::supportedInstruments() const
{
    return m_drivers;
}

std::shared_ptr<Instrument> InstrumentManager::instrument(const QString& libraryName) const
{
    const auto found = m_installed.find(libraryName);
    return found == m_installed.end() ? nullptr : found->second;
}

bool InstrumentManager::connectInstrument(const QString& libraryName)
{
    const auto attached = instrument(libraryName);
    if (!attached || m_connected[libraryName])
        return false;
    m_connected[libraryName] = true;
    emit sgInstrumentConnected(attached);
    return true;
}

bool InstrumentManager::disconnectInstrument(const QString& libraryName)
{
    const auto attached = instrument(libraryName);
    if (!attached || !m_connected[libraryName])
        return false;
    m_connected[libraryName] = false;
    emit sgInstrumentDisconnected(attached);
    return true;
}

bool InstrumentManager::setPreferredInstrument(const QString& libraryName)
{
    const auto preferred = instrument(libraryName);
    if (!preferred || m_preferred == libraryName)
        return false;
    m_preferred = libraryName;
    emit sgPreferredInstrumentChanged(preferred);
    return true;
}

} // namespace vemi
