// Generators of the software pages: system overview, operating system
// installation and configuration, network, resources and processes.
//
// Outside delta mode each page is declared by the builder and written by the
// generic page writer. In delta mode the same definition is compared across
// the collections of the view instead (WriteGenericDeltaReport).
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

void TWriter::Generator_SystemOverview(TBuilderPtr builder, std::string /*pageID*/) {
    WriteOrCompare(
        "TWriter::Generator_SystemOverview", fProviderType == kDeltaProviderType,
        [&] { WriteGenericReport(builder->BuildSystemConfigParams()); },
        [&] { WriteGenericDeltaReport(builder->BuildSystemConfigParams()); });
}

// The critical details exist for the inventory back-end only.
void TWriter::Generator_CriticalDetails(TBuilderPtr builder, std::string /*pageID*/) {
    const std::string name = "TWriter::Generator_CriticalDetails";
    Trace(name + kEntering);
    if (fWriterType == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_INVENTORY) {
        if (fProviderType == kDeltaProviderType) {
            Trace(name + kDeltaDoNothing);
        } else {
            WriteGenericReport(builder->BuildCriticalDetailsParams());
        }
    }
    Trace(name + kExiting);
}

// Installed software, and by operating system its components and fixes,
// drivers and services, or its packages and kernel modules. In delta mode
// each page is compared instead of written.
void TWriter::Generator_OSInstallation(TBuilderPtr builder, std::string /*pageID*/) {
    const std::string name = "TWriter::Generator_OSInstallation";
    const bool delta = fProviderType == kDeltaProviderType;
    typedef TReportParameters (TReportParametersBuilder::*TBuild)() const;
    // One page of the installation: written, or in delta mode compared.
    auto page = [&](TBuild build) {
        if (delta) {
            WriteGenericDeltaReport((builder.get()->*build)());
        } else {
            WriteGenericReport((builder.get()->*build)());
        }
    };
    Trace(name + kEntering);
    if (fPreboot) {
        Trace(name + " -- Under pTKR, no OS installation information needed");
    } else {
        if (delta) Trace(name + kDeltaDoComparison);
        page(&TReportParametersBuilder::BuildInstalledAppsParams);
        if (IsWindows(fOSType)) {
            page(&TReportParametersBuilder::BuildWindowsComponentsParams);
            page(&TReportParametersBuilder::BuildInstalledFixesParams);
            page(&TReportParametersBuilder::BuildDeviceDriverParams);
            page(&TReportParametersBuilder::BuildSystemServiceParams);
        } else if (IsLinux(fOSType)) {
            page(&TReportParametersBuilder::BuildInstalledRPMParams);
            page(&TReportParametersBuilder::BuildKernelModuleParams);
        }
    }
    Trace(name + kExiting);
}

// The network page has one link and two definitions: with the team tables
// when some port belongs to a team, without them otherwise.
void TWriter::Generator_NetworkSettings(TBuilderPtr builder, std::string /*pageID*/) {
    WriteOrCompare(
        "TWriter::Generator_NetworkSettings", fProviderType == kDeltaProviderType,
        [&] {
            WriteGenericReport(builder->HasTeamInfo() ? builder->BuildNetworkWithTeamingParams()
                                                      : builder->BuildNetworkWithoutTeamingParams());
        },
        [&] {
            WriteGenericDeltaReport(builder->HasTeamInfo() ? builder->BuildNetworkWithTeamingParams()
                                                           : builder->BuildNetworkWithoutTeamingParams());
        });
}

void TWriter::Generator_ResourceUtilization(TBuilderPtr builder, std::string /*pageID*/) {
    const std::string name = "TWriter::Generator_ResourceUtilization";
    if (fPreboot) {
        Trace(name + kEntering);
        Trace(name + " -- Under pTKR, no Resource Utilization information needed");
        Trace(name + kExiting);
        return;
    }
    WriteOrCompare(
        name, fProviderType == kDeltaProviderType,
        [&] { WriteGenericReport(builder->BuildResourceUtilizationParams()); },
        [&] { WriteGenericDeltaReport(builder->BuildResourceUtilizationParams()); });
}

void TWriter::Generator_Processes(TBuilderPtr builder, std::string /*pageID*/) {
    const std::string name = "TWriter::Generator_Processes";
    if (fPreboot) {
        Trace(name + kEntering);
        Trace(name + " -- Under pTKR, no Process information needed");
        Trace(name + kExiting);
        return;
    }
    WriteOrCompare(
        name, fProviderType == kDeltaProviderType,
        [&] { WriteGenericReport(builder->BuildProcessesParams()); },
        [&] { WriteGenericDeltaReport(builder->BuildProcessesParams()); });
}

// The configuration of the operating system (not for pre-boot data), and on
// Linux, pre-boot data included, its configuration files. A VMware host has
// no such files page. In delta mode both are compared.
void TWriter::Generator_OSConfiguration(TBuilderPtr builder, std::string /*pageID*/) {
    const std::string name = "TWriter::Generator_OSConfiguration";
    const bool delta = fProviderType == kDeltaProviderType;
    Trace(name + kEntering);
    if (!fPreboot) {
        if (delta) {
            Trace(name + kDeltaDoComparison);
            WriteGenericDeltaReport(builder->BuildOSConfigParams());
        } else {
            WriteGenericReport(builder->BuildOSConfigParams());
        }
    }
    // Linux here, as everywhere an OS type decides, is 2 or 3: a VMware ESX
    // service console is a Linux system with the same configuration files.
    if (fOSType == TReportParametersBuilder::kOSLinux || fOSType == TReportParametersBuilder::kOSVMwareESX) {
        Trace(name + " -- Under Linux, write Linux Config Files");
        if (delta) {
            Trace(name + kDeltaDoComparison);
            WriteGenericDeltaReport(builder->BuildSysConfigParams());
        } else {
            WriteGenericReport(builder->BuildSysConfigParams());
        }
    }
    Trace(name + kExiting);
}

}  // namespace braigrion
