// The raw-data page of the LSI section and the presence tests its callers
// ask first. Three collectors may have left raw data: the utility tool's
// (ORV_LSIRawData, its result perhaps Base64-encoded), the MegaRAID
// command-line tool's (ORVSG_MegaLSIRawData) and the IR tool's
// (ORVSG_lsiRawData). Each gives one table of the one page; a table that
// fails is left out and the page goes on.
#include <cstdlib>
#include <functional>

#include "RawDataSupport.h"
#include "braigrion/TWriter.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace rawdata;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;
using NORVTKR20::TOSSpecific;

namespace {

const char kName[] = "TWriter::WriteLSIRawDataReport";
const char kUtilityClass[] = "ORV_LSIRawData";
const char kMegaClass[] = "ORVSG_MegaLSIRawData";
const char kIRClass[] = "ORVSG_lsiRawData";
const char kLink[] = "lsi_rawData";
const char kTitle[] = "LSI Raw Data Information";

// The text of a property for the ordering of the utility tool's commands;
// a property that cannot be read counts as empty.
std::string KeyText(const TWriter::TInstancePtr& instance, const std::string& property) {
    try {
        return ValueOf(instance, property).ToString(10);
    } catch (...) {
        return std::string();
    }
}

// Orders the utility tool's commands by controller, then by utility, as
// text: "10" comes before "2". Neighbours are swapped only when the left
// one is greater, so equal keys keep their order.
void SortByController(TInstances& instances) {
    std::vector<std::string> keys;
    for (const TWriter::TInstancePtr& instance : instances) {
        keys.push_back(KeyText(instance, "ControllerNumber") + KeyText(instance, "Utility"));
    }
    for (size_t end = instances.size(); end > 1; --end) {
        bool swapped = false;
        for (size_t i = 0; i + 1 < end; ++i) {
            if (keys[i].compare(keys[i + 1]) > 0) {
                std::swap(keys[i], keys[i + 1]);
                std::swap(instances[i], instances[i + 1]);
                swapped = true;
            }
        }
        if (!swapped) break;
    }
}

// Whether the declaration of the property carries "Base64Encode" set to
// true. A property without declaration or qualifier is plain text.
bool IsBase64Encoded(const TWriter::TInstancePtr& instance, const std::string& property) {
    TCIMContext context;
    try {
        TWriter::TPropertyDeclPtr declaration = instance->GetProperty(property, context)->GetDeclaration(context);
        if (!declaration) return false;
        bool propagated = false;
        boost::shared_ptr<const NORVTKR20::ICIMQualifier> qualifier =
            declaration->GetQualifier("Base64Encode", propagated, context);
        return qualifier && static_cast<bool>(qualifier->GetValue(context));
    } catch (...) {
        return false;
    }
}

// The utility tool's result as it is to be written: decoded when encoded,
// and then ending at its first zero byte.
std::string UtilityResult(const TWriter::TInstancePtr& instance) {
    std::string text = static_cast<std::string>(ValueOf(instance, "CommandResult"));
    if (!IsBase64Encoded(instance, "CommandResult")) return text;
    char* decoded = nullptr;
    int length = 0;
    if (!base64_decode(text.data(), static_cast<int>(text.size()), &decoded, length)) return std::string();
    std::string result(decoded);
    std::free(decoded);
    return result;
}

// The instances of a class for a presence test or the page; a class that
// cannot be read is logged with `failure` and gives none.
TInstances GuardedInstances(const TWriter::TNamespacePtr& ns, const std::string& className,
                            const std::string& failure) {
    try {
        return InstancesOf(ns, className);
    } catch (...) {
        Trace(failure + className);
        return TInstances();
    }
}

}  // namespace

bool TWriter::isLSIRawDataPresent() {
    const std::string failure = "TWriter::isLSIRawDataPresent -- Exception when getting class ";
    bool present = false;
    for (const char* className : {kUtilityClass, kIRClass, kMegaClass}) {
        if (!GuardedInstances(fNamespace, className, failure).empty()) present = true;
    }
    return present;
}

