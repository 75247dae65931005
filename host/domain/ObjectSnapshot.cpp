#include "host/domain/ObjectSnapshot.h"

#include "host/domain/CborStream.h"

namespace vemi {

QByteArray ObjectSnapshot::toCbor() const
{
    return CborStream::write(tree, bytes);
}

} // namespace vemi
