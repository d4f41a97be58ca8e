// Definitions of the network page. It exists in two forms under one link:
// with NIC teams, where the teams get a table and the physical ports show
// their team membership, and without. The page writer picks one by
// HasTeamInfo, so exactly one is written per report.
#include "CatalogueSupport.h"
#include "braigrion/TReportParametersBuilder.h"

namespace braigrion {

using namespace catalogue;

namespace {

const char kPortEndpoint[] = "ORVSG_PortImplementsEndpoint";
const char kEndpoint[] = "ORVSG_IPProtocolEndpoint";
const char kPortStatistics[] = "ORVSG_NetworkPortStatistics";
const char kStatistics[] = "ORVSG_NetworkStatisticalData";

// Windows keeps WINS and automatic address configuration per adapter.
TColumns WindowsAddressColumns() {
    return {Column("HaveWins"), Column("PrimaryWinsServer"), Column("SecondaryWinsServer"),
            Column("AutoConfigEnabled"), Column("AutoConfigActive")};
}

// Counters of a port, read from its statistics record.
TColumns StatisticsColumns() {
    TColumns columns;
    for (const char* counter : {"RXPackets", "RXErrors", "RXDropErrors", "RXOverrunErrors", "RXFrameErrors",
                                "TXPackets", "TXErrors", "TXDropErrors", "TXOverrunErrors", "TXCarrierErrors",
                                "Collisions", "RXBytes", "TXBytes"}) {
        columns.push_back(Via(counter, "", kPortStatistics, kStatistics));
    }
    return columns;
}

TReportParameters NetworkPage(const TReportParametersBuilder& builder, bool teaming) {
    const int os = builder.GetOSType();
    const bool windows =
        os == TReportParametersBuilder::kOSWindows || os == TReportParametersBuilder::kOSWindowsServer;

    TReportParameters params = Page("net", "Network Settings");
    TClasses classes;
    TReportClass cls;

    cls.SetClass("ORVSG_IPService");
    cls.SetTitle("Global Settings");
    cls.SetProperties({Column("HostName", "25%"), Column("DomainName", "25%"), Column("ProxyEnabled", "25%"),
                       Column("RoutingEnabled", "25%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_NextHopIPRoute");
    cls.SetTitle("Route Information");
    cls.SetProperties({Column("DestinationAddress", "15%"), Column("Gateway", "15%"), Column("DestinationMask", "15%"),
                       Column("Flags", "15%"), Column("RouteMetric", "15%"), Column("Ref", "10%"),
                       Column("Iface", "15%")});
    classes.push_back(cls);

    if (teaming) {
        cls.Reset();
        cls.SetClass("ORVSG_VirtualNetworkingGroup");
        cls.SetTitle("Virtual Teams");
        cls.SetUniqueIdProperty("TeamName");
        cls.SetProperties(
            {Column("TeamName", "25%"), Column("TeamType", "25%"),
             Via("PermanentAddress", "25%", "ORVSG_VirtualNetworkingPortComponent", "ORVSG_VirtualNetworkPort",
                 "Virtual Members"),
             Via("Name", "25%", "ORVSG_VirtualNetworkingRedundancyGroupComponent", "ORVSG_SpareGroup",
                 "Physical Members")});
        classes.push_back(cls);
    }

    cls.Reset();
    cls.SetClass("ORVSG_VirtualNetworkPort");
    cls.SetTitle("Virtual Network Ports");
    RowReport(cls, "20%", "100%", 2);
    cls.SetUniqueIdProperty("DeviceId");
    TColumns columns = {Column("DeviceID"),         Column("Name"),
                        Column("Description"),      Column("LinkTechnology"),
                        Column("PermanentAddress"), Column("NetworkAddresses"),
                        Via("IPv4Address", "", kPortEndpoint, kEndpoint),
                        Column("GatewayList"),      Column("DnsServers"),
                        Column("DhcpEnabled"),      Column("DhcpServer")};
    if (windows) Append(columns, WindowsAddressColumns());
    Append(columns, {Column("Speed"), Column("ActiveMaximumTransmissionUnit"), Column("EnabledState"),
                     Column("DriverLoaded"), Column("VLANID"), Column("VLANName"), Column("speedDuplex")});
    cls.SetProperties(columns);
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_PhysicalNetworkPort");
    cls.SetTitle("Physical Network Ports");
    RowReport(cls, "20%", "100%", 2);
    cls.SetUniqueIdProperty("DeviceId");
    cls.GetInstanceSorter().AddProperty("DeviceID", true, false);
    cls.GetInstanceSorter().AddProperty("Description", true, false);
    columns = {Column("DeviceID"),
               Column("Name"),
               Column("Description"),
               Column("LinkTechnology"),
               Column("PermanentAddress"),
               Column("NetworkAddresses"),
               Via("IPv4Address", "", kPortEndpoint, kEndpoint),
               Via("IPv6Address", "", kPortEndpoint, kEndpoint),
               Column("GatewayList"),
               Column("DnsServers"),
               Column("DhcpEnabled"),
               Column("DhcpServer")};
    if (windows) Append(columns, WindowsAddressColumns());
    Append(columns, {Column("Speed"), Column("ActiveMaximumTransmissionUnit"), Column("EnabledState"),
                     Column("DriverLoaded")});
    if (windows) columns.push_back(Column("NICType"));
    if (teaming) {
        Append(columns, {Column("MemberType"), Column("TeamName"), Column("TeamID"), Column("MemberPriority")});
    }
    columns.push_back(Column("speedDuplex"));
    Append(columns, StatisticsColumns());
    cls.SetProperties(columns);
    classes.push_back(cls);

    params.SetClasses(classes);
    return params;
}

}  // namespace

TReportParameters TReportParametersBuilder::BuildNetworkWithTeamingParams() const {
    TTrace trace("TReportParametersBuilder::BuildNetworkWithTeamingParams");
    return NetworkPage(*this, true);
}

TReportParameters TReportParametersBuilder::BuildNetworkWithoutTeamingParams() const {
    TTrace trace("TReportParametersBuilder::BuildNetworkWithoutTeamingParams");
    return NetworkPage(*this, false);
}

}  // namespace braigrion
