#pragma once

#include <QMetaType>
#include <QObject>
#include <QString>

#include <map>
#include <memory>
#include <vector>

namespace vemi {

class Instrument;
class InstrumentDriverInfo;

// The host's instrument drivers and the instruments attached through them.
// This host ships simulated drivers; one of them is listed but not installed,
// as happens when a driver package is missing. GUI thread only.
class InstrumentManager : public QObject
{
    Q_OBJECT

public:
    // Never null; lives as long as the program.
    static InstrumentManager* instance();

    // Every driver the host knows, in display order, installed or not.
    std::vector<std::shared_ptr<InstrumentDriverInfo>> supportedInstruments() const;
    // The instrument of an installed driver, the same object at every call;
    // empty for a driver that is not installed or not known.
    std::shared_ptr<Instrument> instrument(const QString& libraryName) const;

    // Attaching and detaching an instrument, and choosing the one to measure
    // with; each announces itself with its signal. False for an unknown or
    // missing driver, or when nothing changes.
    bool connectInstrument(const QString& libraryName);
    bool disconnectInstrument(const QString& libraryName);
    bool setPreferredInstrument(const QString& libraryName);

signals:
    void sgInstrumentConnected(std::shared_ptr<vemi::Instrument> instrument);
    void sgInstrumentDisconnected(std::shared_ptr<vemi::Instrument> instrument);
    void sgPreferredInstrumentChanged(std::shared_ptr<vemi::Instrument> instrument);

private:
    InstrumentManager();

    std::vector<std::shared_ptr<InstrumentDriverInfo>> m_drivers;
    std::map<QString, std::shared_ptr<Instrument>> m_installed;
    std::map<QString, bool> m_connected;
    QString m_preferred;
};

} // namespace vemi

Q_DECLARE_METATYPE(std::shared_ptr<vemi::Instrument>)
