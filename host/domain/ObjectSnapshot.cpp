#include "ObjectSnapshot.h"

#include "CborStream.h"

namespace vemi {

QByteArray ObjectSnapshot::toCbor() const
{
    return CborStream::write(tree, bytes);
}

} // namespace vemi
