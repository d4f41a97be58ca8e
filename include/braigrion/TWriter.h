// The abstract report writer. It holds the report logic and leaves every
// output decision to a back-end derived from it: the back-end supplies the
// pure operations below and sets the protected data that say where and how
// the report is written. TTable is the only structure that crosses between
// the two.
#pragma once

#include <map>
#include <string>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "braigrion/TReportParameters.h"
#include "braigrion/TReportParametersBuilder.h"
#include "braigrion/TTable.h"
#include "tkrcore/CIMInterfaces.h"

namespace braigrion {

class TWriter {
public:
    typedef std::map<std::string, NORVTKR20::TCIMValue> TContext;
    typedef boost::shared_ptr<NORVTKR20::ICIMNamespace> TNamespacePtr;
    typedef boost::shared_ptr<NORVTKR20::ICIMClass> TClassPtr;
    typedef boost::shared_ptr<NORVTKR20::ICIMInstance> TInstancePtr;
    typedef boost::shared_ptr<NORVTKR20::ICIMProperty> TPropertyPtr;
    typedef boost::shared_ptr<const NORVTKR20::ICIMPropertyDecl> TPropertyDeclPtr;
    typedef boost::shared_ptr<TReportParametersBuilder> TBuilderPtr;

    TWriter();

    // --- Driver operations ---

    // Takes the namespace and reads the mode flags through the builder. A
    // failure in reading them is logged and leaves what was read so far.
    void BaseInitialize(TNamespacePtr ns, TContext context, TBuilderPtr builder);
    void BaseDispose();
    std::string GetWriterType() const { return fWriterType; }
    // The OS type BaseInitialize found (TReportParametersBuilder::GetOSType).
    int GetOSType() const { return fOSType; }
    // Writes one page. A page that fails is abandoned where it stood; the
    // report goes on with the next one.
    void WriteReportPage(TBuilderPtr builder, std::string pageID);
    // The page ids asked of this writer whose generator (or part of it) is
    // not in this version of the library, each once, in the order asked.
    const std::vector<std::string>& GetUnavailablePages() const { return fUnavailablePages; }

    // --- Value rendering ---

    // The text of an instance's property: a date in its display form, an
    // array's elements each made safe by EscapeText and joined by
    // `separator`, any other value's display text made safe. "" when the
    // instance lacks the property.
    std::string GetPropertyValue(TInstancePtr instance, std::string propertyName, std::string separator);
    // The same from a property. With `useMappedText` a scalar gives its
    // mapped text as the repository has it.
    std::string GetValueFromProperty(TPropertyPtr property, std::string separator, bool useMappedText);
    // The texts of several properties, with `separator` before each value
    // that is not empty.
    std::string GetValuesFromProperties(std::vector<TPropertyPtr> properties, const std::string& separator,
                                        bool useMappedText);
    // The property of every instance reached through the association,
    // joined by blanks; "" when the association cannot be walked.
    std::string GetPropertyValueFromAssociation(TInstancePtr instance, std::string assocClass, std::string resultClass,
                                                std::string role, std::string property);
    // The class name made safe, with "_" and the property's text when a
    // property is named.
    std::string GetUniqueId(TInstancePtr instance, std::string propertyName);
    // "CurrentReading" scaled by ten to the power "UnitModifier"; "N/A"
    // when either cannot be read.
    std::string GetNumericSensorValue(TInstancePtr instance, bool asReading);
    // The label of a column: a fixed label for a few properties, the
    // column's own label, the declaration's display name, or the property's
    // name when it has no declaration.
    std::string GetTableHeaderLabel(NORVTKR20::ICIMClass& cls, TReportProperty property, TContext context);

    // --- Table engine ---

