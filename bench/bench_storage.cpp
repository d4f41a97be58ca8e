// bench_storage: the storage pages over a large controller, through the HTML
// back-end into a scratch directory.
//
//   bench_storage [DRIVES] [DIR]
//
// The collection holds one MegaRAID controller as the vendor provider
// reports it with DRIVES drives (2000 unless told otherwise), each with its
// extent, physical drive and firmware, in volumes of eight; and DRIVES / 10
// ATA drives with 30 SMART attributes and 5 logged errors each. The pages
// "LSI Controller" and "Drive Health" are written once each, after the
// collection is built. Figures go to standard output as "name: value".

#include <sys/resource.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>

#include "BenchClock.h"
#include "THtmlWriter.h"
#include "braigrion/ReportDefinition.h"
#include "repository/MemoryRepository.h"

namespace {

using bench::CpuSeconds;
using bench::PeakKiB;
using bench::SecondsSince;

using braigrion::repository::TMemoryNamespace;
using braigrion::repository::TPropertyValue;
using NORVTKR20::TCIMValue;

TPropertyValue Value(const std::string& name, const TCIMValue& value) {
    TPropertyValue property;
    property.fName = name;
    property.fValue = value;
    return property;
}

TCIMValue Ref(const boost::shared_ptr<TMemoryNamespace>& ns, const std::string& path) {
    return TCIMValue(NORVTKR20::TCIMReference(ns, path, NORVTKR20::TCIMContext()));
}

void Link(const boost::shared_ptr<TMemoryNamespace>& ns, const std::string& assoc, const std::string& from,
          const std::string& to, const char* fromRole = "Antecedent", const char* toRole = "Dependent") {
    ns->AddInstance(assoc, {Value(fromRole, Ref(ns, from)), Value(toRole, Ref(ns, to))});
}

std::string Path(const std::string& cls, const std::string& key, const std::string& value) {
    return cls + "." + key + "=\"" + value + "\"";
}

void AddController(const boost::shared_ptr<TMemoryNamespace>& ns, unsigned drives) {
    braigrion::repository::TClassData hba;
    hba.fName = "LSIESG_MegaRAIDHBA";
    hba.fSuperClass = "CIM_ComputerSystem";
    ns->DeclareClass(braigrion::repository::TClassData{"CIM_ComputerSystem", "", {}, {}});
    ns->DeclareClass(hba);
    ns->DeclareClass(braigrion::repository::TClassData{"CIM_PhysicalPackage", "", {}, {}});
    ns->DeclareClass(braigrion::repository::TClassData{"LSIESG_IntegratedRaidChip", "CIM_PhysicalPackage", {}, {}});
    const std::string system = Path("LSIESG_MegaRAIDHBA", "Name", "hba0");
    ns->AddInstance("LSIESG_MegaRAIDHBA", {Value("Name", TCIMValue("hba0")), Value("ElementName", TCIMValue("MR"))});
    ns->AddInstance("LSIESG_IntegratedRaidChip", {Value("Tag", TCIMValue("chip0")), Value("Model", TCIMValue("SAS3108"))});
    Link(ns, "LSIESG_SystemPackaging", Path("LSIESG_IntegratedRaidChip", "Tag", "chip0"), system);
    for (const char* cls : {"LSIESG_ControllerBIOSIdentity", "LSIESG_ControllerFirmwareIdentity"}) {
        ns->AddInstance(cls, {Value("InstanceID", TCIMValue(cls)), Value("VersionString", TCIMValue("1.0"))});
        Link(ns, "LSIESG_ElementSoftwareIdentity", Path(cls, "InstanceID", cls), system);
    }
    ns->DeclareClass(braigrion::repository::TClassData{"ORV_LSIRawData", "", {}, {}});
    for (unsigned i = 0; i < drives; ++i) {
        const std::string id = std::to_string(i);
        const std::string drive = Path("LSIESG_DiskDrive", "DeviceID", id);
        const std::string extent = Path("LSIESG_DiskExtent", "DeviceID", id);
        ns->AddInstance("LSIESG_DiskDrive", {Value("DeviceID", TCIMValue(id)), Value("Name", TCIMValue("Drive " + id))});
        ns->AddInstance("LSIESG_DiskExtent", {Value("DeviceID", TCIMValue(id)), Value("Name", TCIMValue("Extent " + id)),
                                              Value("BlockSize", TCIMValue(512u))});
        ns->AddInstance("LSIESG_PhysicalDrive", {Value("Tag", TCIMValue(id)), Value("FRUNumber", TCIMValue("FRU" + id)),
                                                 Value("Vendor", TCIMValue("SEAGATE"))});
        ns->AddInstance("LSIESG_DriveFirmwareIdentity",
                        {Value("InstanceID", TCIMValue(id)), Value("VersionString", TCIMValue("A5B0"))});
        Link(ns, "LSIESG_SystemDevice", system, drive, "GroupComponent", "PartComponent");
        Link(ns, "LSIESG_MediaPresent", drive, extent);
        Link(ns, "LSIESG_Realizes", Path("LSIESG_PhysicalDrive", "Tag", id), drive);
        Link(ns, "LSIESG_ElementSoftwareIdentity", Path("LSIESG_DriveFirmwareIdentity", "InstanceID", id), drive);
        if (i % 8 == 0) {
            ns->AddInstance("LSIESG_StorageVolume", {Value("DeviceID", TCIMValue(id)), Value("Name", TCIMValue("VD " + id))});
            Link(ns, "LSIESG_SystemDevice", system, Path("LSIESG_StorageVolume", "DeviceID", id), "GroupComponent",
                 "PartComponent");
        }
        Link(ns, "LSIESG_ConcreteDependency", extent, Path("LSIESG_StorageVolume", "DeviceID", std::to_string(i - i % 8)));
    }
}

void AddATADrives(const boost::shared_ptr<TMemoryNamespace>& ns, unsigned devices) {
    for (unsigned d = 0; d < devices; ++d) {
        const std::string id = "/dev/sd" + std::to_string(d);
        const std::string device = Path("OMC_ATADevice", "DeviceID", id);
        ns->AddInstance("OMC_ATADevice", {Value("DeviceID", TCIMValue(id)), Value("VendorID", TCIMValue("ATA"))});
        for (unsigned a = 30; a > 0; --a) {
            const std::string attribute = id + ":" + std::to_string(a);
            ns->AddInstance("OMC_IDESMARTAttrib", {Value("InstanceID", TCIMValue(attribute)),
                                                   Value("attribID", TCIMValue(a)), Value("value", TCIMValue(100u))});
            Link(ns, "OMC_IDESMARTElementStatisticalData", device, Path("OMC_IDESMARTAttrib", "InstanceID", attribute),
                 "ManagedElement", "Stats");
        }
        for (unsigned e = 0; e < 5; ++e) {
            const std::string error = id + ":" + std::to_string(e);
            ns->AddInstance("OMC_IDESMARTError", {Value("InstanceID", TCIMValue(error)), Value("RecordID", TCIMValue(e))});
            Link(ns, "OMC_IDESMARTRecordInLog", device, Path("OMC_IDESMARTError", "InstanceID", error));
        }
    }
}

}  // namespace

