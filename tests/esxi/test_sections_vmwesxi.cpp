// The five ESXi sections, each written alone over a small collection:
// what they keep, what they leave out, and what they index.
#include <string>

#include <gtest/gtest.h>

#include "RecordingWriter_vmwesxi.h"
#include "repository/CIMXMLReader.h"
#include "support/LogCapture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using testing::TLogCapture;
using testing::TRecordingWriter_vmwesxi;
using testing::TRepoBuilder;

typedef TWriter_vmwesxi::TContext TContext;
typedef void (TWriter_vmwesxi::*TSection)(TReportParametersBuilder_vmwesxi);

// The transcript of one section over a collection given inline.
std::string WriteSection(TSection section, const std::string& repository) {
    TRepoBuilder repo;
    repo.Parse(repository);
    TRecordingWriter_vmwesxi writer;
    writer.Initialize(repo.Namespace(), TContext(), "out");
    (writer.*section)(TReportParametersBuilder_vmwesxi(repo.Namespace(), "default"));
    const std::string transcript = writer.Transcript();
    return transcript.substr(transcript.find('\n') + 1);
}

bool Has(const std::string& text, const std::string& part) {
    return text.find(part) != std::string::npos;
}

// --- environmentals ---

TEST(EnvironmentalsVmwesxi, ReadingIsScaledByTheUnitModifier) {
    struct TCase {
        const char* sensor;
        const char* reading;
    } const cases[] = {
        {"CurrentReading=sint32:255 UnitModifier=sint32:-1", "25.5"},
        {"CurrentReading=sint32:42 UnitModifier=sint32:0", "42"},
        {"CurrentReading=sint32:331 UnitModifier=sint32:-2", "3.31"},
        {"CurrentReading=sint32:12 UnitModifier=sint32:3", "12000"},
        {"CurrentReading=sint32:42", ""},
        {"CurrentReading=null:sint32 UnitModifier=sint32:0", ""},
        {"CurrentReading=\"high\" UnitModifier=sint32:0", ""},
    };
    for (const TCase& c : cases) {
        const std::string page = WriteSection(&TWriter_vmwesxi::WriteEnvironmentalsPreferred,
                                              std::string("OMC_NumericSensor Name=\"1\" ElementName=\"Ambient\" "
                                                          "BaseUnits=\"Degrees C\" ") +
                                                  c.sensor);
        EXPECT_TRUE(Has(page, std::string("  | \"Ambient\" \"") + c.reading + "\" \"Degrees C\"\n")) << page;
    }
}

TEST(EnvironmentalsVmwesxi, SensorsWithoutNameOrWithUnknownStateAreLeftOut) {
    const std::string page = WriteSection(&TWriter_vmwesxi::WriteEnvironmentalsPreferred,
                                          "OMC_NumericSensor Name=\"2\" ElementName=\"Fan 1\" CurrentReading=sint32:9120 "
                                          "UnitModifier=sint32:0 OperationalStatus=\"OK\"\n"
                                          "OMC_NumericSensor Name=\"1\" ElementName=\"PSU 2\" CurrentReading=sint32:0 "
                                          "UnitModifier=sint32:0 OperationalStatus=\"Unknown\"\n"
                                          "OMC_NumericSensor Name=\"3\" ElementName=\"\" CurrentReading=sint32:1 "
                                          "UnitModifier=sint32:0");
    EXPECT_TRUE(Has(page, "WriteTableGrid(grid 2x3 width=100 widths=[25,25,25] colheaders)\n"
                          "  | \"Name\" \"CurrentReading\" \"BaseUnits\"\n  | \"Fan 1\" \"9120\" \"\"\n"))
        << page;
    EXPECT_TRUE(Has(page, "WriteIndexEntry(\"environmentals\", \"Environmentals\", true)")) << page;

    // Nothing left: the title stands, no grid, no data.
    const std::string empty = WriteSection(&TWriter_vmwesxi::WriteEnvironmentalsPreferred,
                                           "OMC_NumericSensor Name=\"1\" ElementName=\"PSU 2\" "
                                           "OperationalStatus=\"Unknown\"");
    EXPECT_TRUE(Has(empty, "WriteTableTitle(\"Environmentals\", false, false)")) << empty;
    EXPECT_FALSE(Has(empty, "WriteTableGrid")) << empty;
    EXPECT_TRUE(Has(empty, "WriteIndexEntry(\"environmentals\", \"Environmentals\", false)")) << empty;
}

