// The writer frame: the cell grid, the writer's initial state, what
// BaseInitialize reads, and the page frame of WriteReportPage.
#include <stdexcept>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "braigrion/TTable.h"
#include "braigrion/TWriter.h"
#include "support/LogCapture.h"
#include "support/RecordingWriter.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMNamespace;
using NORVTKR20::INamespaceProvider;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMReference;
using testing::TLogCapture;
using testing::TRecordingWriter;
using testing::TRepoBuilder;

TEST(Table, RefusesAnEmptyShape) {
    const int shapes[][2] = {{0, 3}, {3, 0}, {0, 0}};
    for (const auto& shape : shapes) {
        try {
            TTable table(shape[0], shape[1], false);
            ADD_FAILURE() << shape[0] << "x" << shape[1] << " was accepted";
        } catch (const std::invalid_argument& ex) {
            EXPECT_STREQ("rows and cols must not be 0", ex.what());
        }
    }
    EXPECT_THROW(TTable(-1, 2, false), std::invalid_argument);
}

TEST(Table, StartsEmptyAndAddressesCellsRowByRow) {
    TTable table(2, 3, true);
    EXPECT_EQ(std::vector<int>(3, 0), table.fColumnWidths);
    EXPECT_EQ(100, table.fTableWidth);
    EXPECT_FALSE(table.fFlagB);
    EXPECT_FALSE(table.fRowHeaders);
    EXPECT_FALSE(table.fColumnHeaders);
    EXPECT_EQ(3, table.fColumns);
    EXPECT_EQ(2, table.fRows);
    EXPECT_EQ(3, table.fCols);
    EXPECT_TRUE(table.fMarked);
    ASSERT_EQ(6u, table.fCells.size());

    table.Cell(1, 0).text = "row 1, col 0";
    EXPECT_EQ("row 1, col 0", table.fCells[3].text);
    EXPECT_EQ("", table.fCells[3].rawText);
    EXPECT_FALSE(table.fCells[3].monospaced);
}

TEST(Writer, ConstructionSetsTheDefaultsAndTraces) {
    TLogCapture log;
    {
        TRecordingWriter writer("text");
        EXPECT_EQ("default", writer.Mode());
        EXPECT_EQ("", writer.OutputPath());
        EXPECT_FALSE(writer.Preboot());
        EXPECT_FALSE(writer.KMC());
        EXPECT_EQ(0, writer.ProviderType());
        EXPECT_EQ("text", writer.GetWriterType());
    }
    EXPECT_EQ((std::vector<std::string>{"TWriter::TWriter -- Entering ", "TWriter::TWriter -- Exiting",
                                        "TWriter::~TWriter -- Entering ", "TWriter::~TWriter -- Exiting"}),
              log.Messages());
}

TEST(Writer, BaseInitializeReadsTheModeFlags) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_CollectionInfo Build="5.1-preboot"
    )");
    TLogCapture log;
    TRecordingWriter writer;
    boost::shared_ptr<TReportParametersBuilder> builder(
        new TReportParametersBuilder(repo.Namespace(), "default", true));
    writer.BaseInitialize(repo.Namespace(), {}, builder);
    EXPECT_TRUE(writer.Preboot());
    EXPECT_TRUE(writer.KMC());
    EXPECT_EQ(0, writer.ProviderType());
    EXPECT_EQ(2, writer.OSType());  // pre-boot data are Linux
    EXPECT_EQ(repo.Namespace(), writer.Namespace());
    EXPECT_FALSE(log.Contains("TWriter::BaseInitialize -- Exception when initializing member variable"));

    TRecordingWriter delta;
    boost::shared_ptr<ICIMNamespace> view = repo.WithProviderType(1);
    delta.BaseInitialize(view, {}, boost::make_shared<TReportParametersBuilder>(view, "default", false));
    EXPECT_EQ(1, delta.ProviderType());
    EXPECT_FALSE(delta.Preboot());
}

// A namespace whose provider is missing: reading the provider type fails.
class TNoProvider : public ICIMNamespace {
public:
    explicit TNoProvider(boost::shared_ptr<ICIMNamespace> inner) : fInner(inner) {}
    boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(const TCIMContext&) override {
        return boost::shared_ptr<INamespaceProvider>();
    }
    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, const TCIMContext& context) override {
        return fInner->GetClass(name, context);
    }
    boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference& path, const TCIMContext& context) override {
        return fInner->GetInstance(path, context);
    }

private:
    boost::shared_ptr<ICIMNamespace> fInner;
};

TEST(Writer, BaseInitializeKeepsWhatItReadBeforeAFailure) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_OperatingSystem ProductVendor=\"Microsoft\" OSType=uint16:18");
    boost::shared_ptr<ICIMNamespace> ns = boost::make_shared<TNoProvider>(repo.Namespace());
    TLogCapture log;
    TRecordingWriter writer;
    writer.BaseInitialize(ns, {}, boost::make_shared<TReportParametersBuilder>(ns, "default", true));
    EXPECT_TRUE(log.Contains("TWriter::BaseInitialize -- Exception when initializing member variable"));
    EXPECT_TRUE(writer.KMC());             // read before the failure
    EXPECT_EQ(0, writer.ProviderType());   // never read
    EXPECT_EQ(4, writer.OSType());         // never read: still unknown
    EXPECT_EQ("TWriter::BaseInitialize -- Exiting ", log.Messages().back());
}

TEST(Writer, PagesWithoutGeneratorEndInTheUnknownPageLine) {
    TRepoBuilder repo;
    TLogCapture log;
    TRecordingWriter writer("inventory");
    boost::shared_ptr<TReportParametersBuilder> builder(
        new TReportParametersBuilder(repo.Namespace(), "default", false));
    log.Clear();
    writer.WriteReportPage(builder, "");
    writer.WriteReportPage(builder, "NoSuchPage");

    EXPECT_EQ((std::vector<std::string>{"TWriter::WriteReportPage -- Entering ",
                                        "TWriter::WriteReportPage -- WriterType = [inventory] PageID = []",
                                        "TWriter::WriteReportPage -- Unknow PageID = ",
                                        "TWriter::WriteReportPage -- Exiting ",
                                        "TWriter::WriteReportPage -- Entering ",
                                        "TWriter::WriteReportPage -- WriterType = [inventory] PageID = [NoSuchPage]",
                                        "TWriter::WriteReportPage -- Unknow PageID = NoSuchPage",
                                        "TWriter::WriteReportPage -- Exiting "}),
              log.Messages());
    EXPECT_TRUE(writer.Calls().empty());
}

}  // namespace
}  // namespace braigrion