    // Writes one declared table for these instances: its title, then one
    // grid per group of at most MaxInstancesPerTable instances, and under
    // each instance of a top-level table with associated classes the
    // nested tables of those classes.
    void WriteTable(TReportClass reportClass, std::vector<TInstancePtr> instances, bool isTopLevel,
                    bool isAssociated, TContext context);
    typedef std::vector<TReportClass>::iterator TClassIterator;
    // Moves the classes of [first, last) that have an instance passing
    // their filters to the front, in their order, and returns the end of
    // those; the caller erases the rest.
    TClassIterator ClassFilter(TClassIterator first, TClassIterator last);

    // --- Generic pages ---

    // A whole page from a definition: page frame, title, one table per
    // class, index entry.
    void WriteGenericReport(TReportParameters params);
    // The same page with a link to its raw-data page in the title.
    void WriteGenericReportWithLink(TReportParameters params, const std::string& link);

    // --- Raw-data pages ---
    // A raw-data page lists the commands a collector issued to an external
    // tool; each row links to a text file beside the report that holds the
    // tool's output. Each writer takes the link name of its standard page,
    // to which the raw page links back, and returns the raw page's link name,
    // or "" when it wrote no page. The others are back-end slots below.

    // The PCI bus listings. A result file that cannot be written leaves its
    // row blank; "" also when no row could be filled.
    std::string WritePCIRawDataReport(std::string linkName);
    // The Fusion-io tool's commands, each result named by its command when
    // that is a plain file name, by a numbered name otherwise.
    std::string WriteFIORawDataReport(std::string linkName);
    // Whether any LSI tool left raw data (utility, IR or MegaRAID tool).
    bool isLSIRawDataPresent();
    // Whether the MegaRAID command-line tool left raw data.
    bool isMRRawDataPresent();
    // Whether the MegaRAID vendor provider reported an adapter.
    bool isMRVendorProviderPresent();

    // --- Page generators ---
    // WriteReportPage calls one of these per page id. Each decides by the
    // mode flags whether and how its page is written.

    void Generator_SystemOverview(TBuilderPtr builder, std::string pageID);
    void Generator_CriticalDetails(TBuilderPtr builder, std::string pageID);
    void Generator_OSInstallation(TBuilderPtr builder, std::string pageID);
    void Generator_NetworkSettings(TBuilderPtr builder, std::string pageID);
    void Generator_ResourceUtilization(TBuilderPtr builder, std::string pageID);
    void Generator_Processes(TBuilderPtr builder, std::string pageID);
    void Generator_OSConfiguration(TBuilderPtr builder, std::string pageID);
    void Generator_HardwareInventory(TBuilderPtr builder, std::string pageID);
    void Generator_PCIInformation(TBuilderPtr builder, std::string pageID);
    void Generator_FirmwareVPD(TBuilderPtr builder, std::string pageID);
    void Generator_ServProcConfiguration(TBuilderPtr builder, std::string pageID);
    void Generator_Environmentals(TBuilderPtr builder, std::string pageID);
    void Generator_DriveHealth(TBuilderPtr builder, std::string pageID);
    void Generator_LSIController(TBuilderPtr builder, std::string pageID);
    void Generator_LSIIDEController(TBuilderPtr builder, std::string pageID);
    void Generator_Mellanox(TBuilderPtr builder, std::string pageID);
    void Generator_Solarflare(TBuilderPtr builder, std::string pageID);
    void Generator_FusionIO(TBuilderPtr builder, std::string pageID);
    void Generator_PMCRAID(TBuilderPtr builder, std::string pageID);
    void Generator_Halcyon(TBuilderPtr builder, std::string pageID);
    void Generator_HalcyonLogs(TBuilderPtr builder, std::string pageID);
    void Generator_QLogic(TBuilderPtr builder, std::string pageID);
    void Generator_Emulex(TBuilderPtr builder, std::string pageID);
    void Generator_Broadcom(TBuilderPtr builder, std::string pageID);
    void Generator_BrocadeAdapter(TBuilderPtr builder, std::string pageID);
    void Generator_VMwareESXi(TBuilderPtr builder, std::string pageID);
    void Generator_GlowTrace(TBuilderPtr builder, std::string pageID);
    void Generator_SelfBIST(TBuilderPtr builder, std::string pageID);
    void Generator_KMCLicenseKey(TBuilderPtr builder, std::string pageID);
    void Generator_BIOSSettings(TBuilderPtr builder, std::string pageID);
    void Generator_VCX(TBuilderPtr builder, std::string pageID);
    void Generator_OSLogs(TBuilderPtr builder, std::string pageID);
    void Generator_ServProcEvent(TBuilderPtr builder, std::string pageID);
    void Generator_QVAChipsetRegister(TBuilderPtr builder, std::string pageID);
    void Generator_CFTSetting(TBuilderPtr builder, std::string pageID);
    void Generator_NVSMILog(TBuilderPtr builder, std::string pageID);
    void Generator_AMDAticonfigLog(TBuilderPtr builder, std::string pageID);
    void Generator_SPINTLog(TBuilderPtr builder, std::string pageID);
    void Generator_MergedLog(TBuilderPtr builder, std::string pageID);
    void Generator_MergedDevice(TBuilderPtr builder, std::string pageID);
    void Generator_Melody(TBuilderPtr builder, std::string pageID);
    void Generator_PatchBeacon(TBuilderPtr builder, std::string pageID);
    void Generator_FileLoader(TBuilderPtr builder, std::string pageID);
    void Generator_DiagnosticLog(TBuilderPtr builder, std::string pageID);
    void Generator_TKRErrorLog(TBuilderPtr builder, std::string pageID);
    void Generator_Diablo(TBuilderPtr builder, std::string pageID);