TEST(EnvironmentalsVmwesxi, WithoutSensorClassThePageHoldsItsHeadingOnly) {
    EXPECT_EQ("OpenPage(\"out/environmentals\")\nWritePageHeader()\nWriteReportTitle(\"Environmentals\", \"\", \"\")\n"
              "WritePageFooter()\nClosePage()\nWriteIndexEntry(\"environmentals\", \"Environmentals\", false)\n",
              WriteSection(&TWriter_vmwesxi::WriteEnvironmentalsPreferred, "OMC_Chassis IpmiNodeCount=uint16:1"));
}

TEST(EnvironmentalsVmwesxi, MultiNodeHostsGetANodeColumnAfterTheName) {
    const std::string page =
        WriteSection(&TWriter_vmwesxi::WriteEnvironmentalsPreferred,
                     "OMC_Chassis IpmiNodeCount=uint16:2\n"
                     "OMC_NumericSensor Name=\"1\" ElementName=\"Ambient\" NodeID=\"2\" CurrentReading=sint32:20 "
                     "UnitModifier=sint32:0 BaseUnits=\"Degrees C\"");
    EXPECT_TRUE(Has(page, "widths=[25,7,25,25] colheaders)\n  | \"Name\" \"NodeID\" \"CurrentReading\" \"BaseUnits\"\n"
                          "  | \"Ambient\" \"2\" \"20\" \"Degrees C\"\n"))
        << page;
}

// --- service processor configuration ---

TEST(KMCConfigVmwesxi, OnlyDHCPEndpointsAndOneTablePerSettingAreShown) {
    const std::string page = WriteSection(
        &TWriter_vmwesxi::WriteKMCConfigReport,
        "CIM_DNSSettingData InstanceID=\"SP:DNS:1\" RequestedHostname=\"esx14-sp\" ElementName=\"DNS\"\n"
        "CIM_IPProtocolEndpoint Name=\"dhcp\" IPv4Address=\"10.0.0.5\" AddressOrigin=uint16:4\n"
        "CIM_IPProtocolEndpoint Name=\"static\" IPv4Address=\"10.0.0.6\" AddressOrigin=uint16:3\n"
        "CIM_IPProtocolEndpoint Name=\"other\" IPv4Address=\"10.0.0.7\" AddressOrigin=uint16:14\n"
        "CIM_IPProtocolEndpoint Name=\"odd\" IPv4Address=\"10.0.0.8\" AddressOrigin=\"4 (DHCP)\"\n"
        "CIM_SNMPCommunityString CommunityString=\"public\" SystemName=\"sp\"\n"
        "CIM_SNMPCommunityString CommunityString=\"labmon\" SystemName=\"sp\"");
    EXPECT_TRUE(Has(page, "WriteTableTitle(\"SP:DNS:1\", false, false)")) << page;
    EXPECT_FALSE(Has(page, "\"DNSSettingData\"")) << page;
    EXPECT_TRUE(Has(page, "10.0.0.5")) << page;
    EXPECT_FALSE(Has(page, "10.0.0.6")) << page;
    EXPECT_FALSE(Has(page, "10.0.0.7")) << page;
    EXPECT_FALSE(Has(page, "10.0.0.8")) << page;
    // One titled table per community.
    EXPECT_TRUE(Has(page, "WriteTableTitle(\"SNMP Community\", false, false)\n"
                          "WriteTableGrid(grid 2x2 width=70 widths=[40,60] rowheaders)\n"
                          "  | \"CommunityString\" \"labmon\"\n")) << page;
    EXPECT_TRUE(Has(page, "WriteTableTitle(\"SNMP Community\", false, false)\n"
                          "WriteTableGrid(grid 2x2 width=70 widths=[40,60] rowheaders)\n"
                          "  | \"CommunityString\" \"public\"\n")) << page;
    EXPECT_TRUE(Has(page, "WriteIndexEntry(\"SPConfig\", \"KMC Configuration\", true)")) << page;
}

TEST(KMCConfigVmwesxi, MultiNodeTablesStartWithTheNode) {
    const std::string page = WriteSection(&TWriter_vmwesxi::WriteKMCConfigReport,
                                          "OMC_Chassis IpmiNodeCount=uint16:2\n"
                                          "OMC_IPMIIPProtocolEndpoint Name=\"lan1\" NodeID=\"1\" IPv4Address=\"10.0.0.9\"");
    EXPECT_TRUE(Has(page, "rowheaders)\n  | \"NodeID\" \"1\"\n  | \"Name\" \"lan1\"\n")) << page;
    EXPECT_TRUE(Has(WriteSection(&TWriter_vmwesxi::WriteKMCConfigReport, ""),
                    "WriteIndexEntry(\"SPConfig\", \"KMC Configuration\", false)"));
}

