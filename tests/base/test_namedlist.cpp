#include "Qvz_NamedList.h"
#include "Qvz_WizData.h"

#include <gtest/gtest.h>

#include <random>
#include <string>

namespace {

using SignalList = Qvz_NamedList<Qvz_Signal>;

// What a lookup must return: the first item of the name, in order.
Qvz_Signal* FirstByScan(const SignalList& list, const std::string& name) {
    for (const auto& p : list.All())
        if (p->GetName().str() == name)
            return p.get();
    return nullptr;
}

void ExpectLookupsMatchScan(const SignalList& list, int names, const char* when) {
    for (int n = 0; n < names; ++n) {
        const std::string name = "S" + std::to_string(n);
        ASSERT_EQ(list.Find(name.c_str()), FirstByScan(list, name)) << name << " " << when;
    }
}

} // namespace

// Random appends, renames (through the item and by assignment), erasures,
// copies and moves, with names drawn from pools small enough to repeat: after
// every step each name must find what a search from the front finds. A stale
// slot, a probe chain broken by a removal or an item pointing at the wrong
// list shows up as a mismatch.
TEST(NamedList, LookupsAlwaysAgreeWithASearchFromTheFront) {
    const struct {
        int pool;
        int steps;
    } cases[] = {{4, 400}, {40, 1500}, {2000, 3000}};
    for (const auto& c : cases) {
        SCOPED_TRACE("pool " + std::to_string(c.pool));
        std::mt19937 rng(12345u + unsigned(c.pool));
        auto pick = [&](int n) { return int(rng() % unsigned(n)); };
        auto name = [&] { return Port::StringBase(("S" + std::to_string(pick(c.pool))).c_str()); };
        SignalList list;
        for (int step = 0; step < c.steps; ++step) {
            const int op = pick(10);
            const int size = int(list.Size());
            if (op < 4 || size == 0) {
                list.Append(std::make_unique<Qvz_Signal>(name()));
            } else if (op < 6) {
                list.All()[std::size_t(pick(size))]->SetName(name());
            } else if (op == 6) {
                Qvz_Signal other(name());
                *list.All()[std::size_t(pick(size))] = other;
            } else if (op < 9) {
                list.Erase(list.All()[std::size_t(pick(size))].get());
            } else if (pick(2) == 0) {
                SignalList copy(list);
                list = copy;
            } else {
                SignalList moved(std::move(list));
                list = std::move(moved);
            }
            if (step % 7 == 0)
                ExpectLookupsMatchScan(list, c.pool, "mid-run");
        }
        ExpectLookupsMatchScan(list, c.pool, "at the end");
    }
}

TEST(NamedList, ItemsLeaveTheListTheyAreCopiedOrErasedFrom) {
    SignalList list;
    Qvz_Signal* a = list.Append(std::make_unique<Qvz_Signal>("A"));
    ASSERT_EQ(list.Find("A"), a);

    // A copy renamed before it is added does not touch the list it came from.
    Qvz_Signal twin(*a);
    twin.SetName("B");
    EXPECT_EQ(list.Find("A"), a);
    EXPECT_EQ(list.Find("B"), nullptr);

    SignalList copy(list);
    copy.All()[0]->SetName("C");
    EXPECT_EQ(list.Find("A"), a);
    EXPECT_EQ(list.Find("C"), nullptr);
    EXPECT_NE(copy.Find("C"), nullptr);

    // Erasing from the wrong list, or null, does nothing.
    copy.Erase(a);
    list.Erase(nullptr);
    EXPECT_EQ(list.Size(), 1u);
    EXPECT_EQ(copy.Size(), 1u);

    // After a move the items report renames to their new list.
    SignalList moved(std::move(list));
    EXPECT_EQ(moved.Find("A"), a);
    a->SetName("D");
    EXPECT_EQ(moved.Find("D"), a);
    EXPECT_EQ(moved.Find("A"), nullptr);
}

TEST(NamedList, DesignDataFindsRenamedBlocksAndSignalsUnderTheirNewNames) {
    Qvz_WizData d;
    Qvz_Block* master = d.AddBlock(std::make_unique<Qvz_Block>("M", "GT_CUSTOM", Qvz_Family::GT));
    d.CopyBlock(master, "M_COPY");
    master->SetName("M_INST1");
    EXPECT_EQ(d.GetNamedBlock("M"), nullptr);
    EXPECT_EQ(d.GetNamedBlock("M_INST1"), master);
    // A name taken twice finds the first block in order until it goes.
    d.GetNamedBlock("M_COPY")->SetName("M_INST1");
    EXPECT_EQ(d.GetNamedBlock("M_INST1"), master);
    d.DeleteBlock(master);
    ASSERT_NE(d.GetNamedBlock("M_INST1"), nullptr);
    EXPECT_EQ(d.GetNamedBlock("M_INST1")->GetPrimitiveName(), "GT_CUSTOM");

    Qvz_Signal* s = d.AddSignal("RXDATA", true, "O");
    s->SetName("RXDATA_0");
    EXPECT_EQ(d.AddSignal("RXDATA_0", false, ""), s);
    EXPECT_NE(d.AddSignal("RXDATA", false, ""), s);
    EXPECT_EQ(d.GetSignals().size(), 2u);

    // A copy of the design data is looked up in on its own.
    Qvz_WizData e = d;
    e.GetNamedSignal("RXDATA_0")->SetName("X");
    EXPECT_EQ(d.GetNamedSignal("RXDATA_0"), s);
    EXPECT_EQ(e.GetNamedSignal("RXDATA_0"), nullptr);
}
