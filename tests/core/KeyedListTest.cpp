#include "varnex3/core/KeyedList.h"

#include "tests/Printing.h"

using namespace varnex3;
using tests::RaisedBy;

namespace {

KeyedList<int> ListOf(std::initializer_list<const char16_t*> keys)
{
    KeyedList<int> list;
    for (const char16_t* const key : keys)
        list.Add(key, static_cast<int>(list.Count()), "List.Add");
    return list;
}

template <class T>
Text KeysOf(const KeyedList<T>& list)
{
    Text keys;
    for (std::size_t i = 0; i < list.Count(); ++i)
        keys += list.KeyAt(i) + u" ";
    return keys;
}

} // namespace

TEST_CASE("KeyedList: items keep the order in which they were added")
{
    KeyedList<int> list = ListOf({u"b", u"a", u"c"});
    CHECK(KeysOf(list) == u"b a c ");
    CHECK(list.ItemAt(1) == 1);
    CHECK(*list.Find(u"c") == 2);
    CHECK(list.Find(u"B") == nullptr);
}

TEST_CASE("KeyedList: a duplicate key is an error of the operation and changes nothing")
{
    KeyedList<int> list = ListOf({u"a", u"b"});
    CHECK(RaisedBy([&] { list.Add(u"a", 9, "List.Add"); }) == "457 List.Add");
    CHECK(KeysOf(list) == u"a b ");
    CHECK(*list.Find(u"a") == 0);
}

TEST_CASE("KeyedList: removing closes the gap and frees the key")
{
    KeyedList<int> list = ListOf({u"a", u"b", u"c"});
    list.RemoveAt(0);
    list.Remove(u"c", "List.Remove");
    CHECK(KeysOf(list) == u"b ");
    CHECK(list.Find(u"a") == nullptr);
    CHECK(list.Add(u"a", 7, "List.Add") == 7);
    CHECK(KeysOf(list) == u"b a ");
}

TEST_CASE("KeyedList: an unknown key cannot be removed")
{
    KeyedList<int> list = ListOf({u"a"});
    CHECK(RaisedBy([&] { list.Remove(u"A", "List.Remove"); }) == "32811 List.Remove");
    CHECK(list.Count() == 1);
}

TEST_CASE("KeyedList: keys are found however long the list grows")
{
    KeyedList<int> list;
    for (int i = 0; i < 5000; ++i)
        list.Add(ToText(Variant(std::int32_t{i})), i, "List.Add");
    for (int i = 0; i < 5000; i += 2)
        list.Remove(ToText(Variant(std::int32_t{i})), "List.Remove");
    CHECK(list.Count() == 2500);
    int found = 0;
    for (int i = 0; i < 5000; ++i)
        if (const int* const item = list.Find(ToText(Variant(std::int32_t{i}))))
            found += *item == i;
    CHECK(found == 2500);
}

TEST_CASE("KeyedList: keys may hold any characters, also none and a zero")
{
    KeyedList<int> list;
    list.Add(u"", 1, "List.Add");
    list.Add(Text(u"a\0b", 3), 2, "List.Add");
    list.Add(u"a", 3, "List.Add");
    CHECK(*list.Find(u"") == 1);
    CHECK(*list.Find(TextView(u"a\0b", 3)) == 2);
    CHECK(*list.Find(u"a") == 3);
}

TEST_CASE("KeyedList: an item stays where it is while others come and go")
{
    KeyedList<int> list = ListOf({u"a", u"b"});
    int* const b = list.Find(u"b");
    for (int i = 0; i < 1000; ++i)
        list.Add(u"x" + ToText(Variant(std::int32_t{i})), i, "List.Add");
    list.RemoveAt(0);
    CHECK(list.Find(u"b") == b);
}

TEST_CASE("KeyedList: however many keys there are, each is found, and none twice")
{
    const auto keyOf = [](int i) { return Text(static_cast<std::size_t>(i) + 1, u'k'); };
    for (int count = 0; count < 20; ++count) {
        KeyedList<int> list;
        for (int i = 0; i < count; ++i)
            list.Add(keyOf(i), i, "List.Add");
        for (int removed = 0; removed <= count; ++removed) {
            for (int i = 0; i < count; ++i)
                CHECK((list.Find(keyOf(i)) ? *list.Find(keyOf(i)) : -1) == (i < removed ? -1 : i));
            if (removed < count)
                CHECK(RaisedBy([&] { list.Add(keyOf(count - 1), 0, "List.Add"); }) == "457 List.Add");
            if (removed < count)
                list.Remove(keyOf(removed), "List.Remove");
        }
        list.Add(keyOf(0), 7, "List.Add");
        CHECK(*list.Find(keyOf(0)) == 7);
    }
}