    // --- Log sections (sections/Log*.cpp): event and diagnostic logs, operating system logs ---

    // Where the log pages find their lookup files, and the two servers
    // their documentation links point at. The caller sets them before a
    // report; without that the defaults below hold.
    struct TLogLinkSettings {
        TLogLinkSettings();
        std::string fDataFolder;  // holds the lookup files; "./data"
        std::string fDocServer;   // public documentation server, an absolute http(s) address
        std::string fHelpServer;  // internal help server of one machine type, on port 8040
    };
    void SetLogLinkSettings(const TLogLinkSettings& settings) { fLogLinks = settings; }
    const TLogLinkSettings& GetLogLinkSettings() const { return fLogLinks; }

    // The chassis event log, each event linked to its documentation page
    // when the documentation covers this machine type.
    void WriteCustomChassisEventLog(TBuilderPtr builder, std::string pageID);
    // The diagnostics that ran, with links to their codes' pages.
    void WriteCustomDiagnosticLog(TBuilderPtr builder, std::string reportName);
    // The IPMI page, with a link in its title when a multi-tool left one.
    void WriteIPMIReport(TReportParameters params);
    void WriteIPMIEventReportWithLink(TReportParameters params, std::string link);
    // The operating system's logs: Windows event logs, one page per Linux
    // log file, the merged log.
    void WriteWindowsEventReport(TBuilderPtr builder, std::string pageID);
    void WriteLinuxLogReport(TBuilderPtr builder, std::string pageID);
    void WriteMergedLogReport(TBuilderPtr builder, std::string pageID);

    // The four-character machine type inside "-[...]" of the product name;
    // "" when there is none.
    std::string GetMTFromRepository();
    // Whether the IPMI records carry a multi-tool's "Action"; `out` takes
    // the text of the last record read.
    bool IsMultitool(std::string& out);
    // "0X 8000-0123" becomes "80000123".
    void ProcessKMCEventID(std::string& id);
    // The code between a leading "[" and the first "]"; "" otherwise.
    std::string ProcessUefiDiagCodeFromAD(std::string text);
    // A diagnostic code is the first 11 characters of the record text.
    void ProcessDiagnosticErrorCode(std::string& text);
    // Cuts "left_desc_right" at its first "_desc_".
    void ExtractLink(const std::string& line, std::string& left, std::string& right);

private:
    TLogLinkSettings fLogLinks;

public:
    // (end of block)

