// The component as a type library tells of it, in plain data.
//
// Made from the rows of the classes (Describe.h), or read back from the type library in a built component; written as
// IDL for the compiler of type libraries, as a listing for people, and as a manifest.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "varnex3/core/Interface.h"
#include "varnex3/server/Operations.h"

namespace varnex3::server::idl {

struct ValueType
{
    Kind kind = Kind::None;
    std::string name; // of the enumeration or the class; empty otherwise
};

struct Argument
{
    std::string name;
    ValueType type;
    bool isByReference = false;
    bool isOptional = false;
    std::optional<std::string> initial; // what an omitted one has: a text, or digits
};

struct Slot
{
    int slot = 0;
    int dispid = 0;
    Access access = Access::Call;
    std::string name;
    std::string doc;
    std::vector<Argument> arguments; // the index of an indexed property, too
    ValueType type;                  // of the property, or of the method's result
};

struct Class
{
    std::string name;
    std::string guid;
    std::string doc;
    std::string attributes; // as IDL has them
    std::string interfaceName;
    std::string interfaceGuid;
    std::string interfaceDoc;
    std::string interfaceAttributes;
    std::vector<Slot> slots;
};

struct Constant
{
    std::string name;
    std::int32_t value = 0;
    std::string doc;
};

struct Enumeration
{
    std::string name;
    std::string guid;
    std::string doc;
    std::vector<Constant> constants;
};

struct Library
{
    std::string name;
    std::string guid;
    int major = 0;
    int minor = 0;
    std::string doc;
    std::vector<Enumeration> enumerations;
    std::vector<Class> classes;
};

// What every interface and what a predeclared class is marked with, in alphabetical order.
inline constexpr std::string_view kInterfaceAttributes = "dual, hidden, nonextensible, oleautomation";
inline constexpr std::string_view kPredeclared = "appobject";

} // namespace varnex3::server::idl