// --- hardware inventory ---

TEST(HardwareInventoryVmwesxi, ProcessorsAndSlotsComeBeforeTheCards) {
    TLogCapture log;
    const std::string page = WriteSection(&TWriter_vmwesxi::WriteCustomHardwareInventoryReport,
                                          "OMC_Card Name=\"Board\"\n"
                                          "OMC_MemorySlot Tag=\"DIMM 2\" ElementName=\"DIMM 2\"\n"
                                          "OMC_MemorySlot Tag=\"DIMM 1\" ElementName=\"DIMM 1\"\n"
                                          "OMC_ProcessorSlot Tag=\"CPU1\" ElementName=\"Socket 1\" Number=uint16:1\n"
                                          "OMC_Processor DeviceID=\"0\" ElementName=\"CPU 1\" ModelName=\"Xeon\"");
    const size_t processors = page.find("WriteTableTitle(\"Processors\"");
    const size_t cpuSlots = page.find("WriteTableTitle(\"CPU Slots\"");
    const size_t memorySlots = page.find("WriteTableTitle(\"Memory Slots\"");
    const size_t cards = page.find("WriteTableTitle(\"System Card Information\"");
    ASSERT_NE(std::string::npos, cards) << page;
    EXPECT_LT(processors, cpuSlots);
    EXPECT_LT(cpuSlots, memorySlots);
    EXPECT_LT(memorySlots, cards);
    EXPECT_TRUE(Has(page, "  | \"Name\" \"DIMM 1\" \"DIMM 2\"\n")) << page;
    EXPECT_FALSE(Has(page, "WriteReportTitle(\"Hardware Inventory\", \"\", \"\")\nWriteReportTitle")) << page;
    EXPECT_TRUE(Has(page, "WriteIndexEntry(\"hardware_inventory\", \"Hardware Inventory\", true)")) << page;
    // Processors are traced at the error level.
    EXPECT_EQ(0, log.LevelOf("TWriter_vmwesxi::WriteCustomHardwareInventoryReport -- Processor: CPU 1"));
}

// --- firmware ---

TEST(FirmwareVmwesxi, VendorFirmwareJoinsTheFirmwareTable) {
    const std::string page = WriteSection(
        &TWriter_vmwesxi::WriteCustomFirmwareReport,
        "OMC_MCFirmwareIdentity Name=\"SP firmware\" Manufacturer=\"Norvane\" VersionString=\"3.41\"\n"
        "VMware_EPFirmwareSoftwareIdentity ElementName=\"FPGA\" VersionString=\"4.10\"\n"
        "ELXHBA_SoftwareIdentity Name=\"Firmware LPe\" Classifications=uint16[]:10 VersionString=\"14.0\"\n"
        "ELXHBA_SoftwareIdentity Name=\"lpfc\" Classifications=uint16[]:2 VersionString=\"14.2\"\n"
        "QLogic_FCHBA_SoftwareIdentity Name=\"QLE Firmware\" Manufacturer=\"QLogic\" VersionString=\"9.08\"\n"
        "BROCADE_AdapterSoftwareIdentity Description=\"Adapter BIOS\" VersionString=\"3.2\"\n"
        "BROCADE_AdapterSoftwareIdentity Description=\"Adapter firmware\" VersionString=\"3.2\"\n"
        "OMC_SMASHFirmwareIdentity ElementName=\"UEFI\" VersionString=\"2.30\"");
    EXPECT_TRUE(Has(page, "WriteTableTitle(\"Firmware\", false, false)\nStartTable(\"100%\", \"Firmware\", true)\n"))
        << page;
    // Rows in order: the controller, the devices, then the adapters.
    const char* const names[] = {"Name=\"SP firmware\"", "ElementName=\"FPGA\"", "Name=\"Firmware LPe\"",
                                 "Name=\"QLE Firmware\"", "Description=\"Adapter firmware\""};
    size_t at = 0;
    for (const char* name : names) {
        const size_t found = page.find(name, at);
        EXPECT_NE(std::string::npos, found) << name << "\n" << page;
        at = found == std::string::npos ? at : found;
    }
    EXPECT_TRUE(Has(page, "WriteTextCell({Manufacturer width=\"25%\"}, \"Emulex\", \"\")")) << page;
    EXPECT_FALSE(Has(page, "Name=\"lpfc\"")) << page;
    EXPECT_FALSE(Has(page, "Adapter BIOS")) << page;
    EXPECT_TRUE(Has(page, "EndTable()\nWriteTableBreak()\nWriteTableTitle(\"BIOS/uEFI\", false, false)")) << page;
}

