// braigrion compare: the delta report of two or more collections of one
// machine or of several machines.
#include <CLI/CLI.hpp>

#include <algorithm>
#include <ostream>
#include <stdexcept>

#include <sys/stat.h>
#include <dirent.h>

#include <boost/make_shared.hpp>

#include "CollectionLoader.h"
#include "Commands.h"
#include "Progress.h"
#include "ReportDirectory.h"
#include "RunContext.h"
#include "repository/CIMXMLWriter.h"
#include "repository/DeltaRecords.h"
#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"
#include "repository/NamespaceView.h"

namespace braigrion {
namespace cli {

namespace {

bool IsDirectory(const std::string& path) {
    struct stat st;
    return ::stat(path.c_str(), &st) == 0 && S_ISDIR(st.st_mode);
}

}  // namespace

std::vector<std::string> CollectionFiles(const std::string& argument) {
    std::vector<std::string> files;
    if (IsDirectory(argument)) {
        DIR* dir = ::opendir(argument.c_str());
        if (!dir) throw TInputError(argument + ": cannot read the directory");
        while (dirent* entry = ::readdir(dir)) {
            const std::string name = entry->d_name;
            if (name.size() > 4 && name.compare(name.size() - 4, 4, ".xml") == 0) {
                files.push_back(argument + "/" + name);
            }
        }
        ::closedir(dir);
        std::sort(files.begin(), files.end());
        if (files.empty()) throw TInputError(argument + ": no .xml file in the directory");
        return files;
    }
    std::string::size_type start = 0;
    while (start <= argument.size()) {
        std::string::size_type end = argument.find(':', start);
        if (end == std::string::npos) end = argument.size();
        if (end == start) throw TInputError("'" + argument + "': an empty file name in a collection");
        files.push_back(argument.substr(start, end - start));
        start = end + 1;
    }
    return files;
}

CLI::App* AddCompareCommand(CLI::App& app, TCompareOptions& options) {
    CLI::App* command =
        app.add_subcommand("compare", "Write the delta report of two or more collections into a directory");
    command->add_option("collections", options.fCollections,
                        "One argument per collection: a directory (its .xml files) or FILE[:FILE...]")
        ->required()
        ->type_name("COLLECTION");
    command->add_option("-o,--output", options.fOutput, "Directory of the report (replaced when it holds one)")
        ->required()
        ->type_name("DIR");
    command->add_option("--format", options.fFormat, "Output format")
        ->check(CLI::IsMember({"html", "text"}))
        ->capture_default_str();
    command->add_option("--records", options.fRecords,
                        "Read the delta records from FILE instead of computing them")
        ->type_name("FILE");
    command->add_option("--save-records", options.fSaveRecords, "Also save the computed delta records as CIM-XML")
        ->type_name("FILE");
    command->add_flag("--force", options.fForce, "Write into DIR even when it is not an earlier report, among its files; nothing the report did not write is replaced");
    command->add_flag("-q,--quiet", options.fQuiet, "No progress on standard error");
    AddRunOptions(*command, options.fRun);
    command->footer(
        "The first collection is the baseline. Instances match by the keys of their object paths, leaving out\n"
        "keys that name the host. The report is written beside DIR and moved into place when complete; the\n"
        "path of the report's index is printed on standard output.");
    return command;
}

namespace {

// Delta records read from a file must fit the collections they are used
// with: a record that names a collection beyond the last, or of a type the
// report does not know, means the file was made for other collections.
void CheckRecords(repository::TMemoryNamespace& records, const std::string& file, size_t collections) {
    if (!records.FindClass("ORVSG_DeltaClass")) {
        throw TInputError(file + ": holds no delta records (no ORVSG_DeltaClass)");
    }
    repository::TMemoryClass* deltas = records.FindClass("ORVSG_Delta");
    if (!deltas) return;
    for (const auto& record : deltas->GetInstances()) {
        const repository::TMemoryInstance::TSlot* id = record->FindSlot("InstanceID");
        const std::string name = "record \"" + (id && !id->fValue.IsNull() ? id->fValue.ToString(10) : "") + "\"";
        const repository::TMemoryInstance::TSlot* type = record->FindSlot("Type");
        const std::string typeText = type && !type->fValue.IsNull() ? type->fValue.ToString(10) : "";
        if (typeText != "1" && typeText != "2" && typeText != "4") {
            throw TInputError(file + ": " + name + " has Type \"" + typeText + "\"; known types are 1, 2 and 4");
        }
        const repository::TMemoryInstance::TSlot* indices = record->FindSlot("NamespaceIndices");
        if (!indices || indices->fValue.IsNull() || !indices->fValue.IsArray()) continue;
        const auto& elements = static_cast<const std::vector<NORVTKR20::TCIMValue>&>(indices->fValue);
        for (const NORVTKR20::TCIMValue& index : elements) {
            const std::string text = index.IsNull() ? "" : index.ToString(10);
            if (text.empty() || text.find_first_not_of("0123456789") != std::string::npos ||
                text.size() > 5 || std::stoul(text) >= collections) {
                throw TInputError(file + ": " + name + " names collection \"" + text + "\", but " +
                                  std::to_string(collections) + " collections were given (numbered from 0)");
            }
        }
    }
}

}  // namespace

int RunCompare(const TCompareOptions& options, std::ostream& out, std::ostream& err, bool progressToErr) {
    // Everything the user gave is checked before anything is written.
    SetUpLog(options.fRun);
    if (options.fCollections.size() < 2) throw TInputError("a delta report needs at least two collections");
    if (!options.fRecords.empty() && !options.fSaveRecords.empty()) {
        throw TInputError("--records and --save-records exclude each other");
    }
    TProgressLine progress(err, progressToErr && !options.fQuiet);
    std::vector<boost::shared_ptr<repository::TMemoryNamespace>> collections;
    for (const std::string& argument : options.fCollections) {
        progress.Step("loading collection " + std::to_string(collections.size() + 1) + " of " +
                      std::to_string(options.fCollections.size()) + ": " + argument);
        repository::TLoadResult loaded = LoadFiles(CollectionFiles(argument));
        progress.Finish();
        for (const std::string& warning : loaded.fWarnings) err << "braigrion: warning: " << warning << '\n';
        loaded.fNamespace->SetName(argument);
        collections.push_back(loaded.fNamespace);
    }
    boost::shared_ptr<repository::TMemoryNamespace> records;
    if (!options.fRecords.empty()) {
        progress.Step("loading the delta records: " + options.fRecords);
        records = LoadFiles({options.fRecords}).fNamespace;
        progress.Finish();
        CheckRecords(*records, options.fRecords, collections.size());
    }
    TReportDirectory directory(options.fOutput, options.fForce);

    if (!records) {
        repository::TDeltaSummary summary;
        progress.Step("comparing " + std::to_string(collections.size()) + " collections");
        records = repository::ComputeDeltaRecords(collections, &summary);
        progress.Finish();
        for (const std::string& className : summary.fNamedByValues) {
            err << "braigrion: warning: " << className
                << ": the keys do not tell its instances apart; they were matched by their values\n";
        }
        if (!options.fSaveRecords.empty()) repository::WriteCollectionFile(*records, options.fSaveRecords);
    }
    auto view = boost::make_shared<repository::TNamespaceView>(collections, records);

    TContextMap context = MakeContext(options.fRun);
    for (const auto& key : view->MakeContext()) context[key.first] = key.second;
    WriteReport(view, context, options.fRun, options.fFormat, progressToErr && !options.fQuiet, directory, out, err);
    return 0;
}

}  // namespace cli
}  // namespace braigrion
