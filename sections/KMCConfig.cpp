// The "KMC Configuration" page: the network settings a KMC service
// processor keeps in standard CIM classes. One property table per setting.
#include <string>
#include <vector>

#include "braigrion/TWriter.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TCIMReference.h"
#include "tkrcore/TOSSpecific.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;
using NORVTKR20::TOSSpecific;

namespace {

typedef std::vector<TWriter::TInstancePtr> TInstances;

const char kSection[] = "TWriter::WriteKMCConfigReport -- ";

// Where an endpoint's address came from, as AddressOrigin says.
const unsigned short kOriginDHCPv4 = 4;
const unsigned short kOriginDHCPv6 = 7;
const unsigned short kOriginStateless = 9;
const unsigned short kOriginLinkLocal = 10;
const unsigned short kOriginOther = 1;

// The instances of a class; with `logNoInstance` an empty class says so.
// An absent class logs `failure` and gives none.
TInstances InstancesOf(const TWriter::TNamespacePtr& ns, const std::string& className, bool deep,
                       const std::string& failure, bool logNoInstance) {
    TInstances instances;
    try {
        ns->GetClass(className, TCIMContext())
            ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(instances), deep, TCIMContext());
    } catch (...) {
        Trace(kSection + failure);
        return instances;
    }
    if (instances.empty() && logNoInstance) Trace(std::string(kSection) + "No instance of class " + className);
    return instances;
}

std::string TextOf(const TWriter::TInstancePtr& instance, const std::string& property) {
    TCIMContext context;
    return instance->GetProperty(property, context)->GetValue(context).ToString(10);
}

class TKMCConfigPage {
public:
    TKMCConfigPage(TWriter& writer, bool multiNode) : w(writer), fMultiNode(multiNode), fHasData(false) {}
    bool HasData() const { return fHasData; }

    // One property table per instance, each in its own guard. `title` is
    // the table's title; "" takes the instance's InstanceID instead.
    void WriteTables(const TInstances& instances, const std::string& title,
                     const std::vector<std::string>& properties, const std::string& guardName) {
        for (const TWriter::TInstancePtr& instance : instances) {
            try {
                WriteTable(instance, title.empty() ? TextOf(instance, "InstanceID") : title, properties);
            } catch (...) {
                Trace(std::string(kSection) + "Exception when writting current instance of class " + guardName);
            }
        }
    }

private:
    void WriteTable(const TWriter::TInstancePtr& instance, const std::string& title,
                    const std::vector<std::string>& properties) {
        TCIMContext context;
        boost::shared_ptr<ICIMClass> cls = instance->GetClass(context);
        fHasData = true;
        w.WriteTableTitle(title, false, false);
        w.StartPropertyTable("70%", "40%", title);
        std::vector<std::string> rows;
        if (fMultiNode) rows.push_back("NodeID");
        rows.insert(rows.end(), properties.begin(), properties.end());
        for (const std::string& property : rows) {
            const TReportProperty column(property, "0%", "", "", "", "");
            w.StartRow(true);
            w.WriteHeaderCell(cls, column);
            w.WriteValueCell(instance, column, "");
            w.EndRow();
        }
        w.EndTable();
    }

    TWriter& w;
    const bool fMultiNode;
    bool fHasData;
};

// Whether a static IPv6 setting is the one in force: its setting-data link
// to the service processor's LAN endpoint says IsCurrent 1.
bool IsCurrentSetting(const TWriter::TNamespacePtr& ns, const TWriter::TInstancePtr& setting) {
    TCIMValue isCurrent(static_cast<unsigned short>(0));
    try {
        TCIMContext context;
        TInstances links;
        setting->EnumerateReferences(TAddToVectorCallback<ICIMInstance>(links), "CIM_ElementSettingData", "",
                                     context);
        for (const TWriter::TInstancePtr& link : links) {
            const TCIMReference settingData = link->GetProperty("SettingData", context)->GetValue(context);
            const TCIMReference managed = link->GetProperty("ManagedElement", context)->GetValue(context);
            const std::string settingClass = settingData.GetClass()->GetClassName(context);
            TWriter::TInstancePtr element = ns->GetInstance(managed, context);
            if (settingClass == "CIM_ExtendedStaticIPAssignmentSettingData" && element &&
                TextOf(element, "Name").find("sp-lanendpoint") != std::string::npos) {
                isCurrent = link->GetProperty("IsCurrent", context)->GetValue(context);
            }
        }
    } catch (...) {
        Trace(std::string(kSection) + "Exception when getting instance of association class CIM_ElementSettingData");
    }
    try {
        return static_cast<unsigned short>(isCurrent) == 1;
    } catch (...) {
        return false;  // a null IsCurrent says nothing is in force
    }
}

}  // namespace

