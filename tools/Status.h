// How the program ends.
#pragma once

namespace varnex3::tool {

enum class Status : int
{
    Fine = 0,
    Findings = 1,    // it ran, and something is wrong with a file, a setting or the database
    CouldNotRun = 2, // a wrong argument, a folder or file that is not there, a file or output that cannot be written
};

} // namespace varnex3::tool