TEST(FirmwareVmwesxi, WithoutFirmwareThereIsNoFirmwareTable) {
    const std::string page = WriteSection(&TWriter_vmwesxi::WriteCustomFirmwareReport,
                                          "OMC_PowerSupply Name=\"Power Supply 1\"");
    EXPECT_FALSE(Has(page, "StartTable(")) << page;
    EXPECT_TRUE(Has(page, "  | \"Power Supply 1\"\n")) << page;
    EXPECT_TRUE(Has(page, "WriteIndexEntry(\"firmware\", \"Firmware/VPD\", true)")) << page;
    EXPECT_TRUE(Has(WriteSection(&TWriter_vmwesxi::WriteCustomFirmwareReport, ""),
                    "WriteIndexEntry(\"firmware\", \"Firmware/VPD\", false)"));
}

// --- LSI controllers ---

// A collection of Cardinal provider instances, keyed by "Id", with
// associations between them.
std::string Instance(const std::string& cls, const std::string& id, const std::string& properties = "") {
    return "<VALUE.NAMEDOBJECT><INSTANCENAME CLASSNAME=\"" + cls +
           "\"><KEYBINDING NAME=\"Id\"><KEYVALUE VALUETYPE=\"string\" TYPE=\"string\">" + id +
           "</KEYVALUE></KEYBINDING></INSTANCENAME><INSTANCE CLASSNAME=\"" + cls +
           "\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>" + id + "</VALUE></PROPERTY>" + properties +
           "</INSTANCE></VALUE.NAMEDOBJECT>\n";
}

std::string Property(const std::string& name, const std::string& value) {
    return "<PROPERTY NAME=\"" + name + "\" TYPE=\"string\"><VALUE>" + value + "</VALUE></PROPERTY>";
}

std::string Link(const std::string& assoc, const std::string& fromClass, const std::string& from,
                 const std::string& toClass, const std::string& to) {
    auto name = [](const std::string& cls, const std::string& id) {
        return "<INSTANCENAME CLASSNAME=\"" + cls +
               "\"><KEYBINDING NAME=\"Id\"><KEYVALUE VALUETYPE=\"string\" TYPE=\"string\">" + id +
               "</KEYVALUE></KEYBINDING></INSTANCENAME>";
    };
    auto reference = [&](const std::string& role, const std::string& cls, const std::string& id) {
        return "<PROPERTY.REFERENCE NAME=\"" + role + "\" REFERENCECLASS=\"" + cls + "\"><VALUE.REFERENCE>" +
               name(cls, id) + "</VALUE.REFERENCE></PROPERTY.REFERENCE>";
    };
    return "<VALUE.NAMEDOBJECT><INSTANCENAME CLASSNAME=\"" + assoc + "\"><KEYBINDING NAME=\"Antecedent\">" +
           "<VALUE.REFERENCE>" + name(fromClass, from) + "</VALUE.REFERENCE></KEYBINDING><KEYBINDING NAME=\"Dependent\">" +
           "<VALUE.REFERENCE>" + name(toClass, to) + "</VALUE.REFERENCE></KEYBINDING></INSTANCENAME><INSTANCE CLASSNAME=\"" +
           assoc + "\">" + reference("Antecedent", fromClass, from) + reference("Dependent", toClass, to) +
           "</INSTANCE></VALUE.NAMEDOBJECT>\n";
}

