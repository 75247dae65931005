#include "host/client/SupportedInstruments.h"

namespace vemi {

bool SupportedInstruments::supportsSpecificInstrument(std::shared_ptr<Instrument>)
{
    return false;
}

} // namespace vemi
