// A client that knows nothing but the type library inside the DLL: it calls every slot of every class, and the same
// member late bound, and compares.
#include <climits>
#include <cstring>
#include <deque>
#include <limits>
#include <set>

#include "tests/windows/Printing.h"
#include "tests/windows/TypeLibrary.h"

using namespace varnex3::tests;

namespace {

const std::vector<Class>& Classes()
{
    static const std::vector<Class> classes = ClassesOf(BesideProgram(L"Varnex3.dll").c_str());
    return classes;
}

// Properties that derive what they give from what they are set to. How is a rule of each class.
const std::set<std::wstring> kDerived = {
    L"InsurerDetailDef.Values", // an index that is not there stores nothing
    L"MessageDef.MessageDescription",
    L"QuoteDetailsDef.QuoteTypeID",
    L"QuoteItem.UpdateStatusType",
    L"QuoteItemPart.PartOrientationCode",
    L"QuoteItemPartPartSource.PartSourceCode",
    L"RequestDetailsDef.RequestTypeID",
    L"VarnexStatusDef.StatusType",
};

bool IsDerived(const Class& described, const Operation& setter)
{
    return kDerived.count(described.name + L"." + setter.name) != 0;
}

Ptr<IDispatch> New(const Class& described)
{
    Ptr<IDispatch> object;
    CoCreateInstance(described.id, nullptr, CLSCTX_INPROC_SERVER, described.interfaceId, object.OutVoid());
    return object;
}

Ptr<IDispatch> NewOf(const std::wstring& className)
{
    for (const Class& described : Classes())
        if (described.name == className)
            return New(described);
    return {};
}

bool IsPut(const Operation& operation)
{
    return operation.kind == INVOKE_PROPERTYPUT || operation.kind == INVOKE_PROPERTYPUTREF;
}

// A value of a type that means nothing: "", 0, the zero date, False, Nothing, Empty.
Value Nothing(const ValueType& type)
{
    if (type.type == VT_DISPATCH)
        return Value(static_cast<IDispatch*>(nullptr));
    Value value;
    if (type.type != VT_VARIANT)
        VariantChangeType(&value, &value, 0, type.type);
    return value;
}

// Where a slot writes a value of a type, and what it wrote there.
class Room
{
public:
    explicit Room(const ValueType& type)
    {
        if (type.type != VT_VARIANT)
            value.vt = type.type;
        reference.vt = static_cast<VARTYPE>(VT_BYREF | type.type);
        reference.byref = type.type == VT_VARIANT ? static_cast<void*>(&value) : static_cast<void*>(&value.llVal);
    }
    Room(const Room&) = delete;
    Room& operator=(const Room&) = delete;

