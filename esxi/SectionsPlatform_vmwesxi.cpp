// The ESXi platform sections: the sensor readings and the service
// processor's network configuration. docs/esxi-sections.md tells what each
// page shows.
#include <cmath>
#include <sstream>

#include "SectionSupport_vmwesxi.h"
#include "TWriter_vmwesxi.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using NORVTKR20::ICIMProperty;
using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;
using namespace sections_vmwesxi;

namespace {

// Whether the probe answers; a probe that fails counts as a single node.
bool MultiNode(const TReportParametersBuilder_vmwesxi& builder) {
    try {
        return builder.IsMultiNode();
    } catch (...) {
        return false;
    }
}

// The reading of a sensor: CurrentReading times ten to the power of
// UnitModifier, in single precision, six significant digits; "" when
// either cannot be read.
std::string SensorReading(const TInstancePtr& sensor) {
    try {
        TCIMContext context;
        const int reading = static_cast<int>(sensor->GetProperty("CurrentReading", context)->GetValue(context));
        const int modifier = static_cast<int>(sensor->GetProperty("UnitModifier", context)->GetValue(context));
        const float value = static_cast<float>(reading) * static_cast<float>(std::pow(10.0, modifier));
        std::ostringstream text;
        text << value;
        return text.str();
    } catch (...) {
        // A missing, null or non-numeric value reads nothing.
        return std::string();
    }
}

// Whether an endpoint's address came from DHCP (AddressOrigin 4, read as
// a number whatever its declaration maps it to).
bool IsDhcpOrigin(const TInstancePtr& endpoint) {
    try {
        TCIMContext context;
        const NORVTKR20::TCIMValue& origin = endpoint->GetProperty("AddressOrigin", context)->GetValue(context);
        return !origin.IsNull() && static_cast<unsigned short>(origin) == 4;
    } catch (...) {
        return false;  // no origin, or not a number: no DHCP address
    }
}

}  // namespace

void TWriter_vmwesxi::WriteEnvironmentalsPreferred(TReportParametersBuilder_vmwesxi builder) {
    Trace("TWriter_vmwesxi::WriteEnvironmentalsPreferred -- Entering");
    TReportParameters params = builder.BuildEnvironmentalsParams();
    TReportClass sensors = params.GetClasses()[0];
    const bool multiNode = MultiNode(builder);

    // Whether the collection has sensors at all, asked before the page opens.
    bool present = true;
    try {
        builder.GetClass(sensors.GetClass());
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) Trace("TWriter_vmwesxi::WriteEnvironmentalsPreferred -- Exception when getting class " +
                                   sensors.GetClass());
        present = false;
    }
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + params.GetLinkName());
    WritePageHeader();
    WriteReportTitle(params.GetReportName(), "", "");

    bool hasData = false;
    if (present) {
        try {
            WriteTableTitle(sensors.GetTitle(), false, sensors.SubTitleEnabled());
            // A sensor without a name or whose state is unknown reads nothing useful.
            TInstances kept;
            for (const TInstancePtr& sensor : TWriterUtil::GetInstances(fNamespace, sensors)) {
                if (GetPropertyValue(sensor, "ElementName", " ").empty()) continue;
                if (GetPropertyValue(sensor, "OperationalStatus", ",") == "Unknown") continue;
                kept.push_back(sensor);
            }
            std::vector<TReportProperty> columns = sensors.GetProperties();
            if (multiNode) columns.insert(columns.begin() + 1, TReportProperty("NodeID", "7%", "", "", "", ""));
            if (!kept.empty()) {
                hasData = true;
                TTable table(static_cast<int>(kept.size()) + 1, static_cast<int>(columns.size()),
                             sensors.IsTableSortable());
                table.fTableWidth = TReportParameters::ConvertPercent(sensors.GetTableWidth());
                table.fSortable = sensors.IsTableSortable();
                table.fColumnHeaders = true;
                TCIMContext context;
                boost::shared_ptr<NORVTKR20::ICIMClass> cls = kept.front()->GetClass(context);
                for (size_t j = 0; j < columns.size(); ++j) {
                    table.fColumnWidths[j] = TReportParameters::ConvertPercent(columns[j].GetColumnWidth());
                    table.Cell(0, static_cast<int>(j)).text = GetTableHeaderLabel(*cls, columns[j], TContext());
                }
                for (size_t i = 0; i < kept.size(); ++i) {
                    for (size_t j = 0; j < columns.size(); ++j) {
                        const std::string& property = columns[j].GetProperty();
                        TTable::TCell& cell = table.Cell(static_cast<int>(i) + 1, static_cast<int>(j));
                        cell.text = property == "CurrentReading" ? SensorReading(kept[i])
                                                                 : GetPropertyValue(kept[i], property, ", ");
                    }
                }
                WriteTableGrid(table);
                WriteTableBreak();
            }
        } catch (...) {
            Trace("TWriter_vmwesxi::WriteEnvironmentalsPreferred -- Exception when writting sensors");
        }
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(params.GetLinkName(), params.GetReportName(), hasData);
    Trace("TWriter_vmwesxi::WriteEnvironmentalsPreferred -- Exiting");
}

void TWriter_vmwesxi::WriteKMCConfigReport(TReportParametersBuilder_vmwesxi builder) {
    Trace("TWriter_vmwesxi::WriteKMCConfigReport -- Entering");
    TReportParameters params = builder.BuildKMCConfigurationParams();
    const bool multiNode = MultiNode(builder);
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + params.GetLinkName());
    WritePageHeader();
    WriteReportTitle(params.GetReportName(), "", "");

    bool hasData = false;
    for (TReportClass table : params.GetClasses()) {
        const std::string className = table.GetClass();
        if (multiNode) {
            std::vector<TReportProperty> rows = table.GetProperties();
            rows.insert(rows.begin(), TReportProperty("NodeID", "0%", "", "", "", ""));
            table.SetProperties(rows);
        }
        for (const TInstancePtr& instance : TWriterUtil::GetInstances(fNamespace, table)) {
            try {
                // The definition keeps origins that contain a 4; of those,
                // only DHCP (4 itself) is a DHCP address.
                if (className == "CIM_IPProtocolEndpoint" && !IsDhcpOrigin(instance)) continue;
                TReportClass one = table;
                // Each DNS setting is titled by its own id.
                if (className == "CIM_DNSSettingData") {
                    const std::string id = GetPropertyValue(instance, "InstanceID", " ");
                    if (!id.empty()) one.SetTitle(id);
                }
                WriteTable(one, {instance}, true, false, TContext());
                hasData = true;
            } catch (...) {
                Trace("TWriter_vmwesxi::WriteKMCConfigReport -- Exception when writting current instance of class " +
                      className);
            }
        }
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(params.GetLinkName(), params.GetReportName(), hasData);
    Trace("TWriter_vmwesxi::WriteKMCConfigReport -- Exiting");
}

}  // namespace braigrion
