// The factory of page definitions for collections taken from ESXi hosts.
// It names the provider families of such hosts (OMC_, VMware_, IANet_,
// ELXHBA_, ...) and shares only the definition model with the base
// builder, from which it does not derive. Its one probe is IsMultiNode.
#pragma once

#include <string>

#include <boost/shared_ptr.hpp>

#include "braigrion/TReportParameters.h"
#include "tkrcore/CIMInterfaces.h"

namespace braigrion {

class TReportParametersBuilder_vmwesxi {
public:
    typedef boost::shared_ptr<NORVTKR20::ICIMNamespace> TNamespacePtr;

    TReportParametersBuilder_vmwesxi(TNamespacePtr ns, std::string mode);

    // The class from the namespace (first collection of a view). Throws
    // what the namespace throws; status 15 when the class is absent.
    boost::shared_ptr<NORVTKR20::ICIMClass> GetClass(const std::string& name) const;
    // Whether the chassis reports two or more nodes ("IpmiNodeCount" of the
    // first OMC_Chassis, its low byte). No chassis, no count: false.
    bool IsMultiNode() const;

    TNamespacePtr GetNamespace() const { return fNamespace; }
    std::string GetMode() const { return fMode; }

    // --- software pages (CatalogueSoftware_vmwesxi.cpp) ---
    TReportParameters BuildSystemOverviewParams() const;
    TReportParameters BuildInstalledAppsParams() const;
    TReportParameters BuildKernelModuleParams() const;
    TReportParameters BuildNetworkingParams() const;
    TReportParameters BuildResourceUtilizationParams() const;
    TReportParameters BuildProcessesParams() const;
    TReportParameters BuildOSConfigParams() const;
    TReportParameters BuildSysConfigParams() const;
    TReportParameters BuildMergedLogParams() const;
    TReportParameters BuildMergedDevicesParams() const;
    TReportParameters BuildPBParams() const;
    TReportParameters BuildIPMIEventParams() const;
    TReportParameters BuildChassisEventLogParams() const;
    TReportParameters BuildVMwarePrivilegeLogParams() const;
    TReportParameters BuildTKRLogParams() const;
    TReportParameters BuildHealthStatusParams() const;
    TReportParameters BuildRegisteredProfileParams() const;

    // --- hardware pages (CatalogueHardware_vmwesxi.cpp) ---
    TReportParameters BuildHardwareInventoryParams() const;
    TReportParameters BuildHardwareInventoryMemorySlotsParams() const;
    TReportParameters BuildHardwareInventoryCPUSlotsParams() const;
    TReportParameters BuildPCIInfoParams() const;
    TReportParameters BuildFirmwareParams() const;
    TReportParameters BuildKMCConfigurationParams() const;
    TReportParameters BuildEnvironmentalsParams() const;
    TReportParameters BuildDriveHealthParams() const;
    TReportParameters BuildLsiControllerParams() const;
    TReportParameters BuildLSIIDEParams() const;
    TReportParameters BuildPMCRAIDParams() const;
    TReportParameters BuildHalcyonParams() const;
    TReportParameters BuildHalcyonLogsParams() const;
    TReportParameters BuildQlogicParams() const;
    TReportParameters BuildEmulexParams() const;
    TReportParameters BuildBroadcomParams() const;
    TReportParameters BuildBrocadeAdapterParams() const;
    TReportParameters BuildGlowTraceParams() const;
    TReportParameters BuildKMCBuiltinSelfTestParams() const;

private:
    TNamespacePtr fNamespace;
    std::string fMode;
};

}  // namespace braigrion
