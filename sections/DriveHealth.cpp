// The page "Drive Health": the SMART status, attributes and error log of
// ATA drives, the sense data of tape drives and, in LUZ mode, raw SCSI sense
// data. A page without any of them says so in one line.
#include "StorageSupport.h"
#include "braigrion/TWriter.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace storage;
using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;

namespace {

const char kName[] = "TWriter::WriteDriveHealthReport";
const char kLink[] = "Drive_Health";
const char kTitle[] = "Drive Health";
const char kTapeClass[] = "ORVSG_TapeDriveSensePageData";
const char kSenseClass[] = "OMC_SCSISenseRawData";

std::string Said(const std::string& line) { return std::string(kName) + " -- " + line; }

TReportClass Table(const std::string& className, const std::string& title, const std::string& width,
                   const std::vector<std::pair<const char*, const char*>>& columns) {
    TReportClass table;
    table.SetClass(className);
    table.SetTitle(title);
    if (!width.empty()) table.SetTableWidth(width);
    std::vector<TReportProperty> properties;
    for (const auto& column : columns) properties.push_back(TReportProperty(column.first, column.second, "", "", "", ""));
    table.SetProperties(properties);
    return table;
}

TInstances Sorted(TInstances instances, const std::string& property, bool ascending) {
    SortByProperty(instances, property, ascending);
    return instances;
}

// The SMART tables of one ATA device.
void WriteATADevice(TWriter& writer, const TWriter::TInstancePtr& device) {
    const TWriter::TContext context;
    writer.WriteTable(Table("OMC_ATADevice", "ATA Device", "",
                            {{"VendorID", "25%"}, {"ProductID", "25%"}, {"DeviceID", "50%"}}),
                      {device}, true, false, context);

    writer.WriteTable(Table("OMC_IDESMARTErrorLog", "SMART Status", "75%",
                            {{"smartStatus", "25%"}, {"selftestExecutionStatus", "75%"}}),
                      Associated(device, "OMC_IDESMARTUseOfMessageLog", "OMC_IDESMARTErrorLog"), true, false,
                      context);

    TReportClass attributes = Table("OMC_IDESMARTAttrib", "SMART Attributes Data", "90%",
                                    {{"attribID", "10%"},
                                     {"attribName", "18%"},
                                     {"flags", "12%"},
                                     {"value", "11%"},
                                     {"worst", "11%"},
                                     {"threshold", "12%"},
                                     {"type", "12%"},
                                     {"rawVal", "14%"}});
    attributes.GetProperties().back().SetArrayValueSeparator(TReportProperty::SEPARATOR_1);
    // Attributes read in the order of their numbers, as the drive lists them.
    writer.WriteTable(attributes,
                      Sorted(Associated(device, "OMC_IDESMARTElementStatisticalData", "OMC_IDESMARTAttrib"),
                             "attribID", true),
                      true, false, context);

    TReportClass errors = Table("", "SMART Error Log", "",
                                {{"RecordID", "10%"},
                                 {"deviceState", "10%"},
                                 {"errorReg", "10%"},
                                 {"sectorCount", "10%"},
                                 {"statusReg", "10%"},
                                 {"LBAHigh", "10%"},
                                 {"LBAMid", "10%"},
                                 {"LBALow", "10%"},
                                 {"MessageTimestamp", "20%"}});
    TReportClass commands = Table("OMC_IDESMARTErrorCmdData", "Commands that preceded the error", "",
                                  {{"commandId", "10%"},
                                   {"commandReg", "10%"},
                                   {"deviceControl", "10%"},
                                   {"features", "10%"},
                                   {"sectorCount", "10%"},
                                   {"LBAHigh", "9%"},
                                   {"LBAMid", "8%"},
                                   {"LBALow", "8%"},
                                   {"timestamp", "25%"}});
    commands.EnableSubTitle();
    commands.SetAssociatorsFilter("OMC_IDESMARTLogCmdData", "OMC_IDESMARTErrorCmdData", "", "");
    errors.SetAssociatedClass();
    errors.SetAssociatedClasses({commands});
    // The newest error first.
    writer.WriteTable(errors,
                      Sorted(Associated(device, "OMC_IDESMARTRecordInLog", "OMC_IDESMARTError"), "RecordID", false),
                      true, false, context);
}

// One row of a tape drive's table: the declared label and the value.
void WriteDeclaredRow(TWriter& writer, const TWriter::TInstancePtr& instance, const TWriter::TPropertyPtr& property) {
    writer.StartRow(true);
    writer.WriteDeclarationHeader(property->GetDeclaration(TCIMContext()));
    writer.WriteDriveHealthValue(instance, property);
    writer.EndRow();
}

// All properties of a tape drive but its two cleaning properties, and the
// time to clean only while the drive asks for cleaning.
void WriteTapeDrive(TWriter& writer, const TWriter::TInstancePtr& tape) {
    TCIMContext context;
    std::vector<TWriter::TPropertyPtr> properties;
    tape->EnumerateProperties(
        [&properties](TWriter::TPropertyPtr property) {
            properties.push_back(property);
            return true;
        },
        context);
    TWriter::TPropertyPtr cleanNow, timeToClean;
    writer.StartPropertyTable("100%", "40%", "Tape Drive Sense Data");
    for (const TWriter::TPropertyPtr& property : properties) {
        try {
            const std::string name = property->GetDeclaration(context)->GetName(context);
            Trace(Said("Current Property Name: " + name));
            if (name == "cleanNow") {
                cleanNow = property;
            } else if (name == "timeToClean") {
                timeToClean = property;
            } else {
                WriteDeclaredRow(writer, tape, property);
            }
        } catch (...) {
            Trace(Said("Exception When Processing Current Property"));
        }
    }
    try {
        if (cleanNow && timeToClean &&
            writer.GetPropertyValue(tape, cleanNow->GetDeclaration(context)->GetName(context), ",") == "true") {
            WriteDeclaredRow(writer, tape, timeToClean);
        }
    } catch (...) {
        Trace(Said("Exception When Process Clean Property in props2[2]"));
    }
    writer.EndTable();
}

void WriteSenseData(TWriter& writer, const TWriter::TInstancePtr& sense) {
    TCIMContext context;
    writer.StartPropertyTable("100%", "10%", "SCSI Sense Data");
    for (const char* name : {"InstanceID", "pageNumber", "rawData"}) {
        try {
            const TWriter::TPropertyPtr property = sense->GetProperty(name, context);
            writer.StartRow(true);
            writer.WriteHeaderCell(ClassOf(sense), Row(name));
            if (std::string(name) == "rawData") {
                writer.WriteDriveHealthEntry(property);
            } else {
                writer.WriteDriveHealthValue(sense, property);
            }
            writer.EndRow();
        } catch (...) {
            Trace(Said("Exception when writing SCSI Sense Data / " + std::string(name) + " "));
        }
    }
    writer.EndTable();
}

}  // namespace

