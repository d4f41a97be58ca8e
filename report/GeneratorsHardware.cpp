// Generators of the hardware pages: inventory, PCI, firmware, service
// processor, sensors, storage controllers and adapters.
#include <cctype>
#include <cstdlib>

#include "braigrion/ReportDefinition.h"
#include "braigrion/TWriter.h"
#include "GeneratorSupport.h"

namespace braigrion {

using namespace generators;

void TWriter::Generator_HardwareInventory(TBuilderPtr builder, std::string /*pageID*/) {
    WriteOrCompare(
        "TWriter::Generator_HardwareInventory", fProviderType == kDeltaProviderType,
        [&] { WriteGenericReport(builder->BuildHardwareInfoParams()); },
        [&] { WriteGenericDeltaReport(builder->BuildHardwareInfoParams()); });
}

// In LUZ mode an HTML report has a raw-data page beside the PCI page, and
// the PCI page links to it.
void TWriter::Generator_PCIInformation(TBuilderPtr builder, std::string /*pageID*/) {
    const bool withRawData = fMode == "luz" && fWriterType == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_HTML;
    WriteOrCompare(
        "TWriter::Generator_PCIInformation", fProviderType == kDeltaProviderType,
        [&] {
            TReportParameters params = builder->BuildPCIInfoParams();
            if (withRawData) {
                // The raw page is written and closed first; without one the
                // link is "" and the PCI page has no switch.
                const std::string link =
                    WriteRawDataFirst("TWriter::Generator_PCIInformation", "TWriter::WritePCIRawDataReport",
                                      [&] { return WritePCIRawDataReport(params.GetLinkName()); });
                WriteGenericReportWithLink(params, link);
            } else {
                WriteGenericReport(params);
            }
        },
        [&] { WriteGenericDeltaReport(builder->BuildPCIInfoParams()); });
}

void TWriter::Generator_FirmwareVPD(TBuilderPtr builder, std::string pageID) {
    WriteOrCompare(
        "TWriter::Generator_FirmwareVPD", fProviderType == kDeltaProviderType,
        [&] { WriteCustomFirmwareReport(builder, pageID); },
        [&] { WriteGenericDeltaReport(builder->BuildFirmwareParams()); });
}

void TWriter::Generator_ServProcConfiguration(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_ServProcConfiguration", fProviderType == kDeltaProviderType, [&] {
        if (fKMC) {
            WriteKMCConfigReport(builder, pageID);
        } else {
            WriteGenericReport(builder->BuildServProcConfigParams());
        }
    });
}

void TWriter::Generator_Environmentals(TBuilderPtr builder, std::string pageID) {
    const std::string name = "TWriter::Generator_Environmentals";
    Trace(name + kEntering);
    if (fProviderType == kDeltaProviderType) {
        Trace(name + " -- Under DELTA mode [Do nothing]");
    } else {
        WriteEnvironmentalsReport(builder, pageID);
    }
    Trace(name + kExiting);
}

void TWriter::Generator_DriveHealth(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_DriveHealth", fProviderType == kDeltaProviderType,
                     [&] { WriteDriveHealthReport(builder, pageID); });
}

void TWriter::Generator_LSIController(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_LSIController", fProviderType == kDeltaProviderType,
                     [&] { WriteLSIReport(builder, pageID); });
}

void TWriter::Generator_LSIIDEController(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_LSIIDEController", fProviderType == kDeltaProviderType,
                     [&] { WriteLSIIDEReport(builder, pageID); });
}

void TWriter::Generator_Mellanox(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_Mellanox", fProviderType == kDeltaProviderType,
                     [&] { WriteMellanoxReport(builder, pageID); });
}

void TWriter::Generator_Solarflare(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_Solarflare", fProviderType == kDeltaProviderType,
                     [&] { WriteSolarflareReport(builder, pageID); });
}

void TWriter::Generator_FusionIO(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_FusionIO", fProviderType == kDeltaProviderType,
                     [&] { WriteFusionIOReport(builder, pageID); });
}

void TWriter::Generator_PMCRAID(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_PMCRAID", fProviderType == kDeltaProviderType,
                     [&] { WritePMCReport(builder, pageID); });
}

