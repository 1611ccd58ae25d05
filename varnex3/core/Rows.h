// The interface of a class, one row a member, written inside the class in interface order.
//
// A row is the declaration of the C++ accessors (and of the private member they read and store) and at once the entry
// in the interface table from which every other face is made. Rows declare, they never decide: what is written when is
// the business of the class's Write and Read.
//
//     class VersionDef final : public Record
//     {
//         VARNEX_RECORD(VersionDef, "The version of the message language.");
//         VARNEX_SERIALISE("The Version element.");
//         VARNEX_PARSEXML(Variant, "Reads the version; an absent one is the empty text.");
//         VARNEX_PROPERTY(Text, sXaloVersion, XaloVersion, "Version of the message language.");
//         VARNEX_READONLY(Text, DLLVersion, "Version of this library.");
//         VARNEX_RECORD_END;
//     };
//
// and VARNEX_DEFINE(VersionDef); in its source file. One row to a line: the line orders the rows.
#pragma once

#include "varnex3/core/Declarations.h"
#include "varnex3/core/Enumeration.h"
#include "varnex3/core/RareText.h"
#include "varnex3/core/Types.h"
#include "varnex3/core/XmlSection.h"
#include "varnex3/core/XmlWriter.h"

namespace varnex3 {

// The place of a row: the line it stands on.
template <int N>
struct Line
{};

// What the accessors of a property take and give for a private member of this type.
template <class T>
struct Access
{
    using Value = T;
    using Given = const T&;
    static Given Give(const T& member) { return member; }
};
template <class T>
requires std::is_arithmetic_v<T> || std::is_enum_v<T>
struct Access<T>
{
    using Value = T;
    using Given = T;
    static Given Give(T member) { return member; }
};
template <>
struct Access<RareText>
{
    using Value = Text;
    using Given = const Text&;
    static Given Give(const RareText& member) { return member.Held(); }
};
template <>
struct Access<WordText>
{
    using Value = Text;
    using Given = Text;
    static Given Give(const WordText& member) { return member.Copy(); }
};
template <class T, Ref<T> (*Make)()>
struct Access<Child<T, Make>>
{
    using Value = Ref<T>;
    using Given = const Ref<T>&;
    static Given Give(const Child<T, Make>& member) { return member.Held(); }
};

namespace rows {

// A row: the member as plain data, and in its type what a call goes to. Put is nullptr for methods and what is
// read-only.
template <class C, auto Get_, auto Put_ = nullptr>
struct Row : Member
{
    using Owner = C;
    static constexpr auto kGet = Get_;
    static constexpr auto kPut = Put_;
};

template <class F>
struct Signature;
template <class C, class R, class... A>
struct Signature<R (C::*)(A...)>
{
    using Result = std::remove_cvref_t<R>;
    using Parameters = std::tuple<A...>;
    using Owner = C;
};
template <class C, class R, class... A>
struct Signature<R (C::*)(A...) const> : Signature<R (C::*)(A...)>
{};
template <class R, class... A>
struct Signature<R (*)(A...)>
{
    using Result = std::remove_cvref_t<R>;
    using Parameters = std::tuple<A...>;
    using Owner = void;
};

// Calls F with the arguments converted, and those by reference written back. The value of a property that is stored
// stands last.
template <class C, auto F, class... A, std::size_t... I>
auto Invoke(Record* record, Arguments arguments, const Variant* value, std::tuple<A...>*, std::index_sequence<I...>)
{
    Variant last = value ? *value : Empty;
    std::tuple<Argument<A>...> held{Argument<A>(I < arguments.size() ? arguments[I] : last)...};
    const auto call = [&]() -> decltype(auto) {
        if constexpr (std::is_void_v<C>)
            return F(std::get<I>(held).Pass()...);
        else
            return (static_cast<C*>(record)->*F)(std::get<I>(held).Pass()...);
    };
    if constexpr (std::is_void_v<decltype(call())>) {
        call();
        (std::get<I>(held).WriteBack(), ...);
        return Empty;
    } else {
        Variant result = ToVariant(std::remove_cvref_t<decltype(call())>(call()));
        (std::get<I>(held).WriteBack(), ...);
        return result;
    }
}

template <class C, auto F>
Variant Invoke(Record* record, Arguments arguments, const Variant* value = nullptr)
{
    using Parameters = typename Signature<decltype(F)>::Parameters;
    return Invoke<C, F>(record, arguments, value, static_cast<Parameters*>(nullptr),
                        std::make_index_sequence<std::tuple_size_v<Parameters>>());
}

// Fills in the parameters that a function has, named as its declaration names them.
template <class... A>
consteval void Describe(Member& member, Name declaration, std::tuple<A...>*)
{
    static_assert((InterfaceType<typename ParameterOf<A>::Value> && ...),
                  "a parameter is a text, number, date, Boolean, enumeration, record or variant");
    static_assert(sizeof...(A) <= Member::kMaxParameters, "a member has at most six parameters");
    [[maybe_unused]] const auto declared = Declarations(declaration);
    member.parameterCount = sizeof...(A);
    std::size_t i = 0;
    ((member.parameterSlots[i] = {declared[i].name, TypeOf<typename ParameterOf<A>::Value>::type,
                                  ParameterOf<A>::isByReference, ParameterOf<A>::isOutput, declared[i].isOptional,
                                  declared[i].initial},
      ++i),
     ...);
}

// A method of a class, or a function of a module (C is then void).
template <class C, auto F>
consteval auto Method(Name name, Name declaration, Name doc)
{
    using S = Signature<decltype(F)>;
    static_assert(InterfaceType<typename S::Result>,
                  "a result is a text, number, date, Boolean, enumeration, record or variant");
    Row<C, F> row{{MemberKind::Method, name, doc, TypeOf<typename S::Result>::type}};
    Describe(row, declaration, static_cast<typename S::Parameters*>(nullptr));
    row.get = [](Record* record, Arguments arguments) { return Invoke<C, F>(record, arguments); };
    return row;
}

// A property with accessors, indexed when they have parameters. Put may be nullptr.
template <class C, auto Get_, auto Put_>
consteval auto Property(Name name, Name declaration, Name doc)
{
    using S = Signature<decltype(Get_)>;
    static_assert(InterfaceType<typename S::Result>,
                  "a property is a text, number, date, Boolean, enumeration or record");
    Row<C, Get_, Put_> row{{MemberKind::Property, name, doc, TypeOf<typename S::Result>::type}};
    Describe(row, declaration, static_cast<typename S::Parameters*>(nullptr));
    row.get = [](Record* record, Arguments arguments) { return Invoke<C, Get_>(record, arguments); };
    if constexpr (!std::is_null_pointer_v<decltype(Put_)>)
        row.put = [](Record* record, Arguments arguments, const Variant& value) {
            Invoke<C, Put_>(record, arguments, &value);
        };
    return row;
}

// A private member is named by its type's prefix and the property's name: sQuoteNo for the text QuoteNo.
template <class T>
consteval bool IsNamedByConvention(Name member, Name property)
{
    using V = typename Access<T>::Value;
    Name prefix = "obj";
    if constexpr (std::is_same_v<V, Text>)
        prefix = "s";
    else if constexpr (std::is_same_v<V, double>)
        prefix = "d";
    else if constexpr (std::is_same_v<V, Date>)
        prefix = "dt";
    else if constexpr (std::is_same_v<V, std::int16_t>)
        prefix = "i";
    else if constexpr (std::is_same_v<V, std::int32_t>)
        prefix = "l";
    else if constexpr (std::is_same_v<V, bool>)
        prefix = "b";
    else if constexpr (std::is_enum_v<V>)
        prefix = "e";
    return member.starts_with(prefix) && member.substr(prefix.size()) == property;
}

// The row of a class, or of a module, on a line.
template <class T, int N>
concept HasClassRow = requires
{
    T::Row_(Line<N>());
};
template <class T, int N>
concept HasModuleRow = requires
{
    ModuleRow_(static_cast<T*>(nullptr), Line<N>());
};
template <class T, int N>
inline constexpr bool kHasRow = HasClassRow<T, N> || HasModuleRow<T, N>;

template <class T, int N>
consteval auto RowAt()
{
    if constexpr (HasClassRow<T, N>)
        return T::Row_(Line<N>());
    else
        return ModuleRow_(static_cast<T*>(nullptr), Line<N>());
}

template <class T, int N, std::size_t Size>
consteval void Take(std::array<Member, Size>& members, std::size_t& next)
{
    if constexpr (kHasRow<T, N>)
        members[next++] = RowAt<T, N>();
}

template <class T, int First, int... I>
consteval auto Collect(std::integer_sequence<int, I...>)
{
    std::array<Member, (std::size_t{0} + ... + std::size_t{kHasRow<T, First + I>})> members{};
    std::size_t next = 0;
    (Take<T, First + I>(members, next), ...);
    return members;
}

template <int Last, class T, int... I>
consteval bool HasLateRow(std::integer_sequence<int, I...>)
{
    return (false || ... || kHasRow<T, Last + I>);
}

// Automation hosts do not tell Value from value.
consteval bool HasDistinctNames(std::span<const Member> members)
{
    const auto lower = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c; };
    const auto isSame = [&](Name a, Name b) {
        for (std::size_t i = 0; i < a.size() && i < b.size(); ++i)
            if (lower(a[i]) != lower(b[i]))
                return false;
        return a.size() == b.size();
    };
    for (std::size_t i = 0; i < members.size(); ++i)
        for (std::size_t j = i + 1; j < members.size(); ++j)
            if (isSame(members[i].name, members[j].name))
                return false;
    return true;
}

// The members of a class or module, in the order of their lines.
template <class T>
inline constexpr auto
    kMembers = Collect<T, T::kFirstRow>(std::make_integer_sequence<int, T::kLastRow - T::kFirstRow>());

template <class T>
Ref<Record> Create()
{
    return New<T>();
}

template <class T>
concept IsPredeclared = requires
{
    T::kIsPredeclared;
};

template <class T>
const ClassInfo& InfoOf()
{
    static_assert(!HasLateRow<T::kLastRow, T>(std::make_integer_sequence<int, 40>()),
                  "a row stands after the end of its class");
    static_assert(HasDistinctNames(kMembers<T>), "two members have the same name but for the case of letters");
    if constexpr (std::is_base_of_v<Record, T>) {
        static constexpr ClassInfo info{T::ClassName, T::ClassDoc, kMembers<T>, &Create<T>, IsPredeclared<T>};
        return info;
    } else {
        static constexpr ClassInfo info{T::ClassName, T::ClassDoc, kMembers<T>, nullptr};
        return info;
    }
}

} // namespace rows
} // namespace varnex3

