// Writes an HTML report of one page holding one sortable table of ROWS rows,
// for the browser tests and the browser benchmark:
//   write_table_report DIR ROWS
// Columns: "Device" ("Device 1" ...), "Size" (a size with its unit),
// "Address" (hexadecimal), "Reading" (a signed decimal) and "Status". The
// values repeat with different periods, so that sorting by any column moves
// rows, and row N is the only one whose device is "Device N".
#include <cstdlib>
#include <filesystem>
#include <iostream>
#include <string>

#include "THtmlWriter.h"
#include "braigrion/TTable.h"

namespace {

const char* const kSizes[] = {"512 KB", "900 KB", "10 MB", "1.5 GB", "2 GB", "750 GB", "1.2 TB"};
const char* const kStates[] = {"OK", "Degraded", "Rebuilding", "Failed", "Unknown"};

std::string Hex(long value) {
    static const char kDigits[] = "0123456789abcdef";
    std::string out;
    do {
        out.insert(out.begin(), kDigits[value % 16]);
        value /= 16;
    } while (value > 0);
    return "0x" + out;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 3 || std::atol(argv[2]) < 1) {
        std::cerr << "usage: write_table_report DIR ROWS\n";
        return 2;
    }
    const std::string dir = argv[1];
    const int rows = std::atoi(argv[2]);
    std::filesystem::remove_all(dir);
    std::filesystem::create_directories(dir);

    braigrion::backends::THtmlWriter writer;
    writer.Initialize(boost::shared_ptr<NORVTKR20::ICIMNamespace>(), {}, dir);
    writer.StartReport();
    writer.WriteCategory("Hardware");
    writer.OpenPage(dir + "/devices");
    writer.WriteSortScript();
    writer.WritePageHeader();
    writer.WriteReportTitle("Devices", "", "");
    writer.WriteTableTitle("Devices", false, false);

    braigrion::TTable table(rows + 1, 5, false);
    table.fColumnHeaders = true;
    table.fSortable = true;
    table.fColumnWidths = {20, 20, 20, 20, 20};
    const char* const headers[] = {"Device", "Size", "Address", "Reading", "Status"};
    for (int c = 0; c < 5; ++c) table.Cell(0, c).text = headers[c];
    for (int r = 1; r <= rows; ++r) {
        long n = r;
        table.Cell(r, 0).text = "Device " + std::to_string(n);
        table.Cell(r, 1).text = kSizes[(n * 5) % 7];
        table.Cell(r, 2).text = Hex((n * 7919) % 65521);
        table.Cell(r, 2).monospaced = true;
        long tenths = (n * 37) % 2001 - 1000;
        table.Cell(r, 3).text = (tenths < 0 ? "-" : "") + std::to_string(std::labs(tenths) / 10) + "." +
                                std::to_string(std::labs(tenths) % 10);
        table.Cell(r, 4).text = kStates[(n * 3) % 5];
    }
    writer.WriteTableGrid(table);
    writer.WritePageFooter();
    writer.ClosePage();
    writer.WriteIndexEntry("devices", "Devices", true);
    writer.EndCategory();
    writer.EndReport();
    if (!writer.GetFailure().empty()) {
        std::cerr << "write_table_report: " << writer.GetFailure() << '\n';
        return 1;
    }
    return 0;
}
