// Prints what the type library inside a file says, as varnex3_idl prints what the rows of the classes say, so that the
// two can be compared line by line.
//
//     read_typelib.exe Varnex3.dll [--help-strings]
#include <cstdio>
#include <stdexcept>

#include "tests/windows/Automation.h"
#include "varnex3/server/idl/Listing.h"

namespace {

using namespace varnex3;
using namespace varnex3::server;
using tests::Bstr;
using tests::Ptr;

void Require(bool isSo, const std::string& what)
{
    if (!isSo)
        throw std::runtime_error(what);
}

// A description that a type owns, given back with the scope.
template <class T>
class Borrowed
{
public:
    using Giver = HRESULT (STDMETHODCALLTYPE ITypeInfo::*)(UINT, T**);
    using Taker = void (STDMETHODCALLTYPE ITypeInfo::*)(T*);

    Borrowed(ITypeInfo* type_, Giver give, Taker take_, UINT index) : type(type_), take(take_)
    {
        Require(SUCCEEDED((type->*give)(index, &held)), "a description is missing");
    }
    ~Borrowed() { (type->*take)(held); }
    Borrowed(const Borrowed&) = delete;
    Borrowed& operator=(const Borrowed&) = delete;
    const T* operator->() const { return held; }
    const T& operator*() const { return *held; }

private:
    ITypeInfo* type;
    Taker take;
    T* held = nullptr;
};

Borrowed<FUNCDESC> Function(ITypeInfo* type, UINT index)
{
    return {type, &ITypeInfo::GetFuncDesc, &ITypeInfo::ReleaseFuncDesc, index};
}

Borrowed<VARDESC> Variable(ITypeInfo* type, UINT index)
{
    return {type, &ITypeInfo::GetVarDesc, &ITypeInfo::ReleaseVarDesc, index};
}

TYPEATTR AttributesOf(ITypeInfo* type)
{
    TYPEATTR* held = nullptr;
    Require(SUCCEEDED(type->GetTypeAttr(&held)), "the attributes of a type are missing");
    const TYPEATTR attributes = *held;
    type->ReleaseTypeAttr(held);
    return attributes;
}

struct Words
{
    std::string name;
    std::string doc;
};

// Of a type or a library, or of one of its members.
template <class Documented>
Words WordsOf(Documented* documented, long id = MEMBERID_NIL)
{
    Bstr name;
    Bstr doc;
    documented->GetDocumentation(id, name.Out(), doc.Out(), nullptr, nullptr);
    return {tests::ToUtf8(name.Text()), tests::ToUtf8(doc.Text())};
}

std::string ToText(const GUID& guid)
{
    wchar_t braced[40] = {};
    StringFromGUID2(guid, braced, 40);
    const std::string text = tests::ToUtf8(braced);
    return text.substr(1, text.size() - 2);
}

Ptr<ITypeInfo> Referred(ITypeInfo* type, HREFTYPE reference)
{
    Ptr<ITypeInfo> referred;
    Require(SUCCEEDED(type->GetRefTypeInfo(reference, referred.Out())), "GetRefTypeInfo");
    return referred;
}

Ptr<ITypeInfo> Implemented(ITypeInfo* type, int index)
{
    HREFTYPE reference = 0;
    Require(SUCCEEDED(type->GetRefTypeOfImplType(static_cast<UINT>(index), &reference)), "GetRefTypeOfImplType");
    return Referred(type, reference);
}

Kind KindOf(VARTYPE type)
{
    switch (type) {
    case VT_BSTR:
        return Kind::Text;
    case VT_R8:
        return Kind::Double;
    case VT_DATE:
        return Kind::Date;
    case VT_I2:
        return Kind::Int16;
    case VT_I4:
        return Kind::Int32;
    case VT_BOOL:
        return Kind::Boolean;
    case VT_VARIANT:
        return Kind::Variant;
    default:
        throw std::runtime_error("an unknown type: " + std::to_string(type));
    }
}

// A type, and how many pointers lead to it.
struct PointedType
{
    idl::ValueType type;
    int pointers = 0;
};

// An object is reached by a pointer, which is part of its type.
PointedType NamedType(ITypeInfo* type, HREFTYPE reference)
{
    const Ptr<ITypeInfo> named = Referred(type, reference);
    const std::string name = WordsOf(named.get()).name;
    const TYPEKIND kind = AttributesOf(named.get()).typekind;
    if (kind == TKIND_ENUM)
        return {{Kind::Enumeration, name}, 0};
    Require(kind == TKIND_DISPATCH || kind == TKIND_INTERFACE, "a type that is no interface: " + name);
    Require(name.starts_with('_'), "an interface without an underscore: " + name);
    return {{Kind::Object, name.substr(1)}, -1};
}

PointedType TypeOf(ITypeInfo* type, const TYPEDESC& description)
{
    if (description.vt == VT_USERDEFINED)
        return NamedType(type, description.hreftype);
    if (description.vt != VT_PTR)
        return {{KindOf(description.vt), {}}, 0};
    PointedType pointed = TypeOf(type, *description.lptdesc);
    ++pointed.pointers;
    return pointed;
}

std::optional<std::string> InitialOf(const PARAMDESC& description)
{
    if (!(description.wParamFlags & PARAMFLAG_FHASDEFAULT))
        return std::nullopt;
    const VARIANT& value = description.pparamdescex->varDefaultValue;
    if (value.vt == VT_BSTR)
        return tests::ToUtf8(value.bstrVal ? value.bstrVal : L"");
    Require(value.vt == VT_I2 || value.vt == VT_I4, "a default of an unknown type: " + std::to_string(value.vt));
    return std::to_string(value.vt == VT_I2 ? value.iVal : value.lVal);
}

idl::Argument ArgumentOf(ITypeInfo* type, const ELEMDESC& element, const std::string& name)
{
    const USHORT flags = element.paramdesc.wParamFlags;
    const auto [valueType, pointers] = TypeOf(type, element.tdesc);
    const bool isByReference = pointers == 1;
    const USHORT direction = flags & (PARAMFLAG_FIN | PARAMFLAG_FOUT | PARAMFLAG_FRETVAL);
    Require(pointers == 0 || isByReference, "a pointer to a pointer: " + name);
    Require(direction == (isByReference ? PARAMFLAG_FIN | PARAMFLAG_FOUT : PARAMFLAG_FIN),
            "a wrong direction: " + name);
    return {name, valueType, isByReference, (flags & PARAMFLAG_FOPT) != 0, InitialOf(element.paramdesc)};
}

Access AccessOf(INVOKEKIND kind)
{
    switch (kind) {
    case INVOKE_PROPERTYGET:
        return Access::Get;
    case INVOKE_PROPERTYPUT:
        return Access::Put;
    case INVOKE_PROPERTYPUTREF:
        return Access::PutReference;
    default:
        return Access::Call;
    }
}

// The name of a function and those of its arguments, as far as the type library has them.
std::vector<std::string> NamesOf(ITypeInfo* type, const FUNCDESC& function)
{
    std::vector<BSTR> given(static_cast<std::size_t>(function.cParams) + 1);
    UINT count = 0;
    type->GetNames(function.memid, given.data(), static_cast<UINT>(given.size()), &count);
    std::vector<std::string> names(given.size());
    for (UINT i = 0; i < count; ++i) {
        names[i] = tests::ToUtf8(given[i]);
        SysFreeString(given[i]);
    }
    return names;
}

// What a property is stored from, and what a call gives, is the last of the parameters.
bool HasValueLast(const FUNCDESC& function)
{
    if (function.cParams == 0)
        return false;
    const USHORT flags = function.lprgelemdescParam[function.cParams - 1].paramdesc.wParamFlags;
    return (flags & PARAMFLAG_FRETVAL) != 0 || function.invkind == INVOKE_PROPERTYPUT
           || function.invkind == INVOKE_PROPERTYPUTREF;
}

idl::ValueType LastTypeOf(ITypeInfo* type, const FUNCDESC& function)
{
    if (!HasValueLast(function))
        return {};
    const ELEMDESC& last = function.lprgelemdescParam[function.cParams - 1];
    const bool isResult = (last.paramdesc.wParamFlags & PARAMFLAG_FRETVAL) != 0;
    const auto [valueType, pointers] = TypeOf(type, last.tdesc);
    Require(pointers == (isResult ? 1 : 0), "a wrong last parameter: " + WordsOf(type, function.memid).name);
    return valueType;
}

idl::Slot SlotOf(ITypeInfo* type, const FUNCDESC& function)
{
    const auto [name, doc] = WordsOf(type, function.memid);
    Require(function.elemdescFunc.tdesc.vt == VT_HRESULT && function.callconv == CC_STDCALL,
            "no automation call: " + name);
    idl::Slot slot{function.oVft / static_cast<int>(sizeof(void*)),
                   static_cast<int>(function.memid),
                   AccessOf(function.invkind),
                   name,
                   doc,
                   {},
                   LastTypeOf(type, function)};
    const std::vector<std::string> names = NamesOf(type, function);
    const int count = function.cParams - (HasValueLast(function) ? 1 : 0);
    for (int i = 0; i < count; ++i)
        slot.arguments.push_back(
            ArgumentOf(type, function.lprgelemdescParam[i], names[static_cast<std::size_t>(i) + 1]));
    return slot;
}

std::string InterfaceAttributesOf(WORD flags)
{
    struct Flag
    {
        WORD flag;
        std::string_view word;
    };
    constexpr Flag words[] = {{TYPEFLAG_FDUAL, "dual"},
                              {TYPEFLAG_FHIDDEN, "hidden"},
                              {TYPEFLAG_FNONEXTENSIBLE, "nonextensible"},
                              {TYPEFLAG_FOLEAUTOMATION, "oleautomation"}};
    std::string text;
    for (const auto& [flag, word] : words)
        if (flags & flag)
            text += (text.empty() ? "" : ", ") + std::string(word);
    return text;
}

std::string ClassAttributesOf(WORD flags)
{
    return std::string(flags & TYPEFLAG_FCANCREATE ? "" : "noncreatable ")
           + (flags & TYPEFLAG_FAPPOBJECT ? std::string(idl::kPredeclared) : "");
}

// A dual interface is described twice: to callers by name, and, behind that, to callers of its slots.
idl::Class ClassOf(ITypeInfo* coclass)
{
    const TYPEATTR attributes = AttributesOf(coclass);
    const Ptr<ITypeInfo> dispatch = Implemented(coclass, 0);
    const Ptr<ITypeInfo> dual = Implemented(dispatch.get(), -1);
    const TYPEATTR dualAttributes = AttributesOf(dual.get());
    const auto [name, doc] = WordsOf(coclass);
    const auto [interfaceName, interfaceDoc] = WordsOf(dual.get());
    idl::Class described{name,
                         ToText(attributes.guid),
                         doc,
                         ClassAttributesOf(attributes.wTypeFlags),
                         interfaceName,
                         ToText(dualAttributes.guid),
                         interfaceDoc,
                         InterfaceAttributesOf(dualAttributes.wTypeFlags),
                         {}};
    for (UINT i = 0; i < dualAttributes.cFuncs; ++i)
        described.slots.push_back(SlotOf(dual.get(), *Function(dual.get(), i)));
    return described;
}

idl::Enumeration EnumerationOf(ITypeInfo* type)
{
    const TYPEATTR attributes = AttributesOf(type);
    const auto [name, doc] = WordsOf(type);
    idl::Enumeration described{name, ToText(attributes.guid), doc, {}};
    for (UINT i = 0; i < attributes.cVars; ++i) {
        const auto constant = Variable(type, i);
        const auto [constantName, constantDoc] = WordsOf(type, constant->memid);
        described.constants.push_back({constantName, constant->lpvarValue->lVal, constantDoc});
    }
    return described;
}

idl::Library LibraryOf(ITypeLib* typeLibrary)
{
    TLIBATTR* attributes = nullptr;
    Require(SUCCEEDED(typeLibrary->GetLibAttr(&attributes)), "GetLibAttr");
    const auto [name, doc] = WordsOf(typeLibrary);
    idl::Library library{name, ToText(attributes->guid), attributes->wMajorVerNum, attributes->wMinorVerNum, doc, {},
                         {}};
    typeLibrary->ReleaseTLibAttr(attributes);
    for (UINT i = 0; i < typeLibrary->GetTypeInfoCount(); ++i) {
        Ptr<ITypeInfo> type;
        Require(SUCCEEDED(typeLibrary->GetTypeInfo(i, type.Out())), "GetTypeInfo");
        const TYPEKIND kind = AttributesOf(type.get()).typekind;
        if (kind == TKIND_ENUM)
            library.enumerations.push_back(EnumerationOf(type.get()));
        else if (kind == TKIND_COCLASS)
            library.classes.push_back(ClassOf(type.get()));
    }
    return library;
}

} // namespace

int wmain(int count, wchar_t** arguments)
try {
    const tests::Apartment apartment;
    Ptr<ITypeLib> typeLibrary;
    Require(SUCCEEDED(LoadTypeLibEx(count > 1 ? arguments[1] : L"Varnex3.dll", REGKIND_NONE, typeLibrary.Out())),
            "the file has no type library");
    const idl::Library library = LibraryOf(typeLibrary.get());
    const bool wantsHelp = count > 2 && std::wstring_view(arguments[2]) == L"--help-strings";
    std::fputs((wantsHelp ? idl::ToHelpStrings(library) : idl::ToListing(library)).c_str(), stdout);
    return 0;
} catch (const std::exception& error) {
    std::printf("read_typelib: %s\n", error.what());
    return 2;
}
