// The "Environmentals" page: temperature, voltage and fan sensors. The
// numeric sensors of the operating system's provider come first; the
// service processor's own sensors stand in only when the first source
// cannot be read at all.
#include <cmath>
#include <sstream>
#include <string>
#include <vector>

#include "braigrion/TInstanceSorter.h"
#include "braigrion/TWriter.h"
#include "braigrion/TWriterUtil.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TOSSpecific.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;

namespace {

const char kLinkName[] = "Environmentals";
const char kTitle[] = "Environmentals";

std::string TextOf(const TWriter::TInstancePtr& instance, const std::string& property) {
    TCIMContext context;
    return instance->GetProperty(property, context)->GetValue(context).ToString(10);
}

// The reading as a person reads it: CurrentReading times ten to the power of
// UnitModifier, in single precision and six significant digits ("25.5" for
// 255 and -1). "" when either cannot be read.
std::string ScaledReading(const TWriter::TInstancePtr& sensor) {
    try {
        TCIMContext context;
        const int modifier = static_cast<int>(sensor->GetProperty("UnitModifier", context)->GetValue(context));
        const int reading = static_cast<int>(sensor->GetProperty("CurrentReading", context)->GetValue(context));
        const float value = static_cast<float>(reading) * static_cast<float>(std::pow(10.0, modifier));
        std::ostringstream text;
        text << value;
        return text.str();
    } catch (const TTKRException&) {
        return std::string();
    }
}

}  // namespace

void TWriter::WriteEnvironmentalsReport(TBuilderPtr builder, std::string pageID) {
    try {
        WriteEnvironmentalsPreferred(builder, pageID);
        return;
    } catch (...) {
        Trace("TWriter::WriteEnvironmentalsReport --Exception when nvoking WriteEnvironmentalsPreferred");
    }
    try {
        WriteEnvironmentalsBackup(builder, pageID);
    } catch (...) {
        Trace("TWriter::WriteEnvironmentalsReport --Exception when nvoking WriteEnvironmentalsBackup ");
    }
}

void TWriter::WriteEnvironmentalsPreferred(TBuilderPtr builder, std::string /*pageID*/) {
    Trace("TWriter::WriteEnvironmentalsPreferred -- Entering");
    // Only a repository that cannot answer sends the page to the service
    // processor's sensors; an absent class is an answer.
    bool absent = false;
    try {
        fNamespace->GetClass("CIM_NumericSensor", TCIMContext());
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) {
            Trace("TWriter::WriteEnvironmentalsPreferred -- Exception when getting class CIM_NumericSensor ");
            throw TTKRException(ex.fStatusCode.fStatusCode);
        }
        absent = true;
    }

    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + kLinkName);
    WritePageHeader();
    WriteReportTitle(kTitle, "", "");

    const bool kmc = fKMC;
    const bool multiNode = builder->IsMultiNode();
    const std::string nameProperty = kmc ? "ElementName" : "SensorDescription";
    const std::string nodeProperty = kmc ? "NodeID" : "SourceNode";

    TReportClass reportClass;
    reportClass.SetClass("CIM_NumericSensor");
    reportClass.SetTitle(kTitle);
    std::vector<TReportProperty> columns = {TReportProperty(nameProperty, "25%", "", "", "", "")};
    if (multiNode) columns.push_back(TReportProperty(nodeProperty, "7%", "", "", "", ""));
    columns.push_back(TReportProperty("CurrentReading", "25%", "", "", "", ""));
    columns.push_back(TReportProperty("BaseUnits", "25%", "", "", "", ""));
    reportClass.SetProperties(columns);

    bool hasData = false;
    if (!absent) {
        WriteTableTitle(reportClass.GetTitle(), false, reportClass.SubTitleEnabled());
        std::vector<TInstancePtr> kept;
        for (const TInstancePtr& sensor : TWriterUtil::GetInstances(fNamespace, reportClass)) {
            const std::string status = GetPropertyValue(sensor, "OperationalStatus", ",");
            std::string name;
            try {
                name = TextOf(sensor, nameProperty);
            } catch (const TTKRException&) {
            }
            if (!name.empty() && status != "Unknown") kept.push_back(sensor);
        }
        if (!kept.empty()) {
            hasData = true;
            TCIMContext context;
            boost::shared_ptr<ICIMClass> cls = kept.front()->GetClass(context);
            TTable table(static_cast<int>(kept.size()) + 1, static_cast<int>(columns.size()),
                         reportClass.IsTableSortable());
            table.fColumnHeaders = true;
            table.fSortable = reportClass.IsTableSortable();
            table.fTableWidth = TReportParameters::ConvertPercent(reportClass.GetTableWidth());
            for (size_t j = 0; j < columns.size(); ++j) {
                table.fColumnWidths[j] = TReportParameters::ConvertPercent(columns[j].GetColumnWidth());
                table.Cell(0, static_cast<int>(j)).text = GetTableHeaderLabel(*cls, columns[j], TContext());
            }

            TInstanceSorter sorter;
            if (multiNode) sorter.AddProperty(nodeProperty, true, false);
            sorter.AddProperty(nameProperty, true, false);
            TWriterUtil::SortInstances(kept, sorter, true);

            for (size_t i = 0; i < kept.size(); ++i) {
                const int row = static_cast<int>(i) + 1;
                int col = 0;
                // A cell shows what the value means: an enumerated unit its
                // mapped text ("Degrees C"), not its number.
                auto text = [&](const std::string& property) {
                    try {
                        TCIMContext context;
                        return EscapeText(kept[i]->GetProperty(property, context)->GetValueString());
                    } catch (const TTKRException&) {
                        return std::string();
                    }
                };
                table.Cell(row, col++).text = text(nameProperty);
                if (multiNode) table.Cell(row, col++).text = text(nodeProperty);
                table.Cell(row, col++).text = EscapeText(ScaledReading(kept[i]));
                table.Cell(row, col++).text = text("BaseUnits");
            }
            WriteTableGrid(table);
        }
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLinkName, kTitle, hasData);
    Trace("TWriter::WriteEnvironmentalsPreferred -- Exiting");
}

