#include "host/widgets/ImageRepository.h"

#include <QFile>
#include <QPixmap>

#include <map>

namespace vemi {

namespace {

QIcon brightened(const QIcon& icon)
{
    QIcon result;
    for (const QSize& size : icon.availableSizes()) {
        QImage image = icon.pixmap(size).toImage().convertToFormat(QImage::Format_ARGB32);
        image.invertPixels(QImage::InvertRgb);
        result.addPixmap(QPixmap::fromImage(image));
    }
    return result;
}

// Types drawn alike: a subclass or a part looks like the object it belongs to.
const std::map<QString, QString>& sharedDrawings()
{
    static const std::map<QString, QString> drawings = {
        {QStringLiteral("LabToleranceBase"), QStringLiteral("Tolerance")},
        {QStringLiteral("TagValue"), QStringLiteral("TagDefinition")},
        {QStringLiteral("Property"), QStringLiteral("TagDefinition")},
        {QStringLiteral("LabValue"), QStringLiteral("ColorValue")},
        {QStringLiteral("RGBValue"), QStringLiteral("ColorValue")},
        {QStringLiteral("AppearanceValues"), QStringLiteral("ColorValue")},
    };
    return drawings;
}

// The file name (without ".png") of the drawing for typeId; "Object" for a
// type without one, so that every row of a list or tree shows an icon.
QString drawingForType(const std::string& typeId)
{
    // Type ids read "vemi.ClassName"; the drawing is named after the class.
    QString className = QString::fromStdString(typeId).section(QLatin1Char('.'), -1);
    const auto shared = sharedDrawings().find(className);
    if (shared != sharedDrawings().end())
        className = shared->second;
    if (className.isEmpty() || !QFile::exists(QStringLiteral(":/Images/Types/%1.png").arg(className)))
        return QStringLiteral("Object");
    return className;
}

} // namespace

ImageRepository& ImageRepository::instance()
{
    static ImageRepository repository;
    return repository;
}

void ImageRepository::registerAppIcon(const std::string& appName, const QIcon& normal, const QIcon& active,
                                      const QIcon& selected, const QIcon& disabled)
{
    QIcon icon = normal;
    for (const QSize& size : active.availableSizes())
        icon.addPixmap(active.pixmap(size), QIcon::Active);
    for (const QSize& size : selected.availableSizes())
        icon.addPixmap(selected.pixmap(size), QIcon::Selected);
    for (const QSize& size : disabled.availableSizes())
        icon.addPixmap(disabled.pixmap(size), QIcon::Disabled);
    m_appIcons[appName] = icon;
}

QIcon ImageRepository::appIcon(const std::string& appName) const
{
    const auto found = m_appIcons.find(appName);
    return found == m_appIcons.end() ? QIcon() : found->second;
}

QIcon ImageRepository::iconForType(const std::string& typeId, int brightness) const
{
    const QIcon icon(QStringLiteral(":/Images/Types/%1.png").arg(drawingForType(typeId)));
    return brightness > 0 ? brightened(icon) : icon;
}

QIcon ImageRepository::folderIcon() const
{
    return QIcon(QStringLiteral(":/Images/Types/Folder.png"));
}

} // namespace vemi
