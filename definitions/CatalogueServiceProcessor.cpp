// Definitions of the service processor pages: its configuration, the
// built-in self test results, the Glow Trace LEDs and the activation keys.
#include "CatalogueSupport.h"
#include "braigrion/TReportParametersBuilder.h"

namespace braigrion {

using namespace catalogue;

namespace {

// Every service processor table shows one instance per table, as rows.
TReportClass SettingsTable(const std::string& className, const std::string& title, const std::string& tableWidth) {
    TReportClass cls;
    cls.SetClass(className);
    cls.SetTitle(title);
    RowReport(cls, "30%", tableWidth, 1);
    return cls;
}

TColumns Columns(const std::vector<std::string>& properties) {
    TColumns columns;
    for (const std::string& property : properties) columns.push_back(Column(property));
    return columns;
}

// A settings table of the configuration page. On a multi-node system the
// node tells the tables apart, and `nodeColumn` puts it first among the rows.
TReportClass ConfigTable(const std::string& className, const std::string& title, bool multiNode, bool nodeColumn,
                         const std::vector<std::string>& properties) {
    TReportClass cls = SettingsTable(className, title, "80%");
    TColumns columns;
    if (multiNode) {
        cls.SetUniqueIdProperty("SourceNode");
        if (nodeColumn) columns.push_back(Column("SourceNode"));
    }
    Append(columns, Columns(properties));
    cls.SetProperties(columns);
    return cls;
}

// A self test table: the processor's description and, for most kinds, its
// firmware level, then the node when asked for, then the test results.
TReportClass BISTTable(const std::string& className, const std::string& title, bool withVersion, bool withNode,
                       const std::vector<std::string>& results) {
    TReportClass cls = SettingsTable(className, title, "75%");
    TColumns columns = {Column("Description")};
    if (withVersion) columns.push_back(Via("Version", "", "ORVSG_SPSystemFirmware", "ORVSG_FirmwareElement"));
    if (withNode) columns.push_back(Column("SourceNode"));
    Append(columns, Columns(results));
    cls.SetProperties(columns);
    return cls;
}

}  // namespace

TReportParameters TReportParametersBuilder::BuildServProcConfigParams() const {
    TTrace trace("TReportParametersBuilder::BuildServProcConfigParams");
    const bool multiNode = IsMultiNode();
    TReportParameters params = Page("servproc_config", "SP Configurations");
    TClasses classes;

    // The service processor's clock is collected from data source 1.2 on.
    if (GetDataSourceVersion() >= "1.2") {
        classes.push_back(ConfigTable("ORVSG_SP_ComputerSystem", "General Settings", false, false,
                                      multiNode ? std::vector<std::string>{"SourceNode", "SPClock"}
                                                : std::vector<std::string>{"SPClock"}));
    }
    // The TCP/IP table has no node row even on a multi-node system.
    classes.push_back(ConfigTable(
        "ORVSG_ServProc_IPProtocolEndpoint", "TCP/IP Settings", multiNode, false,
        {"Instance", "Enabled", "HostName", "GatewayIPAddress", "HostIPAddress", "HostIPSubnetMask",
         "BurnedInMACAddress", "DHCPEnabled", "DHCPHostName", "DHCPAssignedGatewayAddress", "DHCPAssignedIPAddress",
         "DHCPAssignedSubnetMask", "DHCPDomainName", "DHCPServer", "DHCPPrimaryDNS", "DHCPSecondaryDNS",
         "DHCPTertiaryDNS"}));
    classes.push_back(ConfigTable(
        "ORVSG_ServProc_IPProtocolEndpoint2", "SNMP Settings", multiNode, true,
        {"SystemLocation", "SystemContact", "Traps", "SNMPv1", "SNMPv3", "DNS", "DNSIP1", "DNSIP2", "DNSIP3",
         "DNSHostName1", "DNSHostIP1", "DNSHostName2", "DNSHostIP2", "DNSHostName3", "DNSHostIP3", "DNSHostName4",
         "DNSHostIP4", "Community1Name", "Community1IP1", "Community1IP2", "Community1IP3", "Community2Name",
         "Community2IP1", "Community2IP2", "Community2IP3", "Community3Name", "Community3IP1", "Community3IP2",
         "Community3IP3"}));
    classes.push_back(ConfigTable(
        "ORVSG_ServProc_DialProtocolEndpoint3", "Serial Port Settings", multiNode, true,
        {"Instance", "BaudRate", "Parity", "StopBits", "InitializationString", "PortEnabled", "ModemCallerIDString",
         "FactorySettingsString", "ModemEscapeGuardTime", "ModemEscapeString", "ModemPrefixString",
         "ModemPostfixString", "ModemAutoAnswerString", "ModemAutoAnswerStopString", "ModemQueryString",
         "ModemHangupString"}));
    classes.push_back(ConfigTable("ORVSG_ServProc_DialProtocolEndpoint1", "Dialout Settings", multiNode, true,
                                  {"Instance", "DialStatus", "PhoneNumberLAN", "TextDescription", "ConnectionType",
                                   "DialoutID", "PagerPIN", "EmailAddress", "PPPLoginID",
                                   "SelectiveAlertNotification"}));
    classes.push_back(ConfigTable(
        "ORVSG_ServProc_DialProtocolEndpoint2", "Dialin Settings", multiNode, true,
        {"Instance", "LoginID", "LoginFlags", "DialBackNumber", "DenyAlways", "Supervisor", "ReadOnly",
         "NetworkingAndSecurity", "RemoteConsoleAccess", "RemoteConsoleVirtualMediaAccess",
         "RemoteServerPowerRestartAccess", "BasicConfiguration", "AbilityToClearEventLogs", "AdvancedConfiguration",
         "LastLogin"}));
    classes.push_back(ConfigTable("ORVSG_ServProc_DialProtocolEndpoint4", "Dialout Alerts", multiNode, true,
                                  {"Temperature", "Voltage", "Tamper", "MultipleFanFailure", "PowerFailure",
                                   "HardDrive", "VRMFailure"}));
    params.SetClasses(classes);
    return params;
}

TReportParameters TReportParametersBuilder::BuildBISTParams() const {
    TTrace trace("TReportParametersBuilder::BuildBISTParams");
    TReportParameters params = Page("bist.html", "BIST Results");
    // Only the first kind of processor asks for the node count; the others
    // always show the node.
    params.SetClasses({
        BISTTable("ORVSG_Wren_ComputerSystem", "ZEPH BIST Results", true, IsMultiNode(),
                  {"FlashError", "ROMError", "RAMError", "Watchdog"}),
        BISTTable("ORVSG_GPA_ComputerSystem", "GPA BIST Results", true, true,
                  {"NVRAM", "DRAM", "Com1", "Com2", "RS485Legacy", "RS485LocalBus", "RTC", "I2CController",
                   "ExternalEthernetInternalWrapTest", "ExternalEthernetExternalWrapTest"}),
        BISTTable("ORVSG_YARP_ComputerSystem", "YARP BIST Results", true, true,
                  {"E_SRAM_MEMORY_TEST", "E_SERIAL_PORT_1_TEST", "E_SERIAL_PORT_2_TEST", "E_NVRAM_MEMORY_TEST",
                   "E_RTC_TEST", "E_FPGA_TEST", "E_I2CT_TEST", "E_MAINAPP_CHECKSUM_TEST", "E_BOOTROM_CHECKSUM_TEST",
                   "E_ETH_TEST", "E_PCI_EEPROM_INIT", "E_R485_SEND_SYNC"}),
        BISTTable("ORVSG_QMC_ComputerSystem", "ZEPH BIST Results", false, true,
                  {"FlashError", "ROMError", "RAMError"}),
        BISTTable("ORVSG_BMC_ComputerSystem", "IPMI BIST Results", true, true,
                  {"SELDevice", "SDRRepository", "BMCFRUDevice", "IPMBSignalLines", "SDRRepositoryNonEmpty",
                   "InternalUseAreaofBMCFRU", "ControllerUpdateBootBlockFirmware", "ControllerOperationalFirmware"}),
    });
    return params;
}

TReportParameters TReportParametersBuilder::BuildGlowTraceParams() const {
    TTrace trace("TReportParametersBuilder::BuildGlowTraceParams");
    const bool multiNode = IsMultiNode();
    const bool lookout = IsLookout();
    TReportParameters params = Page("glowtrace.html", "Glow Trace");

    TReportClass cls;
    cls.SetClass("ORVSG_SP_LED");
    cls.SetTitle("LED Settings");
    cls.SetTableWidth("80%");
    if (multiNode) cls.GetInstanceSorter().AddProperty("SourceNode", true, false);
    cls.GetInstanceSorter().AddProperty("SensorTypeName", true, false, true);
    cls.GetInstanceSorter().AddProperty("SensorIndex", true, false);
    if (lookout && multiNode) {
        cls.SetProperties({Column("SourceNode", "10%"), Column("LookoutUnit", "10%"), Column("SensorTypeName", "20%"),
                           Column("SensorIndex", "20%"), Column("CurrentState", "20%"),
                           Column("LocationName", "20%")});
    } else if (lookout) {
        cls.SetProperties({Column("LookoutUnit", "15%"), Column("SensorTypeName", "25%"), Column("SensorIndex", "20%"),
                           Column("CurrentState", "20%"), Column("LocationName", "20%")});
    } else if (multiNode) {
        cls.SetProperties({Column("SourceNode", "15%"), Column("SensorTypeName", "25%"), Column("SensorIndex", "20%"),
                           Column("CurrentState", "20%"), Column("LocationName", "20%")});
    } else {
        cls.SetProperties({Column("SensorTypeName", "25%"), Column("SensorIndex", "25%"),
                           Column("CurrentState", "25%"), Column("LocationName", "25%")});
    }
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildKMCLicenseKeyParams() const {
    TTrace trace("TReportParametersBuilder::BuildKMCLicenseKeyParams");
    TReportParameters params = Page("activation_key", "KoS Activation Key");
    TReportClass cls = SettingsTable("ORV_ActivationKey", "Activation Key", "60%");
    cls.GetInstanceSorter().AddProperty("ActivationKeyDescription", true, false);
    cls.GetInstanceSorter().AddProperty("FeatureDescriptionType", true, false);
    TColumns columns = {Labelled("ActivationKeyDescription", "", "Description"),
                        Labelled("FeatureDescriptionType", "", "Feature Description")};
    // A hardware activation key has neither expiry nor use counts.
    if (IsSupportKMCKey()) {
        columns.push_back(Labelled("ActivationKeyStatus", "", "Status"));
    } else {
        Append(columns, {Labelled("Expires", "", "Expire Date"),
                         Labelled("ActivationKeyIdentifierType", "", "Identifier Type"),
                         Labelled("ActivationKeyIdentifier", "", "Identifier"),
                         Labelled("ActivationKeyStatus", "", "Status"),
                         Labelled("ActivationKeyUseCount", "", "User Count"),
                         Labelled("ActivationKeyUseLimit", "", "User Limit")});
    }
    cls.SetProperties(columns);
    params.SetClasses({cls});
    return params;
}

}  // namespace braigrion
