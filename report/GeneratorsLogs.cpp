// Generators of the log and analysis pages: operating system and service
// processor logs, the pages of the tool's own service mode, merged logs and
// devices, patches, file loads, diagnostics and the tool's error log.
#include "braigrion/ReportDefinition.h"
#include "braigrion/TWriter.h"
#include "GeneratorSupport.h"

namespace braigrion {

using namespace generators;

namespace {

const char kLuzMode[] = "luz";

}  // namespace

void TWriter::Generator_OSLogs(TBuilderPtr builder, std::string pageID) {
    const std::string name = "TWriter::Generator_OSLogs";
    Trace(name + kEntering);
    if (fPreboot) {
        Trace(name + " -- Under pTKR, no OS Logs Information needed");
    } else if (fProviderType == kDeltaProviderType) {
        Trace(name + kDeltaDoNothing);
    } else if (fOSType == TReportParametersBuilder::kOSWindows ||
               fOSType == TReportParametersBuilder::kOSWindowsServer) {
        WriteWindowsEventReport(builder, pageID);
    } else if (fOSType == TReportParametersBuilder::kOSLinux || fOSType == TReportParametersBuilder::kOSVMwareESX) {
        WriteLinuxLogReport(builder, pageID);
    } else {
        Trace(name + " -- Unkown OS Type");
    }
    Trace(name + kExiting);
}

// The service processor's logs. The system inventory of pre-boot data
// shows them in every mode, delta included.
void TWriter::Generator_ServProcEvent(TBuilderPtr builder, std::string pageID) {
    const std::string name = "TWriter::Generator_ServProcEvent";
    Trace(name + kEntering);
    if (fPreboot && fWriterType == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_INVENTORY) {
        Trace(name + " -- Under pTKR GUI System Inventory mode");
        if (!fKMC) {
            WriteGenericReport(builder->BuildDLMLogParams());
            WriteGenericReport(builder->BuildZEPHLogParams());
            WriteIPMIReport(builder->BuildIPMILogParams());
            WriteGenericReport(builder->BuildMergeLogParams());
        } else {
            WriteGenericReport(builder->BuildIPMILogKMCParams());
            WriteCustomChassisEventLog(builder, pageID);
        }
    } else if (fProviderType == kDeltaProviderType) {
        Trace(name + kDeltaDoNothing);
    } else if (!fKMC) {
        WriteGenericReport(builder->BuildDLMLogParams());
        WriteGenericReport(builder->BuildZEPHLogParams());
        WriteCustomChassisEventLog(builder, pageID);
    } else {
        WriteIPMIReport(builder->BuildIPMILogParams());
    }
    Trace(name + kExiting);
}

// The pages of the service mode exist in LUZ mode only.

void TWriter::Generator_QVAChipsetRegister(TBuilderPtr builder, std::string pageID) {
    const std::string name = "TWriter::Generator_QVAChipsetRegister";
    Trace(name + kEntering);
    if (fMode == kLuzMode) {
        if (fProviderType == kDeltaProviderType) {
            Trace(name + kDeltaDoNothing);
        } else {
            WriteQVARegisterReport(builder, pageID);
        }
    }
    Trace(name + kExiting);
}

void TWriter::Generator_CFTSetting(TBuilderPtr builder, std::string pageID) {
    const std::string name = "TWriter::Generator_CFTSetting";
    Trace(name + kEntering);
    if (fMode == kLuzMode) {
        if (fProviderType == kDeltaProviderType) {
            Trace(name + kDeltaDoNothing);
        } else {
            WriteCFTSettingReport(builder, pageID);
        }
    }
    Trace(name + kExiting);
}

void TWriter::Generator_NVSMILog(TBuilderPtr builder, std::string pageID) {
    const std::string name = "TWriter::Generator_NVSMILog";
    Trace(name + kEntering);
    if (fMode == kLuzMode) {
        if (fProviderType == kDeltaProviderType) {
            // This generator's delta line names the settings page, as it always has.
            Trace(std::string("TWriter::Generator_CFTSetting") + kDeltaDoNothing);
        } else {
            WriteNVSMILogReport(builder, pageID);
        }
    }
    Trace(name + kExiting);
}

void TWriter::Generator_AMDAticonfigLog(TBuilderPtr builder, std::string pageID) {
    const std::string name = "TWriter::Generator_AMDAticonfigLog";
    Trace(name + kEntering);
    if (fMode == kLuzMode) {
        if (fProviderType == kDeltaProviderType) {
            Trace(name + kDeltaDoNothing);
        } else {
            WriteAMDAticonfigLogReport(builder, pageID);
        }
    }
    Trace(name + kExiting);
}

void TWriter::Generator_SPINTLog(TBuilderPtr builder, std::string /*pageID*/) {
    const std::string name = "TWriter::Generator_SPINTLog";
    Trace(name + kEntering);
    if (fMode == kLuzMode) {
        if (fProviderType == kDeltaProviderType) {
            Trace(name + kDeltaDoNothing);
        } else {
            WriteGenericReport(builder->BuildSPINTParams());
        }
    }
    Trace(name + kExiting);
}

void TWriter::Generator_MergedLog(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_MergedLog", fProviderType == kDeltaProviderType,
                     [&] { WriteMergedLogReport(builder, pageID); });
}

// Also the analysis page of the inventory. A Red Hat system gets no merged
// device page.
void TWriter::Generator_MergedDevice(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_MergedDevice", fProviderType == kDeltaProviderType, [&] {
        if (builder->IsRedHat()) {
            Trace("TWriter::Generator_MergedDevice -- Do not write Merged Devices under RedHat platform");
        } else {
            WriteMergedDevicesReport(builder, pageID);
        }
    });
}

void TWriter::Generator_Melody(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_Melody", fProviderType == kDeltaProviderType,
                     [&] { WriteMelodyReport(builder, pageID); });
}

void TWriter::Generator_PatchBeacon(TBuilderPtr builder, std::string /*pageID*/) {
    WriteUnlessDelta("TWriter::Generator_PatchBeacon", fProviderType == kDeltaProviderType,
                     [&] { WriteGenericReport(builder->BuildPBParams()); });
}

void TWriter::Generator_FileLoader(TBuilderPtr builder, std::string /*pageID*/) {
    WriteUnlessDelta("TWriter::Generator_FileLoader", fProviderType == kDeltaProviderType,
                     [&] { WriteGenericReport(builder->BuildFileLoaderParams()); });
}

void TWriter::Generator_DiagnosticLog(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_DiagnosticLog", fProviderType == kDeltaProviderType,
                     [&] { WriteCustomDiagnosticLog(builder, pageID); });
}

void TWriter::Generator_TKRErrorLog(TBuilderPtr builder, std::string /*pageID*/) {
    WriteUnlessDelta("TWriter::Generator_TKRErrorLog", fProviderType == kDeltaProviderType,
                     [&] { WriteGenericReport(builder->BuildTKRLogParams()); });
}

}  // namespace braigrion
