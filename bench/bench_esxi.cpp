// bench_esxi: the whole ESXi report of a host with big logs.
//
//   bench_esxi [RECORDS] OUTDIR
//
// The host holds RECORDS (200000 unless told otherwise) IPMI log records
// (shown twice: the merged log and the IPMI event page, sorted by record
// number), a tenth as many privilege records and a hundredth as many
// sensors, beside a chassis and a hypervisor. Building them is timed as
// "load"; then the ESXi report is written as text into OUTDIR, timed as
// "report" (by the clock and in processor time). Figures go to standard
// output one per line as "name: value".
#include <sys/resource.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>

#include "BenchClock.h"
#include "TReport_vmwesxi.h"
#include "TTextWriter_vmwesxi.h"
#include "repository/MemoryRepository.h"

namespace {

using bench::CpuSeconds;
using bench::PeakKiB;
using bench::SecondsSince;

using braigrion::repository::TMemoryNamespace;
using braigrion::repository::TPropertyValue;
using NORVTKR20::TCIMDateTime;
using NORVTKR20::TCIMValue;
typedef NORVTKR20::TCIMValue::TCIMType TType;

TPropertyValue Value(const std::string& name, const TCIMValue& value, TType::ECIMType type) {
    TPropertyValue property;
    property.fName = name;
    property.fValue = value;
    property.fType = type;
    return property;
}

TPropertyValue Text(const std::string& name, const std::string& value) {
    return Value(name, TCIMValue(value), TType::eString);
}

boost::shared_ptr<TMemoryNamespace> BuildHost(unsigned int records) {
    static const char* const kEvents[] = {"Power Supply 2 input lost (AC)", "System boot initiated",
                                          "Drive 1 predictive failure asserted", "Fan 3 speed below threshold",
                                          "Correctable memory error on DIMM 4"};
    boost::shared_ptr<TMemoryNamespace> ns = TMemoryNamespace::Create();
    ns->AddInstance("OMC_Chassis", {Text("Manufacturer", "Norvane Systems"), Text("SerialNumber", "none"),
                                    Value("ChassisPackageType", TCIMValue(static_cast<unsigned short>(17)),
                                          TType::eUint16)});
    ns->AddInstance("VMware_HypervisorSoftwareIdentity",
                    {Text("Name", "VMware ESXi"), Text("VersionString", "VMware ESXi 7.0.3 build-21930508")});
    for (unsigned int i = 0; i < records; ++i) {
        // Records arrive out of order, as the log wraps.
        const unsigned int number = (i * 7919u) % records;
        TCIMDateTime time(2024, static_cast<unsigned short>(1 + number % 12), 1 + number % 28,
                          static_cast<unsigned short>(number % 24), static_cast<unsigned short>(number % 60),
                          static_cast<unsigned short>((number / 60) % 60), 0, 0);
        ns->AddInstance("OMC_IpmiLogRecord", {Value("RecordID", TCIMValue(number), TType::eUint32),
                                              Value("MessageTimestamp", TCIMValue(time), TType::eDateTime),
                                              Text("Description", kEvents[number % 5])});
        if (i % 10 == 0) {
            ns->AddInstance("VMware_Privilege", {Text("ElementName", "user" + std::to_string(i % 97)),
                                                 Text("InstanceID", "Privilege:" + std::to_string(i)),
                                                 Value("PrivilegeGranted", TCIMValue(std::string("true")),
                                                       TType::eString)});
        }
        if (i % 100 == 0) {
            ns->AddInstance("OMC_NumericSensor",
                            {Text("Name", std::to_string(i / 100)), Text("ElementName", "Sensor " + std::to_string(i)),
                             Value("CurrentReading", TCIMValue(235u + i % 100), TType::eUint32),
                             Value("UnitModifier", TCIMValue(0u), TType::eUint32), Text("BaseUnits", "Degrees C")});
        }
    }
    ns->Link();
    return ns;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 2 || argc > 3) {
        std::fprintf(stderr, "usage: bench_esxi [RECORDS] OUTDIR\n");
        return 2;
    }
    const unsigned int records = argc == 3 ? static_cast<unsigned int>(std::strtoul(argv[1], nullptr, 10)) : 200000u;
    const std::string out = argv[argc - 1];
    std::filesystem::create_directories(out);

    auto start = std::chrono::steady_clock::now();
    boost::shared_ptr<TMemoryNamespace> ns = BuildHost(records);
    std::printf("records: %u\nload: %.2f s\n", records, SecondsSince(start));

    start = std::chrono::steady_clock::now();
    const double cpu = CpuSeconds();
    braigrion::backends::TTextWriter_vmwesxi writer;
    braigrion::TReport_vmwesxi report(ns, {}, out);
    report.Write(&writer, {});
    std::printf("report: %.2f s (processor %.2f s)\nended: %s\npeak: %ld MiB\n", SecondsSince(start),
                CpuSeconds() - cpu, writer.IsEnded() ? "yes" : "no", PeakKiB() / 1024);
    if (!writer.GetFailure().empty()) std::printf("failure: %s\n", writer.GetFailure().c_str());
    return writer.IsEnded() && writer.GetFailure().empty() ? 0 : 1;
}
