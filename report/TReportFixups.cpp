// Repairs of the collected data, made in the repository itself before any
// page is read, so that every page sees the mended data. Each repair
// tolerates a missing class or property: a class that is not there ends the
// repair quietly, a failing instance is passed over, and nothing escapes.
#include <cctype>
#include <cstdio>
#include <cstdlib>
#include <sstream>
#include <vector>

#include "braigrion/TReport.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TCIMDateTime.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMProperty;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMDateTime;
using NORVTKR20::TCIMValue;
using NORVTKR20::TTKRException;

namespace {

typedef std::vector<boost::shared_ptr<ICIMInstance>> TInstances;

const char kRaidHint[] = "(possibly RAID drive)";
const char kRemovalDetected[] = "removal detected";
const char kSeeLogs[] = " Check Halcyon or DLM Event or IPMI Event  for more infomation.";

bool Contains(const std::string& text, const char* part) {
    return text.find(part) != std::string::npos;
}

// The class, or null when the repository has no such class.
boost::shared_ptr<ICIMClass> FindClass(const boost::shared_ptr<NORVTKR20::ICIMNamespace>& ns,
                                       const std::string& name) {
    try {
        return ns->GetClass(name, TCIMContext());
    } catch (const TTKRException&) {
        return boost::shared_ptr<ICIMClass>();
    }
}

// Every instance of the class, subclasses included; none when the class is
// missing or cannot be enumerated.
TInstances InstancesOf(const boost::shared_ptr<NORVTKR20::ICIMNamespace>& ns, const std::string& name) {
    TInstances instances;
    boost::shared_ptr<ICIMClass> cls = FindClass(ns, name);
    if (!cls) return instances;
    try {
        cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(instances), true, TCIMContext());
    } catch (const TTKRException&) {
        instances.clear();
    }
    return instances;
}

std::string Text(const boost::shared_ptr<ICIMInstance>& instance, const std::string& property) {
    return static_cast<std::string>(instance->GetProperty(property, TCIMContext())->GetValue(TCIMContext()));
}

// The text of a property, "" when the instance lacks it or it is null.
std::string TextOrEmpty(const boost::shared_ptr<ICIMInstance>& instance, const std::string& property) {
    try {
        return Text(instance, property);
    } catch (const TTKRException&) {
        return std::string();
    }
}

// Whether some instance's "Message" holds every one of `parts`.
bool AnyMessageHolds(const TInstances& records, const std::vector<const char*>& parts) {
    for (const auto& record : records) {
        std::string message = TextOrEmpty(record, "Message");
        bool all = !message.empty();
        for (const char* part : parts) all = all && Contains(message, part);
        if (all) return true;
    }
    return false;
}

// The memory slot a text names: the number after "Node" (1 when there is
// none) and the number after "DIMM", or after the last "/" when the text has
// no "DIMM". {0, 0} when no slot number can be found.
std::pair<int, int> MemorySlot(const std::string& text) {
    auto numberAfter = [&text](std::string::size_type from) {
        while (from < text.size() && !std::isdigit(static_cast<unsigned char>(text[from]))) ++from;
        return from < text.size() ? std::atoi(text.c_str() + from) : 0;
    };
    std::string::size_type node = text.find("Node");
    std::string::size_type dimm = text.find("DIMM");
    if (dimm == std::string::npos) dimm = text.rfind('/');
    if (dimm == std::string::npos) return std::make_pair(0, 0);
    int nodeNumber = node == std::string::npos || node > dimm ? 1 : numberAfter(node + 4);
    return std::make_pair(nodeNumber, numberAfter(dimm + 1));
}

}  // namespace

