// The raw-data pages of the adapter sections: Fusion-io, Emulex and QLogic.
//
// The Fusion-io collector names each result file by its command. That name
// is collected text, so it is used as a file name only when it is a safe
// name inside the report's directory (IsSafeFileName) that no earlier row
// took; any other command is written under a numbered name, and the row
// links to the file actually written.
#include <algorithm>
#include <set>

#include "RawDataSupport.h"
#include "braigrion/TWriter.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace rawdata;
using NORVTKR20::TOSSpecific;

std::string TWriter::WriteFIORawDataReport(std::string linkName) {
    const std::string name = "TWriter::WriteFIORawDataReport";
    const std::string className = "ORV_FIORawData";
    Trace(name + " -- Entering");
    const TInstances instances = RawDataInstances(fNamespace, name, className);
    if (instances.empty()) return std::string();

    const std::string link = "fio_rawData";
    OpenRawPage(*this, fOutputPath, link, "FIO Raw Data Information", linkName);
    WriteTableBreak();
    try {
        WriteTableTitle(kCommandsIssued, false, false);
        TTable table = CommandsTable(instances.size(), "Command", "Raw Result");
        // A command that cannot be read leaves the row with the command of
        // the row before; as that name is taken, its result gets a numbered
        // file, so no result overwrites another.
        std::string command;
        std::set<std::string> used;
        for (size_t index = 0; index < instances.size(); ++index) {
            try {
                command = ValueOf(instances[index], "Command").ToString(10);
            } catch (...) {
                Trace(name + " -- Exception when getting the command");
            }
            const std::string fileName =
                ResultFileName(command, NumberedFileName("FIO_RawData_Results_", static_cast<int>(index)), used);
            const int row = static_cast<int>(index) + 1;
            table.Cell(row, 0).text = CommandCell(*this, command);
            table.Cell(row, 1).text = ResultLinkCell(fileName);
            TResultFile file(fOutputPath + TOSSpecific::kFileSeparator + fileName);
            file.WriteLine(static_cast<std::string>(ValueOf(instances[index], "CommandResult")));
        }
        WriteTableGrid(table);
    } catch (...) {
        Trace(name + " -- Exception when writing FIO raw data table ");
    }
    WritePageFooter();
    ClosePage();
    Trace(name + " -- Exiting");
    return link;
}

std::string TWriter::WriteEmulexRawDataReport(std::string linkName) {
    const std::string name = "TWriter::WriteEmulexRawDataReport";
    const std::string className = "EMXCNA_RawData";
    Trace(name + " -- Entering");
    const TInstances instances = RawDataInstances(fNamespace, name, className);
    if (instances.empty()) return std::string();

    const std::string link = "emulex_rawData";
    OpenRawPage(*this, fOutputPath, link, "Emulex Raw Data Information", linkName);
    WriteTableTitle("EmulexCNA Raw Data", false, false);
    TTable table = CommandsTable(instances.size(), "Command", "Raw Result");
    for (size_t index = 0; index < instances.size(); ++index) {
        // The row is labelled by the adapter's command, its colons made dashes.
        std::string label = "HbaCmd: ";
        try {
            std::string id = ValueOf(instances[index], "InstanceID").ToString(10);
            std::replace(id.begin(), id.end(), ':', '-');
            label += id;
        } catch (...) {
            Trace(name + " -- Exception when processing property InstanceID");
        }
        const std::string fileName = NumberedFileName("ELXCNA_RawData_Results_", static_cast<int>(index));
        const int row = static_cast<int>(index) + 1;
        table.Cell(row, 0).text = CommandCell(*this, label, std::string(kCommandOpen) + " ");
        table.Cell(row, 1).text = ResultLinkCell(fileName);
        TResultFile file(fOutputPath + TOSSpecific::kFileSeparator + fileName);
        std::string result;  // an unreadable result leaves one empty line
        try {
            result = static_cast<std::string>(ValueOf(instances[index], "RawData"));
        } catch (...) {
        }
        file.WriteLine(result);
    }
    WriteTableGrid(table);
    WritePageFooter();
    ClosePage();
    Trace(name + " -- Exiting");
    return link;
}

std::string TWriter::WriteQLogicRawDataReport(std::string linkName) {
    const std::string name = "TWriter::WriteQLogicRawDataReport";
    Trace(name + " -- Entering");
    TInstances fibreChannel;
    TInstances iscsi;
    try {
        fibreChannel = InstancesOf(fNamespace, "ORVSG_QLogicFibreChannelRawData");
        iscsi = InstancesOf(fNamespace, "ORVSG_QLogicIScsiRawData");
    } catch (...) {
        return std::string();
    }
    if (fibreChannel.empty() && iscsi.empty()) return std::string();

    // The page opens with the first table that has commands, and both
    // tables stand on it.
    const std::string link = "QLogic_RawData";
    bool opened = false;
    const std::pair<const TInstances*, const char*> tables[] = {{&fibreChannel, "FC_QLogic_RawData_Results_"},
                                                               {&iscsi, "iSCSI_QLogic_RawData_Results_"}};
    for (const auto& entry : tables) {
        if (entry.first->empty()) continue;
        if (!opened) OpenRawPage(*this, fOutputPath, link, "QLogic Raw Data Information", linkName);
        opened = true;
        WriteTableTitle(kCommandsIssued, false, false);
        TTable table = FillCommandsTable(*this, fOutputPath, *entry.first,
                                         {"Command", "Raw Result", entry.second, "Command", "RawResults"});
        WriteTableGrid(table);
    }
    WritePageFooter();
    ClosePage();
    Trace(name + " -- Exiting");
    return link;
}

}  // namespace braigrion
