// Generators of the software pages: system overview, operating system
// installation and configuration, network, resources and processes.
//
// A call of NotYetGenerated stands for one page whose definition is not part
// of the library yet; the comment beside it names the call that replaces it.
#include "braigrion/ReportDefinition.h"
#include "braigrion/TWriter.h"
#include "GeneratorSupport.h"

namespace braigrion {

using namespace generators;

namespace {

bool IsWindows(int osType) {
    return osType == TReportParametersBuilder::kOSWindows || osType == TReportParametersBuilder::kOSWindowsServer;
}

bool IsLinux(int osType) {
    return osType == TReportParametersBuilder::kOSLinux || osType == TReportParametersBuilder::kOSVMwareESX;
}

}  // namespace

void TWriter::Generator_SystemOverview(TBuilderPtr /*builder*/, std::string pageID) {
    WriteOrCompare(
        "TWriter::Generator_SystemOverview", fProviderType == kDeltaProviderType,
        [&] { NotYetGenerated(pageID); },   // WriteGenericReport(builder->BuildSystemConfigParams())
        [&] { NotYetGenerated(pageID); });  // WriteGenericDeltaReport(builder->BuildSystemConfigParams())
}

// The critical details exist for the inventory back-end only.
void TWriter::Generator_CriticalDetails(TBuilderPtr /*builder*/, std::string pageID) {
    const std::string name = "TWriter::Generator_CriticalDetails";
    Trace(name + kEntering);
    if (fWriterType == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_INVENTORY) {
        if (fProviderType == kDeltaProviderType) {
            Trace(name + kDeltaDoNothing);
        } else {
            NotYetGenerated(pageID);  // WriteGenericReport(builder->BuildCriticalDetailsParams())
        }
    }
    Trace(name + kExiting);
}

// Installed software, and by operating system its components and fixes,
// drivers and services, or its packages and kernel modules. In delta mode
// each page is compared (WriteGenericDeltaReport) instead of written.
void TWriter::Generator_OSInstallation(TBuilderPtr /*builder*/, std::string pageID) {
    const std::string name = "TWriter::Generator_OSInstallation";
    Trace(name + kEntering);
    if (fPreboot) {
        Trace(name + " -- Under pTKR, no OS installation information needed");
    } else {
        if (fProviderType == kDeltaProviderType) Trace(name + kDeltaDoComparison);
        NotYetGenerated(pageID);  // builder->BuildInstalledAppsParams()
        if (IsWindows(fOSType)) {
            NotYetGenerated(pageID);  // builder->BuildWindowsComponentsParams()
            NotYetGenerated(pageID);  // builder->BuildInstalledFixesParams()
            NotYetGenerated(pageID);  // builder->BuildDeviceDriverParams()
            NotYetGenerated(pageID);  // builder->BuildSystemServiceParams()
        } else if (IsLinux(fOSType)) {
            NotYetGenerated(pageID);  // builder->BuildInstalledRPMParams()
            NotYetGenerated(pageID);  // builder->BuildKernelModuleParams()
        }
    }
    Trace(name + kExiting);
}

// builder->HasTeamInfo() chooses BuildNetworkWithTeamingParams or
// BuildNetworkWithoutTeamingParams.
void TWriter::Generator_NetworkSettings(TBuilderPtr /*builder*/, std::string pageID) {
    WriteOrCompare(
        "TWriter::Generator_NetworkSettings", fProviderType == kDeltaProviderType,
        [&] { NotYetGenerated(pageID); },   // WriteGenericReport(params)
        [&] { NotYetGenerated(pageID); });  // WriteGenericDeltaReport(params)
}

void TWriter::Generator_ResourceUtilization(TBuilderPtr /*builder*/, std::string pageID) {
    const std::string name = "TWriter::Generator_ResourceUtilization";
    if (fPreboot) {
        Trace(name + kEntering);
        Trace(name + " -- Under pTKR, no Resource Utilization information needed");
        Trace(name + kExiting);
        return;
    }
    WriteOrCompare(
        name, fProviderType == kDeltaProviderType,
        [&] { NotYetGenerated(pageID); },   // WriteGenericReport(builder->BuildResourceUtilizationParams())
        [&] { NotYetGenerated(pageID); });  // WriteGenericDeltaReport(builder->BuildResourceUtilizationParams())
}

void TWriter::Generator_Processes(TBuilderPtr /*builder*/, std::string pageID) {
    const std::string name = "TWriter::Generator_Processes";
    if (fPreboot) {
        Trace(name + kEntering);
        Trace(name + " -- Under pTKR, no Process information needed");
        Trace(name + kExiting);
        return;
    }
    WriteOrCompare(
        name, fProviderType == kDeltaProviderType,
        [&] { NotYetGenerated(pageID); },   // WriteGenericReport(builder->BuildProcessesParams())
        [&] { NotYetGenerated(pageID); });  // WriteGenericDeltaReport(builder->BuildProcessesParams())
}

// The configuration of the operating system (not for pre-boot data), and on
// Linux its configuration files. In delta mode both are compared.
void TWriter::Generator_OSConfiguration(TBuilderPtr /*builder*/, std::string pageID) {
    const std::string name = "TWriter::Generator_OSConfiguration";
    const bool delta = fProviderType == kDeltaProviderType;
    Trace(name + kEntering);
    if (!fPreboot) {
        if (delta) {
            Trace(name + kDeltaDoComparison);
            NotYetGenerated(pageID);  // WriteGenericDeltaReport(builder->BuildOSConfigParams())
        } else {
            NotYetGenerated(pageID);  // WriteGenericReport(builder->BuildOSConfigParams())
        }
    }
    if (IsLinux(fOSType)) {
        Trace(name + " -- Under Linux, write Linux Config Files");
        if (delta) {
            Trace(name + kDeltaDoComparison);
            NotYetGenerated(pageID);  // WriteGenericDeltaReport(builder->BuildSysConfigParams())
        } else {
            NotYetGenerated(pageID);  // WriteGenericReport(builder->BuildSysConfigParams())
        }
    }
    Trace(name + kExiting);
}

}  // namespace braigrion
