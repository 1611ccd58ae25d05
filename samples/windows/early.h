// What both samples for C++ need: objects and texts that are released by themselves, and failures as exceptions.
//
// For Visual C++ and for mingw-w64. With Visual C++, #import "Varnex3.tlb" gives the same and more.
#pragma once

#include <iostream>
#include <string>

#include "Varnex3.h"

// A text on its way into or out of a call.
class Text
{
public:
    Text() = default;
    Text(const std::wstring& text) : text(SysAllocStringLen(text.data(), static_cast<UINT>(text.size()))) {}
    ~Text() { SysFreeString(text); }
    Text(const Text&) = delete;
    Text& operator=(const Text&) = delete;

    operator BSTR() const { return text; }
    BSTR* Out() { return &text; }

private:
    BSTR text = nullptr;
};

inline std::ostream& operator<<(std::ostream& stream, const Text& text)
{
    const int size = static_cast<int>(SysStringLen(text));
    std::string narrow(
        static_cast<std::size_t>(WideCharToMultiByte(CP_ACP, 0, text, size, nullptr, 0, nullptr, nullptr)), ' ');
    WideCharToMultiByte(CP_ACP, 0, text, size, &narrow[0], static_cast<int>(narrow.size()), nullptr, nullptr);
    return stream << narrow;
}

// A reference to an object.
template <class Interface>
class Object
{
public:
    Object() = default;
    explicit Object(REFCLSID kind); // a new one
    ~Object()
    {
        if (object)
            object->Release();
    }
    Object(const Object&) = delete;
    Object& operator=(const Object&) = delete;

    Interface* operator->() const { return object; }
    Interface** Out() { return &object; }

private:
    Interface* object = nullptr;
};

// Raised when a call fails; the thread's error object then tells of it.
struct Failure
{
    HRESULT status;
};

inline void Check(HRESULT status)
{
    if (FAILED(status))
        throw Failure{status};
}

template <class Interface>
Object<Interface>::Object(REFCLSID kind)
{
    Check(
        CoCreateInstance(kind, nullptr, CLSCTX_INPROC_SERVER, __uuidof(Interface), reinterpret_cast<void**>(&object)));
}

inline void Print(const Failure& failure)
{
    Text source, words;
    Object<IErrorInfo> error;
    if (GetErrorInfo(0, error.Out()) == S_OK) {
        error->GetSource(source.Out());
        error->GetDescription(words.Out());
    }
    std::cout << "Error " << (failure.status & 0xFFFF) << " from " << source << ": " << words << '\n';
}

// COM for the thread that has one.
struct Apartment
{
    Apartment() { Check(CoInitializeEx(nullptr, COINIT_APARTMENTTHREADED)); }
    ~Apartment() { CoUninitialize(); }
};
