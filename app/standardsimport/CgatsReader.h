#pragma once

#include "app/standardsimport/CgatsTable.h"

#include <QByteArray>
#include <QString>

#include <optional>

namespace vemi {

// Reads the first table of a CGATS (IT8) file with Little CMS's parser and
// checks what that parser lets pass: that each row of data stands on a line
// of its own with exactly as many values as the data format names fields.
// Safe to use on any thread; each read has its own Little CMS context.
class CgatsReader
{
public:
    // Files larger than this are refused before they are read.
    static constexpr qint64 kMaxFileBytes = 64 * 1024 * 1024;

    // On failure: empty, and *error says why, naming the line where the fault is.
    // The message does not name the file; the caller does.
    static std::optional<CgatsTable> read(const QByteArray& bytes, QString* error);
};

} // namespace vemi
