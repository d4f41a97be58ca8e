// The raw-data page of the PCI page: the bus listing commands the collector
// ran, each with its output in a text file beside the report.
//
// Unlike the other raw-data pages, a row is filled only once its file has
// been written: a file that cannot be written leaves its row blank and the
// page goes on, and a page whose files all failed is not linked.
#include <cerrno>
#include <fstream>

#include "RawDataSupport.h"
#include "braigrion/TWriter.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace rawdata;
using NORVTKR20::TOSSpecific;

namespace {

const char kName[] = "TWriter::WritePCIRawDataReport";
const char kClass[] = "ORVSG_PCIRawData";
const char kLink[] = "pci_rawdata";
const char kTitle[] = "PCI Raw Data Information";
const char kFilePrefix[] = "pci_raw_data_";
// This page's link carries a blank after the equals sign.
const char kLinkOpen[] = "<a href= \"";

}  // namespace

std::string TWriter::WritePCIRawDataReport(std::string linkName) {
    Trace(std::string(kName) + " -- Entering");
    const TInstances instances = RawDataInstances(fNamespace, kName, kClass);
    if (instances.empty()) return std::string();

    OpenRawPage(*this, fOutputPath, kLink, kTitle, linkName);
    bool anyRow = false;
    try {
        WriteTableTitle(kCommandsIssued, false, false);
        TTable table = CommandsTable(instances.size(), "Command", "Raw Data");
        for (size_t index = 0; index < instances.size(); ++index) {
            const TInstancePtr& instance = instances[index];
            const int row = static_cast<int>(index) + 1;
            const std::string fileName = NumberedFileName(kFilePrefix, static_cast<int>(index));
            const std::string path = fOutputPath + TOSSpecific::kFileSeparator + fileName;
            errno = 0;
            std::ofstream file(path.c_str(), std::ios::out | std::ios::trunc | std::ios::binary);
            if (!file.is_open()) {
                if (errno == EACCES) {
                    Trace(std::string(kName) + " - Access to file " + path + " denied.");
                } else {
                    Trace(std::string(kName) + " - Access to file failed.");
                }
                continue;
            }
            try {
                for (const std::string& line : ResultLines(ValueOf(instance, "RawResult"))) {
                    file << line << '\n';
                    file.flush();
                }
            } catch (...) {
                Trace(std::string(kName) + " - Exception cautht when get property \"RawResult\"");
            }
            file.close();

            if (!TOSSpecific::FileExists(path)) continue;
            try {
                const std::string command = ValueOf(instance, "Command").ToString(10);
                table.Cell(row, 0).text = CommandCell(*this, command);
                table.Cell(row, 1).text = ResultLinkCell(fileName, kLinkOpen);
                anyRow = true;
            } catch (...) {
                Trace(std::string(kName) + " - Exception caught when get property \"Command\"");
            }
        }
        WriteTableGrid(table);
    } catch (...) {
        Trace(std::string(kName) + " - Exception cautht.");
    }
    WritePageFooter();
    ClosePage();
    Trace(std::string(kName) + " -- Exiting");
    return anyRow ? kLink : std::string();
}

}  // namespace braigrion