    Value value;
    VARIANT reference{}; // to it, as an argument
};

// Calls the slot of the vtable itself, by its offset.
Outcome CallSlot(IDispatch* object, const Operation& operation, std::vector<Value> arguments)
{
    Room result(operation.result);
    std::vector<VARTYPE> types;
    std::vector<VARIANTARG*> places;
    for (std::size_t i = 0; i < arguments.size(); ++i) {
        const ValueType& type = operation.parameters[i].type;
        types.push_back(type.isByReference ? static_cast<VARTYPE>(VT_BYREF | type.type) : type.type);
        places.push_back(&arguments[i]);
    }
    if (operation.result.type != VT_EMPTY) {
        types.push_back(result.reference.vt);
        places.push_back(&result.reference);
    }
    Value status;
    const HRESULT called = DispCallFunc(object, operation.offset, CC_STDCALL, VT_ERROR, static_cast<UINT>(types.size()),
                                        types.data(), places.data(), &status);
    Outcome outcome;
    outcome.status = outcome.error = FAILED(called) ? called : status.scode;
    status.vt = VT_EMPTY;
    outcome.value = std::move(result.value);
    if (FAILED(outcome.status))
        outcome.description = TakeError();
    return outcome;
}

Outcome CallLate(IDispatch* object, const Operation& operation, std::vector<Value> arguments)
{
    Outcome outcome = Invoke(object, operation.id, operation.kind, std::move(arguments));
    if (outcome.status == DISP_E_EXCEPTION)
        outcome.description = outcome.source + L": " + outcome.description;
    return outcome;
}

bool IsSame(const VARIANT& a, const VARIANT& b)
{
    if (a.vt != b.vt)
        return false;
    switch (a.vt) {
    case VT_EMPTY:
        return true;
    case VT_BSTR:
        return std::wstring_view(a.bstrVal ? a.bstrVal : L"", SysStringLen(a.bstrVal))
               == std::wstring_view(b.bstrVal ? b.bstrVal : L"", SysStringLen(b.bstrVal));
    case VT_R8:
    case VT_DATE:
        return std::memcmp(&a.dblVal, &b.dblVal, sizeof a.dblVal) == 0;
    case VT_DISPATCH:
        return (a.pdispVal == nullptr) == (b.pdispVal == nullptr);
    default:
        return VarCmp(const_cast<VARIANT*>(&a), const_cast<VARIANT*>(&b), 0, 0) == static_cast<HRESULT>(VARCMP_EQ);
    }
}

// Arguments that mean nothing; variables behind those by reference, which the caller keeps.
std::vector<Value> NothingFor(const Operation& operation, std::deque<Room>& rooms)
{
    std::vector<Value> arguments;
    for (const Parameter& parameter : operation.parameters) {
        rooms.emplace_back(parameter.type);
        if (!parameter.type.isByReference) {
            arguments.push_back(Nothing(parameter.type));
            continue;
        }
        Value reference;
        static_cast<VARIANT&>(reference) = rooms.back().reference; // cleared as a reference: the room frees the value
        arguments.push_back(std::move(reference));
    }
    return arguments;
}

std::string NameOf(const Class& described, const Operation& operation)
{
    return ToUtf8(described.name + L"." + operation.name) + " slot at " + std::to_string(operation.offset);
}

// Values at the edges of a type, all of which a property keeps.
std::vector<Value> EdgesOf(const ValueType& type)
{
    const std::wstring manyCharacters(100000, L'x');
    const std::wstring anyCharacters = L"\t\r\n <&>\"' \u00e9\u20ac\u65e5 \U0001F600";
    const std::wstring zeroInside(L"a\0b", 3);
    using Double = std::numeric_limits<double>;
    switch (type.type) {
    case VT_BSTR:
        return {L"",
                L"x",
                std::wstring_view(anyCharacters),
                std::wstring_view(zeroInside),
                std::wstring_view(manyCharacters),
                L"\xd83d alone",
                L""};
    case VT_R8:
        return {0.0, -0.0, 1.005, Double::max(), Double::lowest(), Double::min(), Double::denorm_min(), 1.0 / 3, 0.0};
    case VT_DATE:
        return {Value::Date(0),       Value::Date(38061.5869560185), Value::Date(-1.25),
                Value::Date(-657434), Value::Date(2958465.99998843), Value::Date(0)};
    case VT_I2:
        return {short{0}, short{SHRT_MAX}, short{SHRT_MIN}, short{-1}};
    case VT_I4:
        return {0, std::numeric_limits<long>::max(), std::numeric_limits<long>::min(), -1, 0};
    case VT_BOOL:
        return {true, false, true};
    default:
        return {};
    }
}

// Calls a function for each property that is set to values, or to objects, with its getter and its setter.
template <class Function>
void ForEachProperty(INVOKEKIND put, Function function)
{
    for (const Class& described : Classes())
        for (std::size_t i = 1; i < described.operations.size(); ++i) {
            const Operation& setter = described.operations[i];
            if (setter.kind == put && setter.parameters.size() == 1)
                function(described, described.operations[i - 1], setter);
        }
}

} // namespace

TEST_CASE("The type library inside the DLL has classes, all of them creatable, with an interface of their own")
{
    const Apartment apartment;
    REQUIRE(Classes().size() >= 15);
    std::set<std::wstring> interfaces;
    for (const Class& described : Classes()) {
        CAPTURE(ToUtf8(described.name));
        CHECK(described.isCreatable);
        wchar_t text[40];
        StringFromGUID2(described.interfaceId, text, 40);
        CHECK(interfaces.insert(text).second);
        CHECK(New(described));
        CHECK(Create((L"Varnex3." + described.name).c_str()));
    }
}

TEST_CASE("The slots of a class follow those of IDispatch without a gap, a getter before its setter")
{
    const Apartment apartment;
    for (const Class& described : Classes()) {
        MEMBERID last = 0;
        for (std::size_t i = 0; i < described.operations.size(); ++i) {
            const Operation& operation = described.operations[i];
            CAPTURE(NameOf(described, operation));
            CHECK(operation.offset == (7 + i) * sizeof(void*));
            CHECK(operation.id == (IsPut(operation) ? last : last + 1));
            last = operation.id;
        }
    }
}

TEST_CASE("Every name of the type library is a name for late binding, whatever its letter case, with the same id")
{
    const Apartment apartment;
    for (const Class& described : Classes()) {
        const Ptr<IDispatch> object = New(described);
        for (const Operation& operation : described.operations) {
            CAPTURE(NameOf(described, operation));
            std::wstring upper = operation.name;
            std::wstring lower = operation.name;
            CharUpperW(upper.data());
            CharLowerW(lower.data());
            CHECK(IdOf(object.get(), operation.name.c_str()) == operation.id);
            CHECK(IdOf(object.get(), upper.c_str()) == operation.id);
            CHECK(IdOf(object.get(), lower.c_str()) == operation.id);
        }
    }
}

