// Natural-order sorting of instances by their declared keys.
#include <algorithm>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/TInstanceSorter.h"
#include "support/RepoBuilder.h"
#include "tkrcore/Callbacks.h"

namespace braigrion {
namespace {

using NORVTKR20::ICIMInstance;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using testing::TRepoBuilder;
typedef boost::shared_ptr<ICIMInstance> TInstancePtr;

int Sign(int value) {
    return value < 0 ? -1 : (value > 0 ? 1 : 0);
}

std::vector<TInstancePtr> Slots(const TRepoBuilder& repo) {
    std::vector<TInstancePtr> slots;
    repo.Namespace()->GetClass("ORVSG_Slot", TCIMContext())
        ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(slots), true, TCIMContext());
    return slots;
}

TEST(InstanceSorter, PropertyCompareOrdersNaturally) {
    const struct {
        const char* a;
        const char* b;
        int expected;  // sign of PropertyCompare(a, b, true)
    } cases[] = {
        {"Slot 9", "Slot 10", -1},
        {"slot 2", "SLOT 3", -1},
        {"a1", "A01", 0},
        {"Bay 07b", "bay 7B", 0},
        {"", "", 0},
        {"", "abc", -1},
        {"", "123", -1},
        {"123", "abc", -1},        // numbers before text
        {"DIMM 1", "DIMM1", 1},    // "dimm " is longer than "dimm"
        {"abc", "abd", -1},
        {"a", "a1", -1},           // fewer tokens first
        {"CPU 2 Core 10", "CPU 2 Core 9", 1},
        {"e", "\xc3\xa9", -1},     // bytes compare unsigned
        // A run longer than 64 bits wraps: 2^64 reads as 0.
        {"18446744073709551616", "0", 0},
        {"18446744073709551617", "2", -1},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(std::string(c.a) + " vs " + c.b);
        EXPECT_EQ(c.expected, Sign(TInstanceSorter::PropertyCompare(c.a, c.b, true)));
        EXPECT_EQ(-c.expected, Sign(TInstanceSorter::PropertyCompare(c.b, c.a, true))) << "antisymmetric";
    }
    EXPECT_EQ(-1, Sign(TInstanceSorter::PropertyCompare("Bay", "bay", false))) << "case counts without `lower`";
    // 2^63 and 0 differ by 2^63 either way, which reads as negative: each
    // goes before the other.
    EXPECT_EQ(-1, Sign(TInstanceSorter::PropertyCompare("9223372036854775808", "0", true)));
    EXPECT_EQ(-1, Sign(TInstanceSorter::PropertyCompare("0", "9223372036854775808", true)));
    EXPECT_EQ(1, Sign(TInstanceSorter::PropertyCompare("9223372036854775808", "1", true)));
}

TEST(InstanceSorter, KeysApplyInOrderAndTiesFallThrough) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_Slot Tag="a" Bay="Bay 2" Name="Slot 10"
        ORVSG_Slot Tag="b" Bay="Bay 10" Name="Slot 1"
        ORVSG_Slot Tag="c" Bay="bay 2" Name="Slot 9"
        ORVSG_Slot Tag="d" Bay="Bay 1"
        ORVSG_Slot Tag="e" Name="slot 3"
    )");
    const struct {
        const char* name;
        std::vector<std::pair<const char*, bool>> keys;  // property, ascending
        std::vector<std::string> expected;
    } cases[] = {
        {"no keys keeps the repository's order", {}, {"a", "b", "c", "d", "e"}},
        // "d" has no Name: it sorts as the empty string, first.
        {"ascending", {{"Name", true}}, {"d", "b", "e", "c", "a"}},
        {"descending", {{"Name", false}}, {"a", "c", "e", "b", "d"}},
        // Bay ties "Bay 2" with "bay 2"; the second key decides between them.
        {"two keys", {{"Bay", true}, {"Name", true}}, {"e", "d", "c", "a", "b"}},
        {"descending first key, ties to the second", {{"Bay", false}, {"Name", true}}, {"b", "c", "a", "d", "e"}},
        {"same property twice acts as once", {{"Name", true}, {"Name", false}}, {"d", "b", "e", "c", "a"}},
    };
    for (const auto& c : cases) {
        TInstanceSorter sorter;
        for (const auto& key : c.keys) sorter.AddProperty(key.first, key.second, false);
        std::vector<TInstancePtr> instances = Slots(repo);
        std::stable_sort(instances.begin(), instances.end(), sorter);
        std::vector<std::string> tags;
        for (const TInstancePtr& instance : instances) tags.push_back(TInstanceSorter::GetFinalPropertyValue("Tag", instance));
        EXPECT_EQ(c.expected, tags) << c.name;
    }
}

