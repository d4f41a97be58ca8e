// bench_page: the cost of one generic page over a large class, against the
// cost of putting the same instances into the repository.
//
//   bench_page [INSTANCES]            build the collection in memory
//   bench_page --save FILE [INSTANCES] build it and save it as CIM-XML
//   bench_page --load FILE             load a saved collection
//
// The collection holds INSTANCES (1000000 unless told otherwise) log
// records of five properties: a record number, a date, a severity, a source
// and a message. Building or loading it is timed as "load". Then one generic
// page of five columns over the class is written through a back-end that
// discards what it is given, twice: once plain, once with the log page's
// usual filter (leaving out the debug records) and sort key (newest record
// first). Figures go to standard output one per line as "name: value".

#include <sys/resource.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

#include "BenchClock.h"
#include "NullWriter.h"
#include "braigrion/TWriter.h"
#include "repository/CIMXMLReader.h"
#include "repository/CIMXMLWriter.h"
#include "repository/MemoryRepository.h"

namespace {

using bench::CpuSeconds;
using bench::PeakKiB;
using bench::SecondsSince;

using braigrion::TReportClass;
using braigrion::TReportParameters;
using braigrion::TReportProperty;
using braigrion::TTable;
using braigrion::TWriter;
using NORVTKR20::TCIMDateTime;
using NORVTKR20::TCIMValue;
typedef NORVTKR20::TCIMValue::TCIMType TType;


braigrion::repository::TPropertyDeclData Declared(const std::string& name, TType::ECIMType type) {
    braigrion::repository::TPropertyDeclData declaration;
    declaration.fName = name;
    declaration.fType = type;
    return declaration;
}

braigrion::repository::TPropertyValue Value(const std::string& name, const TCIMValue& value, TType::ECIMType type) {
    braigrion::repository::TPropertyValue property;
    property.fName = name;
    property.fValue = value;
    property.fType = type;
    return property;
}

boost::shared_ptr<braigrion::repository::TMemoryNamespace> BuildCollection(unsigned int count) {
    static const char* const kSeverities[] = {"Information", "Warning", "Error", "Debug"};
    static const char* const kSources[] = {"kernel", "sshd", "systemd", "smartd", "ipmievd", "crond"};
    boost::shared_ptr<braigrion::repository::TMemoryNamespace> ns = braigrion::repository::TMemoryNamespace::Create();
    braigrion::repository::TClassData cls;
    cls.fName = "ORVSG_LinuxEventLogRecord";
    cls.fProperties = {Declared("RecordNumber", TType::eUint32), Declared("TimeWritten", TType::eDateTime),
                       Declared("Severity", TType::eString), Declared("Source", TType::eString),
                       Declared("Message", TType::eString)};
    ns->DeclareClass(cls);
    for (unsigned int i = 0; i < count; ++i) {
        // Records arrive out of order, as several log files interleave.
        unsigned int number = (i * 7919u) % count;
        TCIMDateTime time(2024, static_cast<unsigned short>(1 + number % 12), 1 + number % 28,
                          static_cast<unsigned short>(number % 24), static_cast<unsigned short>(number % 60),
                          static_cast<unsigned short>((number / 60) % 60), 0, 0);
        ns->AddInstance("ORVSG_LinuxEventLogRecord",
                        {Value("RecordNumber", TCIMValue(number), TType::eUint32),
                         Value("TimeWritten", TCIMValue(time), TType::eDateTime),
                         Value("Severity", TCIMValue(kSeverities[number % 4]), TType::eString),
                         Value("Source", TCIMValue(kSources[number % 6]), TType::eString),
                         Value("Message", TCIMValue("service state changed, unit " + std::to_string(number % 1000) +
                                                    " entered state running"),
                               TType::eString)});
    }
    ns->Link();
    return ns;
}

TReportParameters LogPage(bool filteredAndSorted) {
    TReportClass table;
    table.SetClass("ORVSG_LinuxEventLogRecord");
    table.SetTitle("System Log");
    table.SetProperties({TReportProperty("RecordNumber", "8%", "", "", "", ""),
                         TReportProperty("TimeWritten", "17%", "", "", "", ""),
                         TReportProperty("Severity", "10%", "", "", "", ""),
                         TReportProperty("Source", "10%", "", "", "", ""),
                         TReportProperty("Message", "55%", "", "", "", "")});
    if (filteredAndSorted) {
        table.GetPropertyFilters().push_back(TReportClass::TPropertyFilter("Debug", "Severity", true));
        table.GetInstanceSorter().AddProperty("RecordNumber", false, true);
    }
    TReportParameters page;
    page.SetLinkName("syslog");
    page.SetReportName("System Log");
    page.SetShowReportTitle(true);
    page.SetClasses({table});
    return page;
}

void WritePage(const char* name, TWriter::TNamespacePtr ns, bool filteredAndSorted) {
    bench::TNullWriter writer;
    writer.BaseInitialize(ns, {}, boost::shared_ptr<braigrion::TReportParametersBuilder>(
                                      new braigrion::TReportParametersBuilder(ns, "default", false)));
    writer.Initialize(ns, {}, "out");
    auto start = std::chrono::steady_clock::now();
    writer.WriteGenericReport(LogPage(filteredAndSorted));
    double seconds = SecondsSince(start);
    std::printf("page %s: %.3f s, %zu cells\n", name, seconds, writer.fCells);
    std::printf("peak rss after page %s: %ld KiB\n", name, PeakKiB());
}

}  // namespace

int main(int argc, char** argv) {
    std::vector<std::string> args(argv + 1, argv + argc);
    std::string save;
    std::string load;
    if (args.size() >= 2 && args[0] == "--save") save = args[1];
    if (args.size() >= 2 && args[0] == "--load") load = args[1];
    if (!save.empty() || !load.empty()) args.erase(args.begin(), args.begin() + 2);
    unsigned int count = args.empty() ? 1000000u : static_cast<unsigned int>(std::strtoul(args[0].c_str(), nullptr, 10));

    boost::shared_ptr<braigrion::repository::TMemoryNamespace> ns;
    auto start = std::chrono::steady_clock::now();
    try {
        if (load.empty()) {
            ns = BuildCollection(count);
            std::printf("load (in-memory build): %.3f s\n", SecondsSince(start));
        } else {
            ns = braigrion::repository::LoadCollection({load}).fNamespace;
            std::printf("load (CIM-XML %s): %.3f s\n", load.c_str(), SecondsSince(start));
        }
        std::printf("instances: %zu\n", ns->GetInstanceCount());
        std::printf("peak rss after load: %ld KiB\n", PeakKiB());
        if (!save.empty()) {
            braigrion::repository::WriteCollectionFile(*ns, save);
            std::printf("saved: %s\n", save.c_str());
            std::fflush(stdout);
            std::_Exit(0);
        }
    } catch (const std::exception& ex) {
        std::fprintf(stderr, "bench_page: %s\n", ex.what());
        return 1;
    }

    WritePage("plain", ns, false);
    WritePage("filtered+sorted", ns, true);
    // Tearing down millions of small objects measures nothing; leave.
    std::fflush(stdout);
    std::_Exit(0);
}
