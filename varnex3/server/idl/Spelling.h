// The spelling of names in a type library, which keeps each name once and does not tell Count from count.
#pragma once

#include <map>
#include <stdexcept>
#include <string>
#include <vector>

namespace varnex3::server::idl {

// The first spelling of a name is the one that hosts would see everywhere. So public names must agree on theirs,
// wherever they are used; a parameter, which hosts meet at most as the name of an argument, in any letter case, gives
// way.
class Spelling
{
public:
    // Takes the name of a class, member, enumeration or constant; `place` is where it is used.
    void Claim(const std::string& name, const std::string& place);

    // The spelling of a parameter's name: that of the same public name or of an earlier parameter, else its own.
    std::string OfParameter(const std::string& name);

    // Raises ClashingNames when public names differ in the case of letters alone.
    void Check() const;

private:
    struct Claimed
    {
        std::string name;
        std::string place;
    };
    std::map<std::string, Claimed> claimed; // by the name in lower case
    std::vector<std::string> clashes;
};

class ClashingNames : public std::runtime_error
{
    using std::runtime_error::runtime_error;
};

} // namespace varnex3::server::idl
