#include "tests/windows/Automation.h"

#include <algorithm>

namespace varnex3::tests {

DISPID IdOf(IDispatch* object, const wchar_t* name)
{
    std::wstring copy(name);
    wchar_t* names = copy.data();
    DISPID id = DISPID_UNKNOWN;
    object->GetIDsOfNames(IID_NULL, &names, 1, LOCALE_USER_DEFAULT, &id);
    return id;
}

Outcome Invoke(IDispatch* object, DISPID id, int flags, std::vector<Value> arguments)
{
    std::reverse(arguments.begin(), arguments.end());
    DISPID put = DISPID_PROPERTYPUT;
    const bool isPut = (flags & (DISPATCH_PROPERTYPUT | DISPATCH_PROPERTYPUTREF)) != 0;
    DISPPARAMS parameters{arguments.data(), isPut ? &put : nullptr, static_cast<UINT>(arguments.size()),
                          isPut ? 1U : 0U};
    EXCEPINFO exception{};
    Outcome outcome;
    outcome.status = object->Invoke(id, IID_NULL, LOCALE_USER_DEFAULT, static_cast<WORD>(flags), &parameters,
                                    outcome.value.Out(), &exception, &outcome.argument);
    outcome.error = outcome.status == DISP_E_EXCEPTION ? exception.scode : outcome.status;
    if (exception.bstrSource)
        outcome.source.assign(exception.bstrSource, SysStringLen(exception.bstrSource));
    if (exception.bstrDescription)
        outcome.description.assign(exception.bstrDescription, SysStringLen(exception.bstrDescription));
    SysFreeString(exception.bstrSource);
    SysFreeString(exception.bstrDescription);
    SysFreeString(exception.bstrHelpFile);
    return outcome;
}

namespace {

Outcome InvokeByName(IDispatch* object, const wchar_t* name, int flags, std::vector<Value> arguments)
{
    const DISPID id = IdOf(object, name);
    if (id == DISPID_UNKNOWN)
        return {DISP_E_UNKNOWNNAME, DISP_E_UNKNOWNNAME, {}, {}, {}, 0};
    return Invoke(object, id, flags, std::move(arguments));
}

} // namespace

Outcome Call(IDispatch* object, const wchar_t* name, std::vector<Value> arguments)
{
    return InvokeByName(object, name, DISPATCH_METHOD, std::move(arguments));
}

Outcome Get(IDispatch* object, const wchar_t* name, std::vector<Value> arguments)
{
    return InvokeByName(object, name, DISPATCH_PROPERTYGET, std::move(arguments));
}

Outcome Put(IDispatch* object, const wchar_t* name, Value value, std::vector<Value> indexes)
{
    indexes.push_back(std::move(value));
    return InvokeByName(object, name, DISPATCH_PROPERTYPUT, std::move(indexes));
}

Outcome PutReference(IDispatch* object, const wchar_t* name, IDispatch* value)
{
    return InvokeByName(object, name, DISPATCH_PROPERTYPUTREF, {Value(value)});
}

std::wstring TakeError()
{
    Ptr<IErrorInfo> info;
    if (GetErrorInfo(0, info.Out()) != S_OK)
        return {};
    Bstr source;
    Bstr description;
    info->GetSource(source.Out());
    info->GetDescription(description.Out());
    return source.Text() + L": " + description.Text();
}

Ptr<IDispatch> Create(const wchar_t* programId)
{
    CLSID id{};
    Ptr<IDispatch> object;
    if (SUCCEEDED(CLSIDFromProgID(programId, &id)))
        CoCreateInstance(id, nullptr, CLSCTX_INPROC_SERVER, IID_IDispatch, object.OutVoid());
    return object;
}

std::wstring BesideProgram(const wchar_t* file)
{
    wchar_t program[1024];
    const std::wstring path(program, GetModuleFileNameW(nullptr, program, 1024));
    return path.substr(0, path.find_last_of(L'\\') + 1) + file;
}

std::string ToUtf8(std::wstring_view text)
{
    const int units = static_cast<int>(text.size());
    const int size = WideCharToMultiByte(CP_UTF8, 0, text.data(), units, nullptr, 0, nullptr, nullptr);
    std::string bytes(static_cast<std::size_t>(size), '\0');
    WideCharToMultiByte(CP_UTF8, 0, text.data(), units, bytes.data(), size, nullptr, nullptr);
    return bytes;
}

} // namespace varnex3::tests