bool TWriter::isMRRawDataPresent() {
    return !GuardedInstances(fNamespace, kMegaClass, "TWriter::isMRRawDataPresent -- Exception when getting class ")
                .empty();
}

bool TWriter::isMRVendorProviderPresent() {
    return !GuardedInstances(fNamespace, "LSIESG_MegaRAIDHBA",
                             "TWriter::isMRVendorProviderPresent -- Exception when getting class ")
                .empty();
}

std::string TWriter::WriteLSIRawDataReport(std::string& linkName) {
    Trace(std::string(kName) + " -- Entering");
    const std::string failure = std::string(kName) + " -- Exception when getting class ";
    TInstances utility = GuardedInstances(fNamespace, kUtilityClass, failure);
    TInstances mega = GuardedInstances(fNamespace, kMegaClass, failure);
    TInstances ir = GuardedInstances(fNamespace, kIRClass, failure);
    if (utility.empty() && mega.empty() && ir.empty()) {
        Trace(std::string(kName) + " -- No LSI raw data instance");
        return std::string();
    }
    SortByController(utility);

    OpenRawPage(*this, fOutputPath, kLink, kTitle, linkName);
    WriteTableBreak();

    // One table; a failure leaves it out, logged with the table's name.
    auto writeTable = [&](const TInstances& instances, const std::string& table, const std::function<void()>& body) {
        if (instances.empty()) return;
        try {
            body();
        } catch (...) {
            Trace(std::string(kName) + " -- Exception when writing " + table + " raw data table ");
        }
    };
    // The command of a row; a failure is logged and leaves it empty.
    auto command = [&](const TInstancePtr& instance, const std::string& tool) {
        try {
            return ValueOf(instance, "Command").ToString(10);
        } catch (...) {
            Trace(std::string(kName) + " -- Exception when getting the command sent to " + tool);
            return std::string();
        }
    };

    writeTable(utility, "LSI", [&] {
        WriteTableTitle(kCommandsIssued, false, false);
        TTable table = CommandsTable(utility.size(), "Command", "Raw Result");
        for (size_t index = 0; index < utility.size(); ++index) {
            const std::string fileName = NumberedFileName("LSI_RawData_Rresults_", static_cast<int>(index));
            const int row = static_cast<int>(index) + 1;
            table.Cell(row, 0).text = CommandCell(*this, command(utility[index], "LSI utility tool"));
            table.Cell(row, 1).text = ResultLinkCell(fileName);
            TResultFile file(fOutputPath + TOSSpecific::kFileSeparator + fileName);
            file.WriteLine(UtilityResult(utility[index]));
        }
        WriteTableGrid(table);
    });
    writeTable(mega, "LSI MR", [&] {
        WriteTableTitle(kCommandsIssued, false, false);
        TTable table = CommandsTable(mega.size(), "Command", "Raw Result");
        for (size_t index = 0; index < mega.size(); ++index) {
            const std::string fileName = NumberedFileName("MegaLSI_RawData_Rresults_", static_cast<int>(index));
            const int row = static_cast<int>(index) + 1;
            table.Cell(row, 0).text = CommandCell(*this, command(mega[index], "LSI MegaRAID tool - megacli"));
            table.Cell(row, 1).text = ResultLinkCell(fileName);
            TResultFile file(fOutputPath + TOSSpecific::kFileSeparator + fileName);
            for (const std::string& line : ResultLines(ValueOf(mega[index], "RawResults"))) file.WriteLine(line);
        }
        WriteTableGrid(table);
    });
    writeTable(ir, "LSI IR", [&] {
        WriteTableTitle(kCommandsIssued, false, false);
        TTable table = FillCommandsTable(*this, fOutputPath, ir,
                                         {"Command", "Result", "LSI_RawData_Results_", "Command", "RawResults"});
        WriteTableGrid(table);
    });

    WritePageFooter();
    ClosePage();
    Trace(std::string(kName) + " -- Exiting");
    return kLink;
}

}  // namespace braigrion
