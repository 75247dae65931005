#pragma once

#include <memory>

namespace vemi {

class Instrument;

// Tells the host which measuring instruments a client can work with.
class SupportedInstruments
{
public:
    virtual ~SupportedInstruments() = default;
    // False by default: a client that measures overrides it.
    virtual bool supportsSpecificInstrument(std::shared_ptr<Instrument> instrument);
};

} // namespace vemi
