// Repairs of the collected data, made in the repository itself before any
// page is read, so that every page sees the mended data. Each repair
// tolerates a missing class or property.
//
// The repairs are not written yet: each traces its entry and exit and leaves
// the repository as it is.
#include "braigrion/TReport.h"
#include "braigrion/Trace.h"


namespace braigrion {

void TReport::fixCriticalDetailforRaidDiskRemoval() {
    Trace("TReport::fixCriticalDetailforRaidDiskRemoval -- Entering");
    Trace("TReport::fixCriticalDetailforRaidDiskRemoval -- Exiting");
}

void TReport::fixProductNameofComputerSystem() {
    Trace("TReport::fixProductNameofComputerSystem -- Entering");
    Trace("TReport::fixProductNameofComputerSystem -- Exiting");
}

void TReport::fixRedundantMonitorInfo(TContext /*context*/) {
    Trace("TReport::fixRedundantMonitorInfo -- Entering");
    Trace("TReport::fixRedundantMonitorInfo -- Exiting");
}

void TReport::AddManufacturerForMem() {
    Trace("TReport::AddManufacturerForMem -- Entering");
    Trace("TReport::AddManufacturerForMem -- Exiting");
}

void TReport::ConvertEmulexKoSTypeIDToHex() {
    Trace("TReport::ConvertEmulexKoSTypeIDToHex -- Entering");
    Trace("TReport::ConvertEmulexKoSTypeIDToHex -- Exiting");
}

void TReport::fixMemInfo() {
    Trace("TReport::fixMemInfo -- Entering");
    Trace("TReport::fixMemInfo -- Exiting");
}

}  // namespace braigrion
