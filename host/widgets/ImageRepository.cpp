#include "host/widgets/ImageRepository.h"

#include <QFile>
#include <QPixmap>

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
    // Type ids read "vemi.ClassName"; the icon file is named after the class.
    const QString className = QString::fromStdString(typeId).section(QLatin1Char('.'), -1);
    const QString path = QStringLiteral(":/Images/Types/%1.png").arg(className);
    if (!QFile::exists(path))
        return QIcon();
    const QIcon icon(path);
    return brightness > 0 ? brightened(icon) : icon;
}

QIcon ImageRepository::folderIcon() const
{
    return QIcon(QStringLiteral(":/Images/Types/Folder.png"));
}

} // namespace vemi
