#include "host/domain/GlobalDirEntry.h"

#include "host/domain/ObjectCodec.h"

namespace vemi {

const std::string& GlobalDirEntry::typeId()
{
    static const std::string id = "vemi.GlobalDirEntry";
    return id;
}

std::string GlobalDirEntry::objectTypeId() const
{
    return typeId();
}

void GlobalDirEntry::writeFields(QCborMap& map) const
{
    DirEntry::writeFields(map);
    map.insert(QStringLiteral("dispatcherId"), ObjectCodec::text(m_dispatcherId));
}

void GlobalDirEntry::readFields(const QCborMap& map)
{
    DirEntry::readFields(map);
    m_dispatcherId = ObjectCodec::readText(map, QStringLiteral("dispatcherId"));
}

} // namespace vemi