TEST_CASE("Every slot, called with arguments that mean nothing, does and gives what Invoke does and gives")
{
    const Apartment apartment;
    for (const Class& described : Classes()) {
        const Ptr<IDispatch> early = New(described);
        const Ptr<IDispatch> late = New(described);
        for (const Operation& operation : described.operations) {
            CAPTURE(NameOf(described, operation));
            std::deque<Room> earlyRooms;
            std::deque<Room> lateRooms;
            const Outcome slot = CallSlot(early.get(), operation, NothingFor(operation, earlyRooms));
            const Outcome invoked = CallLate(late.get(), operation, NothingFor(operation, lateRooms));
            CHECK(slot.error == invoked.error);
            CHECK(slot.description == invoked.description);
            CHECK((FAILED(slot.error) || IsSame(slot.value, invoked.value)));
            for (std::size_t i = 0; i < earlyRooms.size(); ++i)
                CHECK(IsSame(earlyRooms[i].value, lateRooms[i].value));
        }
    }
}

TEST_CASE("A property gives back what it was set to, at the edges of its type, set and read early and late bound")
{
    const Apartment apartment;
    ForEachProperty(INVOKE_PROPERTYPUT, [](const Class& described, const Operation& getter, const Operation& setter) {
        CAPTURE(NameOf(described, setter));
        const Ptr<IDispatch> object = New(described);
        if (IsDerived(described, setter))
            return;
        for (const Value& value : EdgesOf(getter.result)) {
            CHECK(CallSlot(object.get(), setter, {value}).error == S_OK);
            CHECK(IsSame(CallLate(object.get(), getter, {}).value, value));
            CHECK(CallLate(object.get(), setter, {Nothing(getter.result)}).error == S_OK);
            CHECK(CallLate(object.get(), setter, {value}).error == S_OK);
            CHECK(IsSame(CallSlot(object.get(), getter, {}).value, value));
        }
    });
}

TEST_CASE("A property that derives what it gives does so early bound as late bound, at the edges of its type")
{
    const Apartment apartment;
    ForEachProperty(INVOKE_PROPERTYPUT, [](const Class& described, const Operation& getter, const Operation& setter) {
        if (!IsDerived(described, setter))
            return;
        CAPTURE(NameOf(described, setter));
        const Ptr<IDispatch> early = New(described);
        const Ptr<IDispatch> late = New(described);
        for (const Value& value : EdgesOf(getter.result)) {
            CHECK(CallSlot(early.get(), setter, {value}).error == CallLate(late.get(), setter, {value}).error);
            CHECK(IsSame(CallSlot(early.get(), getter, {}).value, CallLate(late.get(), getter, {}).value));
        }
    });
}

TEST_CASE("A property of an object gives back the very object, made by itself after Nothing")
{
    const Apartment apartment;
    ForEachProperty(INVOKE_PROPERTYPUTREF,
                    [](const Class& described, const Operation& getter, const Operation& setter) {
                        CAPTURE(NameOf(described, setter));
                        const Ptr<IDispatch> object = New(described);
                        const Ptr<IDispatch> early = NewOf(getter.result.name);
                        const Ptr<IDispatch> late = NewOf(getter.result.name);
                        REQUIRE(early);
                        CHECK(CallSlot(object.get(), setter, {Value(early.get())}).error == S_OK);
                        CHECK(CallLate(object.get(), getter, {}).value.pdispVal == early.get());
                        CHECK(CallLate(object.get(), setter, {Value(late.get())}).error == S_OK);
                        CHECK(CallSlot(object.get(), getter, {}).value.pdispVal == late.get());
                        CHECK(CallSlot(object.get(), setter, {Nothing(getter.result)}).error == S_OK);
                        const Value made = CallSlot(object.get(), getter, {}).value;
                        CHECK(made.pdispVal != nullptr);
                        CHECK(made.pdispVal != late.get());
                        CHECK(CallLate(object.get(), getter, {}).value.pdispVal == made.pdispVal);
                    });
}

