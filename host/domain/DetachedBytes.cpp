#include "host/domain/DetachedBytes.h"

#include "host/domain/DecodeError.h"

namespace vemi {

namespace {

// A tag of the private range, never written to a stored file.
constexpr QCborTag kPlaceholderTag = QCborTag(0x51434A42);

thread_local DetachedBytes* t_current = nullptr;

} // namespace

DetachedBytes::Scope::Scope(DetachedBytes& table)
    : m_previous(t_current)
{
    t_current = &table;
}

DetachedBytes::Scope::~Scope()
{
    t_current = m_previous;
}

DetachedBytes* DetachedBytes::current()
{
    return t_current;
}

bool DetachedBytes::isPlaceholder(const QCborValue& value)
{
    return value.isTag() && value.tag() == kPlaceholderTag;
}

QCborValue DetachedBytes::add(SharedBytes bytes)
{
    if (!bytes)
        bytes = std::make_shared<const std::vector<unsigned char>>();
    m_totalSize += qint64(bytes->size());
    m_buffers.push_back(std::move(bytes));
    return QCborValue(kPlaceholderTag, QCborValue(qint64(m_buffers.size() - 1)));
}

SharedBytes DetachedBytes::bytesOf(const QCborValue& placeholder) const
{
    const qint64 index = placeholder.taggedValue().toInteger(-1);
    if (index < 0 || index >= qint64(m_buffers.size()))
        throw DecodeError("a byte field refers to bytes that are not there");
    return m_buffers[size_t(index)];
}

} // namespace vemi