void TWriter::WriteKMCConfigReport(TBuilderPtr builder, std::string /*pageID*/) {
    Trace(std::string(kSection) + "Entering");
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + "KMCConfig");
    WritePageHeader();
    WriteReportTitle("KMC Configuration", "", "");
    TKMCConfigPage page(*this, builder->IsMultiNode());

    page.WriteTables(InstancesOf(fNamespace, "CIM_DNSSettingData", true,
                                 "Exception when getting class CIM_DNSSettingData", true),
                     "", {"RequestedHostname", "DNSServerAddresses", "ElementName"}, "CIM_DNSSettingData");

    // The endpoints by where their address came from; a static address
    // (origin 3) comes from the setting classes alone.
    TInstances dhcp4, dhcp6, stateless, linkLocal;
    for (const TInstancePtr& endpoint :
         InstancesOf(fNamespace, "CIM_IPProtocolEndpoint", false,
                     "Exception when writting getting class CIM_IPProtocolEndpoint", false)) {
        try {
            TCIMContext context;
            const unsigned short origin = endpoint->GetProperty("AddressOrigin", context)->GetValue(context);
            if (origin == kOriginDHCPv4) {
                dhcp4.push_back(endpoint);
            } else if (origin == kOriginDHCPv6) {
                dhcp6.push_back(endpoint);
            } else if (origin == kOriginStateless) {
                stateless.push_back(endpoint);
            } else if (origin == kOriginLinkLocal || origin == kOriginOther) {
                linkLocal.push_back(endpoint);
            }
        } catch (...) {
            Trace(std::string(kSection) + "Exception when processing property AddressOrigin");
        }
    }
    const std::string endpointGuard = "CIM_IPProtocolEndpoint [DHCP]";

    page.WriteTables(dhcp4, "DHCP IPv4 Address", {"IPv4Address", "SubnetMask", "SystemName"}, endpointGuard);
    page.WriteTables(InstancesOf(fNamespace, "CIM_StaticIPAssignmentSettingData", true,
                                 "Exception when getting class CIM_StaticIPAssignmentSettingData", true),
                     "Static IPv4 Address", {"InstanceID", "IPv4Address", "SubnetMask", "GatewayIPv4Address"},
                     "CIM_StaticIPAssignmentSettingData");
    page.WriteTables(dhcp6, "DHCP IPv6 Address", {"IPv6Address", "IPv6SubnetPrefixLength", "SystemName"},
                     endpointGuard);
    page.WriteTables(stateless, "IPv6 Stateless Address", {"IPv6Address", "PrefixLength", "SystemName"},
                     endpointGuard);
    page.WriteTables(linkLocal, "IPv6 Local Link Address", {"IPv6Address", "PrefixLength", "SystemName"},
                     endpointGuard);

    Trace(std::string(kSection) + "Begin write static IPv6 report !");
    TInstances current;
    for (const TInstancePtr& setting :
         InstancesOf(fNamespace, "CIM_ExtendedStaticIPAssignmentSettingData", false,
                     "Exception when getting class CIM_ExtendedStaticIPAssignmentSettingData", false)) {
        if (IsCurrentSetting(fNamespace, setting)) {
            current.push_back(setting);
        } else {
            Trace(std::string(kSection) +
                  "This static IPv6 setting is not the  current setting, do not show this instance  in report!");
        }
    }
    page.WriteTables(current, "Static IPv6 Address",
                     {"InstanceID", "IPAddresses", "IPv6SubnetPrefixLengths", "GatewayAddresses"},
                     "CIM_ExtendedStaticIPAssignmentSettingData");
    Trace(std::string(kSection) + "End write static IPv6 report !");

    // The vendor's community strings when it has any, else the standard ones.
    TInstances communities = InstancesOf(fNamespace, "ORV_SNMPCommunityString", true,
                                         "Exception when getting class ORV_SNMPCommunityString", false);
    std::string communityClass = "ORV_SNMPCommunityString";
    if (communities.empty()) {
        communities = InstancesOf(fNamespace, "CIM_SNMPCommunityString", true,
                                  "Exception when getting class CIM_SNMPCommunityString", true);
        communityClass = "CIM_SNMPCommunityString";
    }
    page.WriteTables(communities, "SNMP Community", {"Name", "CommunityString", "SystemName"}, communityClass);

    WritePageFooter();
    ClosePage();
    WriteIndexEntry("KMCConfig", "KMC Configuration", page.HasData());
    Trace(std::string(kSection) + "Exiting");
}

}  // namespace braigrion
