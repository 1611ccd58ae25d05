#include "tests/windows/TypeLibrary.h"

namespace varnex3::tests {

namespace {

// The attributes of a type, given back with the scope.
class Attributes
{
public:
    explicit Attributes(ITypeInfo* type_) : type(type_) { type->GetTypeAttr(&held); }
    ~Attributes() { type->ReleaseTypeAttr(held); }
    Attributes(const Attributes&) = delete;
    Attributes& operator=(const Attributes&) = delete;
    const TYPEATTR* operator->() const { return held; }

private:
    ITypeInfo* type;
    TYPEATTR* held = nullptr;
};

class Function
{
public:
    Function(ITypeInfo* type_, UINT index) : type(type_) { type->GetFuncDesc(index, &held); }
    ~Function() { type->ReleaseFuncDesc(held); }
    Function(const Function&) = delete;
    Function& operator=(const Function&) = delete;
    const FUNCDESC* operator->() const { return held; }

private:
    ITypeInfo* type;
    FUNCDESC* held = nullptr;
};

std::wstring NameOf(ITypeInfo* type, MEMBERID id = MEMBERID_NIL)
{
    Bstr name;
    type->GetDocumentation(id, name.Out(), nullptr, nullptr, nullptr);
    return name.Text();
}

// The interface of a class is named after it, behind an underscore.
std::wstring ClassNameOf(const std::wstring& interfaceName) { return interfaceName.substr(1); }

ValueType Referred(ITypeInfo* type, HREFTYPE reference)
{
    Ptr<ITypeInfo> referred;
    type->GetRefTypeInfo(reference, referred.Out());
    const bool isEnumeration = Attributes(referred.get())->typekind == TKIND_ENUM;
    const std::wstring name = NameOf(referred.get());
    return isEnumeration ? ValueType{VT_I4, false, name} : ValueType{VT_DISPATCH, false, ClassNameOf(name)};
}

ValueType TypeOf(ITypeInfo* type, const TYPEDESC& description)
{
    if (description.vt == VT_USERDEFINED)
        return Referred(type, description.hreftype);
    if (description.vt != VT_PTR)
        return {description.vt, false, {}};
    ValueType pointed = TypeOf(type, *description.lptdesc);
    pointed.isByReference = pointed.type != VT_DISPATCH || description.lptdesc->vt == VT_PTR;
    return pointed;
}

Operation OperationOf(ITypeInfo* type, const Function& function)
{
    std::vector<BSTR> names(static_cast<std::size_t>(function->cParams) + 1);
    UINT count = 0;
    type->GetNames(function->memid, names.data(), static_cast<UINT>(names.size()), &count);
    Operation operation{NameOf(type, function->memid),
                        function->memid,
                        function->invkind,
                        static_cast<ULONG_PTR>(function->oVft),
                        {},
                        {}};
    for (std::size_t i = 0; i < names.size() - 1; ++i) {
        const ELEMDESC& element = function->lprgelemdescParam[i];
        const ValueType valueType = TypeOf(type, element.tdesc);
        const USHORT flags = element.paramdesc.wParamFlags;
        if (flags & PARAMFLAG_FRETVAL)
            operation.result = {valueType.type, false, valueType.name};
        else
            operation.parameters.push_back({i + 1 < count ? names[i + 1] : L"", valueType,
                                            (flags & (PARAMFLAG_FOPT | PARAMFLAG_FHASDEFAULT)) != 0});
    }
    for (UINT i = 0; i < count; ++i)
        SysFreeString(names[i]);
    return operation;
}

// The vtable of a dual interface, which its dispatch interface refers to.
Ptr<ITypeInfo> VtableOf(ITypeInfo* dispatch)
{
    HREFTYPE reference = 0;
    Ptr<ITypeInfo> vtable;
    if (SUCCEEDED(dispatch->GetRefTypeOfImplType(static_cast<UINT>(-1), &reference)))
        dispatch->GetRefTypeInfo(reference, vtable.Out());
    return vtable;
}

Ptr<ITypeInfo> DefaultInterfaceOf(ITypeInfo* coclass)
{
    HREFTYPE reference = 0;
    Ptr<ITypeInfo> dispatch;
    if (SUCCEEDED(coclass->GetRefTypeOfImplType(0, &reference)))
        coclass->GetRefTypeInfo(reference, dispatch.Out());
    return dispatch;
}

Class ClassOf(ITypeInfo* coclass)
{
    const Attributes attributes(coclass);
    const Ptr<ITypeInfo> vtable = VtableOf(DefaultInterfaceOf(coclass).get());
    const Attributes vtableAttributes(vtable.get());
    Class described{NameOf(coclass),
                    attributes->guid,
                    vtableAttributes->guid,
                    (attributes->wTypeFlags & TYPEFLAG_FCANCREATE) != 0,
                    {}};
    for (UINT i = 0; i < vtableAttributes->cFuncs; ++i)
        described.operations.push_back(OperationOf(vtable.get(), Function(vtable.get(), i)));
    return described;
}

} // namespace

std::vector<Class> ClassesOf(const wchar_t* file)
{
    std::vector<Class> classes;
    Ptr<ITypeLib> library;
    if (FAILED(LoadTypeLibEx(file, REGKIND_NONE, library.Out())))
        return classes;
    for (UINT i = 0; i < library->GetTypeInfoCount(); ++i) {
        TYPEKIND kind{};
        Ptr<ITypeInfo> type;
        if (SUCCEEDED(library->GetTypeInfoType(i, &kind)) && kind == TKIND_COCLASS
            && SUCCEEDED(library->GetTypeInfo(i, type.Out())))
            classes.push_back(ClassOf(type.get()));
    }
    return classes;
}

} // namespace varnex3::tests
