// Natural-order sorting of instances by their declared keys.
#include <algorithm>
#include <climits>
#include <ostream>
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

struct TCompareCase {
    const char* a;
    const char* b;
    int expected;  // sign of PropertyCompare(a, b, true)
};

void PrintTo(const TCompareCase& c, std::ostream* os) {
    *os << "\"" << c.a << "\" vs \"" << c.b << "\"";
}

class PropertyCompareTest : public ::testing::TestWithParam<TCompareCase> {};

TEST_P(PropertyCompareTest, OrdersNaturally) {
    const TCompareCase& c = GetParam();
    EXPECT_EQ(c.expected, Sign(TInstanceSorter::PropertyCompare(c.a, c.b, true))) << c.a << " vs " << c.b;
    // The order is antisymmetric.
    EXPECT_EQ(-c.expected, Sign(TInstanceSorter::PropertyCompare(c.b, c.a, true))) << c.b << " vs " << c.a;
}

INSTANTIATE_TEST_SUITE_P(
    Table, PropertyCompareTest,
    ::testing::Values(TCompareCase{"Slot 9", "Slot 10", -1},
                      TCompareCase{"slot 2", "SLOT 3", -1},
                      TCompareCase{"a1", "A01", 0},
                      TCompareCase{"007", "7", 0},
                      TCompareCase{"", "", 0},
                      TCompareCase{"", "abc", -1},
                      TCompareCase{"", "123", -1},
                      TCompareCase{"123", "abc", -1},           // numbers before text
                      TCompareCase{"DIMM 1", "DIMM1", 1},      // "dimm " is longer than "dimm"
                      TCompareCase{"abc", "abd", -1},
                      TCompareCase{"ab", "abc", -1},
                      TCompareCase{"a", "a1", -1},             // fewer tokens first
                      TCompareCase{"CPU 2 Core 10", "CPU 2 Core 9", 1},
                      TCompareCase{"e", "\xc3\xa9", -1},       // bytes compare unsigned
                      // A run longer than 64 bits wraps: 2^64 reads as 0.
                      TCompareCase{"18446744073709551616", "0", 0},
                      TCompareCase{"18446744073709551617", "2", -1}));

TEST(InstanceSorter, NumbersCompareByTheirDifferenceTakenAsSigned) {
    // 2^63 and 0 differ by 2^63 either way, which reads as negative: each
    // goes before the other.
    EXPECT_EQ(-1, Sign(TInstanceSorter::PropertyCompare("9223372036854775808", "0", true)));
    EXPECT_EQ(-1, Sign(TInstanceSorter::PropertyCompare("0", "9223372036854775808", true)));
    EXPECT_EQ(1, Sign(TInstanceSorter::PropertyCompare("9223372036854775808", "1", true)));
}

TEST(InstanceSorter, SplitsIntoNumberAndTextRuns) {
    std::vector<TInstanceSorter::TToken> tokens;
    TInstanceSorter::PropertySplit("Bay 07b", tokens, true);
    ASSERT_EQ(3u, tokens.size());
    EXPECT_EQ(TInstanceSorter::kTextToken, tokens[0].first);
    EXPECT_EQ("bay ", tokens[0].second.text);
    EXPECT_EQ(0u, tokens[0].second.number);
    EXPECT_EQ(TInstanceSorter::kNumberToken, tokens[1].first);
    EXPECT_EQ(7u, tokens[1].second.number);
    EXPECT_EQ("", tokens[1].second.text);
    EXPECT_EQ("b", tokens[2].second.text);

    TInstanceSorter::PropertySplit("Bay", tokens, false);
    ASSERT_EQ(1u, tokens.size());
    EXPECT_EQ("Bay", tokens[0].second.text);  // case kept without `lower`
    TInstanceSorter::PropertySplit("", tokens, true);
    EXPECT_TRUE(tokens.empty());
}

