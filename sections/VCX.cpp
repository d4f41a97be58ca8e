// The "VCX Information" page: the inventory a chassis management module
// keeps of its chassis, the devices in it and their firmware.
#include <stdexcept>
#include <string>
#include <vector>

#include "braigrion/TWriter.h"
#include "braigrion/TWriterUtil.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;

namespace {

typedef std::vector<TWriter::TInstancePtr> TInstances;

// The text of a property, a date in the report's date form; "" when the
// instance lacks it. The cells make the text safe themselves.
std::string TextOf(const TWriter::TInstancePtr& instance, const std::string& property) {
    try {
        TCIMContext context;
        const NORVTKR20::TCIMValue& value = instance->GetProperty(property, context)->GetValue(context);
        if (value.GetType() == NORVTKR20::TCIMValue::TCIMType::eDateTime) return TWriterUtil::GetDateTime(value, true);
        return value.ToString(10);
    } catch (...) {
        return std::string();
    }
}

// The chassis's vital product data, cut out of the modular system's
// identifying text: "<UUID>, <type><model>...:<serial>,...".
struct TChassisVPD {
    std::string machineType;
    std::string model;
    std::string serialNumber;
    std::string uuid;
};

// Throws std::out_of_range when the text is too short for its fields, or
// has no "," to find them by.
TChassisVPD ParseChassisVPD(const std::string& info) {
    TChassisVPD vpd;
    const std::string::size_type c = info.find(',');
    if (c == std::string::npos) throw std::out_of_range("no ',' in the chassis identifying text: " + info);
    const std::string::size_type k = info.find(':');
    const std::string::size_type l = info.rfind(',');
    vpd.machineType = info.substr(c + 2, 4);
    vpd.model = info.substr(c + 6, 3);
    if (k != std::string::npos && l != std::string::npos && k + 1 < l) vpd.serialNumber = info.substr(k + 1, l - k - 1);
    vpd.uuid = info.substr(1, c - 1);
    return vpd;
}

}  // namespace

void TWriter::WriteVCXReport(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    Trace("TWriter::WriteVCXReport -- Entering");
    boost::shared_ptr<ICIMClass> firmwareClass, systemClass, packageClass;
    try {
        TCIMContext context;
        firmwareClass = fNamespace->GetClass("ORVSD_VCXFirmwareIdentity", context);
        systemClass = fNamespace->GetClass("ORVSD_ModularComputerSystem", context);
        packageClass = fNamespace->GetClass("ORVx_PhysicalPackage", context);
    } catch (...) {
        Trace("TWriter::WriteVCXReport -- Exception when getting class ");
        return;
    }
    TInstances firmware, systems, packages;
    try {
        TCIMContext context;
        firmwareClass->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(firmware), true, context);
        systemClass->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(systems), true, context);
        packageClass->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(packages), true, context);
    } catch (...) {
        Trace("TWriter::WriteVCXReport -- Exception when getting instance ");
    }

    // Without a modular system there is no chassis to describe, and its
    // table is left out.
    TChassisVPD vpd;
    if (!systems.empty()) vpd = ParseChassisVPD(TextOf(systems.front(), "OtherIdentifyingInfo"));

    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + "vcx");
    WritePageHeader();
    WriteReportTitle("VCX Information", "", "");
    bool hasData = false;

    auto startTable = [&](const std::string& title, const std::vector<std::string>& labels) {
        WriteTableTitle(title, false, false);
        StartColumnTable("80%", "", false);
        StartRow(false);
        for (const std::string& label : labels) WriteTextCell(TReportProperty("", "", "", "", label, ""), label, "");
        EndRow();
        EndTableHeader();
    };
    auto textRow = [&](const std::vector<std::string>& texts) {
        hasData = true;
        StartRow(true);
        for (const std::string& text : texts) WriteTextCell(TReportProperty("", "", "", "", "", ""), text, "");
        EndRow();
    };

    if (!systems.empty()) {
        startTable("Chassis VPD", {"Machine Type", "Model", "Serial Number", "UUID"});
        textRow({vpd.machineType, vpd.model, vpd.serialNumber, vpd.uuid});
        EndTable();
    }
    startTable("Chassis Physical Device",
               {"Product Name", "Manufacturer", "Part Number", "FRU Number", "Serial Number", "UUID"});
    for (const TInstancePtr& package : packages) {
        const std::string product = TextOf(package, "ProductName");
        if (product.empty()) continue;
        textRow({product, TextOf(package, "Manufacturer"), TextOf(package, "PartNumber"), TextOf(package, "SKU"),
                 TextOf(package, "SerialNumber"), TextOf(package, "UUID")});
    }
    EndTable();
    startTable("Chassis Device Firmware", {"Firmware Element Name", "Version", "Build Number", "Release Date"});
    for (const TInstancePtr& element : firmware) {
        textRow({TextOf(element, "ElementName"), TextOf(element, "VersionString"), TextOf(element, "BuildNumber"),
                 TextOf(element, "ReleaseDate")});
    }
    EndTable();

    WritePageFooter();
    ClosePage();
    WriteIndexEntry("vcx", "VCX Information", hasData);
    Trace("TWriter::WriteVCXReport -- Exiting");
}

}  // namespace braigrion