    // --- Storage sections (sections/LSI*.cpp, Halcyon*.cpp, PMC*.cpp, DriveHealth*.cpp) ---

    // The page "LSI Controller": through the Cardinal provider where it left
    // data, else through the legacy provider's classes.
    void WriteLSIReport(TBuilderPtr builder, std::string pageID);
    void WriteLSIReportWithCardinal(TBuilderPtr builder, std::string pageID);
    void WriteLSIReportWithLegacyProvider(TBuilderPtr builder, std::string pageID);
    // Whether the Cardinal provider's classes are all there and one of them
    // holds an instance.
    bool isCardinalSupport();
    // Whether a legacy controller is an LSI 1030 chip.
    bool isLSIIntegratedRaid1030Exsited();
    // The legacy reports: integrated RAID, its 1030 form, MegaRAID. Each sets
    // `noCard` false when it finds a controller (the IR report true when it
    // finds none).
    void WriteLSIIntegratedRaidReport(bool& noCard);
    void WriteLSIIntegratedRaid1030Report();
    void WriteMegaLSIReport(bool& noCard);
    // A MegaRAID report from the vendor provider's classes, joined by their
    // identifiers; no page writes it.
    void WriteLSIMegaRaidReport(bool& noCard);
    // The tables after the controllers; each says whether it wrote one.
    bool WriteSSDWarrantyInfoReport();
    bool WriteLSIPCIeSSDReport();

    // The page "LSI IDE Controller".
    void WriteLSIIDEReport(TBuilderPtr builder, std::string pageID);
    // The pages "Halcyon" and "Halcyon Logs".
    void WriteHalcyonReport(TBuilderPtr builder, std::string pageID);
    void WriteHalcyonLogsReport(TBuilderPtr builder, std::string pageID);
    // The page "PMC RAID".
    void WritePMCReport(TBuilderPtr builder, std::string pageID);
    // The page "Drive Health": SMART data, tape and SCSI sense data.
    void WriteDriveHealthReport(TBuilderPtr builder, std::string pageID);

    // (end of block)

    // --- Platform sections (sections/Firmware*.cpp, Environmentals*.cpp, BIOS*.cpp, KMC*.cpp, VCX*.cpp) ---

    // "Firmware/VPD": the firmware elements, BIOS and VPD tables, with the
    // vendor providers' firmware merged into the shared tables.
    void WriteCustomFirmwareReport(TBuilderPtr builder, std::string pageID);
    // "Environmentals": the numeric sensors, or the service processor's
    // sensors when the first source cannot be read at all.
    void WriteEnvironmentalsReport(TBuilderPtr builder, std::string pageID);
    void WriteEnvironmentalsPreferred(TBuilderPtr builder, std::string pageID);
    void WriteEnvironmentalsBackup(TBuilderPtr builder, std::string pageID);
    // "BIOS Settings": the system firmware's attributes, sorted by name.
    void WriteBIOSEnumeration(TBuilderPtr builder, std::string pageID);
    // "KMC Configuration": the network settings a KMC service processor keeps.
    void WriteKMCConfigReport(TBuilderPtr builder, std::string pageID);
    // "VCX Information": a chassis management module's inventory.
    void WriteVCXReport(TBuilderPtr builder, std::string pageID);

    // (end of block)

    // --- Adapter, device analysis and tool output sections (sections/Mellanox*.cpp, ...) ---

