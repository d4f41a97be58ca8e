// The chipset register page: the error registers the service mode read from
// the scalability chipset, one table per register block. A block is one
// instance of the dump class; its registers are the properties whose names
// begin with "Register", in natural order, each value as collected in a
// fixed-pitch font (an integer in hexadecimal). See docs/chipset-registers.md.
#include <algorithm>
#include <strings.h>

#include "MellanoxBlocks.h"
#include "braigrion/TInstanceSorter.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace sections;

namespace {

const char kLinkName[] = "qva_reg";
const char kTitle[] = "QVA Chipset Registers";
const char kRegisterPrefix[] = "Register";

struct TRegisterBlock {
    std::string title;
    TWriter::TInstancePtr instance;
    std::vector<TWriter::TPropertyPtr> registers;
};

std::string DeclaredName(const TWriter::TPropertyPtr& property) {
    return property->GetDeclaration(NORVTKR20::TCIMContext())->GetName(NORVTKR20::TCIMContext());
}

bool IsRegister(const std::string& name) {
    const size_t length = sizeof kRegisterPrefix - 1;
    return name.size() >= length && strncasecmp(name.c_str(), kRegisterPrefix, length) == 0;
}

// The block's name: "ElementName", else "InstanceID", else its place on the page.
std::string BlockTitle(const TWriter::TInstancePtr& instance, size_t index) {
    for (const char* property : {"ElementName", "InstanceID"}) {
        const std::string text = ValueText(instance, property);
        if (!text.empty()) return text;
    }
    return "Register block " + std::to_string(index + 1);
}

TRegisterBlock ReadBlock(const TWriter::TInstancePtr& instance, size_t index) {
    TRegisterBlock block;
    block.title = BlockTitle(instance, index);
    block.instance = instance;
    std::vector<TWriter::TPropertyPtr> properties;
    instance->EnumerateProperties(
        [&properties](TWriter::TPropertyPtr property) {
            properties.push_back(property);
            return true;
        },
        NORVTKR20::TCIMContext());
    std::vector<std::pair<std::string, TWriter::TPropertyPtr>> named;
    for (const TWriter::TPropertyPtr& property : properties) {
        const std::string name = DeclaredName(property);
        if (IsRegister(name)) named.push_back(std::make_pair(name, property));
    }
    std::stable_sort(named.begin(), named.end(), [](const auto& a, const auto& b) {
        return TInstanceSorter::PropertyCompare(a.first, b.first, true) < 0;
    });
    for (const auto& each : named) block.registers.push_back(each.second);
    return block;
}

}  // namespace

void TWriter::WriteQVARegisterReport(TBuilderPtr /*builder*/, std::string reportName) {
    Trace("Entering TWriter::WriteQVARegisterReport");
    OpenPage(fOutputPath + NORVTKR20::TOSSpecific::kFileSeparator + kLinkName);
    WritePageHeader();
    WriteReportTitle(kTitle, "", "");

    TClassPtr dumps = GuardedVendorClass(fNamespace, "ORVSG_QVAChipsetErrorData",
                                         "TWriter::WriteQVARegisterReport -- No ORVSG_QVAChipsetErrorData");
    std::vector<TRegisterBlock> blocks;
    const TInstances instances = DeepInstances(dumps);
    for (size_t index = 0; index < instances.size(); ++index) {
        try {
            blocks.push_back(ReadBlock(instances[index], index));
        } catch (const NORVTKR20::TTKRException&) {
            Trace("TWriter::WriteQVARegisterReport -- Exception when reading register block " +
                  std::to_string(index + 1));
        }
    }
    std::stable_sort(blocks.begin(), blocks.end(), [](const TRegisterBlock& a, const TRegisterBlock& b) {
        return TInstanceSorter::PropertyCompare(a.title, b.title, true) < 0;
    });

    const TReportProperty registerColumn("Register", "60%", "", "", "Register", "");
    const TReportProperty valueColumn("Value", "40%", "", "", "Value", "");
    bool hasData = false;
    for (const TRegisterBlock& block : blocks) {
        if (block.registers.empty()) continue;
        WriteTableTitle(block.title, false, false);
        StartColumnTable("50%", block.title, false);
        StartRow(false);
        WriteHeaderCell(dumps, registerColumn);
        WriteHeaderCell(dumps, valueColumn);
        EndRow();
        EndTableHeader();
        for (const TPropertyPtr& property : block.registers) {
            StartRow(true);
            WriteDeclarationHeader(property->GetDeclaration(NORVTKR20::TCIMContext()));
            WriteRegisterValue(block.instance, property);
            EndRow();
        }
        EndTable();
        hasData = true;
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLinkName, reportName, hasData);
    Trace("Exiting TWriter::WriteQVARegisterReport");
}

}  // namespace braigrion
