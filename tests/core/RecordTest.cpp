#include "varnex3/core/Record.h"

#include "tests/Printing.h"
#include "tests/Threads.h"
#include "varnex3/core/CustomerDef.h"
#include "varnex3/core/Rows.h"

namespace varnex3 {
namespace {

int living = 0;

struct Life
{
    Life() { ++living; }
    ~Life() { --living; }
    Life(const Life&) = delete;
    Life& operator=(const Life&) = delete;
};

class Leaf final : public Record
{
    VARNEX_RECORD(Leaf, "A record that counts how many of it live.");
    VARNEX_PROPERTY(Text, sName, Name, "Name.");

private:
    Life life;
    VARNEX_RECORD_END;
};

class Branch final : public Record
{
    VARNEX_RECORD(Branch, "A record that holds another.");
    VARNEX_PROPERTY(Child<Leaf>, objFirst, First, "The other.");
    VARNEX_RECORD_END;
};

Ref<Leaf> NewNamedLeaf()
{
    const auto leaf = New<Leaf>();
    leaf->Name(u"made");
    return leaf;
}

class Twig final : public Record
{
    using NamedLeaf = Child<Leaf, &NewNamedLeaf>;
    VARNEX_RECORD(Twig, "A record whose child starts with a name.");
    VARNEX_PROPERTY(NamedLeaf, objFirst, First, "The child.");
    VARNEX_RECORD_END;
};

VARNEX_DEFINE(Twig);
VARNEX_DEFINE(Leaf);
VARNEX_DEFINE(Branch);

} // namespace
} // namespace varnex3

using namespace varnex3;

TEST_CASE("Ref: a record lives as long as somebody holds it")
{
    Ref<Record> held;
    {
        const auto leaf = New<Leaf>();
        CHECK(living == 1);
        held = leaf;
    }
    CHECK(living == 1);
    held = nullptr;
    CHECK(living == 0);
}

TEST_CASE("Ref: copying holds once more, moving does not")
{
    std::vector<Ref<Leaf>> holders(3, New<Leaf>());
    CHECK(holders[0] == holders[2]);
    Ref<Leaf> moved = std::move(holders[0]);
    CHECK_FALSE(static_cast<bool>(holders[0]));
    holders.clear();
    CHECK(living == 1);
    moved = nullptr;
    CHECK(living == 0);
}

TEST_CASE("Ref: assigning itself changes nothing")
{
    auto leaf = New<Leaf>();
    const auto& same = leaf;
    leaf = same;
    CHECK(living == 1);
    CHECK(static_cast<bool>(leaf));
}

TEST_CASE("Ref: references may come and go on several threads")
{
    const auto leaf = New<Leaf>();
    tests::OnThreads(4, [&leaf] {
        for (int i = 0; i < 20000; ++i)
            const auto copy = leaf; // NOLINT(performance-unnecessary-copy-initialization): the copy is the test
    });
    CHECK(living == 1);
}

TEST_CASE("Child: made on first use, and only then")
{
    const auto branch = New<Branch>();
    CHECK(living == 0);
    branch->First()->Name(u"x");
    CHECK(living == 1);
    CHECK(branch->First()->Name() == u"x");
    CHECK(living == 1);
}

TEST_CASE("Child: goes with its holder, unless somebody else holds it")
{
    Ref<Leaf> kept;
    {
        const auto branch = New<Branch>();
        kept = branch->First();
        New<Branch>()->First();
        CHECK(living == 1);
    }
    CHECK(living == 1);
    kept = nullptr;
    CHECK(living == 0);
}

TEST_CASE("Child: another one takes its place, and the first is released")
{
    const auto branch = New<Branch>();
    branch->First()->Name(u"first");
    const auto second = New<Leaf>();
    branch->First(second);
    CHECK(living == 1);
    CHECK(branch->First() == second);
}

TEST_CASE("Child: set to nothing it is released, and made again with its defaults at the next use")
{
    const auto branch = New<Branch>();
    branch->First()->Name(u"first");
    branch->First(nullptr);
    CHECK(living == 0);
    CHECK(branch->First()->Name() == u"");
    CHECK(living == 1);
}

TEST_CASE("Child: one that starts with values of its own has them until it is set to nothing")
{
    const auto twig = New<Twig>();
    CHECK(living == 0);
    CHECK(twig->First()->Name() == u"made");
    twig->First(nullptr);
    CHECK(twig->First()->Name() == u"");
    const auto other = New<Twig>();
    other->First(nullptr); // before its first use
    CHECK(other->First()->Name() == u"");
}

TEST_CASE("Child: a holder that is not changed makes its child, too")
{
    const auto customer = New<CustomerDef>();
    const CustomerDef& unchanged = *customer;
    CHECK(unchanged.PersonalName()->FullName() == u"");
    CHECK(unchanged.PersonalName() == customer->PersonalName());
}