void TReport::fixCriticalDetailforRaidDiskRemoval() {
    const std::string name = "TReport::fixCriticalDetailforRaidDiskRemoval";
    Trace(name + " -- Entering");
    try {
        boost::shared_ptr<ICIMClass> highlights = FindClass(fNamespace, "ORVSG_HeavyHittersLogRecord");
        if (highlights) {
            TInstances records = InstancesOf(fNamespace, "ORVSG_HeavyHittersLogRecord");
            bool changed = false;
            // A message that already carries the hint was mended by an
            // earlier run, or is the record this repair creates: the repair
            // is done, and neither a second hint nor a second record comes.
            bool mended = false;
            for (const auto& record : records) {
                try {
                    boost::shared_ptr<ICIMProperty> property = record->GetProperty("Message", TCIMContext());
                    std::string message = static_cast<std::string>(property->GetValue(TCIMContext()));
                    if (Contains(message, kRaidHint)) {
                        mended = true;
                        continue;
                    }
                    if (!Contains(message, "GPA") || !Contains(message, "Hard drive") ||
                        !Contains(message, kRemovalDetected)) {
                        continue;
                    }
                    std::string::size_type at = message.find(kRemovalDetected);
                    std::string rebuilt = message.substr(0, at) + kRaidHint + " " + message.substr(at) + kSeeLogs;
                    property->SetValue(TCIMValue(rebuilt), TCIMContext());
                    changed = true;
                    break;
                } catch (const TTKRException&) {
                    Trace(name + " -- TTKRException caught for one record");
                }
            }
            if (!changed && !mended) {
                bool evidence =
                    AnyMessageHolds(InstancesOf(fNamespace, "ORVSG_DLMlog"), {"Hard drive", kRemovalDetected}) ||
                    AnyMessageHolds(InstancesOf(fNamespace, "ORVSG_IPMILogRecord"),
                                    {"Disk or disk bay", "ssertion", "Drive Slot Present"});
                if (evidence) {
                    std::ostringstream recordID;
                    recordID << records.size() + 1;
                    boost::shared_ptr<ICIMInstance> created = highlights->CreateInstance(TCIMContext());
                    created->AddProperty("CreationClassName", TCIMValue("Test"), TCIMContext());
                    created->AddProperty("LogName", TCIMValue("Test"), TCIMContext());
                    created->AddProperty("LogCreationClassName", TCIMValue("Test"), TCIMContext());
                    created->AddProperty("Message",
                                         TCIMValue(std::string("Hard drive ") + kRaidHint + " " + kRemovalDetected +
                                                   "." + kSeeLogs),
                                         TCIMContext());
                    created->AddProperty("MessageTimestamp", TCIMValue(TCIMDateTime(2000, 1, 1, 0, 0, 0, 0, 0)),
                                         TCIMContext());
                    created->AddProperty("RecordID", TCIMValue(recordID.str()), TCIMContext());
                    Trace(name + " -- Created a highlight for a drive removal found in the logs");
                }
            }
        }
    } catch (const TTKRException&) {
        Trace(name + " -- TTKRException caught");
    } catch (...) {
        Trace(name + " -- Exception caught");
    }
    Trace(name + " -- Exiting");
}

void TReport::fixProductNameofComputerSystem() {
    const std::string name = "TReport::fixProductNameofComputerSystem";
    Trace(name + " -- Entering");
    try {
        for (const auto& system : InstancesOf(fNamespace, "ORVSG_ComputerSystem")) {
            try {
                boost::shared_ptr<ICIMProperty> property = system->GetProperty("ProductName", TCIMContext());
                std::string product = static_cast<std::string>(property->GetValue(TCIMContext()));
                if (!product.empty() && product[product.size() - 1] == '-') {
                    product.erase(product.size() - 1);
                    property->SetValue(TCIMValue(product), TCIMContext());
                }
            } catch (const TTKRException&) {
                Trace(name + " -- TTKRException caught for one system");
            }
        }
    } catch (...) {
        Trace(name + " -- Exception caught");
    }
    Trace(name + " -- Exiting");
}

void TReport::fixRedundantMonitorInfo(TContext context) {
    const std::string name = "TReport::fixRedundantMonitorInfo";
    Trace(name + " -- Entering");
    try {
        for (const auto& monitor : InstancesOf(fNamespace, "ORVSG_DesktopMonitor")) {
            try {
                if (Contains(Text(monitor, "Name"), "ORV GPA2")) monitor->Delete(context);
            } catch (const TTKRException&) {
                Trace(name + " -- TTKRException caught for one monitor");
            }
        }
    } catch (...) {
        Trace(name + " -- Exception caught");
    }
    Trace(name + " -- Exiting");
}

