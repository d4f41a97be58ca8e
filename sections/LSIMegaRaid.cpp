// A MegaRAID report from the vendor provider's classes that joins them by
// their identifiers rather than by associations, as the earliest versions
// of that provider required. No page writes it today; it stays a member so
// that the choice of provider can turn to it.
//
// Each controller is known by the InstanceID of its port (LSIESG_DAPort);
// its card, BIOS and firmware are the instances whose identifiers hold that
// id, the RAID level of a pool the setting whose id holds the pool's, and a
// drive's extent and firmware those whose ids hold the drive's DeviceID.
#include "StorageSupport.h"
#include "braigrion/TWriter.h"

namespace braigrion {

using namespace storage;

namespace {

const char kName[] = "TWriter::WriteLSIMegaRaidReport";

// The instances of a class, none when the collection lacks it.
TInstances AllOf(const TWriter::TNamespacePtr& ns, const std::string& className) {
    try {
        return InstancesOf(ns, className);
    } catch (...) {
        Trace(std::string(kName) + " -- Exception when getting class " + className);
        return TInstances();
    }
}

// The first instance whose `property` text holds `id`.
TWriter::TInstancePtr Holding(TWriter& writer, const TInstances& instances, const std::string& property,
                              const std::string& id) {
    if (id.empty()) return TWriter::TInstancePtr();
    for (const TWriter::TInstancePtr& instance : instances) {
        if (writer.GetPropertyValue(instance, property, ",").find(id) != std::string::npos) return instance;
    }
    return TWriter::TInstancePtr();
}

// A row of `property` read from `source`, or a label with an empty value
// when there is no source.
void WriteJoinedRow(TWriter& writer, const TWriter::TInstancePtr& owner, const TWriter::TInstancePtr& source,
                    const TReportProperty& property) {
    if (source) {
        WriteMixedRow(writer, owner, property, source, property);
    } else {
        writer.StartRow(true);
        writer.WriteHeaderCell(ClassOf(owner), property);
        writer.WriteTextCell(property, "", "");
        writer.EndRow();
    }
}

}  // namespace

void TWriter::WriteLSIMegaRaidReport(bool& noCard) {
    Trace(std::string("Entering ") + kName);
    try {
        ClassNamed(fNamespace, "LSIESG_MegaRAIDHBA");
        ClassNamed(fNamespace, "LSIESG_PhysicalCard");
    } catch (...) {
        Trace(std::string(kName) + " -- raidCSClass = NULL && raidCardClass = NULL");
        return;
    }
    const TInstances controllers = AllOf(fNamespace, "LSIESG_MegaRAIDHBA");
    const TInstances cards = AllOf(fNamespace, "LSIESG_PhysicalCard");
    const TInstances bios = AllOf(fNamespace, "LSIESG_ControllerBIOSIdentity");
    const TInstances firmware = AllOf(fNamespace, "LSIESG_ControllerFirmwareIdentity");
    const TInstances driveFirmware = AllOf(fNamespace, "LSIESG_DriveFirmwareIdentity");
    const TInstances extents = AllOf(fNamespace, "LSIESG_DiskExtent");
    const TInstances settings = AllOf(fNamespace, "LSIESG_StorageVolumeSetting");
    for (const TInstancePtr& controller : controllers) {
        try {
            noCard = false;
            const TInstances ports = Associated(controller, "LSIESG_SystemDevice", "LSIESG_DAPort");
            const std::string id = ports.empty() ? std::string() : GetPropertyValue(ports.front(), "InstanceID", ",");

            WriteTableTitle("Controller Information", false, false);
            StartPropertyTable("50%", "40%", "Controller Information");
            WriteJoinedRow(*this, controller, Holding(*this, cards, "Tag", id), Row("Model"));
            WriteJoinedRow(*this, controller, Holding(*this, bios, "InstanceID", id),
                           Row("VersionString", "BIOS Version"));
            WriteJoinedRow(*this, controller, Holding(*this, firmware, "InstanceID", id),
                           Row("VersionString", "Firmware Version"));
            EndTable();

            for (const TInstancePtr& pool : Associated(controller, "LSIESG_HostedStoragePool", "LSIESG_StoragePool")) {
                WriteTableTitle("Logical drive information", false, false);
                StartPropertyTable("50%", "40%", "Controller Information -- Logical drive information");
                WritePropertyRow(*this, pool, Row("ElementName"));
                WritePropertyRow(*this, pool, Row("OperationalStatus"));
                WriteJoinedRow(*this, pool,
                               Holding(*this, settings, "InstanceID", GetPropertyValue(pool, "InstanceID", ",")),
                               Row("ElementName", "RAIDLevel"));
                for (const TInstancePtr& extent : Associated(pool, "LSIESG_MemberOfCollection", "LSIESG_DiskExtent")) {
                    WriteRowBreak(1);
                    WritePropertyRow(*this, extent, Row("DeviceID", "Name"));
                    WritePropertyRow(*this, extent, Row("ExtentStatus"));
                }
                EndTable();
            }

            for (const TInstancePtr& drive : Associated(controller, "LSIESG_SystemDevice", "LSIESG_DiskDrive")) {
                const std::string deviceID = GetPropertyValue(drive, "DeviceID", ",");
                const TInstancePtr extent = Holding(*this, extents, "DeviceID", deviceID);
                WriteTableTitle("Physical Drive Information", false, false);
                StartPropertyTable("50%", "40%", "Controller Information -- Physical Drive Information");
                WritePropertyRow(*this, drive, Row("Name"));
                WritePropertyRow(*this, drive, Row("OperationalStatus"));
                WriteJoinedRow(*this, drive, extent, Row("BlockSize"));
                WriteJoinedRow(*this, drive, extent, Row("NumberOfBlocks"));
                WritePropertyRow(*this, drive, Row("Manufacturer"));
                WriteJoinedRow(*this, drive, Holding(*this, driveFirmware, "InstanceID", deviceID),
                               Row("VersionString", "Firmware version"));
                EndTable();
            }
        } catch (...) {
            EndTable();
            Trace(std::string(kName) + " -- Exception when processing controller");
        }
    }
    Trace(std::string("Exiting ") + kName);
}

}  // namespace braigrion
