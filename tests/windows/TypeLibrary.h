// What a type library says of its classes, and nothing that is known otherwise.
#pragma once

#include <string>
#include <vector>

#include "tests/windows/Automation.h"

namespace varnex3::tests {

struct ValueType
{
    VARTYPE type = VT_EMPTY;    // VT_I4 for an enumeration, VT_DISPATCH for an object, VT_EMPTY for none
    bool isByReference = false; // a pointer to such a value
    std::wstring name;          // of the enumeration or the class
};

struct Parameter
{
    std::wstring name;
    ValueType type;
    bool isOptional = false;
};

// A slot of the vtable: a method, or one accessor of a property. What a property is set to is its last parameter.
struct Operation
{
    std::wstring name;
    MEMBERID id = 0;
    INVOKEKIND kind = INVOKE_FUNC;
    ULONG_PTR offset = 0;
    std::vector<Parameter> parameters; // without the result
    ValueType result;
};

struct Class
{
    std::wstring name;
    CLSID id{};
    IID interfaceId{};
    bool isCreatable = false;
    std::vector<Operation> operations;
};

// The classes of a file's type library, in its order; none when it cannot be read.
std::vector<Class> ClassesOf(const wchar_t* file);

} // namespace varnex3::tests