void TReport::AddManufacturerForMem() {
    const std::string name = "TReport::AddManufacturerForMem";
    Trace(name + " -- Entering");
    try {
        std::string makers;
        for (const auto& module : InstancesOf(fNamespace, "ORVSG_SPDData")) {
            try {
                std::string maker = Text(module, "Manufacturer");
                if (makers.empty()) {
                    makers = maker;
                } else if (!Contains(makers, maker.c_str())) {
                    makers += "   " + maker;
                }
            } catch (const TTKRException&) {
                Trace(name + " -- TTKRException caught for one module");
            }
        }
        for (const auto& device : InstancesOf(fNamespace, "ORVSG_LogicalDevice")) {
            try {
                if (Text(device, "DeviceClass") != "memory") continue;
                device->GetProperty("Manufacturer", TCIMContext())->SetValue(TCIMValue(makers), TCIMContext());
            } catch (const TTKRException&) {
                Trace(name + " -- TTKRException caught for one device");
            }
        }
    } catch (...) {
        Trace(name + " -- Exception caught");
    }
    Trace(name + " -- Exiting");
}

// The collector stored the type as the number of its hexadecimal digits
// read in base ten; the Emulex page prints this number, so the same reading
// is kept: 16 becomes 10, 32 becomes 20, and 31 ("1f") becomes 1.
void TReport::ConvertEmulexKoSTypeIDToHex() {
    const std::string name = "TReport::ConvertEmulexKoSTypeIDToHex";
    Trace(name + " -- Entering");
    try {
        for (const auto& record : InstancesOf(fNamespace, "ELXUCNA_KoSIDData")) {
            try {
                boost::shared_ptr<ICIMProperty> property = record->GetProperty("KoSType", TCIMContext());
                unsigned int type = static_cast<unsigned int>(property->GetValue(TCIMContext()));
                char buffer[16];
                std::snprintf(buffer, sizeof(buffer), "%02x", type);
                unsigned int converted = static_cast<unsigned int>(std::strtol(buffer, nullptr, 10));
                property->SetValue(TCIMValue(converted), TCIMContext());
            } catch (const TTKRException&) {
                Trace(name + " -- TTKRException caught during convertion");
            }
        }
    } catch (const TTKRException&) {
        Trace(name + " -- TTKRException caught");
    } catch (...) {
        Trace(name + " -- Exception caught");
    }
    Trace(name + " -- Exiting");
}

// Fills what a memory module's SPD left empty from the FRU record of the
// same slot. No run calls it; it stays available for data whose SPD is
// incomplete.
void TReport::fixMemInfo() {
    const std::string name = "TReport::fixMemInfo";
    Trace(name + " -- Entering");
    try {
        TInstances frus = InstancesOf(fNamespace, "ORVSG_IPMIFRU");
        for (const auto& module : InstancesOf(fNamespace, "ORVSG_SPDData")) {
            try {
                if (TextOrEmpty(module, "MemoryType").empty()) continue;
                std::pair<int, int> slot = MemorySlot(TextOrEmpty(module, "Tag"));
                if (slot.second == 0) continue;
                for (const auto& fru : frus) {
                    if (MemorySlot(TextOrEmpty(fru, "Name")) != slot) continue;
                    std::string fruMaker = TextOrEmpty(fru, "Manufacturer");
                    if (fruMaker.empty()) fruMaker = TextOrEmpty(fru, "Vendor");
                    const std::pair<const char*, std::string> fills[] = {
                        {"Manufacturer", fruMaker},
                        {"PartNumber", TextOrEmpty(fru, "PartNumber")},
                        {"SerialNumber", TextOrEmpty(fru, "SerialNumber")},
                    };
                    for (const auto& fill : fills) {
                        if (fill.second.empty() || !TextOrEmpty(module, fill.first).empty()) continue;
                        try {
                            module->GetProperty(fill.first, TCIMContext())->SetValue(TCIMValue(fill.second),
                                                                                     TCIMContext());
                        } catch (const TTKRException&) {
                            module->AddProperty(fill.first, TCIMValue(fill.second), TCIMContext());
                        }
                    }
                    break;
                }
            } catch (const TTKRException&) {
                Trace(name + " -- TTKRException caught for one module");
            }
        }
    } catch (...) {
        Trace(name + " -- Exception caught");
    }
    Trace(name + " -- Exiting");
}

}  // namespace braigrion
