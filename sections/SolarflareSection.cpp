// The Solarflare adapter page, in the scheme of the Mellanox page: the
// vendor's driver and firmware identities, connectors and cards, each
// instance a block of label and value rows. The page is left open for the
// back-end to finish; its index entry counts the firmware alone.
#include "MellanoxBlocks.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace sections;

namespace {

const char kLinkName[] = "Solarflare";
const char kTableWidth[] = "40%";
const char kLabelWidth[] = "50%";

bool Contains(const std::string& text, const char* word) {
    return text.find(word) != std::string::npos;
}

}  // namespace

void TWriter::WriteSolarflareReport(TBuilderPtr /*builder*/, std::string reportName) {
    OpenPage(fOutputPath + NORVTKR20::TOSSpecific::kFileSeparator + kLinkName);
    WritePageHeader();
    WriteReportTitle("Solarflare Adapter", "", "");

    const std::string notFound = "::WriteSolarflareReport, ex.fStatusCode.fStatusCode=";
    TClassPtr card = GuardedVendorClass(fNamespace, "SF_NICCard", notFound);
    TClassPtr connector = GuardedVendorClass(fNamespace, "SF_PhysicalConnector", notFound);
    TClassPtr software = GuardedVendorClass(fNamespace, "SF_SoftwareIdentity", notFound);

    // Software identities other than the driver and the firmware (tools,
    // boot images) are left out of the first table.
    bool hasFirmware = false;
    bool softwareTitle = false;
    const std::vector<TReportProperty> softwareRows =
        BlockColumns({"Description", "InstanceID", "IsLargeBuildNumber", "LargeBuildNumber", "MajorVersion",
                      "MinorVersion", "Name", "RevisionNumber", "VersionString"});
    for (const TInstancePtr& instance : DeepInstances(software)) {
        const std::string id = ValueText(instance, "InstanceID");
        if (Contains(id, "Firmware")) hasFirmware = true;
        if (!Contains(id, "Driver") && !Contains(id, "Firmware")) continue;
        if (!softwareTitle) WriteTableTitle("Driver and Firmware", false, false);
        softwareTitle = true;
        WritePropertyBlock(*this, software, instance, "Driver and Firmware", softwareRows, kTableWidth, kLabelWidth);
    }

    struct TBlock {
        const char* title;
        TClassPtr cls;
        std::vector<std::string> properties;
    };
    const TBlock blocks[] = {
        {"Physical Connector", connector,
         {"ConnectorLayout", "ConnectorType", "CreationClassName", "Description", "ElementName", "InstanceID", "Name",
          "Tag"}},
        {"NIC Card", card,
         {"CreationClassName", "Description", "ElementName", "HostingBoard", "InstanceID", "Manufacturer", "Model",
          "Name", "PartNumber", "PoweredOn", "SerialNumber", "SKU", "Tag"}},
    };
    for (const TBlock& block : blocks) {
        const TInstances instances = DeepInstances(block.cls);
        if (instances.empty()) continue;
        WriteTableTitle(block.title, false, false);
        const std::vector<TReportProperty> rows = BlockColumns(block.properties);
        for (const TInstancePtr& instance : instances)
            WritePropertyBlock(*this, block.cls, instance, block.title, rows, kTableWidth, kLabelWidth);
    }

    // Only a firmware identity makes the page count as holding data.
    WriteIndexEntry(kLinkName, reportName, hasFirmware);
}

}  // namespace braigrion