#define VARNEX_UNWRAP(...) __VA_ARGS__

// The first line of a class.
#define VARNEX_RECORD(Name_, doc)                                                                                      \
protected:                                                                                                             \
    ~Name_() override = default;                                                                                       \
                                                                                                                       \
public:                                                                                                                \
    using Self = Name_;                                                                                                \
    static constexpr ::varnex3::Name ClassName = #Name_;                                                               \
    static constexpr ::varnex3::Name ClassDoc = doc;                                                                   \
    const ::varnex3::ClassInfo& Class() const override;                                                                \
    static const ::varnex3::ClassInfo& Info();                                                                         \
    static constexpr int kFirstRow = __LINE__

// The last line of a class.
#define VARNEX_RECORD_END                                                                                              \
public:                                                                                                                \
    static constexpr int kLastRow = __LINE__

// In a class that hosts may use by its name alone, without creating an object.
#define VARNEX_PREDECLARED static constexpr bool kIsPredeclared = true

// In the class's source file.
#define VARNEX_DEFINE(Name_)                                                                                           \
    const ::varnex3::ClassInfo& Name_::Class() const { return Info(); }                                                \
    const ::varnex3::ClassInfo& Name_::Info() { return ::varnex3::rows::InfoOf<Name_>(); }                             \
    static_assert(true)