TEST(InstanceSorter, CompareReducesToOneStepAndToleratesMissingInstances) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_Slot Name=\"Slot 2\"\nORVSG_Slot Name=\"Slot 300\"");
    std::vector<TInstancePtr> slots = Slots(repo);
    ASSERT_EQ(2u, slots.size());
    TInstanceSorter sorter;
    sorter.AddProperty("Name", true, true, true);
    const TInstanceSorter::TPropertyInfo& key = sorter.GetProperties()[0];
    EXPECT_EQ(-1, sorter.Compare(key, slots[0], slots[1]));
    EXPECT_EQ(1, sorter.Compare(key, slots[1], slots[0]));
    EXPECT_EQ(0, sorter.Compare(key, slots[0], slots[0]));
    // A null instance reads as "" and goes first.
    EXPECT_EQ(-1, sorter.Compare(key, TInstancePtr(), slots[0]));
    EXPECT_TRUE(sorter(TInstancePtr(), slots[0]));
    EXPECT_FALSE(sorter(slots[0], slots[0]));
}

TEST(InstanceSorter, FinalValueJoinsArraysWithoutSeparator) {
    TRepoBuilder repo;
    repo.Parse(R"(ORVSG_Slot Names=string[]:"Bay ","12" Count=uint16:42 Empty=null:string)");
    TInstancePtr slot = Slots(repo).at(0);
    EXPECT_EQ("Bay 12", TInstanceSorter::GetFinalPropertyValue("Names", slot));
    EXPECT_EQ("42", TInstanceSorter::GetFinalPropertyValue("Count", slot));
    EXPECT_EQ("", TInstanceSorter::GetFinalPropertyValue("Empty", slot));
    EXPECT_EQ("", TInstanceSorter::GetFinalPropertyValue("Missing", slot));
    EXPECT_EQ("", TInstanceSorter::GetFinalPropertyValue("Names", TInstancePtr()));
}

TEST(InstanceSorter, TextHelpers) {
    EXPECT_TRUE(TInstanceSorter::IsNumber(""));
    EXPECT_TRUE(TInstanceSorter::IsNumber("0123"));
    EXPECT_FALSE(TInstanceSorter::IsNumber("12a"));
    EXPECT_FALSE(TInstanceSorter::IsNumber("-1"));
    EXPECT_FALSE(TInstanceSorter::ThereisNumberic(""));
    EXPECT_FALSE(TInstanceSorter::ThereisNumberic("abc"));
    EXPECT_TRUE(TInstanceSorter::ThereisNumberic("ab7"));

    std::string text = "Slot 9b";
    EXPECT_EQ("SLOT 9B", TInstanceSorter::uppercaseString(text));
    EXPECT_EQ("Slot 9b", text);

    std::vector<int> numbers = {5};  // appended to, not replaced
    std::string embedded = "a12b003c99999999999";
    TInstanceSorter::TokenizeEmbeddedNumeric(embedded, numbers);
    ASSERT_EQ(4u, numbers.size());
    EXPECT_EQ(std::vector<int>({5, 12, 3}), std::vector<int>(numbers.begin(), numbers.begin() + 3));
}

}  // namespace
}  // namespace braigrion
