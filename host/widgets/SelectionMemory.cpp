#include "host/widgets/SelectionMemory.h"

#include "host/domain/DirEntry.h"
#include "host/domain/NamedObject.h"
#include "host/widgets/DirEntryTreeModel.h"

#include <QSettings>

namespace vemi {

void SelectionMemory::setKey(const std::string& settingsName, const std::string& typeId)
{
    m_settingsKey = QStringLiteral("Browser/%1/%2/lastSelection")
                        .arg(QString::fromStdString(settingsName), QString::fromStdString(typeId));
}

void SelectionMemory::remember(const BaseObjectTreeModel::Node* node) const
{
    const auto* entry = dynamic_cast<const DirEntryTreeModel::DirEntryNode*>(node);
    if (entry && entry->isSaved() && !m_settingsKey.isEmpty())
        QSettings().setValue(m_settingsKey, QString::fromStdString(keyOf(entry)));
}

std::string SelectionMemory::remembered() const
{
    if (m_settingsKey.isEmpty())
        return {};
    return QSettings().value(m_settingsKey).toString().toStdString();
}

std::string SelectionMemory::keyOf(const BaseObjectTreeModel::Node* node)
{
    if (const auto* folder = dynamic_cast<const DirEntryTreeModel::FolderNode*>(node))
        return "folder:" + folder->folder().id;
    const auto* entry = dynamic_cast<const DirEntryTreeModel::DirEntryNode*>(node);
    if (entry && entry->isSaved())
        return "entry:" + entry->dirEntry()->id();
    if (entry && entry->object())
        return "object:" + entry->object()->id();
    return {};
}

} // namespace vemi
