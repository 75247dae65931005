#include "host/domain/BaseObject.h"

#include "host/domain/Header.h"

namespace vemi {

BaseObject::BaseObject()
    : m_id(QUuid::createUuid().toString(QUuid::WithoutBraces).toStdString())
    , m_header(std::make_shared<Header>())
{
}

BaseObject::~BaseObject() = default;

QUuid BaseObject::uuid() const
{
    return QUuid::fromString(QString::fromStdString(m_id));
}

void BaseObject::writeFields(QCborMap&) const
{
}

void BaseObject::readFields(const QCborMap&)
{
}

std::vector<std::string> BaseObject::referencedIds() const
{
    return {};
}

std::string BaseObject::referencedTypeId() const
{
    return {};
}

void BaseObject::resolveReferences(const ObjectLookup&)
{
}

void BaseObject::dropReferences(const std::vector<std::string>&)
{
}

} // namespace vemi
