#include "varnex3/server/Errors.h"

#include <bit>
#include <string>

#include "varnex3/core/Error.h"
#include "varnex3/server/Guids.h"

namespace varnex3::server {

namespace {

HRESULT StatusOf(std::int32_t number) { return MAKE_HRESULT(SEVERITY_ERROR, FACILITY_CONTROL, number); }

LPOLESTR HostText(const Text& text) { return reinterpret_cast<LPOLESTR>(const_cast<char16_t*>(text.c_str())); }

void LeaveWithThread(const Error& error, Name className)
{
    ICreateErrorInfo* made = nullptr;
    if (FAILED(CreateErrorInfo(&made)))
        return;
    made->SetGUID(std::bit_cast<GUID>(InterfaceGuid(className)));
    made->SetSource(HostText(error.Source()));
    made->SetDescription(HostText(error.Description()));
    IErrorInfo* info = nullptr;
    if (SUCCEEDED(made->QueryInterface(IID_IErrorInfo, reinterpret_cast<void**>(&info)))) {
        SetErrorInfo(0, info);
        info->Release();
    }
    made->Release();
}

} // namespace

HRESULT Raised(Name className, Name member) noexcept
{
    try {
        const Error error = CurrentError(std::string(className) + "." + std::string(member));
        LeaveWithThread(error, className);
        return StatusOf(error.Number());
    } catch (...) { // no memory, not even for the words
        SetErrorInfo(0, nullptr);
        return StatusOf(static_cast<std::int32_t>(ErrorNumber::OutOfMemory));
    }
}

HRESULT Told(HRESULT status, EXCEPINFO* exception) noexcept
{
    IErrorInfo* info = nullptr;
    GetErrorInfo(0, &info);
    if (exception) {
        *exception = {};
        exception->scode = status;
        if (info) {
            info->GetSource(&exception->bstrSource);
            info->GetDescription(&exception->bstrDescription);
        }
    }
    if (info)
        info->Release();
    return DISP_E_EXCEPTION;
}

} // namespace varnex3::server
