// A plain-text form of a page definition, one line per setting, for
// comparison with expected definitions kept as fixture files. Settings at
// their defaults are left out, so a line says what a definition chose:
//
//   page hw_info "Hardware Inventory"
//     report title: shown
//     link: plain
//   table ORVSG_MediaAccessDevice
//     title "Disk Information"
//     sortable
//     sorted by Name numeric
//     reached by association
//     column Name 20%
//     nested table ORVSG_DiskPartition
//       no title
//       associators filter: association class ORVSG_PartitionPresent, result class ORVSG_DiskPartition
//       column FileSystemName 15% via ORVSG_LogicalDiskBasedOnPartition to ORVSG_LogicalDisk, label "Format"
#pragma once

#include <string>

#include "braigrion/TReportParameters.h"

namespace braigrion {
namespace testing {

std::string DumpDefinition(const TReportParameters& params);

}  // namespace testing
}  // namespace braigrion
