#pragma once

#include <QIcon>

#include <map>
#include <string>

namespace vemi {

// The host's icons: those of the clients' applications, registered by the
// clients, and those of the object types, from the host's resources.
class ImageRepository
{
public:
    // How an icon is drawn: for light backgrounds, or lightened for dark ones.
    enum EBrightness { Light = 0, Dark = 1 };

    static ImageRepository& instance();

    // The four icons are the application icon for the normal, active,
    // selected and disabled looks of the client's tab.
    void registerAppIcon(const std::string& appName, const QIcon& normal, const QIcon& active,
                         const QIcon& selected, const QIcon& disabled);
    // A null icon for an application that registered none.
    QIcon appIcon(const std::string& appName) const;
    // Never null: a type without an icon of its own gets the generic object icon.
    // brightness: an EBrightness; 0 for icons on light backgrounds, 1 for dark ones.
    QIcon iconForType(const std::string& typeId, int brightness = 0) const;
    QIcon folderIcon() const;

private:
    ImageRepository() = default;

    std::map<std::string, QIcon> m_appIcons;
};

} // namespace vemi
