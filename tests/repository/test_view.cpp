// A view over several collections, and the collection facts read from them.
#include <gtest/gtest.h>

#include "RepoFixture.h"
#include "repository/NamespaceView.h"

#include <boost/make_shared.hpp>

using namespace testrepo;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMSchemaHelper;

namespace {

boost::shared_ptr<TMemoryNamespace> Collection(const std::string& serial, const std::string& host, bool withInfo) {
    auto ns = TMemoryNamespace::Create();
    if (withInfo) {
        ns->AddInstance("ORVSG_CollectionInfo", {V("Build", TCIMValue("4.2.1-preboot")), V("MajorVersion", TCIMValue("1")),
                                                 V("MinorVersion", TCIMValue("3")), V("SerialNumber", TCIMValue(serial)),
                                                 V("OSVersion", TCIMValue("5.14.0-362.el9.x86_64"))});
    }
    ns->AddInstance("ORVSG_ComputerSystem", {V("Name", TCIMValue(host)), V("SerialNumber", TCIMValue(serial + "-cs"))});
    ns->Link();
    return ns;
}

TCIMContext At(unsigned short index) {
    TCIMContext c;
    c["nsIndex"] = TCIMValue(index);
    return c;
}

}  // namespace

TEST(NamespaceView, IndexSelectsTheCollectionAndViewRecordsShowEverywhere) {
    auto records = TMemoryNamespace::Create();
    records->AddInstance("ORVSG_DeltaClass", {V("ClassName", TCIMValue("ORVSG_ComputerSystem"))});
    auto view = boost::make_shared<TNamespaceView>(
        std::vector<boost::shared_ptr<TMemoryNamespace>>{Collection("SN1", "alpha", true), Collection("SN2", "beta", false)},
        records);
    EXPECT_EQ(1, view->GetNamespaceProvider(TCIMContext())->GetProviderType(TCIMContext()));
    EXPECT_EQ(2, static_cast<int>(view->MakeContext().at("nNamespaces")));

    EXPECT_EQ(std::vector<std::string>{"alpha"}, Names(All(*view, "ORVSG_ComputerSystem", At(0))));
    EXPECT_EQ(std::vector<std::string>{"beta"}, Names(All(*view, "ORVSG_ComputerSystem", At(1))));
    EXPECT_EQ(std::vector<std::string>{"alpha"}, Names(All(*view, "ORVSG_ComputerSystem"))) << "no index means the first collection";
    for (unsigned short i : {0, 1})
        EXPECT_EQ(1u, All(*view, "ORVSG_DeltaClass", At(i)).size()) << i;
    EXPECT_THROW(view->GetClass("ORVSG_ComputerSystem", At(2)), NORVTKR20::TTKRException);
    EXPECT_THROW(view->GetClass("ORVSG_CollectionInfo", At(1)), NORVTKR20::TTKRException);
}

TEST(NamespaceView, ReferencesResolveInTheCollectionTheirContextNames) {
    auto view = boost::make_shared<TNamespaceView>(
        std::vector<boost::shared_ptr<TMemoryNamespace>>{Collection("SN1", "alpha", true), Collection("SN2", "alpha", true)},
        boost::shared_ptr<TMemoryNamespace>());
    for (unsigned short i : {0, 1}) {
        NORVTKR20::TCIMReference ref(view, "ORVSG_ComputerSystem.Name=\"alpha\"", At(i));
        auto inst = boost::dynamic_pointer_cast<NORVTKR20::ICIMInstance>(ref.GetCIMElement(false));
        ASSERT_TRUE(inst);
        EXPECT_EQ(i == 0 ? "SN1-cs" : "SN2-cs", inst->GetProperty("SerialNumber", TCIMContext())->GetValueString());
    }
}

TEST(SchemaHelper, ReadsCollectionFactsPerIndexWithSerialFallback) {
    auto view = boost::make_shared<TNamespaceView>(
        std::vector<boost::shared_ptr<TMemoryNamespace>>{Collection("SN1", "alpha", true), Collection("SN2", "beta", false)},
        boost::shared_ptr<TMemoryNamespace>());
    EXPECT_EQ("4.2.1-preboot", TCIMSchemaHelper::GetDataSourceBuild(view, At(0)));
    EXPECT_EQ("1", TCIMSchemaHelper::GetDataSourceMajorVersion(view, At(0)));
    EXPECT_EQ("3", TCIMSchemaHelper::GetDataSourceMinorVersion(view, At(0)));
    EXPECT_EQ("5.14.0-362.el9.x86_64", TCIMSchemaHelper::GetOperatingSystemVersion(view));
    EXPECT_EQ("SN1", TCIMSchemaHelper::GetRawSerialNumberString(view, At(0)));
    EXPECT_EQ("SN2-cs", TCIMSchemaHelper::GetRawSerialNumberString(view, At(1)));
    EXPECT_EQ("", TCIMSchemaHelper::GetDataSourceBuild(view, At(1))) << "a collection without its facts reads as empty";
}
