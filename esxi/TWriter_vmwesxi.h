// The abstract writer of the ESXi report. It is a class of its own, not a
// TWriter: it holds the ESXi report logic (the generic page, the table
// engine, value and label rendering, the system overview and the five
// hand-written sections) and leaves every output decision to a back-end,
// which implements the pure operations below. Like the base writer it
// hands finished TTable grids to the back-end, and sections that write a
// table cell by cell do so through StartTable ... EndTable.
#pragma once

#include <map>
#include <string>
#include <utility>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "TReportParametersBuilder_vmwesxi.h"
#include "braigrion/TReportParameters.h"
#include "braigrion/TTable.h"
#include "tkrcore/CIMInterfaces.h"

namespace braigrion {

class TWriter_vmwesxi {
public:
    typedef std::map<std::string, NORVTKR20::TCIMValue> TContext;
    typedef boost::shared_ptr<NORVTKR20::ICIMNamespace> TNamespacePtr;
    typedef boost::shared_ptr<NORVTKR20::ICIMClass> TClassPtr;
    typedef boost::shared_ptr<NORVTKR20::ICIMInstance> TInstancePtr;
    typedef boost::shared_ptr<NORVTKR20::ICIMProperty> TPropertyPtr;

    TWriter_vmwesxi();

    // --- pages ---

    // A whole page from a definition: frame, title, one table per class
    // that has instances (the patch results always get theirs), index entry.
    void WriteGenericReport(TReportParameters params);
    // The page "System Overview": the chassis (its serial number mended
    // from the system's identifying info when it reads "none"), the
    // hypervisor and the data source.
    void WriteCustomSystemOverview(TReportParameters params);
    // The hand-written sections (SectionsHardware_vmwesxi.cpp,
    // SectionsPlatform_vmwesxi.cpp; see docs/esxi-sections.md). Each writes
    // one page, frame to index entry, and contains its own failures.
    void WriteCustomHardwareInventoryReport(TReportParametersBuilder_vmwesxi builder);
    void WriteCustomFirmwareReport(TReportParametersBuilder_vmwesxi builder);
    void WriteKMCConfigReport(TReportParametersBuilder_vmwesxi builder);
    void WriteEnvironmentalsPreferred(TReportParametersBuilder_vmwesxi builder);
    void WriteLSIReportWithCardinal();

    // --- table engine and values (TWriterTable_vmwesxi.cpp) ---

    // One declared table for these instances: its title, then one grid per
    // group of at most MaxInstancesPerTable instances.
    void WriteTable(TReportClass reportClass, std::vector<TInstancePtr> instances, bool isTopLevel,
                    bool isAssociated, TContext context);
    // Opens the hand-written "Firmware" table: four columns of 25% and
    // their header cells, labelled on `cls`.
    void WriteFirmwareTableHeader(TClassPtr cls);
    // The label override, else the display name of the property's
    // declaration (on the association target when there is one), else the
    // property's name.
    std::string GetTableHeaderLabel(NORVTKR20::ICIMClass& cls, TReportProperty property, TContext context);
    // The text of a property: dates in their display form, array elements
    // joined by `separator`, every value made safe by EscapeText; "" when
    // the instance lacks the property or it is null.
    std::string GetPropertyValue(TInstancePtr instance, std::string propertyName, std::string separator);
    std::string GetValueFromProperty(TPropertyPtr property, std::string separator, bool useMappedText);
    // The texts of several properties, with `separator` before each value
    // that is not empty.
    std::string GetValuesFromProperties(std::vector<TPropertyPtr> properties, const std::string& separator,
                                        bool useMappedText);

    // --- helpers ---

    // "AABBCCDD-EEFF-GGHH-..." as "DDCCBBAA-FFEE-HHGG-...": the byte pairs
    // of the first three groups reversed. Throws std::out_of_range for a
    // text shorter than 18 characters.
    std::string SwitchUUID(std::string uuid);
    // Whether the text of the instance's property holds `key`; false for a
    // null instance, a missing property or any failure.
    bool HasKey(TInstancePtr instance, std::string key, std::string property);
    // The serial number the system's identifying info carries: the text
    // behind the first ":" of the first element of OtherIdentifyingInfo
    // (OMC_UnitaryComputerSystem) that holds a ":" and does not end in "-";
    // "" without one. The argument is not used.
    std::string GetSerialNumber(std::string unused);

    std::string GetMode() const { return fMode; }
    std::string GetOutputPath() const { return fOutputPath; }

    // --- back-end operations, in slot order ---