    // Each takes the page's report name for its index entry.
    // Mellanox and Solarflare: a block of label and value rows per instance.
    // The page is left open for the back-end to finish, and counts as holding
    // data only when it shows firmware.
    void WriteMellanoxReport(TBuilderPtr builder, std::string reportName);
    void WriteSolarflareReport(TBuilderPtr builder, std::string reportName);
    // Declared pages; in LUZ mode the vendor tool's raw page comes first and
    // the title links to it.
    void WriteEmulexReport(TBuilderPtr builder, std::string reportName);
    void WriteQLogicReport(TBuilderPtr builder, std::string reportName);
    // Fusion-io flash adapters, with the raw page in LUZ mode.
    void WriteFusionIOReport(TBuilderPtr builder, std::string reportName);
    // Port controllers with their Fibre Channel and Ethernet ports.
    void WriteBrocadeReport(TBuilderPtr builder, std::string reportName);
    // Every logical device grouped by class; the short form for pre-boot data.
    void WriteMergedDevicesReport(TBuilderPtr builder, std::string reportName);
    // What the service mode's GPU and settings tools printed, command by command.
    void WriteAMDAticonfigLogReport(TBuilderPtr builder, std::string reportName);
    void WriteNVSMILogReport(TBuilderPtr builder, std::string reportName);
    void WriteCFTSettingReport(TBuilderPtr builder, std::string reportName);
    // Device properties scored by how unusual their values are.
    void WriteMelodyReport(TBuilderPtr builder, std::string reportName);
    // The chipset's error registers, one table per register block.
    void WriteQVARegisterReport(TBuilderPtr builder, std::string reportName);

    // (end of block)

    // --- Delta comparison (delta/) ---

    // A delta page from a definition: for each class, the instances that
    // differ between the collections of the view (property differences,
    // then those missing from some sources, then those unique to some),
    // each under its parent on the page; index entry with whether any
    // class had a difference.
    void WriteGenericDeltaReport(TReportParameters params);

    // (end of block)

    // --- Back-end operations, in slot order ---

