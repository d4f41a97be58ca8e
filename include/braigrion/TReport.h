// The entry point of the library. A TReport is built over a repository
// namespace and a context map; it writes the whole report through a back-end
// (Write) or one page as text through an inventory back-end (GetPage).
#pragma once

#include <map>
#include <string>
#include <vector>

#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>

#include "braigrion/TReportParametersBuilder.h"
#include "tkrcore/CIMInterfaces.h"

namespace braigrion {

class TWriter;

class TReport {
public:
    typedef std::map<std::string, NORVTKR20::TCIMValue> TContext;
    // Told before each page of Write: its number (from 1), the number of
    // pages the run will ask for, and the page id.
    typedef boost::function<void(size_t number, size_t total, const std::string& pageID)> TPageObserver;

    // Context keys read: "mode", "KMC", "VCX", "pageID", "viewID", "dataID",
    // "testID". Throws std::invalid_argument for a null namespace.
    TReport(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, TContext context, std::string outputPath);
    ~TReport();

    // The writer belongs to the caller; a null writer is logged and ignored.
    void Write(TWriter* writer, TContext context);
    // The page named by the context key "pageID", for an inventory back-end;
    // "" for any other back-end.
    std::string GetPage(TWriter* writer, TContext context);

    void SetPageObserver(TPageObserver observer) { fPageObserver = observer; }
    // The page ids Write asks for, in order, for this report's flags and the
    // operating system that `builder` finds.
    std::vector<std::string> PlannedPages(const TReportParametersBuilder& builder) const;

    // Finds the KMC flag from the firmware elements rather than the context.
    // Nothing in the report calls it.
    void DetermineKMC();

    // Repairs of the collected data, made in the repository before pages are
    // written.
    void fixCriticalDetailforRaidDiskRemoval();
    void fixProductNameofComputerSystem();
    void fixRedundantMonitorInfo(TContext context);
    void AddManufacturerForMem();
    void ConvertEmulexKoSTypeIDToHex();
    void fixMemInfo();

    const std::string& GetMode() const { return fMode; }
    const std::string& GetPageID() const { return fPageID; }
    const std::string& GetViewID() const { return fViewID; }
    const std::string& GetDataID() const { return fDataID; }
    const std::string& GetTestID() const { return fTestID; }
    bool IsKMC() const { return fKMC; }
    bool IsDelta() const { return fDelta; }
    bool IsPreboot() const { return fPreboot; }

private:
    struct TStep;
    boost::shared_ptr<TReportParametersBuilder> MakeBuilder() const;
    std::vector<TStep> PlanCategories() const;
    static std::vector<TStep> OSLogsSteps(int osType);
    void WriteCategories(TWriter* writer, const boost::shared_ptr<TReportParametersBuilder>& builder);
    void RunStep(TWriter* writer, const boost::shared_ptr<TReportParametersBuilder>& builder, const TStep& step,
                 size_t& done, size_t total);

    boost::shared_ptr<NORVTKR20::ICIMNamespace> fNamespace;
    std::string fOutputPath;
    std::string fMode;
    std::string fPageID;
    std::string fViewID;
    std::string fDataID;
    std::string fTestID;
    bool fKMC;
    bool fDelta;
    bool fPreboot;
    bool fSpare;
    TPageObserver fPageObserver;
};

}  // namespace braigrion