TEST_CASE("A property of an object refuses an object of any other class with a type mismatch, and keeps its own")
{
    const Apartment apartment;
    ForEachProperty(INVOKE_PROPERTYPUTREF,
                    [](const Class& described, const Operation& getter, const Operation& setter) {
                        const Ptr<IDispatch> object = New(described);
                        const Value before = CallSlot(object.get(), getter, {}).value;
                        for (const Class& other : Classes()) {
                            if (other.name == getter.result.name)
                                continue;
                            CAPTURE(NameOf(described, setter));
                            CAPTURE(ToUtf8(other.name));
                            const Ptr<IDispatch> foreign = New(other);
                            CHECK(CallSlot(object.get(), setter, {Value(foreign.get())}).error == Raised(13));
                            CHECK(CallLate(object.get(), setter, {Value(foreign.get())}).error != S_OK);
                            CHECK(CallSlot(object.get(), getter, {}).value.pdispVal == before.pdispVal);
                        }
                    });
}

TEST_CASE("A property of values refuses an object with a type mismatch, and keeps its value")
{
    const Apartment apartment;
    ForEachProperty(INVOKE_PROPERTYPUT, [](const Class& described, const Operation& getter, const Operation& setter) {
        CAPTURE(NameOf(described, setter));
        const Ptr<IDispatch> object = New(described);
        const Value before = CallLate(object.get(), getter, {}).value;
        const Outcome outcome = CallLate(object.get(), setter, {Value(object.get())});
        CHECK(outcome.status == DISP_E_EXCEPTION);
        CHECK(outcome.error == Raised(13));
        CHECK(IsSame(CallLate(object.get(), getter, {}).value, before));
    });
}

TEST_CASE("A number beyond an integer property raises an overflow; a text that is no number, a type mismatch")
{
    const Apartment apartment;
    ForEachProperty(INVOKE_PROPERTYPUT, [](const Class& described, const Operation& getter, const Operation& setter) {
        CAPTURE(NameOf(described, setter));
        const Ptr<IDispatch> object = New(described);
        const VARTYPE type = getter.result.type;
        const bool isInteger = type == VT_I2 || type == VT_I4;
        if (isInteger)
            for (const double number : {3e9, -3e9})
                CHECK(CallLate(object.get(), setter, {Value(number)}).error == Raised(6));
        if (type == VT_I2)
            CHECK(CallLate(object.get(), setter, {Value(32768)}).error == Raised(6));
        if (isInteger || type == VT_R8 || type == VT_BOOL || type == VT_DATE)
            CHECK(CallLate(object.get(), setter, {Value(L"soon")}).error == Raised(13));
    });
}

TEST_CASE("One argument too many is refused before anything is called")
{
    const Apartment apartment;
    for (const Class& described : Classes()) {
        const Ptr<IDispatch> object = New(described);
        for (const Operation& operation : described.operations) {
            CAPTURE(NameOf(described, operation));
            std::vector<Value> arguments(operation.parameters.size() + 1, Value(L"x"));
            CHECK(CallLate(object.get(), operation, std::move(arguments)).status == DISP_E_BADPARAMCOUNT);
        }
    }
}

TEST_CASE("A slot without a place for its result gives E_POINTER and changes nothing")
{
    const Apartment apartment;
    for (const Class& described : Classes()) {
        const Ptr<IDispatch> object = New(described);
        for (Operation operation : described.operations) {
            if (operation.result.type == VT_EMPTY || !operation.parameters.empty())
                continue;
            CAPTURE(NameOf(described, operation));
            operation.parameters.push_back({L"place of the result", {VT_BSTR, true, {}}, false});
            operation.result = {};
            Value nowhere;
            nowhere.vt = VT_BYREF | VT_BSTR;
            CHECK(CallSlot(object.get(), operation, {std::move(nowhere)}).error == E_POINTER);
        }
    }
}

TEST_CASE("Every object tells its class, and that its interface has errors")
{
    const Apartment apartment;
    for (const Class& described : Classes()) {
        CAPTURE(ToUtf8(described.name));
        const Ptr<IDispatch> object = New(described);
        const auto provider = object.As<IProvideClassInfo>(IID_IProvideClassInfo);
        REQUIRE(provider);
        Ptr<ITypeInfo> type;
        REQUIRE(provider->GetClassInfo(type.Out()) == S_OK);
        TYPEATTR* attributes = nullptr;
        REQUIRE(type->GetTypeAttr(&attributes) == S_OK);
        CHECK(attributes->typekind == TKIND_COCLASS);
        CHECK(IsEqualGUID(attributes->guid, described.id));
        type->ReleaseTypeAttr(attributes);
        const auto errors = object.As<ISupportErrorInfo>(IID_ISupportErrorInfo);
        REQUIRE(errors);
        CHECK(errors->InterfaceSupportsErrorInfo(described.interfaceId) == S_OK);
        CHECK(errors->InterfaceSupportsErrorInfo(IID_IClassFactory) == S_FALSE);
    }
}