std::string WriteLSI(const std::string& instances) {
    const std::string xml =
        "<?xml version=\"1.0\"?><CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>"
        "<VALUE.OBJECT><CLASS NAME=\"CIM_ComputerSystem\"></CLASS></VALUE.OBJECT>"
        "<VALUE.OBJECT><CLASS NAME=\"LSIESG_MegaRAIDHBA\" SUPERCLASS=\"CIM_ComputerSystem\"></CLASS></VALUE.OBJECT>"
        "<VALUE.OBJECT><CLASS NAME=\"CIM_PhysicalPackage\"></CLASS></VALUE.OBJECT>"
        "<VALUE.OBJECT><CLASS NAME=\"LSIESG_EnclosureChassis\" SUPERCLASS=\"CIM_PhysicalPackage\"></CLASS></VALUE.OBJECT>"
        "<VALUE.OBJECT><CLASS NAME=\"LSIESG_IntegratedRaidChip\" SUPERCLASS=\"CIM_PhysicalPackage\"></CLASS></VALUE.OBJECT>"
        "</DECLGROUP><DECLGROUP.WITHNAME>" +
        instances + "</DECLGROUP.WITHNAME></DECLARATION></CIM>";
    auto ns = repository::LoadCollectionFromString(xml).fNamespace;
    TRecordingWriter_vmwesxi writer;
    writer.Initialize(ns, TContext(), "out");
    writer.WriteLSIReportWithCardinal();
    const std::string transcript = writer.Transcript();
    return transcript.substr(transcript.find('\n') + 1);
}

TEST(LSIVmwesxi, WithoutControllerThePageSaysSo) {
    for (const std::string& instances :
         {std::string(), Instance("CIM_ComputerSystem", "sys") +
                             Instance("LSIESG_EnclosureChassis", "encl", Property("Model", "Enclosure 252")) +
                             Link("LSIESG_SystemPackaging", "LSIESG_EnclosureChassis", "encl", "CIM_ComputerSystem", "sys")}) {
        const std::string page = WriteLSI(instances);
        EXPECT_TRUE(Has(page, "WriteTableGrid(grid 1x1 width=100 widths=[100])\n  | \"No LSI RAID card detected\\n\"\n"))
            << page;
        EXPECT_TRUE(Has(page, "WriteIndexEntry(\"lsi_mir\", \"LSI Controller\", false)")) << page;
    }
}

TEST(LSIVmwesxi, AMegaRAIDControllerShowsItsPackageBuild) {
    const std::string page = WriteLSI(
        Instance("LSIESG_MegaRAIDHBA", "hba", Property("ElementName", "MegaRAID 9460-8i")) +
        Instance("LSIESG_EnclosureChassis", "encl", Property("Model", "Enclosure 252")) +
        Instance("LSIESG_IntegratedRaidChip", "chip", Property("Model", "SAS3508")) +
        Link("LSIESG_SystemPackaging", "LSIESG_EnclosureChassis", "encl", "LSIESG_MegaRAIDHBA", "hba") +
        Link("LSIESG_SystemPackaging", "LSIESG_IntegratedRaidChip", "chip", "LSIESG_MegaRAIDHBA", "hba") +
        Instance("LSIESG_ControllerFirmwareIdentity", "fw", Property("VersionString", "5.220")) +
        Link("LSIESG_ElementSoftwareIdentity", "LSIESG_ControllerFirmwareIdentity", "fw", "LSIESG_MegaRAIDHBA", "hba") +
        Instance("LSIESG_DiskDrive", "pd1", Property("Name", "Drive 1")) +
        Instance("LSIESG_DiskDrive", "pd0", Property("Name", "Drive 0")) +
        Link("LSIESG_SystemDevice", "LSIESG_MegaRAIDHBA", "hba", "LSIESG_DiskDrive", "pd1") +
        Link("LSIESG_SystemDevice", "LSIESG_MegaRAIDHBA", "hba", "LSIESG_DiskDrive", "pd0"));
    EXPECT_TRUE(Has(page, "WriteTableTitle(\"Controller Information\", false, false)\n"
                          "WriteTableGrid(grid 5x2 width=50 widths=[40,60] rowheaders)\n"
                          "  | \"Model\" \"SAS3508\"\n  | \"Name\" \"MegaRAID 9460-8i\"\n"
                          "  | \"BIOS Version\" \"\"\n  | \"Firmware Version\" \"5.220\"\n"
                          "  | \"FW Package Build version\" \"N/A\"\n"))
        << page;
    EXPECT_EQ(page.find("Controller Information"), page.rfind("Controller Information")) << page;
    EXPECT_TRUE(Has(page, "  | \"Name\" \"Drive 0\" \"Drive 1\"\n")) << page;
    EXPECT_FALSE(Has(page, "Logical drive information")) << page;
    EXPECT_TRUE(Has(page, "WriteIndexEntry(\"lsi_mir\", \"LSI Controller\", true)")) << page;
}

}  // namespace
}  // namespace braigrion
