// bench_logs: the cost of the log pages of a report over a collection of
// many log records, against the cost of loading those records.
//
//   bench_logs [RECORDS]             build the collection in memory
//   bench_logs --save FILE [RECORDS] build it and save it as CIM-XML
//   bench_logs --load FILE           load a saved collection
//
// The collection holds RECORDS (1000000 unless told otherwise) log records
// of a machine whose type the lookup file lists, so that documentation links
// are built: 40% lines of 200 Linux log files (two of them without time
// stamps), 20% chassis event log entries (event ids, some UEFI codes, some
// hidden), 10% each IPMI records, the tool's own error log, DLM records and
// diagnostic completion records. Building or loading it is timed as "load".
// Then the log pages are written through the report's generators into a
// back-end that renders every cell's text and discards it: the operating
// system logs (one page per file), the service processor's logs (DLM, ZEPH,
// chassis event log), the IPMI page of a KMC machine, the diagnostics log,
// the merged log and the error log. Figures go to standard output one per
// line as "name: value".

#include <sys/resource.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "BenchClock.h"
#include "NullWriter.h"
#include "braigrion/ReportDefinition.h"
#include "braigrion/TWriter.h"
#include "repository/CIMXMLReader.h"
#include "repository/CIMXMLWriter.h"
#include "repository/MemoryRepository.h"

namespace {

using bench::CpuSeconds;
using bench::PeakKiB;
using bench::SecondsSince;

using braigrion::TReportParameters;
using braigrion::TReportParametersBuilder;
using braigrion::TReportProperty;
using braigrion::TTable;
using braigrion::TWriter;
using NORVTKR20::TCIMDateTime;
using NORVTKR20::TCIMValue;
typedef NORVTKR20::TCIMValue::TCIMType TType;
namespace repo = braigrion::repository;

// A back-end that renders what a real one would (each value cell's text,
// each grid) and keeps only counts.
class TRenderingWriter : public bench::TNullWriter {
public:
    size_t fBytes = 0;
    size_t fPages = 0;

