#pragma once

namespace vemi {

// How a store file is opened.
struct StoreOptions
{
    bool readOnly = false;
    // How long a write waits for another program's lock before it fails.
    int busyTimeoutMs = 5000;
};

} // namespace vemi
