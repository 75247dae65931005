#pragma once

#include "host/store/Response.h"

namespace vemi {

class FillEmptyStoreResponse : public Response
{
public:
    explicit FillEmptyStoreResponse(bool written) : m_written(written) {}
    // False when the store already held something: then nothing was written.
    bool written() const { return m_written; }

private:
    bool m_written;
};

} // namespace vemi
