// bench_devices: the cost of the merged device page and of the Melody device
// analysis page over many devices, written by the text back-end into a
// scratch directory.
//
//   bench_devices [DEVICES] [DIR]
//
// The collection holds DEVICES (100000 unless told otherwise) logical
// devices in 24 device classes, and as many scored device properties.
// Building it is timed as "build"; then each page is written once. Figures
// go to standard output one per line as "name: value".
#include <sys/resource.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>

#include <boost/make_shared.hpp>

#include "BenchClock.h"
#include "TTextWriter.h"
#include "braigrion/ReportDefinition.h"
#include "repository/MemoryRepository.h"

namespace {

using bench::CpuSeconds;
using bench::PeakKiB;
using bench::SecondsSince;

using NORVTKR20::TCIMValue;
typedef NORVTKR20::TCIMValue::TCIMType TType;
namespace repository = braigrion::repository;

repository::TPropertyValue Text(const std::string& name, const std::string& text) {
    repository::TPropertyValue property;
    property.fName = name;
    property.fValue = TCIMValue(text);
    property.fType = TType::eString;
    return property;
}

repository::TPropertyValue Count(unsigned int count) {
    repository::TPropertyValue property;
    property.fName = "MelodyCommonFrequencies";
    property.fValue = TCIMValue(count);
    property.fType = TType::eUint32;
    return property;
}

void Declare(repository::TMemoryNamespace& ns, const std::string& name, std::initializer_list<const char*> properties) {
    repository::TClassData cls;
    cls.fName = name;
    for (const char* property : properties) {
        repository::TPropertyDeclData declaration;
        declaration.fName = property;
        declaration.fType = TType::eString;
        cls.fProperties.push_back(declaration);
    }
    ns.DeclareClass(cls);
}

boost::shared_ptr<repository::TMemoryNamespace> BuildCollection(unsigned int count) {
    static const char* const kClasses[] = {"storage", "network", "display", "usb", "unknown", "System"};
    auto ns = repository::TMemoryNamespace::Create();
    Declare(*ns, "ORVSG_OperatingSystem", {"ProductVendor"});
    ns->AddInstance("ORVSG_OperatingSystem", {Text("ProductVendor", "SUSE LLC")});
    Declare(*ns, "ORVSG_LogicalDevice",
            {"DeviceID", "DeviceClass", "ElementName", "Location", "Manufacturer", "OperationalStatus"});
    Declare(*ns, "ORVSG_MelodyDevices", {"InstanceID", "MelodyScore", "MelodyType", "MelodyCimType",
                                         "MelodyPropertyName", "MelodyValue", "MelodyFrequency", "MelodyCommonValues"});
    for (unsigned int i = 0; i < count; ++i) {
        const unsigned int n = (i * 7919u) % count;  // devices arrive in no order
        const std::string id = std::to_string(n);
        ns->AddInstance("ORVSG_LogicalDevice",
                        {Text("DeviceID", "dev" + id),
                         Text("DeviceClass", std::string(kClasses[n % 6]) + (n % 24 < 6 ? "" : std::to_string(n % 4))),
                         Text("ElementName", "Device " + id), Text("Location", "PCI bus " + std::to_string(n % 256)),
                         Text("Manufacturer", "Vendor " + std::to_string(n % 40)), Text("OperationalStatus", "OK")});
        ns->AddInstance("ORVSG_MelodyDevices",
                        {Text("InstanceID", id), Text("MelodyScore", std::to_string(n % 100)),
                         Text("MelodyType", "Network adapter"), Text("MelodyCimType", "ORVSG_NetworkPort"),
                         Text("MelodyPropertyName", "DriverVersion"), Text("MelodyValue", "4.0." + id),
                         Text("MelodyFrequency", "2%"), Text("MelodyCommonValues", "4.9.7"), Count(n % 90)});
    }
    ns->Link();
    return ns;
}

}  // namespace

int main(int argc, char** argv) {
    const unsigned int count = argc > 1 ? static_cast<unsigned int>(std::strtoul(argv[1], nullptr, 10)) : 100000u;
    const std::filesystem::path dir =
        argc > 2 ? std::filesystem::path(argv[2]) : std::filesystem::temp_directory_path() / "bench_devices";
    std::filesystem::create_directories(dir);

    auto start = std::chrono::steady_clock::now();
    auto ns = BuildCollection(count);
    std::printf("devices: %u\nbuild: %.2f s\n", count, SecondsSince(start));

    braigrion::backends::TTextWriter writer;
    std::map<std::string, TCIMValue> context;
    auto builder = boost::make_shared<braigrion::TReportParametersBuilder>(ns, "default", false);
    writer.BaseInitialize(ns, context, builder);
    writer.Initialize(ns, context, dir.string());
    for (const std::string& page :
         {TKR_REPORT_DEFINITION::PAGE_MERGED_DEVICE, TKR_REPORT_DEFINITION::PAGE_MELODY_DEVICE}) {
        start = std::chrono::steady_clock::now();
        writer.WriteReportPage(builder, page);
        std::printf("page %s: %.2f s\n", page.c_str(), SecondsSince(start));
    }
    writer.EndReport();
    std::printf("peak rss: %ld KiB\n", PeakKiB());
    if (!writer.GetFailure().empty()) {
        std::fprintf(stderr, "bench_devices: %s\n", writer.GetFailure().c_str());
        return 1;
    }
    return 0;
}