    virtual ~TWriter_vmwesxi();
    // Sets the namespace, the output directory and the mode (SetUp does it).
    virtual void Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) = 0;
    virtual void EndCategory() = 0;
    virtual void WriteCategory(const std::string& categoryName) = 0;
    virtual void EndReport() = 0;
    virtual void OpenPage(const std::string& path) = 0;
    virtual void ClosePage() = 0;
    virtual void WritePageHeader() = 0;
    virtual void WritePageFooter() = 0;
    virtual void WriteHeaderCell(TClassPtr cls, TReportProperty property) = 0;
    virtual void WriteReportTitle(const std::string& title, const std::string& link, const std::string& linkText) = 0;
    virtual void WriteIndexEntry(const std::string& linkName, const std::string& reportName, bool hasData) = 0;
    virtual void WriteTableTitle(const std::string& title, bool subTitle, bool unused) = 0;
    virtual void WriteTableGrid(TTable& table) = 0;
    virtual void StartTable(const std::string& width, const std::string& id, bool sortable) = 0;
    virtual void StartRow(bool first) = 0;
    virtual void EndRow() = 0;
    virtual std::string GetSeparatorText(int separator) = 0;
    virtual void WriteInstalledApps(TReportParameters params) = 0;
    virtual void WriteKernelModules(TReportParameters params) = 0;
    virtual void WriteNetworking(TReportParameters params) = 0;
    virtual void WriteResourceUtilization(TReportParameters params) = 0;
    virtual void WriteProcesses(TReportParameters params) = 0;
    virtual void WriteOSConfig(TReportParameters params) = 0;
    virtual void WriteSysConfig(TReportParameters params) = 0;
    virtual void WriteChassisEventLog(TReportParameters params) = 0;
    virtual void WriteMergedLog(TReportParameters params) = 0;
    virtual void WriteMergedDevices(TReportParameters params) = 0;
    virtual void WritePBReport(TReportParameters params) = 0;
    virtual void WritePCIInfo(TReportParameters params) = 0;
    virtual void WriteDriveHealth(TReportParameters params) = 0;
    virtual void WriteLSIIDE(TReportParameters params) = 0;
    virtual void WritePMCRAID(TReportParameters params) = 0;
    virtual void WriteHalcyon(TReportParameters params) = 0;
    virtual void WriteHalcyonLogs(TReportParameters params) = 0;
    virtual void WriteQlogic(TReportParameters params) = 0;
    virtual void WriteEmulex(TReportParameters params) = 0;
    virtual void WriteBroadcom(TReportParameters params) = 0;
    virtual void WriteBrocadeAdapter(TReportParameters params) = 0;
    virtual void WriteGlowTrace(TReportParameters params) = 0;
    virtual void WriteKMCBuiltinSelfTest(TReportParameters params) = 0;
    // The pages "VMware Privilege Log" and "TKR Error Log".
    virtual void WriteLogPage(TReportParameters params) = 0;
    virtual void WriteIPMIEvent(TReportParameters params) = 0;
    virtual void EndTableHeader() = 0;
    // The slots the sections use beyond those: the cells of a table opened
    // by StartTable, its end, the gap after a grid, and the making safe of
    // collected text for the format.
    virtual void WriteValueCell(TInstancePtr instance, TReportProperty property, std::string separator) = 0;
    virtual void WriteTextCell(TReportProperty property, std::string text, std::string link) = 0;
    virtual void EndTable() = 0;
    virtual void WriteTableBreak() = 0;
    virtual std::string EscapeText(std::string text) = 0;

protected:
    // What a back-end's Initialize sets: the namespace, the output
    // directory, and the mode from the context key "mode" ("default"
    // without it).
    void SetUp(TNamespacePtr ns, const TContext& context, const std::string& outputPath);

    TNamespacePtr fNamespace;
    std::string fOutputPath;  // every page path is fOutputPath + kFileSeparator + link name
    std::string fMode;        // "default" or "luz"

private:
    // Whether a date property's declaration carries "NOTIMEPRECISION".
    // While a table is written the answer is kept per declaration: an
    // absent qualifier answers by an exception, dear on every cell.
    bool HasNoTimePrecision(NORVTKR20::ICIMProperty& property);

    bool fCachingDates;
    std::vector<std::pair<boost::shared_ptr<const NORVTKR20::ICIMPropertyDecl>, bool>> fDateQualifiers;

    TWriter_vmwesxi(const TWriter_vmwesxi&) = delete;
    TWriter_vmwesxi& operator=(const TWriter_vmwesxi&) = delete;
};

}  // namespace braigrion