#define VARNEX_ROW_(...)                                                                                               \
    static consteval auto Row_(::varnex3::Line<__LINE__>) { return __VA_ARGS__; }                                      \
    static_assert(true)

#define VARNEX_MEMBER_(Type_, member, Name_)                                                                           \
    static_assert(::varnex3::rows::IsNamedByConvention<Type_>(#member, #Name_),                                        \
                  "the member of a property is named by its type's prefix and the property's name");                   \
                                                                                                                       \
private:                                                                                                               \
    Type_ member{};                                                                                                    \
                                                                                                                       \
public:                                                                                                                \
    ::varnex3::Access<Type_>::Given Name_() const { return ::varnex3::Access<Type_>::Give(member); }

// A property that reads and stores a private member and does nothing else. A Child member is made on first use.
#define VARNEX_PROPERTY(Type_, member, Name_, doc)                                                                     \
    VARNEX_MEMBER_(Type_, member, Name_)                                                                               \
    void Name_(::varnex3::Access<Type_>::Value value) { member = std::move(value); }                                   \
    VARNEX_ROW_(                                                                                                       \
        ::varnex3::rows::Property<Self, static_cast<::varnex3::Access<Type_>::Given (Self::*)() const>(&Self::Name_),  \
                                  static_cast<void (Self::*)(::varnex3::Access<Type_>::Value)>(&Self::Name_)>(         \
            #Name_, "()", doc))

// The same, read-only: hosts change the child, but cannot put another one in its place.
#define VARNEX_PROPERTY_GET(Type_, member, Name_, doc)                                                                 \
    VARNEX_MEMBER_(Type_, member, Name_)                                                                               \
    VARNEX_ROW_(                                                                                                       \
        ::varnex3::rows::Property<Self, static_cast<::varnex3::Access<Type_>::Given (Self::*)() const>(&Self::Name_),  \
                                  nullptr>(#Name_, "()", doc))

// A property whose accessors are written in the source file.
#define VARNEX_ACCESSORS(Type_, Name_, doc)                                                                            \
    Type_ Name_();                                                                                                     \
    void Name_(Type_ value);                                                                                           \
    VARNEX_ROW_(::varnex3::rows::Property<Self, static_cast<Type_ (Self::*)()>(&Self::Name_),                          \
                                          static_cast<void (Self::*)(Type_)>(&Self::Name_)>(#Name_, "()", doc))

// A read-only property whose getter is written in the source file.
#define VARNEX_READONLY(Type_, Name_, doc)                                                                             \
    Type_ Name_() const;                                                                                               \
    VARNEX_ROW_(::varnex3::rows::Property<Self, &Self::Name_, nullptr>(#Name_, "()", doc))

// An indexed property, written in the source file: VARNEX_INDEXED(Text, Values, (const Variant& Index), "...").
#define VARNEX_INDEXED(Type_, Name_, parameters, doc)                                                                  \
    Type_ Name_ parameters;                                                                                            \
    void Name_(VARNEX_UNWRAP parameters, const Type_& value);                                                          \
    VARNEX_ROW_(                                                                                                       \
        ::varnex3::rows::Property<Self, static_cast<Type_(Self::*) parameters>(&Self::Name_),                          \
                                  static_cast<void (Self::*)(VARNEX_UNWRAP parameters, const Type_&)>(&Self::Name_)>(  \
            #Name_, #parameters, doc))

// The same, read-only.
#define VARNEX_INDEXED_READONLY(Type_, Name_, parameters, doc)                                                         \
    Type_ Name_ parameters;                                                                                            \
    VARNEX_ROW_(::varnex3::rows::Property<Self, &Self::Name_, nullptr>(#Name_, #parameters, doc))

// A method, written in the source file: VARNEX_METHOD(void, Add, (const Text& sFieldName, const Text& sValue), "...").
// A parameter with a default is optional; a pointer is an optional one by reference.
#define VARNEX_METHOD(Type_, Name_, parameters, doc)                                                                   \
    Type_ Name_ parameters;                                                                                            \
    VARNEX_ROW_(::varnex3::rows::Method<Self, &Self::Name_>(#Name_, #parameters, doc))

// Serialise, as the text of what Write, in the source file, writes.
#define VARNEX_SERIALISE(doc)                                                                                          \
    void Write(::varnex3::XmlWriter& xml) const;                                                                       \
    ::varnex3::Text Serialise() const { return ::varnex3::XmlWriter::TextOf(*this); }                                  \
    VARNEX_ROW_(::varnex3::rows::Method<Self, &Self::Serialise>("Serialise", "()", doc))

// ParseXML, as Read, in the source file, reads a text. Its result, of type Type_, is always empty.
#define VARNEX_PARSEXML(Type_, doc)                                                                                    \
    void Read(const ::varnex3::XmlSection& section);                                                                   \
    Type_ ParseXML(const ::varnex3::Text& sXML)                                                                        \
    {                                                                                                                  \
        ::varnex3::XmlSection::ReadText(*this, sXML);                                                                  \
        return {};                                                                                                     \
    }                                                                                                                  \
    VARNEX_ROW_(::varnex3::rows::Method<Self, &Self::ParseXML>("ParseXML", "(const Text& sXML)", doc))

// ParseXML of a whole message, and of a few records: its result is the text written again from what was read.
#define VARNEX_PARSEXML_OF_MESSAGE(Type_, doc)                                                                         \
    void Read(const ::varnex3::XmlSection& section);                                                                   \
    Type_ ParseXML(const ::varnex3::Text& sXML)                                                                        \
    {                                                                                                                  \
        ::varnex3::XmlSection::ReadText(*this, sXML);                                                                  \
        return Serialise();                                                                                            \
    }                                                                                                                  \
    VARNEX_ROW_(::varnex3::rows::Method<Self, &Self::ParseXML>("ParseXML", "(const Text& sXML)", doc))

// A module: functions that need no object. Its rows stand between VARNEX_MODULE and VARNEX_MODULE_END, at namespace
// scope; each declares a function of the namespace varnex3.
#define VARNEX_MODULE(Name_, doc)                                                                                      \
    struct Name_                                                                                                       \
    {                                                                                                                  \
        static constexpr ::varnex3::Name ClassName = #Name_;                                                           \
        static constexpr ::varnex3::Name ClassDoc = doc;                                                               \
        static const ::varnex3::ClassInfo& Info();                                                                     \
        static constexpr int kFirstRow = __LINE__;                                                                     \
        static const int kLastRow;                                                                                     \
    }

#define VARNEX_FUNCTION(Module_, Type_, Name_, parameters, doc)                                                        \
    Type_ Name_ parameters;                                                                                            \
    consteval auto ModuleRow_(Module_*, ::varnex3::Line<__LINE__>)                                                     \
    {                                                                                                                  \
        return ::varnex3::rows::Method<void, &Name_>(#Name_, #parameters, doc);                                        \
    }                                                                                                                  \
    static_assert(true)

#define VARNEX_MODULE_END(Name_) inline constexpr int Name_::kLastRow = __LINE__

// In the module's source file.
#define VARNEX_MODULE_DEFINE(Name_)                                                                                    \
    const ::varnex3::ClassInfo& Name_::Info() { return ::varnex3::rows::InfoOf<Name_>(); }                             \
    static_assert(true)
