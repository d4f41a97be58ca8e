// bench_compare: loads one CIM-XML file twice, as an earlier and a later
// collection, changes the later one a little, and times the comparison that
// makes the delta records against the time the two loads took.
//
//   bench_compare FILE.xml [--keyless]
//
// The later collection loses every 997th instance and has one property
// changed on every 101st, so that the records of each kind are made. Figures
// go to standard output one per line as "name: value". With --keyless every
// key of both collections is given one value, as a collector that leaves
// its keys out would, so that the comparison fails by keys twice and then
// names each instance by its values.

#include <sys/resource.h>

#include <chrono>
#include <cstdio>
#include <string>
#include <vector>

#include "BenchClock.h"
#include "repository/CIMXMLReader.h"
#include "repository/DeltaRecords.h"
#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"

namespace {

using bench::CpuSeconds;
using bench::PeakKiB;
using bench::SecondsSince;

using braigrion::repository::TMemoryNamespace;

// Deletes every 997th instance and rewrites a string property of every
// 101st; returns how many of each.
std::pair<size_t, size_t> Change(TMemoryNamespace& ns) {
    size_t deleted = 0, changed = 0, n = 0;
    NORVTKR20::TCIMContext none;
    for (auto* cls : ns.GetClasses()) {
        if (cls->IsAssociation()) continue;
        std::vector<std::string> keys;
        for (const std::string& key : cls->GetKeyNames()) keys.push_back(key);
        for (const auto& instance : cls->GetInstances()) {
            ++n;
            if (n % 997 == 0) {
                instance->Delete(none);
                ++deleted;
                continue;
            }
            if (n % 101 != 0) continue;
            for (const auto& slot : instance->GetSlots()) {
                const auto& decl = cls->GetProperties()[slot.fDecl];
                bool key = false;
                for (const std::string& k : keys) key = key || braigrion::repository::NamesEqual(k, decl->GetName());
                if (key || slot.fValue.IsArray() || slot.fValue.GetType() != NORVTKR20::TCIMValue::TCIMType::eString)
                    continue;
                instance->GetProperty(decl->GetName(), none)->SetValue(NORVTKR20::TCIMValue("changed"), none);
                ++changed;
                break;
            }
        }
    }
    return {deleted, changed};
}

// Gives every key of every instance one and the same value.
void Unkey(TMemoryNamespace& ns) {
    NORVTKR20::TCIMContext none;
    for (auto* cls : ns.GetClasses()) {
        if (cls->IsAssociation()) continue;
        for (const auto& instance : cls->GetInstances()) {
            for (const std::string& key : cls->GetKeyNames()) {
                if (!instance->FindSlot(key)) continue;
                instance->GetProperty(key, none)->SetValue(NORVTKR20::TCIMValue("-"), none);
            }
        }
    }
}

}  // namespace

int main(int argc, char** argv) {
    const bool keyless = argc == 3 && std::string(argv[2]) == "--keyless";
    if (argc != 2 && !keyless) {
        std::fprintf(stderr, "usage: bench_compare FILE.xml [--keyless]\n");
        return 2;
    }
    const std::vector<std::string> files{argv[1]};
    double cpu = CpuSeconds();
    auto start = std::chrono::steady_clock::now();
    auto earlier = braigrion::repository::LoadCollection(files).fNamespace;
    const double loadEarlier = SecondsSince(start);
    start = std::chrono::steady_clock::now();
    auto later = braigrion::repository::LoadCollection(files).fNamespace;
    const double loadLater = SecondsSince(start);
    const double loadCpu = CpuSeconds() - cpu;
    if (keyless) {
        Unkey(*earlier);
        Unkey(*later);
    }
    const auto changes = Change(*later);

    braigrion::repository::TDeltaSummary summary;
    cpu = CpuSeconds();
    start = std::chrono::steady_clock::now();
    auto records = braigrion::repository::ComputeDeltaRecords({earlier, later}, &summary);
    const double compare = SecondsSince(start);
    const double compareCpu = CpuSeconds() - cpu;

    std::printf("instances: %zu\n", earlier->GetInstanceCount());
    std::printf("deleted: %zu\nchanged: %zu\n", changes.first, changes.second);
    std::printf("classes: %zu\nmissing: %zu\nunique: %zu\nproperty_deltas: %zu\n", summary.fClasses,
                summary.fMissing, summary.fUnique, summary.fPropertyDeltas);
    std::printf("classes_matched_by_values: %zu\n", summary.fNamedByValues.size());
    std::printf("load_seconds: %.2f + %.2f\n", loadEarlier, loadLater);
    std::printf("compare_seconds: %.2f\n", compare);
    std::printf("compare_over_loads: %.2f\n", compare / (loadEarlier + loadLater));
    std::printf("cpu_seconds: loads %.2f, compare %.2f (%.2f of the loads)\n", loadCpu, compareCpu,
                compareCpu / loadCpu);
    std::printf("peak_rss_mib: %ld\n", PeakKiB() / 1024);
    return 0;
}
