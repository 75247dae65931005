#pragma once

namespace vemi {

// Base of every answer the object store gives to a command.
class Response
{
public:
    virtual ~Response() = default;
};

} // namespace vemi
