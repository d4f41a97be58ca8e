// The repository text of the test helpers. (The transcript notation shows in
// every expected transcript of the report tests.)
#include <stdexcept>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/RepoBuilder.h"
#include "tkrcore/Callbacks.h"

namespace braigrion {
namespace testing {
namespace {

using NORVTKR20::ICIMInstance;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;
typedef TCIMValue::TCIMType TType;

std::vector<boost::shared_ptr<ICIMInstance>> InstancesOf(const TRepoBuilder& repo, const std::string& cls) {
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    repo.Namespace()->GetClass(cls, TCIMContext())
        ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(instances), true, TCIMContext());
    return instances;
}

TEST(RepoBuilder, ReadsEveryKindOfValue) {
    TRepoBuilder repo;
    repo.Parse(R"(
        # comment lines and blank lines are skipped

        ORVSG_Disk Name="Disk \"0\"" Size=uint64:500107862016 Online=true Bays=3 Offset=sint32:-1 Tags=string[]:"a b",c Gone=null:uint16
        class ORVSG_Empty
    )");
    std::vector<boost::shared_ptr<ICIMInstance>> disks = InstancesOf(repo, "ORVSG_Disk");
    ASSERT_EQ(1u, disks.size());
    TCIMContext none;
    const std::pair<const char*, TCIMValue> expected[] = {
        {"Name", TCIMValue("Disk \"0\"")},
        {"Size", TCIMValue::Unsigned(TType::eUint64, 500107862016u)},
        {"Online", TCIMValue::Boolean(true)},
        {"Bays", TCIMValue(3u)},
        {"Offset", TCIMValue::Signed(TType::eSint32, -1)},
        {"Tags", TCIMValue::Array(TType::eString, {TCIMValue("a b"), TCIMValue("c")})},
        {"Gone", TCIMValue::Null(TType::eUint16)},
    };
    for (const auto& e : expected) EXPECT_TRUE(disks[0]->GetProperty(e.first, none)->GetValue(none) == e.second) << e.first;

    EXPECT_TRUE(InstancesOf(repo, "ORVSG_Empty").empty());
    EXPECT_EQ(0, repo.Namespace()->GetNamespaceProvider(none)->GetProviderType(none));
    EXPECT_EQ(1, repo.WithProviderType(1)->GetNamespaceProvider(none)->GetProviderType(none));
}

TEST(RepoBuilder, NamesTheLineOfAMistake) {
    struct TCase {
        const char* text;
        const char* message;
    };
    const TCase cases[] = {
        {"ORVSG_A Name=\"x\"\n\nORVSG_A Name=\"unterminated", "repository text, line 3: unterminated string"},
        {"ORVSG_A Size=uint99:4", "repository text, line 1: unknown CIM type \"uint99\""},
        {"ORVSG_A Name", "repository text, line 1: expected '=' at column 13"},
        {"ORVSG_A Name=maybe", "repository text, line 1: cannot read the value of Name: \"maybe\""},
        {"class A B", "repository text, line 1: a class line holds only the class name"},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        try {
            repo.Parse(c.text);
            ADD_FAILURE() << "accepted: " << c.text;
        } catch (const std::invalid_argument& ex) {
            EXPECT_EQ(c.message, std::string(ex.what()));
        }
    }
    TRepoBuilder repo;
    EXPECT_THROW(repo.Parse("ORVSG_A Count=uint8:300"), std::invalid_argument);
}

}  // namespace
}  // namespace testing
}  // namespace braigrion