    virtual ~TWriter();
    // Takes the output path and sets fOutputPath, fReportPath, fMode and
    // fWriterType.
    virtual void Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) = 0;
    virtual void StartReport() = 0;
    // Closes the open category of the index.
    virtual void EndCategory() = 0;
    virtual void WriteCategory(const std::string& categoryName) = 0;
    virtual void EndReport() = 0;
    // For an inventory back-end: the text of the page just written.
    virtual std::string GetInventoryPage() = 0;
    // Raw-data pages: each returns the link name of the page it wrote, or ""
    // when it wrote none.
    virtual std::string WriteLSIRawDataReport(std::string& linkName);
    virtual std::string WriteHalcyonRawDataReport(std::string linkName);
    virtual std::string WriteHalcyonManagerRawDataReport(std::string linkName);
    virtual void WriteHalcyonEventLog(const std::vector<TInstancePtr>& records, const std::string& fileStem,
                                      const std::string& title) = 0;
    virtual std::string WriteQLogicRawDataReport(std::string linkName);
    virtual std::string WriteEmulexRawDataReport(std::string linkName);
    // One Windows event log page, whole.
    virtual void WriteEventLogReport(TReportParameters params) = 0;
    virtual void ReservedSlot15() {}
    // The merged log page, whole.
    virtual void WriteMergedLogPage(TReportParameters params) = 0;
    virtual void ReservedSlot17() {}
    virtual void WriteMelodyPrologue(const std::string& headerText) = 0;
    virtual void WriteMelodyDeviceRow(TInstancePtr device, const std::string& score, const std::string& type,
                                      const std::string& cimType, const std::string& propertyName,
                                      const std::string& value, const std::string& frequency,
                                      const std::string& commonValues, int commonFrequencies) = 0;
    virtual void WriteMelodyTableStart() = 0;
    virtual void ReservedSlot21() {}
    virtual void ReservedSlot22() {}
    virtual void ReservedSlot23() {}
    virtual void WriteDriveHealthEntry(TPropertyPtr rawData) = 0;
    virtual void WriteDeclarationHeader(TPropertyDeclPtr declaration) = 0;
    virtual void WriteDriveHealthValue(TInstancePtr instance, TPropertyPtr property) = 0;
    virtual void WriteRegisterValue(TInstancePtr instance, TPropertyPtr property) = 0;
    virtual void OpenPage(const std::string& path) = 0;
    virtual void ClosePage() = 0;
    virtual void WritePageHeader() = 0;
    virtual void WritePageFooter() = 0;
    // The last two are empty on most pages.
    virtual void WriteReportTitle(const std::string& title, const std::string& link,
                                  const std::string& linkText) = 0;
    virtual void WriteReportTitleWithLink(const std::string& title, const std::string& link,
                                          const std::string& linkText) = 0;
    // The last step of every page: its line in the index.
    virtual void WriteIndexEntry(const std::string& linkName, const std::string& reportName,
                                 const bool& hasData) = 0;
    virtual void WriteTableBreak() = 0;
    virtual void WriteTableTitle(const std::string& title, const bool& a, const bool& b) = 0;
    virtual void StartColumnTable(const std::string& tableWidth, const std::string& summary, bool sortable) = 0;
    virtual void ReservedSlot38() {}
    virtual void StartPropertyTable(const std::string& tableWidth, const std::string& headerWidth,
                                    const std::string& title) = 0;
    virtual void WriteHeaderCell(TClassPtr cls, TReportProperty property) = 0;
    virtual void EndTableHeader() = 0;
    virtual void StartRow(const bool& first) = 0;
    virtual void EndRow() = 0;
    virtual void EndTable() = 0;
    virtual void WriteRowBreak(int span) = 0;
    // The generic engine's only table operation.
    virtual void WriteTableGrid(TTable& table) = 0;
    virtual void ReservedSlot47() {}
    virtual void ReservedSlot48() {}
    virtual void WriteValueCell(TInstancePtr instance, TReportProperty property, std::string text) = 0;
    virtual void WriteTextCell(TReportProperty property, std::string text, std::string link) = 0;
    virtual void WriteMessageCell(TReportProperty property, const std::string& message) = 0;
    virtual void WriteSensorCell(TInstancePtr sensor, const std::string& readingProperty,
                                 const std::string& modifierProperty) = 0;
    // Between OpenPage and WritePageHeader on declared pages.
    virtual void WriteSortScript() = 0;
    virtual std::string EscapeText(std::string text) = 0;
    // The text put between array elements for TReportProperty::GetArrayValueSeparator.
    virtual std::string GetSeparatorText(int separator) = 0;

protected:
    TNamespacePtr fNamespace;
    std::string fOutputPath;  // every page path is fOutputPath + kFileSeparator + link name
    std::string fReportPath;  // the back-end's second path
    std::string fMode;        // "default", or "luz"
    std::string fWriterType;  // one of the TKR_WRITER_TYPE_* names
    bool fPreboot;
    bool fKMC;
    int fProviderType;  // 1 for a delta view
    int fOSType;        // as TReportParametersBuilder::GetOSType answers

private:
    // Stands in a generator for a page whose definition or section writer
    // is not part of the library yet: writes nothing and logs the line of a
    // page without generator, so that the report keeps its shape. Each call
    // stands for one page that the generator will write.
    void NotYetGenerated(const std::string& pageID);
    std::vector<std::string> fUnavailablePages;

    TWriter(const TWriter&) = delete;
    TWriter& operator=(const TWriter&) = delete;
};

// Orderings of patch results by their "Type" and "Name" texts; an instance
// whose text cannot be read orders after nothing.
bool pb_comp_type(boost::shared_ptr<NORVTKR20::ICIMInstance> a, boost::shared_ptr<NORVTKR20::ICIMInstance> b);
bool pb_comp_name(boost::shared_ptr<NORVTKR20::ICIMInstance> a, boost::shared_ptr<NORVTKR20::ICIMInstance> b);
// A copy of the patch results ordered by type, and within a type by name.
std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> PBResultSort(
    std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>>& results);

}  // namespace braigrion
