// bench_load: loads CIM-XML files into one collection, builds its
// association links, and reports how fast and how big that was.
//
//   bench_load FILE.xml [MORE.xml ...]
//
// One load per process, so that the peak resident size the kernel reports
// belongs to this load alone. Figures go to standard output one per line as
// "name: value" so that scripts can pick them up.

#include <sys/resource.h>
#include <sys/stat.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

#include "repository/CIMXMLReader.h"
#include "repository/MemoryClass.h"
#include "repository/MemoryRepository.h"
#include "repository/RepositoryIndexes.h"

namespace {

double Seconds(const timeval& t) { return static_cast<double>(t.tv_sec) + static_cast<double>(t.tv_usec) / 1e6; }

struct TUsage {
    double fCpuSeconds;
    long fPeakKiB;  // ru_maxrss is in KiB on Linux
};

TUsage Usage() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return {Seconds(usage.ru_utime) + Seconds(usage.ru_stime), usage.ru_maxrss};
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 2) {
        std::fprintf(stderr, "usage: bench_load FILE.xml [MORE.xml ...]\n");
        return 2;
    }
    std::vector<std::string> files(argv + 1, argv + argc);
    unsigned long long bytes = 0;
    for (const std::string& file : files) {
        struct stat info {};
        if (stat(file.c_str(), &info) != 0) {
            std::perror(file.c_str());
            return 1;
        }
        bytes += static_cast<unsigned long long>(info.st_size);
    }

    const TUsage before = Usage();
    const auto start = std::chrono::steady_clock::now();
    braigrion::repository::TLoadResult result;
    try {
        result = braigrion::repository::LoadCollection(files);
    } catch (const std::exception& ex) {
        std::fprintf(stderr, "bench_load: %s\n", ex.what());
        return 1;
    }
    const double parse = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    // The association links and the object-path indexes they need belong to
    // the load: the first association query of a report would build them.
    result.fNamespace->Indexes().BuildLinksNow();
    const double wall = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    const TUsage after = Usage();

    const auto& ns = *result.fNamespace;
    size_t classes = 0;
    for (const auto* cls : ns.GetClasses()) {
        if (cls->GetInstanceCount() > 0) ++classes;
    }
    const double megabytes = static_cast<double>(bytes) / 1e6;
    const double peakBytes = static_cast<double>(after.fPeakKiB) * 1024.0;

    std::printf("files: %zu\n", files.size());
    std::printf("file size: %llu bytes (%.1f MB)\n", bytes, megabytes);
    std::printf("wall time: %.3f s\n", wall);
    std::printf("of which association links: %.3f s\n", wall - parse);
    std::printf("cpu time: %.3f s\n", after.fCpuSeconds - before.fCpuSeconds);
    std::printf("throughput: %.1f MB/s\n", wall > 0 ? megabytes / wall : 0.0);
    std::printf("instances: %zu\n", ns.GetInstanceCount());
    std::printf("classes with instances: %zu of %zu\n", classes, ns.GetClasses().size());
    std::printf("warnings: %zu\n", result.fWarnings.size());
    std::printf("peak rss: %ld KiB (%.1f MB)\n", after.fPeakKiB, peakBytes / 1e6);
    std::printf("peak rss / file size: %.2f\n", bytes > 0 ? peakBytes / static_cast<double>(bytes) : 0.0);
    // Tearing down millions of small objects takes seconds and measures
    // nothing; the figures are out, so leave without it.
    std::fflush(stdout);
    std::_Exit(0);
}
