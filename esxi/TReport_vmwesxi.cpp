#include "TReport_vmwesxi.h"

#include <vector>

#include "TReportParametersBuilder_vmwesxi.h"
#include "TWriter_vmwesxi.h"
#include "braigrion/Trace.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMInstance;
using NORVTKR20::TCIMContext;
using NORVTKR20::TTKRException;

TReport_vmwesxi::TReport_vmwesxi(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, TContext context,
                                 std::string outputPath)
    : fNamespace(ns), fOutputPath(outputPath), fMode("default") {
    TContext::const_iterator mode = context.find("mode");
    if (mode != context.end()) fMode = static_cast<std::string>(mode->second);
}

void TReport_vmwesxi::Write(TWriter_vmwesxi* writer, TContext context) {
    Trace("TWriter_vmwesxi::Write -- Entering ");
    if (writer == nullptr) {
        Log(0, "TReport_vmwesxi::Write -- Null-Pointor exception: Parameter (TWriter_vmwesxi *writer == NULL)");
        return;
    }
    try {
        TReportParametersBuilder_vmwesxi builder(fNamespace, fMode);
        writer->Initialize(fNamespace, context, fOutputPath);

        writer->WriteCategory("Software");
        writer->WriteCustomSystemOverview(builder.BuildSystemOverviewParams());
        writer->WriteInstalledApps(builder.BuildInstalledAppsParams());
        writer->WriteKernelModules(builder.BuildKernelModuleParams());
        writer->WriteNetworking(builder.BuildNetworkingParams());
        writer->WriteResourceUtilization(builder.BuildResourceUtilizationParams());
        writer->WriteProcesses(builder.BuildProcessesParams());
        writer->WriteOSConfig(builder.BuildOSConfigParams());
        writer->WriteSysConfig(builder.BuildSysConfigParams());

        writer->EndCategory();
        writer->WriteCategory("Hardware");
        writer->WriteCustomHardwareInventoryReport(builder);
        writer->WritePCIInfo(builder.BuildPCIInfoParams());
        writer->WriteCustomFirmwareReport(builder);
        writer->WriteKMCConfigReport(builder);
        writer->WriteEnvironmentalsPreferred(builder);
        writer->WriteDriveHealth(builder.BuildDriveHealthParams());
        writer->WriteLSIReportWithCardinal();
        writer->WriteLSIIDE(builder.BuildLSIIDEParams());
        writer->WritePMCRAID(builder.BuildPMCRAIDParams());
        writer->WriteHalcyon(builder.BuildHalcyonParams());
        writer->WriteHalcyonLogs(builder.BuildHalcyonLogsParams());
        writer->WriteQlogic(builder.BuildQlogicParams());
        writer->WriteEmulex(builder.BuildEmulexParams());
        writer->WriteBroadcom(builder.BuildBroadcomParams());
        writer->WriteBrocadeAdapter(builder.BuildBrocadeAdapterParams());
        writer->WriteGlowTrace(builder.BuildGlowTraceParams());
        writer->WriteKMCBuiltinSelfTest(builder.BuildKMCBuiltinSelfTestParams());

        writer->EndCategory();
        writer->WriteCategory("KMC Logs");
        writer->WriteChassisEventLog(builder.BuildChassisEventLogParams());
        writer->WriteIPMIEvent(builder.BuildIPMIEventParams());

        writer->EndCategory();
        writer->WriteCategory("Analysis");
        writer->WriteMergedLog(builder.BuildMergedLogParams());
        writer->WriteMergedDevices(builder.BuildMergedDevicesParams());
        writer->WritePBReport(builder.BuildPBParams());

        writer->EndCategory();
        writer->WriteCategory("Log");
        writer->WriteLogPage(builder.BuildVMwarePrivilegeLogParams());

        // The error log stands after the last category, in none of its own.
        writer->EndCategory();
        writer->WriteLogPage(builder.BuildTKRLogParams());

        writer->EndReport();
    } catch (...) {
        Trace("TWriter_vmwesxi::Write -- Exception when generating TKR HTML report for ESXi");
    }
    Trace("TWriter_vmwesxi::Write -- Exiting ");
}

bool TReport_vmwesxi::IsESXiCollection(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns) {
    // Whether the class exists and holds at least one instance.
    auto populated = [&ns](const char* name) {
        try {
            TCIMContext context;
            bool found = false;
            ns->GetClass(name, context)->EnumerateInstances(
                [&found](boost::shared_ptr<ICIMInstance>) {
                    found = true;
                    return false;
                },
                true, context);
            return found;
        } catch (const TTKRException&) {
            return false;
        }
    };
    if (!ns || populated("ORVSG_OperatingSystem")) return false;
    return populated("OMC_UnitaryComputerSystem") || populated("VMware_HypervisorSoftwareIdentity") ||
           populated("OMC_Chassis");
}

}  // namespace braigrion
