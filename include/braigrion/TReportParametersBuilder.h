// The factory of page definitions and the answerer of questions about the
// collected data: is this a delta view, a pre-boot collection, which
// operating system. No answer is cached: every probe reads the repository
// again, so a probe asked after the data were mended sees the mended data.
#pragma once

#include <string>

#include <boost/shared_ptr.hpp>

#include "braigrion/TReportParameters.h"
#include "tkrcore/CIMInterfaces.h"

namespace braigrion {

class TReportParametersBuilder {
public:
    // Operating system families, as GetOSType answers them.
    enum EOSType {
        kOSWindows = 0,         // Windows, CIM OSType at most 73
        kOSWindowsServer = 1,   // Windows, CIM OSType above 73
        kOSLinux = 2,
        kOSVMwareESX = 3,
        kOSUnknown = 4
    };

    TReportParametersBuilder(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, std::string mode, bool kmc);

    // The flag given to the constructor.
    bool IsKMC() const { return fKMC; }
    // The namespace is a delta view over several collections.
    bool IsDelta() const;
    // The data come from the pre-boot edition; never for a delta view.
    bool IsPreboot() const;
    int GetOSType() const;
    // The class by name, asked for in the first collection of a view.
    // Throws what the namespace throws (status 15 for an absent class).
    boost::shared_ptr<NORVTKR20::ICIMClass> GetClass(std::string name) const;

    // Probes of the collected data. A class that is absent answers false.
    // The data source version as major "." first digit of minor; a pre-boot
    // collection counts as at least 3. Callers compare it as text.
    std::string GetDataSourceVersion() const;
    bool IsLookout() const;        // the service processor reports a lookout
    bool IsMultiNode() const;      // the computer system has two nodes or more
    bool HasTeamInfo() const;      // some physical port belongs to a NIC team
    bool IsSupportKMCKey() const;  // a hardware activation key is installed
    bool IsRedHat() const;         // the one operating system is Red Hat's

    // Software pages.
    TReportParameters BuildSystemConfigParams() const;
    TReportParameters BuildOSConfigParams() const;
    TReportParameters BuildSysConfigParams() const;
    TReportParameters BuildInstalledAppsParams() const;
    TReportParameters BuildInstalledFixesParams() const;
    TReportParameters BuildInstalledRPMParams() const;
    TReportParameters BuildWindowsComponentsParams() const;
    TReportParameters BuildSystemServiceParams() const;
    TReportParameters BuildDeviceDriverParams() const;
    TReportParameters BuildKernelModuleParams() const;
    TReportParameters BuildProcessesParams() const;
    TReportParameters BuildResourceUtilizationParams() const;
    TReportParameters BuildVmware3iParams() const;
    TReportParameters BuildPBParams() const;

    // Network pages: one link, chosen by HasTeamInfo.
    TReportParameters BuildNetworkWithTeamingParams() const;
    TReportParameters BuildNetworkWithoutTeamingParams() const;

    // Hardware pages.
    TReportParameters BuildHardwareInfoParams() const;
    TReportParameters BuildPCIInfoParams() const;
    TReportParameters BuildFirmwareParams() const;

    // Service processor pages.
    TReportParameters BuildServProcConfigParams() const;
    TReportParameters BuildBISTParams() const;
    TReportParameters BuildGlowTraceParams() const;
    TReportParameters BuildKMCLicenseKeyParams() const;
    // Log pages. The IPMI page's name tells a BMC read over the LAN; in LUZ
    // mode the IPMI pages add the parser's output and the raw records.
    TReportParameters BuildTKRLogParams() const;
    TReportParameters BuildMergeLogParams() const;
    TReportParameters BuildWinSysEventParams() const;
    TReportParameters BuildWinSecEventParams() const;
    TReportParameters BuildWinAppEventParams() const;
    TReportParameters BuildCELLogParams() const;
    TReportParameters BuildZEPHLogParams() const;
    TReportParameters BuildDLMLogParams() const;
    TReportParameters BuildIPMILogParams() const;
    TReportParameters BuildIPMILogKMCParams() const;
    TReportParameters BuildCriticalDetailsParams() const;
    TReportParameters BuildDiagsParams() const;
    TReportParameters BuildSPINTParams() const;
    TReportParameters BuildFileLoaderParams() const;
    // Adapter pages of outside vendors.
    TReportParameters BuildBroadcomParams() const;
    TReportParameters BuildQlogicParams() const;
    TReportParameters BuildEmulexParams() const;
    TReportParameters BuildBrocadeParams() const;

private:
    // The operating system as read from the one instance of the OS class;
    // kOSUnknown when there is not exactly one.
    int OSTypeFromOperatingSystem() const;
    // Windows event log records are proof of a Windows collection.
    bool HasWindowsEventRecords() const;

    boost::shared_ptr<NORVTKR20::ICIMNamespace> fNamespace;
    std::string fMode;
    bool fKMC;
};

}  // namespace braigrion
