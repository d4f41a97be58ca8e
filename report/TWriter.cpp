#include "braigrion/TWriter.h"
#include "braigrion/Trace.h"

#include "braigrion/ReportDefinition.h"
#include "tkrcore/TRootObject.h"

namespace braigrion {

using NORVTKR20::TRootObject;

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

}  // namespace braigrion
