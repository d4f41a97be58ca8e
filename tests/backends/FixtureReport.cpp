#include "backends/FixtureReport.h"

#include "braigrion/ReportDefinition.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace testing {

namespace {

using namespace TKR_REPORT_DEFINITION;

boost::shared_ptr<repository::TMemoryNamespace> FixtureRepository() {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_Sensor SensorDescription="Inlet <Temp>" CurrentReading=sint32:2375 UnitModifier=sint32:-2 BaseUnits="C"
        ORVSG_Sensor SensorDescription="Fan 1" CurrentReading=sint32:5400 BaseUnits="RPM"
        ORVSG_Chassis Name="Main \"A\" & B" SerialNumber="SN-<1>" Tags=string[]:"rack 3","row 9"
    )");
    return repo.Namespace();
}

// A grid as the table engine hands it over: values already through EscapeText.
void WriteDeclaredTables(TWriter& writer) {
    writer.WriteTableTitle("PCI Slots", false, false);
    TTable slots(5, 3, false);
    slots.fColumnHeaders = true;
    slots.fSortable = true;
    slots.fTableWidth = 80;
    slots.fColumnWidths = {20, 30, 50};
    const char* const cells[5][3] = {{"Slot", "Device", "Notes"},
                                     {"Slot 10", "Ethernet", "<script>alert(1)</script>"},
                                     {"Slot 9", "RAID", "a \"quoted\" & 'single' value"},
                                     {"Slot 1", "Äpfel – ünïcödé", ""},
                                     {"slot 2", "GPU", "N/A"}};
    for (int r = 0; r < 5; ++r) {
        for (int c = 0; c < 3; ++c) slots.Cell(r, c).text = r == 0 ? cells[r][c] : writer.EscapeText(cells[r][c]);
    }
    // An array joined by the separator the column asks for, a mapped text.
    slots.Cell(3, 2).text = writer.EscapeText("lane 1") + writer.GetSeparatorText(1) + writer.EscapeText("lane 2");
    slots.Cell(4, 1).rawText = writer.EscapeText("Graphics <adapter>");
    slots.Cell(1, 0).monospaced = true;
    writer.WriteTableGrid(slots);
    writer.WriteTableBreak();

    writer.WriteTableTitle("Memory", true, false);
    TTable memory(3, 3, false);
    memory.fRowHeaders = true;
    memory.fColumnWidths = {30, 35, 35};
    const char* const rows[3][3] = {{"Size", "8 GB", "16 GB"},
                                    {"Speed", "3200 MT/s", "2933 MT/s"},
                                    {"Location", "DIMM A1", "DIMM B1"}};
    for (int r = 0; r < 3; ++r) {
        for (int c = 0; c < 3; ++c) memory.Cell(r, c).text = writer.EscapeText(rows[r][c]);
    }
    writer.WriteTableGrid(memory);
    writer.WriteTableBreak();
}

void WriteDeclaredPage(TWriter& writer, const std::string& outputDir) {
    writer.OpenPage(outputDir + "/slots");
    writer.WriteSortScript();
    writer.WritePageHeader();
    writer.WriteReportTitle("System <Slots>", "", "");
    WriteDeclaredTables(writer);
    writer.WritePageFooter();
    writer.ClosePage();
    writer.WriteIndexEntry("slots", "System Slots", true);
}

