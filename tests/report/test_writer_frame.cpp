// The writer frame: the cell grid and what BaseInitialize reads.
#include <stdexcept>
#include <string>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "braigrion/TTable.h"
#include "braigrion/TWriter.h"
#include "support/LogCapture.h"
#include "support/RecordingWriter.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using NORVTKR20::ICIMNamespace;
using testing::TLogCapture;
using testing::TRecordingWriter;
using testing::TRepoBuilder;

TEST(Table, RefusesAnEmptyShapeAndAddressesCellsRowByRow) {
    for (const auto& shape : {std::make_pair(0, 3), std::make_pair(3, 0), std::make_pair(-1, 2)}) {
        EXPECT_THROW(TTable(shape.first, shape.second, false), std::invalid_argument) << shape.first << "x" << shape.second;
    }
    TTable table(2, 3, true);
    ASSERT_EQ(6u, table.fCells.size());
    table.Cell(1, 0).text = "row 1, col 0";
    EXPECT_EQ("row 1, col 0", table.fCells[3].text);
}

TEST(Writer, BaseInitializeReadsTheModeFlags) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_CollectionInfo Build=\"5.1-preboot\"");
    TLogCapture log;
    TRecordingWriter writer;
    writer.BaseInitialize(repo.Namespace(), {}, boost::make_shared<TReportParametersBuilder>(repo.Namespace(), "default", true));
    EXPECT_TRUE(writer.Preboot());
    EXPECT_TRUE(writer.KMC());
    EXPECT_EQ(0, writer.ProviderType());
    EXPECT_EQ(2, writer.OSType());  // pre-boot data are Linux
    EXPECT_FALSE(log.Contains("TWriter::BaseInitialize -- Exception when initializing member variable"));

    // Without a builder nothing can be read, and the run goes on.
    TRecordingWriter bare;
    bare.BaseInitialize(repo.Namespace(), {}, {});
    EXPECT_TRUE(log.Contains("TWriter::BaseInitialize -- Exception when initializing member variable"));
    EXPECT_EQ(4, bare.OSType());  // still unknown

    TRecordingWriter delta;
    boost::shared_ptr<ICIMNamespace> view = repo.WithProviderType(1);
    delta.BaseInitialize(view, {}, boost::make_shared<TReportParametersBuilder>(view, "default", false));
    EXPECT_EQ(1, delta.ProviderType());
    EXPECT_FALSE(delta.Preboot());
}

}  // namespace
}  // namespace braigrion
