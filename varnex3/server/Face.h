// What automation hosts hold of a record: one object with several interfaces, made when a host first sees the record,
// ending with it. Hosts' references are the record's own, so the same record is always the same object to them.
#pragma once

#include <windows.h>

#include <oleauto.h>

#include "varnex3/core/Record.h"
#include "varnex3/server/Coclass.h"

namespace varnex3::server {

// What an interface pointer of ours points to. Automation demands the first word: it leads to the functions.
struct Port
{
    const void* vtable = nullptr;
    Record* record = nullptr;

    // Precondition: the record is of this class.
    template <class C>
    C& As() const
    {
        return static_cast<C&>(*record);
    }
};

HRESULT STDMETHODCALLTYPE QueryInterface(Port* self, REFIID iid, void** result) noexcept;
ULONG STDMETHODCALLTYPE AddRef(Port* self) noexcept;
ULONG STDMETHODCALLTYPE Release(Port* self) noexcept;

// The three functions that every vtable begins with. The first of them marks an interface pointer as ours: nobody else
// has it.
struct UnknownFunctions
{
    decltype(&QueryInterface) queryInterface = &QueryInterface;
    decltype(&AddRef) addRef = &AddRef;
    decltype(&Release) release = &Release;
};

class Face final : public Attachment
{
public:
    // The face of a record, made if it has none yet.
    static Face& Of(Record& record);

    // The record's own interface, with a reference for the host; null for no record.
    static Port* PortFor(const Ref<Record>& record);

    explicit Face(Record& record);
    ~Face() override;

    const Coclass& Class() const { return coclass; }

    // One of the interfaces, without a reference; null for an unknown one.
    Port* Find(REFIID iid);

private:
    const Coclass& coclass;
    Port dispatch;
    Port supportErrorInfo;
    Port provideClassInfo;
};

// The record behind an interface pointer of a host; null when the object is not one of ours. The proxy of a record that
// lives in another apartment is not one of ours.
Record* RecordBehind(const void* object);

} // namespace varnex3::server