void TWriter::Generator_Halcyon(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_Halcyon", fProviderType == kDeltaProviderType,
                     [&] { WriteHalcyonReport(builder, pageID); });
}

void TWriter::Generator_HalcyonLogs(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_HalcyonLogs", fProviderType == kDeltaProviderType,
                     [&] { WriteHalcyonLogsReport(builder, pageID); });
}

void TWriter::Generator_QLogic(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_QLogic", fProviderType == kDeltaProviderType,
                     [&] { WriteQLogicReport(builder, pageID); });
}

void TWriter::Generator_Emulex(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_Emulex", fProviderType == kDeltaProviderType,
                     [&] { WriteEmulexReport(builder, pageID); });
}

void TWriter::Generator_Broadcom(TBuilderPtr builder, std::string /*pageID*/) {
    WriteUnlessDelta("TWriter::Generator_Broadcom", fProviderType == kDeltaProviderType,
                     [&] { WriteGenericReport(builder->BuildBroadcomParams()); });
}

void TWriter::Generator_BrocadeAdapter(TBuilderPtr builder, std::string pageID) {
    WriteUnlessDelta("TWriter::Generator_BrocadeAdapter", fProviderType == kDeltaProviderType,
                     [&] { WriteBrocadeReport(builder, pageID); });
}

void TWriter::Generator_VMwareESXi(TBuilderPtr builder, std::string /*pageID*/) {
    WriteUnlessDelta("TWriter::Generator_VMwareESXi", fProviderType == kDeltaProviderType,
                     [&] { WriteGenericReport(builder->BuildVmware3iParams()); });
}

void TWriter::Generator_GlowTrace(TBuilderPtr builder, std::string /*pageID*/) {
    WriteUnlessDelta("TWriter::Generator_GlowTrace", fProviderType == kDeltaProviderType,
                     [&] { WriteGenericReport(builder->BuildGlowTraceParams()); });
}

void TWriter::Generator_SelfBIST(TBuilderPtr builder, std::string /*pageID*/) {
    WriteUnlessDelta("TWriter::Generator_SelfBIST", fProviderType == kDeltaProviderType,
                     [&] { WriteGenericReport(builder->BuildBISTParams()); });
}

void TWriter::Generator_KMCLicenseKey(TBuilderPtr builder, std::string /*pageID*/) {
    const std::string name = "TWriter::Generator_KMCLicenseKey";
    if (!fKMC) {
        Trace(name + kEntering);
        Trace(name + " -- Under Non-KMC system, No KMC License Key");
        Trace(name + kExiting);
        return;
    }
    WriteUnlessDelta(name, fProviderType == kDeltaProviderType,
                     [&] { WriteGenericReport(builder->BuildKMCLicenseKeyParams()); });
}

// The BIOS settings page exists only when its collector was switched on
// through the environment: TKR_BIOSPROVIDER reads "yes" in any case.
void TWriter::Generator_BIOSSettings(TBuilderPtr builder, std::string pageID) {
    const std::string name = "TWriter::Generator_BIOSSettings";
    Trace(name + kEntering);
    if (fProviderType == kDeltaProviderType) {
        Trace(name + " -- Uder DELTA mode [Do Nothing]");
    } else if (const char* provider = std::getenv("TKR_BIOSPROVIDER")) {
        std::string value(provider);
        for (char& c : value) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
        if (value == "yes") WriteBIOSEnumeration(builder, pageID);
    }
    Trace(name + kExiting);
}

void TWriter::Generator_VCX(TBuilderPtr builder, std::string pageID) {
    const std::string name = "TWriter::Generator_VCX";
    Trace(name + kEntering);
    if (fProviderType == kDeltaProviderType) {
        Trace(name + " -- Under DELTA mode [Do Nothing, Not Support]");
    } else {
        WriteVCXReport(builder, pageID);
    }
    Trace(name + kExiting);
}

// Declared for a page that no report asks for; it writes nothing.
void TWriter::Generator_Diablo(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    WriteUnlessDelta("TWriter::Generator_Diablo", fProviderType == kDeltaProviderType, [] {});
}

}  // namespace braigrion
