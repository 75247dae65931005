#include "host/domain/DirEntry.h"

#include "host/domain/ObjectCodec.h"

namespace vemi {

const std::string& DirEntry::typeId()
{
    static const std::string id = "vemi.DirEntry";
    return id;
}

std::string DirEntry::objectTypeId() const
{
    return typeId();
}

void DirEntry::writeFields(QCborMap& map) const
{
    BaseObject::writeFields(map);
    map.insert(QStringLiteral("entryObjectId"), ObjectCodec::text(m_entryObjectId));
    map.insert(QStringLiteral("entryObjectType"), ObjectCodec::text(m_entryObjectType));
    map.insert(QStringLiteral("folderId"), ObjectCodec::text(m_folderId));
}

void DirEntry::readFields(const QCborMap& map)
{
    BaseObject::readFields(map);
    m_entryObjectId = ObjectCodec::readText(map, QStringLiteral("entryObjectId"));
    m_entryObjectType = ObjectCodec::readText(map, QStringLiteral("entryObjectType"));
    m_folderId = ObjectCodec::readText(map, QStringLiteral("folderId"));
}

} // namespace vemi