int main(int argc, char** argv) {
    const unsigned drives = argc > 1 ? static_cast<unsigned>(std::strtoul(argv[1], nullptr, 10)) : 2000;
    // The scratch directory defaults to the system's, not the working directory.
    const std::string dir =
        argc > 2 ? argv[2] : (std::filesystem::temp_directory_path() / "bench_storage").string();
    std::filesystem::create_directories(dir);

    auto start = std::chrono::steady_clock::now();
    boost::shared_ptr<TMemoryNamespace> ns = TMemoryNamespace::Create();
    AddController(ns, drives);
    AddATADrives(ns, drives / 10);
    ns->Link();
    std::printf("build_seconds: %.3f\n", SecondsSince(start));

    braigrion::backends::THtmlWriter writer;
    braigrion::TWriter::TContext context;
    auto builder = boost::make_shared<braigrion::TReportParametersBuilder>(ns, "default", false);
    writer.BaseInitialize(ns, context, builder);
    writer.Initialize(ns, context, dir);
    writer.StartReport();
    for (const std::string& page : {TKR_REPORT_DEFINITION::PAGE_LSI_CONTROLLER, TKR_REPORT_DEFINITION::PAGE_DRIVE_HEALTH}) {
        start = std::chrono::steady_clock::now();
        writer.WriteReportPage(builder, page);
        std::printf("%s_seconds: %.3f\n", page.c_str(), SecondsSince(start));
    }
    writer.EndReport();
    writer.BaseDispose();
    std::printf("drives: %u\nata_devices: %u\npeak_kib: %ld\n", drives, drives / 10, PeakKiB());
    return writer.GetFailure().empty() ? 0 : 1;
}
