#pragma once

#include "host/domain/DetachedBytes.h"

#include <QByteArray>
#include <QCborValue>

namespace vemi {

// An object's state at one moment: its CBOR tree with the byte fields kept
// aside and shared. Taking one copies no image data, so it is cheap on the
// caller's thread; the bytes of the encoding are produced later, anywhere.
class ObjectSnapshot
{
public:
    QCborValue tree;
    DetachedBytes bytes;

    QByteArray toCbor() const;
};

} // namespace vemi
