#pragma once

#include <map>
#include <string>
#include <vector>

namespace vemi {

// The first data table of a CGATS file as Little CMS read it: texts as they
// stand in the file (in its own encoding), each row as wide as the data format.
struct CgatsTable
{
    std::map<std::string, std::string> keywords; // keyword in upper case → value
    std::vector<std::string> fields;             // the data format, in column order
    std::vector<std::vector<std::string>> rows;  // in file order
    std::vector<int> rowLines;                   // the line of each row, from 1
    bool utf8 = true;                            // false: the texts are Latin-1
    int tableCount = 1;

    // The column of a field, or -1.
    int column(const std::string& field) const
    {
        for (size_t i = 0; i < fields.size(); ++i) {
            if (fields[i] == field)
                return int(i);
        }
        return -1;
    }
};

} // namespace vemi
