// One attempt to reach the workshop's database, step by step, with what came of each.
#pragma once

#include <chrono>
#include <cstddef>
#include <optional>
#include <vector>

#include "varnex3/core/Text.h"

namespace varnex3::tool {

using Milliseconds = std::chrono::duration<double, std::milli>;

struct ReferenceSetFacts
{
    Text name;
    std::optional<std::size_t> rows; // none when the set could not be had
    Text reason;                     // why not
};

struct DatabaseFacts
{
    bool hasDriverManager = false;
    std::vector<Text> drivers; // those registered
    Text wantedDriver;         // the one that the connection string names
    Text driver;               // the one that is used for it
    bool isDriverRegistered = false;
    Text connectionString; // without the password
    bool isTried = false;  // not without a driver
    bool isAnswering = false;
    Text product; // as the server calls itself
    Text reason;  // why it does not answer
    Milliseconds duration{0};
    std::vector<ReferenceSetFacts> referenceSets; // of a server that answers
};

// Reads the settings as a host does, but writes none.
DatabaseFacts CheckDatabase();

} // namespace varnex3::tool
