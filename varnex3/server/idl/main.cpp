// Tells what hosts of the component are bound to, from the rows of the classes.
//
//     varnex3_idl --idl            the IDL, from which the type library is made
//     varnex3_idl --header-idl     the IDL, from which the header for C and C++ is made
//     varnex3_idl --listing        every identifier, slot and constant, a line each; then the modules' functions
//     varnex3_idl --help-strings   every help string, a line each
//     varnex3_idl --manifest win32|win64
#include <cstdio>
#include <exception>
#include <iostream>

#include "varnex3/Library.h"
#include "varnex3/server/idl/Describe.h"
#include "varnex3/server/idl/Idl.h"
#include "varnex3/server/idl/Listing.h"
#include "varnex3/server/idl/Manifest.h"

namespace {

using namespace varnex3;
using namespace varnex3::server;

// Modules are no part of the type library; C and Python call their functions by name.
std::string ModulesOf(std::span<const ClassInfo* const> classes)
{
    std::string text;
    for (const ClassInfo* const info : classes) {
        if (!info->IsModule())
            continue;
        text += "\nmodule " + std::string(info->name) + "\n";
        for (const Member& member : info->members)
            text += "    "
                    + idl::Signature(std::string(member.name), idl::DescribeParameters(member),
                                     idl::DescribeType(member.type))
                    + "\n";
    }
    return text;
}

std::string Answer(std::string_view option, std::string_view argument)
{
    const idl::Library library = idl::Describe();
    if (option == "--idl")
        return idl::ToIdl(library);
    if (option == "--header-idl")
        return idl::ToHeaderIdl(library);
    if (option == "--listing")
        return idl::ToListing(library) + ModulesOf(Classes());
    if (option == "--help-strings")
        return idl::ToHelpStrings(library);
    if (option == "--manifest" && argument == "win32")
        return idl::ToManifest(library, "x86", VARNEX3_VERSION ".0");
    if (option == "--manifest" && argument == "win64")
        return idl::ToManifest(library, "amd64", VARNEX3_VERSION ".0");
    throw std::runtime_error(
        "one of --idl, --header-idl, --listing, --help-strings, --manifest win32|win64 is required");
}

} // namespace

int main(int argc, char** argv)
try {
    std::cout << Answer(argc > 1 ? argv[1] : "", argc > 2 ? argv[2] : "") << std::flush;
    return std::cout ? 0 : 2;
} catch (const std::exception& error) {
    std::cerr << "varnex3_idl: " << error.what() << '\n';
    return 2;
}