void WriteHandWrittenPage(TWriter& writer, const std::string& outputDir,
                          const boost::shared_ptr<repository::TMemoryNamespace>& ns) {
    NORVTKR20::TCIMContext context;
    std::vector<TWriter::TInstancePtr> sensors;
    std::vector<TWriter::TInstancePtr> chassis;
    ns->GetClass("ORVSG_Sensor", context)
        ->EnumerateInstances(NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(sensors), true, context);
    ns->GetClass("ORVSG_Chassis", context)
        ->EnumerateInstances(NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(chassis), true, context);

    writer.OpenPage(outputDir + "/Environmentals");
    writer.WritePageHeader();
    writer.WriteReportTitle("Environmentals", "", "");

    // A column table: header row, then one row per sensor.
    TReportProperty description("SensorDescription", "50%", "", "", "Sensor", "");
    TReportProperty reading("CurrentReading", "25%", "", "", "", "");
    TReportProperty unit("BaseUnits", "25%", "", "", "", "none");
    writer.WriteTableTitle("Sensors", false, false);
    writer.StartColumnTable("80%", "Sensors", true);
    writer.StartRow(false);
    for (const TReportProperty& p : {description, reading, unit}) writer.WriteHeaderCell(sensors[0]->GetClass(context), p);
    writer.EndRow();
    writer.EndTableHeader();
    for (const TWriter::TInstancePtr& sensor : sensors) {
        writer.StartRow(true);
        writer.WriteValueCell(sensor, description, "");
        writer.WriteSensorCell(sensor, "CurrentReading", "UnitModifier");
        writer.WriteValueCell(sensor, unit, "");
        writer.EndRow();
    }
    writer.EndTable();

    // A property table: a label and a value per row, a break, a message, links.
    TReportProperty name("Name", "0%", "", "", "", "");
    TReportProperty tags("Tags", "0%", "", "", "", "");
    tags.SetArrayValueSeparator(TReportProperty::SEPARATOR_2);
    TReportProperty link("Documentation", "100%", "", "", "", "");
    writer.WriteTableTitle("Chassis", false, false);
    writer.StartPropertyTable("60%", "40%", "Chassis");
    for (const TReportProperty& p : {name, tags}) {
        writer.StartRow(true);
        writer.WriteHeaderCell(chassis[0]->GetClass(context), p);
        writer.WriteValueCell(chassis[0], p, "");
        writer.EndRow();
    }
    writer.WriteRowBreak(1);
    writer.StartRow(true);
    writer.WriteTextCell(link, "Event 0x80 <guide>", "https://docs.example.com/event?id=80&lang=en");
    writer.WriteTextCell(link, "Script link", "javascript:alert(1)");
    writer.EndRow();
    writer.StartRow(true);
    writer.WriteMessageCell(link, "No LSI RAID card detected\n");
    writer.EndRow();
    writer.EndTable();

    writer.WritePageFooter();
    writer.ClosePage();
    writer.WriteIndexEntry("Environmentals", "Environmentals", true);
}

// The raw-data page as the logic writes it: mark-up of its own in the cells,
// the command text not escaped, and the switch back to the standard page.
void WriteRawDataPage(TWriter& writer, const std::string& outputDir) {
    writer.OpenPage(outputDir + "/lsi_rawData");
    writer.WritePageHeader();
    writer.WriteReportTitle("LSI Raw Data Information", kTKRShowStandard, "lsi_mir");
    writer.WriteTableBreak();
    writer.WriteTableTitle("Commands Issued", false, false);
    TTable commands(4, 2, false);
    commands.fTableWidth = 75;
    commands.fColumnHeaders = true;
    commands.fColumnWidths = {80, 20};
    commands.Cell(0, 0).text = "Command";
    commands.Cell(0, 1).text = "Raw Result";
    commands.Cell(1, 0).text = "<font face=\"Courier\">storcli /c0 show <all></font>";
    commands.Cell(1, 1).text = "<a href=\"LSI_RawData_Rresults_0.txt\">View Results</a>";
    commands.Cell(2, 0).text = "<font face=\"Courier\"><img src=x onerror=alert(1)></font>";
    commands.Cell(2, 1).text = "<a href= \"../../etc/passwd\">View Results</a>";
    commands.Cell(3, 0).text = "<font face=\"Courier\">megacli -v";
    commands.Cell(3, 1).text = "<a href=\"javascript:alert(1)\">View Results</a>";
    writer.WriteTableGrid(commands);
    writer.WritePageFooter();
    writer.ClosePage();
}

}  // namespace

void WriteFixturePage(TWriter& writer, const std::string& outputDir) {
    WriteDeclaredPage(writer, outputDir);
}

void WriteFixtureReport(TWriter& writer, const std::string& outputDir) {
    boost::shared_ptr<repository::TMemoryNamespace> ns = FixtureRepository();
    std::map<std::string, NORVTKR20::TCIMValue> context;
    writer.Initialize(ns, context, outputDir);
    writer.StartReport();
    // A heading whose pages were none is left out of the index.
    writer.WriteCategory("Empty heading");
    writer.EndCategory();
    writer.WriteCategory("Hardware <&>");
    WriteDeclaredPage(writer, outputDir);
    WriteHandWrittenPage(writer, outputDir, ns);
    writer.EndCategory();
    writer.WriteCategory(CATEGORY_ANALYSIS);
    WriteRawDataPage(writer, outputDir);
    // A page under a name that tries to climb out of the report, with no table.
    writer.OpenPage(outputDir + "/../../escape");
    writer.WritePageHeader();
    writer.WriteReportTitle("Nothing \"here\"", "", "");
    writer.WritePageFooter();
    writer.ClosePage();
    writer.WriteIndexEntry("../../escape", "<b>Escaped</b> page", true);
    // The error log closes the index without a heading, and holds no data.
    writer.EndCategory();
    writer.OpenPage(outputDir + "/tkrlog");
    writer.WriteSortScript();
    writer.WritePageHeader();
    writer.WriteReportTitle("TKR Error Log", "", "");
    writer.WritePageFooter();
    writer.ClosePage();
    writer.WriteIndexEntry("tkrlog", "TKR Error Log", false);
    writer.EndReport();
}

}  // namespace testing
}  // namespace braigrion
