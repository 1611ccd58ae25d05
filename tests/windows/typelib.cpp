// Prints the classes of a type library in the words of the rules: the name of each, then its members in their order.
//
//     typelib.exe Varnex3.dll
#include <cstdio>
#include <map>

#include "tests/windows/TypeLibrary.h"

namespace {

using namespace varnex3::tests;

std::wstring WordsOf(const ValueType& type)
{
    static const std::map<VARTYPE, std::wstring> words = {
        {VT_BSTR, L"text"},         {VT_R8, L"double"},    {VT_DATE, L"date"},       {VT_I2, L"16-bit integer"},
        {VT_I4, L"32-bit integer"}, {VT_BOOL, L"Boolean"}, {VT_VARIANT, L"variant"},
    };
    if (!type.name.empty())
        return type.name;
    const auto found = words.find(type.type);
    return found == words.end() ? L"VARTYPE " + std::to_wstring(type.type) : found->second;
}

std::wstring WordsOf(const Parameter& parameter)
{
    std::wstring words =
        (parameter.type.isByReference ? L"out " : L"") + parameter.name + L": " + WordsOf(parameter.type);
    return parameter.isOptional ? L"[" + words + L"]" : words;
}

std::wstring WordsOf(const std::vector<Parameter>& parameters)
{
    std::wstring words;
    for (const Parameter& parameter : parameters)
        words += (words.empty() ? L"" : L", ") + WordsOf(parameter);
    return L"(" + words + L")";
}

bool IsPut(const Operation& operation)
{
    return operation.kind == INVOKE_PROPERTYPUT || operation.kind == INVOKE_PROPERTYPUTREF;
}

// A method, or a property in the words of its getter.
std::wstring WordsOf(const Operation& operation, bool isWritable)
{
    const bool isProperty = operation.kind == INVOKE_PROPERTYGET;
    std::wstring words = operation.name;
    if (!isProperty || !operation.parameters.empty())
        words += WordsOf(operation.parameters);
    if (operation.result.type != VT_EMPTY)
        words += L": " + WordsOf(operation.result);
    return isProperty && !isWritable ? words + L" (read-only)" : words;
}

void Print(const Class& described)
{
    std::printf("%s\n", ToUtf8(described.name).c_str());
    const auto& operations = described.operations;
    for (std::size_t i = 0; i < operations.size(); ++i) {
        const bool isWritable =
            i + 1 < operations.size() && operations[i + 1].id == operations[i].id && IsPut(operations[i + 1]);
        if (!IsPut(operations[i]))
            std::printf("\t%s\n", ToUtf8(WordsOf(operations[i], isWritable)).c_str());
    }
}

} // namespace

int wmain(int count, wchar_t** arguments)
{
    const Apartment apartment;
    for (const Class& described : ClassesOf(count > 1 ? arguments[1] : L"Varnex3.dll"))
        Print(described);
    return 0;
}
