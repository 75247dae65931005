#pragma once

#include "host/domain/SharedBytes.h"

#include <QCborValue>

namespace vemi {

// Byte strings kept beside a CBOR tree instead of inside it. While a scope is
// active on a thread, ObjectCodec puts a placeholder (a tagged index) into the
// tree for each byte field and keeps the bytes here, shared; the stream codec
// writes them where the placeholders stand and, when reading, does the
// reverse. Large images thus pass through the codec without extra copies.
class DetachedBytes
{
public:
    // Makes table the one ObjectCodec uses on this thread until the scope ends.
    class Scope
    {
    public:
        explicit Scope(DetachedBytes& table);
        Scope(const Scope&) = delete;
        Scope& operator=(const Scope&) = delete;
        ~Scope();

    private:
        DetachedBytes* m_previous;
    };

    // Null when no scope is active on this thread.
    static DetachedBytes* current();
    static bool isPlaceholder(const QCborValue& value);

    QCborValue add(SharedBytes bytes);
    // The bytes a placeholder stands for; throws DecodeError for a placeholder of another table.
    SharedBytes bytesOf(const QCborValue& placeholder) const;
    qint64 totalSize() const { return m_totalSize; }

private:
    std::vector<SharedBytes> m_buffers;
    qint64 m_totalSize = 0;
};

} // namespace vemi
