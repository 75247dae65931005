#pragma once

#include <QString>

namespace vemi {

class MarloModel;

// The objects a new user finds on first start: colour standards and their
// library, a property library, a tolerance set, a measurement configuration
// and job templates with schematics and check lists that use them.
class SampleData
{
public:
    // Fills the default store when its job template tree holds neither folders
    // nor entries; otherwise leaves the store as it is. Runs the commands one
    // by one and waits for each answer in a local event loop, so call it at
    // start-up only. Returns the store's error message, empty on success.
    static QString seedIfEmpty(MarloModel& store);
};

} // namespace vemi
