#include "braigrion/TWriter.h"

#include <stdexcept>

#include "braigrion/ReportDefinition.h"
#include "tkrcore/TRootObject.h"

namespace braigrion {

using NORVTKR20::INamespaceProvider;
using NORVTKR20::TRootObject;

namespace {

void Trace(const std::string& line) {
    TRootObject::GetCoreLogger()->Log(3, line);
}

}  // namespace

TWriter::TWriter()
    : fOutputPath(""),
      fReportPath(""),
      fMode("default"),
      fWriterType(TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_DEFAULT),
      fPreboot(false),
      fKMC(false),
      fProviderType(0),
      fOSType(TReportParametersBuilder::kOSUnknown) {
    Trace("TWriter::TWriter -- Entering ");
    Trace("TWriter::TWriter -- Exiting");
}

TWriter::~TWriter() {
    Trace("TWriter::~TWriter -- Entering ");
    Trace("TWriter::~TWriter -- Exiting");
}

void TWriter::BaseInitialize(TNamespacePtr ns, TContext context, TBuilderPtr builder) {
    Trace("TWriter::BaseInitialize -- Entering ");
    fNamespace = ns;
    try {
        if (!builder) throw std::invalid_argument("no report parameters builder");
        fPreboot = builder->IsPreboot();
        fKMC = builder->IsKMC();
        TContext empty;
        if (!ns) throw std::invalid_argument("no namespace");
        boost::shared_ptr<INamespaceProvider> provider = ns->GetNamespaceProvider(empty);
        if (!provider) throw std::invalid_argument("namespace without provider");
        fProviderType = provider->GetProviderType(empty);
        fOSType = builder->GetOSType();
    } catch (...) {
        Trace("TWriter::BaseInitialize -- Exception when initializing member variable");
    }
    // A delta view sets up the state of the comparison here, from `context`,
    // once the comparison is part of the library.
    (void)context;
    Trace("TWriter::BaseInitialize -- Exiting ");
}

void TWriter::BaseDispose() {
    Trace("TWriter::BaseDispose -- Entering ");
    // A delta view releases the state of the comparison here.
    Trace("TWriter::BaseDispose -- Exiting ");
}

void TWriter::WriteReportPage(TBuilderPtr builder, std::string pageID) {
    Trace("TWriter::WriteReportPage -- Entering ");
    Trace("TWriter::WriteReportPage -- WriterType = [" + fWriterType + "] PageID = [" + pageID + "]");
    try {
        // Each page id is compared with the pages that have a generator, in
        // a fixed order; the first match writes the page. An id that matches
        // none ends here.
        (void)builder;
        Trace("TWriter::WriteReportPage -- Unknow PageID = " + pageID);
    } catch (...) {
        // A failed page stays as far as it was written; the next page runs.
    }
    Trace("TWriter::WriteReportPage -- Exiting ");
}

}  // namespace braigrion
