// The test helpers themselves: the repository text and the transcript notation.
#include <stdexcept>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/RecordingWriter.h"
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
    EXPECT_EQ("Disk \"0\"", static_cast<std::string>(disks[0]->GetProperty("Name", none)->GetValue(none)));
    const TCIMValue& size = disks[0]->GetProperty("Size", none)->GetValue(none);
    EXPECT_EQ(TType::eUint64, static_cast<int>(size.GetType()));
    EXPECT_EQ(500107862016u, size.AsUnsigned());
    EXPECT_TRUE(static_cast<bool>(disks[0]->GetProperty("Online", none)->GetValue(none)));
    EXPECT_EQ(3u, static_cast<unsigned int>(disks[0]->GetProperty("Bays", none)->GetValue(none)));
    EXPECT_EQ(-1, disks[0]->GetProperty("Offset", none)->GetValue(none).AsSigned());
    const TCIMValue& tags = disks[0]->GetProperty("Tags", none)->GetValue(none);
    ASSERT_TRUE(tags.IsArray());
    std::vector<TCIMValue>& elements = tags;
    ASSERT_EQ(2u, elements.size());
    EXPECT_EQ("a b", static_cast<std::string>(elements[0]));
    EXPECT_EQ("c", static_cast<std::string>(elements[1]));
    EXPECT_TRUE(disks[0]->GetProperty("Gone", none)->GetValue(none).IsNull());

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

TEST(RecordingWriter, WritesOneReadableLinePerCall) {
    TRepoBuilder repo;
    repo.Add("ORVSG_Fan", {Str("DeviceID", "FAN 1")});
    boost::shared_ptr<ICIMInstance> fan = InstancesOf(repo, "ORVSG_Fan")[0];

    TRecordingWriter writer;
    TTable table(2, 2, false);
    table.fColumnHeaders = true;
    table.fColumnWidths = {40, 60};
    table.Cell(0, 0).text = "Name";
    table.Cell(0, 1).text = "Speed";
    table.Cell(1, 0).text = "FAN 1";
    table.Cell(1, 1).text = "3000\tRPM";
    table.Cell(1, 1).rawText = "3000";
    table.Cell(1, 1).monospaced = true;
    writer.WriteTableGrid(table);
    TReportProperty column("Name", "25%", "ORVSG_Assoc", "ORVSG_Target", "", "");
    column.SetMonospaced();
    writer.WriteValueCell(fan, column, "");
    writer.WriteIndexEntry("fans", "Fans", true);
    writer.SetSeparatorText(1, "<br>");
    EXPECT_EQ("<br>", writer.GetSeparatorText(1));
    EXPECT_EQ(", ", writer.GetSeparatorText(0));

    EXPECT_EQ("WriteTableGrid(grid 2x2 width=100 widths=[40,60] colheaders | \"Name\" \"Speed\" | \"FAN 1\" "
              "#\"3000\\tRPM\"~\"3000\")\n"
              "WriteValueCell(" + TRecordingWriter::Describe(fan) +
                  ", {Name width=\"25%\" assoc=\"ORVSG_Assoc\" target=\"ORVSG_Target\" mono}, \"\")\n"
              "WriteIndexEntry(\"fans\", \"Fans\", true)\n"
              "GetSeparatorText(1)\n"
              "GetSeparatorText(0)\n",
              writer.Transcript());
    EXPECT_NE(std::string::npos, TRecordingWriter::Describe(fan).find("FAN 1"));
    EXPECT_EQ(1u, writer.CallsStartingWith("WriteIndexEntry(").size());
}

}  // namespace
}  // namespace testing
}  // namespace braigrion
