#include "host/domain/SchematicImage.h"

#include "host/domain/Header.h"
#include "host/domain/ObjectCodec.h"

#include <utility>

namespace vemi {

const std::string& SchematicImage::typeId()
{
    static const std::string id = "vemi.SchematicImage";
    return id;
}

std::string SchematicImage::objectTypeId() const
{
    return typeId();
}

std::string SchematicImage::name() const
{
    return header()->name();
}

void SchematicImage::setName(const std::string& name)
{
    header()->setName(name);
}

SchematicImage::SchematicImage()
    : m_imageData(std::make_shared<const std::vector<unsigned char>>())
{
}

const std::vector<unsigned char>& SchematicImage::imageData() const
{
    return *m_imageData;
}

// The bytes are never changed in place, so snapshots and clones may share them.
void SchematicImage::setImageData(std::vector<unsigned char> data)
{
    m_imageData = std::make_shared<const std::vector<unsigned char>>(std::move(data));
}

void SchematicImage::writeFields(QCborMap& map) const
{
    BaseObject::writeFields(map);
    map.insert(QStringLiteral("originalFilename"), ObjectCodec::text(m_originalFilename));
    map.insert(QStringLiteral("format"), ObjectCodec::text(m_format));
    map.insert(QStringLiteral("imageData"), ObjectCodec::bytes(m_imageData));
}

void SchematicImage::readFields(const QCborMap& map)
{
    BaseObject::readFields(map);
    m_originalFilename = ObjectCodec::readText(map, QStringLiteral("originalFilename"));
    m_format = ObjectCodec::readText(map, QStringLiteral("format"));
    m_imageData = ObjectCodec::readBytes(map, QStringLiteral("imageData"));
}

} // namespace vemi
