// The builder's frame: the mode probes and the operating system probe, read
// from small inline repositories.
#include <string>
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "braigrion/TReportParametersBuilder.h"
#include "support/LogCapture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMNamespace;
using NORVTKR20::INamespaceProvider;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMReference;
using NORVTKR20::TTKRException;
using testing::TLogCapture;
using testing::TRepoBuilder;

TReportParametersBuilder BuilderOver(const TRepoBuilder& repo) {
    return TReportParametersBuilder(repo.Namespace(), "default", false);
}

const char kEventRecord[] = "ORVSG_WindowsSystemEventLogRecord RecordID=1 Message=\"started\"\n";

TEST(ReportParametersBuilder, ReadsTheOperatingSystemOfTheCollection) {
    const struct {
        const char* name;
        const char* repository;
        int expected;
    } cases[] = {
        {"MicrosoftAt73", "ORVSG_OperatingSystem ProductVendor=\"Microsoft Corporation\" OSType=uint16:73", 0},
        {"MicrosoftAbove73", "ORVSG_OperatingSystem ProductVendor=\"Microsoft Corporation\" OSType=uint16:74", 1},
        {"MicrosoftWithoutOSType", "ORVSG_OperatingSystem ProductVendor=\"Microsoft\"", 0},
        {"RedHatLinux", "ORVSG_OperatingSystem ProductVendor=\"Red Hat, Inc.\" OSType=uint16:36", 2},
        {"LinuxOfAnyVendor", "ORVSG_OperatingSystem ProductVendor=\"SUSE\" OSType=uint16:36", 2},
        {"ESX78", "ORVSG_OperatingSystem ProductVendor=\"VMware, Inc.\" OSType=uint16:78", 3},
        {"ESX81", "ORVSG_OperatingSystem ProductVendor=\"VMware, Inc.\" OSType=uint16:81", 3},
        // The vendor decides Windows even where the number means Linux.
        {"MicrosoftBeatsTheNumber", "ORVSG_OperatingSystem ProductVendor=\"Microsoft\" OSType=uint16:36", 0},
        {"OtherNumber", "ORVSG_OperatingSystem ProductVendor=\"Sun\" OSType=uint16:29", 4},
        {"NullOSType", "ORVSG_OperatingSystem ProductVendor=\"Sun\" OSType=null:uint16", 4},
        {"NoOperatingSystemClass", "ORVSG_ComputerSystem Name=\"x\"", 4},
        {"NoOperatingSystemButEventRecords", kEventRecord, 0},
        {"TwoOperatingSystemsAndEventRecords",
         "ORVSG_OperatingSystem ProductVendor=\"Red Hat\" OSType=uint16:36\n"
         "ORVSG_OperatingSystem ProductVendor=\"Red Hat\" OSType=uint16:36\n"
         "ORVSG_WindowsApplicationEventLogRecord RecordID=7",
         0},
        {"TwoOperatingSystemsWithoutEventRecords",
         "ORVSG_OperatingSystem ProductVendor=\"Microsoft\" OSType=uint16:18\n"
         "ORVSG_OperatingSystem ProductVendor=\"Microsoft\" OSType=uint16:18",
         4},
        {"EventRecordClassWithoutRecords", "class ORVSG_WindowsSecurityEventLogRecord", 4},
        {"UnknownSystemWithEventRecords",
         "ORVSG_OperatingSystem ProductVendor=\"Sun\" OSType=uint16:29\n"
         "ORVSG_WindowsSecurityEventLogRecord RecordID=3",
         0},
        {"PrebootIsLinux",
         "ORVSG_CollectionInfo Build=\"3.1-preboot-77\"\n"
         "ORVSG_OperatingSystem ProductVendor=\"Microsoft\" OSType=uint16:73",
         2},
    };
    for (const auto& c : cases) {
        TRepoBuilder repo;
        repo.Parse(c.repository);
        EXPECT_EQ(c.expected, BuilderOver(repo).GetOSType()) << c.name;
    }
}

TEST(ReportParametersBuilder, ProbesReadTheRepositoryAgainOnEveryCall) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_OperatingSystem ProductVendor=\"Sun\" OSType=uint16:29");
    TReportParametersBuilder builder = BuilderOver(repo);
    EXPECT_EQ(4, builder.GetOSType());
    EXPECT_FALSE(builder.IsPreboot());

    repo.Parse(kEventRecord);
    repo.Parse("ORVSG_CollectionInfo Build=\"preboot\"");
    EXPECT_EQ(2, builder.GetOSType());
    EXPECT_TRUE(builder.IsPreboot());
}

TEST(ReportParametersBuilder, DeltaViewIsNeverPreboot) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_CollectionInfo Build=\"2.0-preboot\"");
    TLogCapture log;

    TReportParametersBuilder plain(repo.WithProviderType(0), "default", false);
    EXPECT_FALSE(plain.IsDelta());
    EXPECT_TRUE(plain.IsPreboot());
    EXPECT_TRUE(log.Contains("TReportParametersBuilder::IsDelta -- Generation mode is not DELTA "));

    TReportParametersBuilder delta(repo.WithProviderType(1), "default", false);
    EXPECT_TRUE(delta.IsDelta());
    EXPECT_FALSE(delta.IsPreboot());
    EXPECT_TRUE(log.Contains("TReportParametersBuilder::IsDelta -- Generation mode is DELTA "));
    EXPECT_FALSE(TReportParametersBuilder(boost::shared_ptr<ICIMNamespace>(), "default", false).IsDelta());
}

// A namespace without a provider, and one that remembers the contexts it was asked with.
class TSpyNamespace : public ICIMNamespace {
public:
    explicit TSpyNamespace(boost::shared_ptr<ICIMNamespace> inner) : fInner(inner) {}
    boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(const TCIMContext&) override {
        return boost::shared_ptr<INamespaceProvider>();
    }
    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, const TCIMContext& context) override {
        fContexts.push_back(context);
        return fInner->GetClass(name, context);
    }
    boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference& path, const TCIMContext& context) override {
        return fInner->GetInstance(path, context);
    }
    std::vector<TCIMContext> fContexts;

private:
    boost::shared_ptr<ICIMNamespace> fInner;
};

TEST(ReportParametersBuilder, GetClassAsksTheFirstCollection) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_ComputerSystem Name=\"n1\"");
    boost::shared_ptr<TSpyNamespace> spy = boost::make_shared<TSpyNamespace>(repo.Namespace());
    TReportParametersBuilder builder(spy, "luz", true);

    boost::shared_ptr<ICIMClass> cls = builder.GetClass("ORVSG_ComputerSystem");
    ASSERT_TRUE(cls != nullptr);
    EXPECT_EQ("ORVSG_ComputerSystem", cls->GetClassName(TCIMContext()));
    ASSERT_EQ(1u, spy->fContexts.size());
    ASSERT_EQ(1u, spy->fContexts[0].count("nsIndex"));
    const NORVTKR20::TCIMValue& index = spy->fContexts[0].at("nsIndex");
    EXPECT_EQ(NORVTKR20::TCIMValue::TCIMType::eUint16, static_cast<int>(index.GetType()));
    EXPECT_EQ(0u, static_cast<unsigned int>(index));

    try {
        builder.GetClass("ORVSG_NoSuchClass");
        ADD_FAILURE() << "an absent class must throw";
    } catch (const TTKRException& ex) {
        EXPECT_EQ(NORVTKR20::kNotFound, ex.fStatusCode.fStatusCode);
    }
    EXPECT_FALSE(builder.IsDelta()) << "a namespace without a provider is no delta view";
}

}  // namespace
}  // namespace braigrion
