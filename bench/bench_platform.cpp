// bench_platform: the cost of the two platform pages that grow with the
// machine, the "Firmware/VPD" page and the "Environmentals" page, written
// through the HTML back-end into a directory.
//
//   bench_platform DIR [COUNT]
//
// The collection holds COUNT (100000 unless told otherwise) firmware
// elements, each linked to a device, COUNT field replaceable units and
// COUNT numeric sensors, plus one row of each vendor class the firmware page
// merges. Figures go to standard output one per line as "name: value".
#include <sys/resource.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstdint>
#include <filesystem>
#include <map>
#include <string>

#include <boost/make_shared.hpp>

#include "BenchClock.h"
#include "THtmlWriter.h"
#include "repository/MemoryRepository.h"

namespace {

using bench::CpuSeconds;
using bench::PeakKiB;
using bench::SecondsSince;

using braigrion::repository::TClassData;
using braigrion::repository::TMemoryNamespace;
using braigrion::repository::TPropertyDeclData;
using braigrion::repository::TPropertyValue;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;
typedef NORVTKR20::TCIMValue::TCIMType TType;

TPropertyValue Value(const std::string& name, const TCIMValue& value) {
    TPropertyValue property;
    property.fName = name;
    property.fValue = value;
    return property;
}

// A class whose first property is its key.
void Declare(TMemoryNamespace& ns, const std::string& name, const std::string& key, bool association = false) {
    TClassData cls;
    cls.fName = name;
    TPropertyDeclData declaration;
    declaration.fName = key;
    declaration.fType = TType::eString;
    braigrion::repository::TQualifierData isKey;
    isKey.fName = "Key";
    isKey.fValue = TCIMValue::Boolean(true);
    declaration.fQualifiers.push_back(isKey);
    cls.fProperties.push_back(declaration);
    if (association) {
        braigrion::repository::TQualifierData assoc;
        assoc.fName = "Association";
        assoc.fValue = TCIMValue::Boolean(true);
        cls.fQualifiers.push_back(assoc);
    }
    ns.DeclareClass(cls);
}

TCIMValue RefTo(const boost::shared_ptr<TMemoryNamespace>& ns, const std::string& path) {
    return TCIMValue(TCIMReference(ns, path, NORVTKR20::TCIMContext()));
}

boost::shared_ptr<TMemoryNamespace> BuildCollection(unsigned int count) {
    boost::shared_ptr<TMemoryNamespace> ns = TMemoryNamespace::Create();
    Declare(*ns, "ORVSG_FirmwareElement", "SoftwareElementID");
    Declare(*ns, "ORVSG_SysBusDevice", "DeviceID");
    Declare(*ns, "ORVSG_DeviceFirmware", "Antecedent", true);
    for (unsigned int i = 0; i < count; ++i) {
        const std::string id = std::to_string((i * 7919u) % count);
        ns->AddInstance("ORVSG_FirmwareElement",
                        {Value("SoftwareElementID", TCIMValue("FW" + id)), Value("Name", TCIMValue("Adapter " + id + " Firmware")),
                         Value("Manufacturer", TCIMValue("Norvane")), Value("Version", TCIMValue("4.20." + id)),
                         Value("BuildNumber", TCIMValue("B" + id))});
        ns->AddInstance("ORVSG_SysBusDevice", {Value("DeviceID", TCIMValue("PCI" + id)),
                                               Value("ProductID", TCIMValue("0x16d" + id)),
                                               Value("OtherIdentifyingInfo", TCIMValue("Slot " + id))});
        ns->AddInstance("ORVSG_DeviceFirmware",
                        {Value("Antecedent", RefTo(ns, "ORVSG_FirmwareElement.SoftwareElementID=\"FW" + id + "\"")),
                         Value("Dependent", RefTo(ns, "ORVSG_SysBusDevice.DeviceID=\"PCI" + id + "\""))});
        ns->AddInstance("ORVSG_FRU", {Value("Name", TCIMValue("Power Supply " + id)), Value("Vendor", TCIMValue("Norvane")),
                                      Value("FRUNumber", TCIMValue("94Y" + id))});
        ns->AddInstance("CIM_NumericSensor",
                        {Value("SensorDescription", TCIMValue("Sensor " + id)), Value("SourceNode", TCIMValue("Node 1")),
                         Value("CurrentReading", TCIMValue(2375u + i % 100)), Value("UnitModifier", TCIMValue(0u)),
                         Value("BaseUnits", TCIMValue("Degrees C"))});
    }
    ns->AddInstance("MLNX_FirmwareIdentity", {Value("Name", TCIMValue("ConnectX-5")), Value("VersionString", TCIMValue("16.35"))});
    ns->AddInstance("EMXCNA_FirmwareVersion", {Value("Name", TCIMValue("OCe14102")), Value("Version", TCIMValue("12.0"))});
    ns->AddInstance("PMC_FirmwareSoftwareIdentity", {Value("InstanceID", TCIMValue("Adapter 1")), Value("VersionString", TCIMValue("3.00"))});
    ns->Link();
    return ns;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 2) {
        std::fprintf(stderr, "usage: bench_platform DIR [COUNT]\n");
        return 2;
    }
    const std::string dir = argv[1];
    const unsigned int count = argc > 2 ? static_cast<unsigned int>(std::strtoul(argv[2], nullptr, 10)) : 100000u;
    std::filesystem::remove_all(dir);
    std::filesystem::create_directories(dir);

    auto start = std::chrono::steady_clock::now();
    boost::shared_ptr<TMemoryNamespace> ns = BuildCollection(count);
    std::printf("instances per class: %u\nload: %.2f s\npeak after load: %ld KiB\n", count, SecondsSince(start),
                PeakKiB());

    braigrion::backends::THtmlWriter writer;
    std::map<std::string, TCIMValue> context;
    auto builder = boost::make_shared<braigrion::TReportParametersBuilder>(ns, "default", false);
    writer.BaseInitialize(ns, context, builder);
    writer.Initialize(ns, context, dir);
    writer.StartReport();

    start = std::chrono::steady_clock::now();
    writer.WriteReportPage(builder, "Firmware");
    std::printf("firmware page: %.2f s\npeak after firmware page: %ld KiB\n", SecondsSince(start), PeakKiB());
    start = std::chrono::steady_clock::now();
    writer.WriteReportPage(builder, "Environmentals");
    std::printf("environmentals page: %.2f s\npeak after environmentals page: %ld KiB\n", SecondsSince(start),
                PeakKiB());
    writer.EndReport();
    std::printf("firmware.html: %ju bytes\nEnvironmentals.html: %ju bytes\n",
                static_cast<std::uintmax_t>(std::filesystem::file_size(dir + "/firmware.html")),
                static_cast<std::uintmax_t>(std::filesystem::file_size(dir + "/Environmentals.html")));
    return writer.GetFailure().empty() ? 0 : 1;
}
