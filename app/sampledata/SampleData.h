#pragma once

#include <QString>

#include <memory>

namespace vemi {

class FillEmptyStore;
class MarloModel;

// The objects a new user finds on first start: colour standards and their
// library, a property library, a tolerance set, a measurement configuration
// and job templates with schematics and check lists that use them.
class SampleData
{
public:
    // Stores the whole sample set in one transaction when the default store
    // holds no folder and no object; otherwise leaves the store as it is, also
    // when another program fills it at the same moment. Waits for the store's
    // answer, so call it at start-up only. Returns the error message, empty on
    // success and when nothing needed writing.
    static QString seedIfEmpty(MarloModel& store);

    // The sample set as one command, built in memory. Null, with error set,
    // when the display colours of the standards cannot be computed.
    static std::shared_ptr<FillEmptyStore> buildSet(QString* error);
};

} // namespace vemi