void TWriter::WriteEnvironmentalsBackup(TBuilderPtr builder, std::string /*pageID*/) {
    Trace("TWriter::WriteEnvironmentalsBackup -- Entering");
    boost::shared_ptr<ICIMClass> cls;
    try {
        cls = fNamespace->GetClass("ORVSG_SP_NumericSensor", TCIMContext());
    } catch (...) {
        Trace("TWriter::WriteEnvironmentalsBackup -- Exception when getting class ORVSG_SP_NumericSensor");
        WriteIndexEntry(kLinkName, kTitle, false);
        return;
    }
    std::vector<TInstancePtr> sensors;
    cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(sensors), true, TCIMContext());
    if (sensors.empty()) {
        Trace("TWriter::WriteEnvironmentalsBackup -- Exiting due to empty instance vector");
        WriteIndexEntry(kLinkName, kTitle, false);
        return;
    }

    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + kLinkName);
    WritePageHeader();
    WriteReportTitle(kTitle, "", "");

    const bool multiNode = builder->IsMultiNode();
    TReportProperty description("SensorDescription", "34%", "", "", "", "");
    TReportProperty node("SourceNode", "25%", "", "", "", "");
    TReportProperty reading("CurrentReading", "33%", "", "", "", "");
    TReportProperty units("BaseUnits", "33%", "", "", "", "");
    if (multiNode) {
        description.SetColumnWidth("25%");
        reading.SetColumnWidth("25%");
        units.SetColumnWidth("25%");
    }

    StartColumnTable("80%", kTitle, true);
    StartRow(false);
    WriteHeaderCell(cls, description);
    if (multiNode) WriteHeaderCell(cls, node);
    WriteHeaderCell(cls, reading);
    WriteHeaderCell(cls, units);
    EndRow();
    EndTableHeader();
    for (const TInstancePtr& sensor : sensors) {
        StartRow(true);
        WriteValueCell(sensor, description, "");
        if (multiNode) WriteValueCell(sensor, node, "");
        WriteSensorCell(sensor, "CurrentReading", "UnitModifier");
        WriteValueCell(sensor, units, "");
        EndRow();
    }
    EndTable();
    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLinkName, kTitle, true);
    Trace("TWriter::WriteEnvironmentalsBackup -- Exiting");
}

}  // namespace braigrion