// Instances of one class, sorted by a sorter, reported by their "Name".
class SortedInstances : public ::testing::Test {
protected:
    std::vector<std::string> Sorted(const TInstanceSorter& sorter) {
        std::vector<TInstancePtr> instances;
        repo.Namespace()->GetClass("ORVSG_Slot", TCIMContext())
            ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(instances), true, TCIMContext());
        std::stable_sort(instances.begin(), instances.end(), sorter);
        std::vector<std::string> names;
        for (const TInstancePtr& instance : instances) names.push_back(TInstanceSorter::GetFinalPropertyValue("Tag", instance));
        return names;
    }
    TRepoBuilder repo;
};

TEST_F(SortedInstances, KeysApplyInOrderAndTiesFallThrough) {
    repo.Parse(R"(
        ORVSG_Slot Tag="a" Bay="Bay 2" Name="Slot 10"
        ORVSG_Slot Tag="b" Bay="Bay 10" Name="Slot 1"
        ORVSG_Slot Tag="c" Bay="bay 2" Name="Slot 9"
        ORVSG_Slot Tag="d" Bay="Bay 1"
        ORVSG_Slot Tag="e" Name="slot 3"
    )");
    struct TKey {
        const char* property;
        bool ascending;
    };
    struct TCase {
        const char* name;
        std::vector<TKey> keys;
        std::vector<std::string> expected;
    };
    const std::vector<TCase> cases = {
        {"no keys keeps the repository's order", {}, {"a", "b", "c", "d", "e"}},
        // "d" has no Name: it sorts as the empty string, first.
        {"ascending", {{"Name", true}}, {"d", "b", "e", "c", "a"}},
        {"descending", {{"Name", false}}, {"a", "c", "e", "b", "d"}},
        // Bay ties "Bay 2" with "bay 2"; the second key decides between them.
        {"two keys", {{"Bay", true}, {"Name", true}}, {"e", "d", "c", "a", "b"}},
        {"descending first key, ties to the second", {{"Bay", false}, {"Name", true}}, {"b", "c", "a", "d", "e"}},
        {"same property twice acts as once", {{"Name", true}, {"Name", false}}, {"d", "b", "e", "c", "a"}},
    };
    for (const TCase& c : cases) {
        TInstanceSorter sorter;
        for (const TKey& key : c.keys) sorter.AddProperty(key.property, key.ascending, false);
        EXPECT_EQ(c.expected, Sorted(sorter)) << c.name;
    }
}

TEST(InstanceSorter, CompareReducesToOneStepAndToleratesMissingInstances) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_Slot Name="Slot 2"
        ORVSG_Slot Name="Slot 300"
    )");
    std::vector<TInstancePtr> slots;
    repo.Namespace()->GetClass("ORVSG_Slot", TCIMContext())
        ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(slots), true, TCIMContext());
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
    std::vector<TInstancePtr> slots;
    repo.Namespace()->GetClass("ORVSG_Slot", TCIMContext())
        ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(slots), true, TCIMContext());
    ASSERT_EQ(1u, slots.size());
    EXPECT_EQ("Bay 12", TInstanceSorter::GetFinalPropertyValue("Names", slots[0]));
    EXPECT_EQ("42", TInstanceSorter::GetFinalPropertyValue("Count", slots[0]));
    EXPECT_EQ("", TInstanceSorter::GetFinalPropertyValue("Empty", slots[0]));
    EXPECT_EQ("", TInstanceSorter::GetFinalPropertyValue("Missing", slots[0]));
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

    std::vector<int> numbers = {5};
    std::string embedded = "a12b003c99999999999";
    TInstanceSorter::TokenizeEmbeddedNumeric(embedded, numbers);
    ASSERT_EQ(4u, numbers.size());
    EXPECT_EQ(5, numbers[0]);  // appended, not replaced
    EXPECT_EQ(12, numbers[1]);
    EXPECT_EQ(3, numbers[2]);
}

}  // namespace
}  // namespace braigrion
