#pragma once

#include <QByteArray>
#include <QCborValue>

namespace vemi {

class DetachedBytes;

// Encodes and decodes a CBOR tree with its detached byte strings in one pass
// over one buffer: the bytes go straight from their shared buffers into the
// output, and straight from the input into new shared buffers.
class CborStream
{
public:
    static QByteArray write(const QCborValue& tree, const DetachedBytes& bytes);
    // Every byte string of the input becomes a placeholder of bytes. Throws DecodeError.
    static QCborValue read(const QByteArray& data, DetachedBytes& bytes);
};

} // namespace vemi