    void Initialize(TNamespacePtr, TContext context, const std::string& outputPath) override {
        fOutputPath = outputPath;
        fMode = context.count("mode") ? static_cast<std::string>(context["mode"]) : std::string("default");
        fWriterType = TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_HTML;
    }
    void WriteEventLogReport(TReportParameters params) override { WriteGenericReport(params); }
    void WriteMergedLogPage(TReportParameters params) override { WriteGenericReport(params); }
    void OpenPage(const std::string&) override { ++fPages; }
    void WriteTableGrid(TTable& table) override {
        fCells += table.fCells.size();
        for (const TTable::TCell& cell : table.fCells) fBytes += cell.text.size();
    }
    void WriteValueCell(TInstancePtr instance, TReportProperty property, std::string) override {
        ++fCells;
        fBytes += GetPropertyValue(instance, property.GetProperty(), ", ").size();
    }
    void WriteTextCell(TReportProperty, std::string text, std::string link) override {
        ++fCells;
        fBytes += text.size() + link.size();
    }
};

repo::TPropertyDeclData Declared(const std::string& name, TType::ECIMType type, bool key = false) {
    repo::TPropertyDeclData declaration;
    declaration.fName = name;
    declaration.fType = type;
    if (key) {
        repo::TQualifierData qualifier;
        qualifier.fName = "Key";
        qualifier.fValue = TCIMValue::Boolean(true);
        declaration.fQualifiers.push_back(qualifier);
    }
    return declaration;
}

repo::TPropertyValue Value(const std::string& name, const TCIMValue& value, TType::ECIMType type) {
    repo::TPropertyValue property;
    property.fName = name;
    property.fValue = value;
    property.fType = type;
    return property;
}

void Declare(repo::TMemoryNamespace& ns, const std::string& name, const std::string& superclass,
             std::vector<repo::TPropertyDeclData> properties) {
    repo::TClassData cls;
    cls.fName = name;
    cls.fSuperClass = superclass;
    cls.fProperties = properties;
    ns.DeclareClass(cls);
}

TCIMDateTime TimeOf(unsigned int n) {
    return TCIMDateTime(2025, static_cast<unsigned short>(1 + n % 12), 1 + n % 28, static_cast<unsigned short>(n % 24),
                        static_cast<unsigned short>(n % 60), static_cast<unsigned short>((n / 60) % 60), 0, 0);
}

boost::shared_ptr<repo::TMemoryNamespace> BuildCollection(unsigned int count) {
    boost::shared_ptr<repo::TMemoryNamespace> ns = repo::TMemoryNamespace::Create();
    Declare(*ns, "ORVSG_ComputerSystem", "", {Declared("Name", TType::eString, true), Declared("ProductName", TType::eString)});
    Declare(*ns, "ORVSG_OperatingSystem", "",
            {Declared("Name", TType::eString, true), Declared("OSType", TType::eUint16),
             Declared("ProductVendor", TType::eString)});
    Declare(*ns, "ORVSG_LogRecord", "",
            {Declared("LogName", TType::eString, true), Declared("RecordID", TType::eString, true),
             Declared("MessageTimestamp", TType::eDateTime), Declared("Source", TType::eString),
             Declared("Message", TType::eString)});
    Declare(*ns, "ORVSG_LinuxEventLogRecord", "ORVSG_LogRecord", {});
    Declare(*ns, "ORVSG_TKRLogRecord", "ORVSG_LogRecord", {Declared("Type", TType::eUint16)});
    Declare(*ns, "ORVSG_DLMLog", "ORVSG_LogRecord", {Declared("Type", TType::eString), Declared("LoggingSource", TType::eString)});
    Declare(*ns, "ORVSG_IPMILogRecord", "ORVSG_LogRecord", {Declared("AuxLog", TType::eString)});
    Declare(*ns, "ORV_StandardMessageLogEntry", "",
            {Declared("RecordID", TType::eString, true), Declared("LogName", TType::eString),
             Declared("CreationTimeStamp", TType::eDateTime), Declared("EventID", TType::eString),
             Declared("MessageID", TType::eString), Declared("Message", TType::eString),
             Declared("PerceivedSeverity", TType::eUint16), Declared("AuxiliaryData", TType::eString),
             Declared("Hidden", TType::eString)});
    Declare(*ns, "CIM_DiagnosticCompletionRecord", "",
            {Declared("InstanceID", TType::eString, true), Declared("ServiceName", TType::eString),
             Declared("ManagedElementName", TType::eString), Declared("RecordData", TType::eString),
             Declared("CreationTimeStamp", TType::eDateTime)});

    ns->AddInstance("ORVSG_ComputerSystem", {Value("Name", TCIMValue("bench"), TType::eString),
                                             Value("ProductName", TCIMValue("Norvane Stratus NS4620 M6 -[4712AC1]"),
                                                   TType::eString)});
    ns->AddInstance("ORVSG_OperatingSystem", {Value("Name", TCIMValue("SUSE Linux Enterprise Server 15 SP5"), TType::eString),
                                              Value("OSType", TCIMValue(static_cast<unsigned short>(36)), TType::eUint16),
                                              Value("ProductVendor", TCIMValue("SUSE LLC"), TType::eString)});
    for (unsigned int i = 0; i < count; ++i) {
        const unsigned int n = (i * 7919u) % count;  // records arrive out of order
        const std::string id = std::to_string(n);
        const unsigned int kind = i % 10;
        if (kind < 4) {
            const unsigned int file = (i / 10) % 200;
            std::string log = "/var/log/app" + std::to_string(file) + ".log";
            if (file == 0) log = "/var/log/boot.msg";
            if (file == 1) log = "/var/log/dmesg";
            std::vector<repo::TPropertyValue> values = {
                Value("LogName", TCIMValue(log), TType::eString), Value("RecordID", TCIMValue(id), TType::eString),
                Value("Message", TCIMValue("unit " + std::to_string(n % 1000) + " entered state running"),
                      TType::eString)};
            if (file > 1) {
                values.push_back(Value("MessageTimestamp", TCIMValue(TimeOf(n)), TType::eDateTime));
                values.push_back(Value("Source", TCIMValue("systemd"), TType::eString));
            }
            ns->AddInstance("ORVSG_LinuxEventLogRecord", values);
        } else if (kind < 6) {
            std::vector<repo::TPropertyValue> values = {
                Value("RecordID", TCIMValue(id), TType::eString),
                Value("LogName", TCIMValue("CEL"), TType::eString),
                Value("CreationTimeStamp", TCIMValue(TimeOf(n)), TType::eDateTime),
                Value("EventID", TCIMValue("0X 8000-" + std::to_string(1000 + n % 9000)), TType::eString),
                Value("MessageID", TCIMValue("NVSP" + std::to_string(n % 100)), TType::eString),
                Value("Message", TCIMValue("Power supply " + std::to_string(n % 4) + " changed state."),
                      TType::eString),
                Value("PerceivedSeverity", TCIMValue(static_cast<unsigned short>(2 + n % 3)), TType::eUint16)};
            if (n % 7 == 0) {
                values.push_back(Value("AuxiliaryData", TCIMValue("[UEFI:DXE:" + std::to_string(n % 500) + "] note"),
                                       TType::eString));
            }
            if (n % 50 == 0) values.push_back(Value("Hidden", TCIMValue("true"), TType::eString));
            ns->AddInstance("ORV_StandardMessageLogEntry", values);
        } else {
            static const char* const kClasses[] = {"ORVSG_IPMILogRecord", "ORVSG_TKRLogRecord", "ORVSG_DLMLog",
                                                   "CIM_DiagnosticCompletionRecord"};
            const std::string cls = kClasses[kind - 6];
            if (cls == "CIM_DiagnosticCompletionRecord") {
                ns->AddInstance(cls, {Value("InstanceID", TCIMValue(id), TType::eString),
                                      Value("ServiceName", TCIMValue("Quick Memory Test"), TType::eString),
                                      Value("ManagedElementName", TCIMValue("DIMM " + std::to_string(n % 24)),
                                            TType::eString),
                                      Value("RecordData", TCIMValue("DGN-0C71-" + std::to_string(n % 90 + 10) +
                                                                    " Passed"),
                                            TType::eString),
                                      Value("CreationTimeStamp", TCIMValue(TimeOf(n)), TType::eDateTime)});
            } else {
                ns->AddInstance(cls, {Value("LogName", TCIMValue(cls), TType::eString),
                                      Value("RecordID", TCIMValue(id), TType::eString),
                                      Value("MessageTimestamp", TCIMValue(TimeOf(n)), TType::eDateTime),
                                      Value("Source", TCIMValue("bmc"), TType::eString),
                                      Value("Message", TCIMValue("event " + std::to_string(n % 1000)),
                                            TType::eString)});
            }
        }
    }
    ns->Link();
    return ns;
}

// Writes one page id through a fresh writer, as a report run would.
void WritePage(const char* name, TWriter::TNamespacePtr ns, const std::string& pageID, bool kmc,
               const std::string& dataFolder) {
    TRenderingWriter writer;
    std::map<std::string, TCIMValue> context;
    context["mode"] = TCIMValue(std::string("default"));
    boost::shared_ptr<TReportParametersBuilder> builder(new TReportParametersBuilder(ns, "default", kmc));
    writer.BaseInitialize(ns, context, builder);
    writer.Initialize(ns, context, "out");
    TWriter::TLogLinkSettings links;
    links.fDataFolder = dataFolder;
    writer.SetLogLinkSettings(links);
    auto start = std::chrono::steady_clock::now();
    const double cpu = CpuSeconds();
    writer.WriteReportPage(builder, pageID);
    std::printf("page %s: %.3f s wall, %.3f s CPU, %zu pages, %zu cells, %zu bytes\n", name, SecondsSince(start),
                CpuSeconds() - cpu, writer.fPages, writer.fCells, writer.fBytes);
    std::fflush(stdout);
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

    boost::shared_ptr<repo::TMemoryNamespace> ns;
    auto start = std::chrono::steady_clock::now();
    const double loadCpu = CpuSeconds();
    try {
        if (load.empty()) {
            ns = BuildCollection(count);
            std::printf("load (in-memory build): %.3f s wall, %.3f s CPU\n", SecondsSince(start), CpuSeconds() - loadCpu);
        } else {
            ns = repo::LoadCollection({load}).fNamespace;
            std::printf("load (CIM-XML %s): %.3f s wall, %.3f s CPU\n", load.c_str(), SecondsSince(start),
                        CpuSeconds() - loadCpu);
        }
        std::printf("instances: %zu\n", ns->GetInstanceCount());
        std::printf("peak rss after load: %ld KiB\n", PeakKiB());
        if (!save.empty()) {
            repo::WriteCollectionFile(*ns, save);
            std::printf("saved: %s\n", save.c_str());
            std::fflush(stdout);
            std::_Exit(0);
        }
    } catch (const std::exception& ex) {
        std::fprintf(stderr, "bench_logs: %s\n", ex.what());
        return 1;
    }

    // The lookup file that turns the documentation links on.
    const std::string data = "/tmp/bench_logs_data." + std::to_string(getpid());
    std::filesystem::create_directories(data);
    std::ofstream(data + "/kmcEventsAtInfoC.txt") << "4712\n";
    std::ofstream(data + "/tkrEventsAtInfoC.txt") << "4712\n";

    auto all = std::chrono::steady_clock::now();
    const double allCpu = CpuSeconds();
    WritePage("OS logs", ns, TKR_REPORT_DEFINITION::PAGE_OS_LOGS, false, data);
    WritePage("SP logs", ns, TKR_REPORT_DEFINITION::PAGE_SP_LOGS, false, data);
    WritePage("KMC logs", ns, TKR_REPORT_DEFINITION::PAGE_KMC_LOGS, true, data);
    WritePage("diagnostics", ns, TKR_REPORT_DEFINITION::PAGE_DIAGNOSTIC, false, data);
    WritePage("merged log", ns, TKR_REPORT_DEFINITION::PAGE_MERGED_LOG, false, data);
    WritePage("error log", ns, TKR_REPORT_DEFINITION::PAGE_TKR_ERROR_LOGS, false, data);
    std::printf("log pages in all: %.3f s wall, %.3f s CPU\n", SecondsSince(all), CpuSeconds() - allCpu);
    std::printf("peak rss after pages: %ld KiB\n", PeakKiB());
    std::filesystem::remove_all(data);
    // Tearing down millions of small objects measures nothing; leave.
    std::fflush(stdout);
    std::_Exit(0);
}