void TWriter::WriteDriveHealthReport(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    Trace(Said("Entering"));
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + kLink);
    WritePageHeader();
    WriteReportTitle(kTitle, "", "");
    bool noData = true;

    TInstances devices;
    try {
        devices = InstancesOf(fNamespace, "OMC_ATADevice");
    } catch (...) {
        Trace(Said("Exception when getting class OMC_ATADevice"));
    }
    for (const TInstancePtr& device : devices) {
        noData = false;
        try {
            WriteATADevice(*this, device);
        } catch (...) {
            Trace(Said("Exception when processing ATA Device "));
        }
    }

    TInstances tapes;
    try {
        ClassNamed(fNamespace, kTapeClass);
        try {
            tapes = InstancesOf(fNamespace, kTapeClass);
        } catch (...) {
            Trace(Said(std::string("Exception When Enumerate Instance of ") + kTapeClass));
        }
    } catch (...) {
        Trace(Said(std::string("Exception when getting class ") + kTapeClass));
    }
    if (!tapes.empty()) {
        noData = false;
        WriteTableTitle("Tape Drive Sense Data", false, false);
        for (const TInstancePtr& tape : tapes) {
            try {
                WriteTapeDrive(*this, tape);
            } catch (...) {
                EndTable();
                Trace(Said("Exception when processing Tape Drive Sense Data"));
            }
        }
    }

    if (fMode == "luz") {
        Trace(Said("Under LUZ mode, write SCSI Sense Data"));
        TInstances senses;
        try {
            senses = InstancesOf(fNamespace, kSenseClass);
        } catch (...) {
            Trace(Said(std::string("Exception when getting class ") + kSenseClass));
        }
        if (!senses.empty()) {
            noData = false;
            WriteTableTitle("SCSI Sense Data", false, false);
            for (const TInstancePtr& sense : senses) WriteSenseData(*this, sense);
        }
    }

    if (noData) WriteNothingFound(*this, "No Supported IDE or Tape Drive found\n", "No Supported IDE or Tape Drive\n");
    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLink, kTitle, !noData);
    Trace(Said("Exiting"));
}

}  // namespace braigrion
