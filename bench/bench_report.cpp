// bench_report: the whole HTML report of a collection, timed against its load.
//
//   bench_report FILE.xml [MORE.xml ...] [--keep DIR]
//
// One run per process: the load (CIM-XML into the repository, then the
// association links and object-path indexes built, as the first association
// query would), then the report written through the HTML back-end into a
// fresh directory, as `braigrion report` does. Figures go to standard output
// one per line as "name: value". The report directory is removed at the end
// unless --keep names where to put it.

#include <sys/resource.h>
#include <sys/stat.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <vector>

#include "BenchClock.h"
#include "THtmlWriter.h"
#include "braigrion/TReport.h"
#include "repository/CIMXMLReader.h"
#include "repository/MemoryRepository.h"
#include "repository/RepositoryIndexes.h"
#include "tkrcore/TRootObject.h"

namespace {

using bench::CpuSeconds;
using bench::PeakKiB;
using bench::SecondsSince;

namespace fs = std::filesystem;
typedef std::chrono::steady_clock TClock;

}  // namespace

int main(int argc, char** argv) {
    std::vector<std::string> files;
    std::string keep;
    for (int i = 1; i < argc; ++i) {
        std::string arg = argv[i];
        if (arg == "--keep" && i + 1 < argc) keep = argv[++i];
        else files.push_back(arg);
    }
    if (files.empty()) {
        std::fprintf(stderr, "usage: bench_report FILE.xml [MORE.xml ...] [--keep DIR]\n");
        return 2;
    }
    unsigned long long bytes = 0;
    for (const std::string& file : files) {
        struct stat info {};
        if (stat(file.c_str(), &info) != 0) {
            std::perror(file.c_str());
            return 1;
        }
        bytes += static_cast<unsigned long long>(info.st_size);
    }
    NORVTKR20::TRootObject::GetDefaultLogger().SetLogToStderr();
    NORVTKR20::TRootObject::GetDefaultLogger().SetLevel(0);

    const double cpuStart = CpuSeconds();
    const auto loadStart = TClock::now();
    braigrion::repository::TLoadResult loaded;
    try {
        loaded = braigrion::repository::LoadCollection(files);
    } catch (const std::exception& ex) {
        std::fprintf(stderr, "bench_report: %s\n", ex.what());
        return 1;
    }
    const double parse = SecondsSince(loadStart);
    const auto linkStart = TClock::now();
    loaded.fNamespace->Indexes().BuildLinksNow();
    const double links = SecondsSince(linkStart);
    const double load = SecondsSince(loadStart);
    const double loadCpu = CpuSeconds() - cpuStart;
    const long loadPeak = PeakKiB();

    fs::path out = keep.empty() ? fs::temp_directory_path() / ("bench_report-" + std::to_string(getpid())) : fs::path(keep);
    std::error_code ec;
    fs::remove_all(out, ec);
    fs::create_directories(out);
    const auto reportStart = TClock::now();
    {
        braigrion::backends::THtmlWriter writer;
        braigrion::TReport::TContext context;
        context["mode"] = NORVTKR20::TCIMValue(std::string("default"));
        context["KMC"] = NORVTKR20::TCIMValue(std::string("FALSE"));
        braigrion::TReport report(loaded.fNamespace, context, out.string());
        report.Write(&writer, context);
        if (!writer.GetFailure().empty()) std::fprintf(stderr, "bench_report: %s\n", writer.GetFailure().c_str());
    }
    const double report = SecondsSince(reportStart);
    const double reportCpu = CpuSeconds() - cpuStart - loadCpu;
    const long peak = PeakKiB();
    unsigned long long written = 0;
    size_t pages = 0;
    for (const auto& entry : fs::recursive_directory_iterator(out, ec)) {
        if (!entry.is_regular_file()) continue;
        written += entry.file_size();
        ++pages;
    }
    if (keep.empty()) fs::remove_all(out, ec);

    std::printf("file size: %llu bytes (%.1f MB)\n", bytes, static_cast<double>(bytes) / 1e6);
    std::printf("instances: %zu\n", loaded.fNamespace->GetInstanceCount());
    std::printf("load, parse: %.3f s\n", parse);
    std::printf("load, links: %.3f s\n", links);
    std::printf("load: %.3f s\n", load);
    std::printf("report: %.3f s\n", report);
    std::printf("report / load: %.2f\n", load > 0 ? report / load : 0.0);
    std::printf("cpu: load %.3f s, report %.3f s, report / load %.2f\n", loadCpu, reportCpu,
                loadCpu > 0 ? reportCpu / loadCpu : 0.0);
    std::printf("files written: %zu (%.1f MB)\n", pages, static_cast<double>(written) / 1e6);
    std::printf("peak rss after load: %ld KiB\n", loadPeak);
    std::printf("peak rss: %ld KiB (%.1f MB)\n", peak, static_cast<double>(peak) * 1024.0 / 1e6);
    std::printf("peak rss / file size: %.2f\n", bytes > 0 ? static_cast<double>(peak) * 1024.0 / static_cast<double>(bytes) : 0.0);
    std::fflush(stdout);
    std::_Exit(0);  // tearing down millions of objects measures nothing
}
