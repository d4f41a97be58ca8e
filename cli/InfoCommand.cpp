#include <CLI/CLI.hpp>

#include <algorithm>
#include <iomanip>
#include <ostream>

#include "CollectionLoader.h"
#include "Commands.h"
#include "TReport_vmwesxi.h"
#include "braigrion/TReportParametersBuilder.h"
#include "repository/MemoryClass.h"
#include "tkrcore/tkrcore.h"

namespace braigrion {
namespace cli {

namespace {

void Fact(std::ostream& out, const char* label, const std::string& value) {
    out << "  " << std::left << std::setw(22) << label << (value.empty() ? "(not recorded)" : value) << '\n';
}

const char* OSTypeName(int type) {
    switch (type) {
        case TReportParametersBuilder::kOSWindows:
        case TReportParametersBuilder::kOSWindowsServer: return "Windows";
        case TReportParametersBuilder::kOSLinux: return "Linux";
        case TReportParametersBuilder::kOSVMwareESX: return "VMware ESX";
        default: return "";
    }
}

}  // namespace

CLI::App* AddInfoCommand(CLI::App& app, TInfoOptions& options) {
    CLI::App* command =
        app.add_subcommand("info", "Print what a collection holds: data source facts, OS type, classes, counts");
    command->add_option("collection", options.fFiles, "CIM-XML files that together form one collection")
        ->required()
        ->type_name("FILE");
    return command;
}

int RunInfo(const TInfoOptions& options, std::ostream& out, std::ostream& err) {
    repository::TLoadResult loaded = LoadFiles(options.fFiles);
    for (const std::string& w : loaded.fWarnings) err << "braigrion: warning: " << w << '\n';
    auto ns = loaded.fNamespace;
    NORVTKR20::TCIMContext context;

    out << "Collection: ";
    for (size_t i = 0; i < options.fFiles.size(); ++i) out << (i ? ", " : "") << options.fFiles[i];
    out << "\n\nData source\n";
    Fact(out, "Build", NORVTKR20::TCIMSchemaHelper::GetDataSourceBuild(ns, context));
    std::string major = NORVTKR20::TCIMSchemaHelper::GetDataSourceMajorVersion(ns, context);
    std::string minor = NORVTKR20::TCIMSchemaHelper::GetDataSourceMinorVersion(ns, context);
    Fact(out, "Version", major.empty() && minor.empty() ? std::string() : major + "." + minor);
    Fact(out, "Serial number", NORVTKR20::TCIMSchemaHelper::GetRawSerialNumberString(ns, context));
    Fact(out, "OS version", NORVTKR20::TCIMSchemaHelper::GetOperatingSystemVersion(ns));
    Fact(out, "OS type", OSTypeName(TReportParametersBuilder(ns, "default", false).GetOSType()));
    Fact(out, "Report", TReport_vmwesxi::IsESXiCollection(ns) ? "ESXi host (its own page list)" : "base");

    std::vector<repository::TMemoryClass*> classes = ns->GetClasses();
    std::sort(classes.begin(), classes.end(), [](repository::TMemoryClass* a, repository::TMemoryClass* b) {
        return a->GetName() < b->GetName();
    });
    size_t width = 5;
    size_t empty = 0;
    for (auto* c : classes) {
        if (c->GetInstanceCount()) width = std::max(width, c->GetName().size());
        else ++empty;
    }
    out << "\nClasses with instances (" << classes.size() - empty << " of " << classes.size() << " classes)\n";
    for (auto* c : classes) {
        if (!c->GetInstanceCount()) continue;
        out << "  " << std::left << std::setw(static_cast<int>(width)) << c->GetName() << "  " << std::right
            << std::setw(9) << c->GetInstanceCount() << '\n';
    }
    out << "\nInstances: " << ns->GetInstanceCount() << '\n';
    return 0;
}

}  // namespace cli
}  // namespace braigrion
