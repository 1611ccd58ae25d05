// What a host written in C++ has around automation: texts, variants and interface pointers that free themselves, calls
// by name, and the error that came with a failure.
#pragma once

#include <windows.h>

#include <ocidl.h>
#include <ole2.h>
#include <oleauto.h>

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace varnex3::tests {

// The automation of this thread, from here to the end of the scope.
class Apartment
{
public:
    explicit Apartment(DWORD model = COINIT_APARTMENTTHREADED) { CoInitializeEx(nullptr, model); }
    ~Apartment() { CoUninitialize(); }
    Apartment(const Apartment&) = delete;
    Apartment& operator=(const Apartment&) = delete;
};

// A counted interface pointer.
template <class I>
class Ptr
{
public:
    Ptr() = default;
    Ptr(std::nullptr_t) {}
    Ptr(const Ptr& other) : held(other.held)
    {
        if (held)
            held->AddRef();
    }
    Ptr(Ptr&& other) noexcept : held(std::exchange(other.held, nullptr)) {}
    ~Ptr() { Drop(); }
    Ptr& operator=(Ptr other) noexcept
    {
        std::swap(held, other.held);
        return *this;
    }

    I* get() const { return held; }
    I* operator->() const { return held; }
    explicit operator bool() const { return held != nullptr; }

    // Where a call puts an interface pointer; what was held is released.
    I** Out()
    {
        Drop();
        return &held;
    }
    void** OutVoid() { return reinterpret_cast<void**>(Out()); }

    void Drop()
    {
        if (I* const dropped = std::exchange(held, nullptr))
            dropped->Release();
    }

    template <class J>
    Ptr<J> As(REFIID id) const
    {
        Ptr<J> other;
        held->QueryInterface(id, other.OutVoid());
        return other;
    }

private:
    I* held = nullptr;
};

// A text of automation.
class Bstr
{
public:
    Bstr() = default;
    Bstr(std::wstring_view text) : held(SysAllocStringLen(text.data(), static_cast<UINT>(text.size()))) {}
    Bstr(const wchar_t* text) : Bstr(std::wstring_view(text)) {}
    Bstr(const Bstr&) = delete;
    Bstr& operator=(const Bstr&) = delete;
    ~Bstr() { SysFreeString(held); }

    operator BSTR() const { return held; }
    std::wstring Text() const { return held ? std::wstring(held, SysStringLen(held)) : std::wstring(); }
    BSTR* Out()
    {
        SysFreeString(std::exchange(held, nullptr));
        return &held;
    }
    BSTR* InOut() { return &held; }

private:
    BSTR held = nullptr;
};

// A value of automation.
class Value : public VARIANT
{
public:
    Value() { VariantInit(this); }
    Value(const wchar_t* text) : Value(std::wstring_view(text)) {}
    Value(std::wstring_view text) : Value()
    {
        vt = VT_BSTR;
        bstrVal = SysAllocStringLen(text.data(), static_cast<UINT>(text.size()));
    }
    Value(long number) : Value()
    {
        vt = VT_I4;
        lVal = number;
    }
    Value(int number) : Value(static_cast<long>(number)) {}
    Value(short number) : Value()
    {
        vt = VT_I2;
        iVal = number;
    }
    Value(double number) : Value()
    {
        vt = VT_R8;
        dblVal = number;
    }
    Value(bool flag) : Value()
    {
        vt = VT_BOOL;
        boolVal = flag ? VARIANT_TRUE : VARIANT_FALSE;
    }
    Value(IDispatch* object) : Value()
    {
        vt = VT_DISPATCH;
        pdispVal = object;
        if (object)
            object->AddRef();
    }
    Value(const Value& other) : Value()
    {
        VariantCopy(this, const_cast<Value*>(&other));
    } // whose declaration forgot const
    Value(Value&& other) noexcept : Value() { std::swap(static_cast<VARIANT&>(*this), static_cast<VARIANT&>(other)); }
    Value& operator=(Value other) noexcept
    {
        std::swap(static_cast<VARIANT&>(*this), static_cast<VARIANT&>(other));
        return *this;
    }
    ~Value() { VariantClear(this); }

    static Value Date(double serial)
    {
        Value value(serial);
        value.vt = VT_DATE;
        return value;
    }
    // An argument that a host left out.
    static Value Missing()
    {
        Value value;
        value.vt = VT_ERROR;
        value.scode = DISP_E_PARAMNOTFOUND;
        return value;
    }
    // A variable that is passed by reference.
    static Value Reference(VARIANT& variable)
    {
        Value value;
        value.vt = VT_BYREF | VT_VARIANT;
        value.pvarVal = &variable;
        return value;
    }

    VARIANT* Out()
    {
        VariantClear(this);
        return this;
    }
    std::wstring Text() const { return vt == VT_BSTR ? std::wstring(bstrVal, SysStringLen(bstrVal)) : L"(no text)"; }
};

// The error number of the library in an HRESULT.
constexpr HRESULT Raised(int number) { return static_cast<HRESULT>(0x800A0000U | static_cast<unsigned>(number)); }

// What a call gave: a value, or an error.
struct Outcome
{
    HRESULT status = S_OK; // what Invoke returned
    HRESULT error = S_OK;  // the error's own number where status is DISP_E_EXCEPTION, status otherwise
    Value value;
    std::wstring source;
    std::wstring description;
    UINT argument = 0; // which one is to blame, from the last one, with a type mismatch
};

// The dispatch id of a name, or DISPID_UNKNOWN.
DISPID IdOf(IDispatch* object, const wchar_t* name);

// Invoke with its arguments in the order of their declaration.
Outcome Invoke(IDispatch* object, DISPID id, int flags, std::vector<Value> arguments = {});

// By name, as scripts call. What does not exist has the status DISP_E_UNKNOWNNAME.
Outcome Call(IDispatch* object, const wchar_t* name, std::vector<Value> arguments = {});
Outcome Get(IDispatch* object, const wchar_t* name, std::vector<Value> arguments = {});
Outcome Put(IDispatch* object, const wchar_t* name, Value value, std::vector<Value> indexes = {});
Outcome PutReference(IDispatch* object, const wchar_t* name, IDispatch* value);

// "SourceDef.ParseXML: TimeStamp: ...": the error that the last early-bound call left; the empty text when it left
// none.
std::wstring TakeError();

// A new object of a class, by its program id.
Ptr<IDispatch> Create(const wchar_t* programId);

// The path of a file that stands beside this program.
std::wstring BesideProgram(const wchar_t* file);

std::string ToUtf8(std::wstring_view text);

} // namespace varnex3::tests
