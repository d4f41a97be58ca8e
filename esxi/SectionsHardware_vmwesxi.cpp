// The ESXi hardware sections: the hardware inventory, the firmware page
// with the firmware of the vendor providers merged into one table, and the
// LSI controllers through the Cardinal provider. docs/esxi-sections.md
// tells what each page shows.
#include <sstream>

#include "SectionSupport_vmwesxi.h"
#include "TWriter_vmwesxi.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;
using namespace sections_vmwesxi;

namespace {

// The processors, with the caches each one reaches.
TReportClass ProcessorTable() {
    TReportClass cls;
    cls.SetClass("OMC_Processor");
    cls.SetTitle("Processors");
    cls.SetTableWidth("100%");
    cls.GetInstanceSorter().AddProperty("DeviceID", true, false);
    cls.SetProperties({TReportProperty("ElementName", "20%", "", "", "Name", ""),
                       TReportProperty("ModelName", "30%", "", "", "", ""),
                       TReportProperty("CurrentClockSpeed", "15%", "", "", "", ""),
                       TReportProperty("NumberOfEnabledCores", "10%", "", "", "", ""),
                       TReportProperty("ElementName", "25%", "CIM_AssociatedCacheMemory", "OMC_CacheMemory", "Caches",
                                       "")});
    return cls;
}

bool Contains(const std::string& text, const std::string& part) {
    return text.find(part) != std::string::npos;
}

}  // namespace

void TWriter_vmwesxi::WriteCustomHardwareInventoryReport(TReportParametersBuilder_vmwesxi builder) {
    Trace("TWriter_vmwesxi::WriteCustomHardwareInventoryReport -- Entering");
    TReportParameters params = builder.BuildHardwareInventoryParams();
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + params.GetLinkName());
    WritePageHeader();
    WriteReportTitle(params.GetReportName(), "", "");

    // Processors, then the slots, then the cards, devices and connectors.
    std::vector<TReportClass> tables = {ProcessorTable()};
    for (const TReportParameters& part : {builder.BuildHardwareInventoryCPUSlotsParams(),
                                          builder.BuildHardwareInventoryMemorySlotsParams(), params}) {
        tables.insert(tables.end(), part.GetClasses().begin(), part.GetClasses().end());
    }
    bool hasData = false;
    for (const TReportClass& table : tables) {
        try {
            TInstances instances = TWriterUtil::GetInstances(fNamespace, table);
            if (table.GetClass() == "OMC_Processor") {
                for (const TInstancePtr& processor : instances) {
                    Log(0, "TWriter_vmwesxi::WriteCustomHardwareInventoryReport -- Processor: " +
                               GetPropertyValue(processor, "ElementName", " "));
                    for (const TInstancePtr& cache :
                         Associated(processor, "CIM_AssociatedCacheMemory", "OMC_CacheMemory")) {
                        Log(0, "TWriter_vmwesxi::WriteCustomHardwareInventoryReport -- Cache: " +
                                   GetPropertyValue(cache, "ElementName", " "));
                    }
                }
            }
            if (instances.empty()) continue;
            WriteTable(table, instances, true, false, TContext());
            hasData = true;
        } catch (...) {
            Trace("TWriter_vmwesxi::WriteCustomHardwareInventoryReport -- Exception when writting table of class " +
                  table.GetClass());
        }
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(params.GetLinkName(), params.GetReportName(), hasData);
    Trace("TWriter_vmwesxi::WriteCustomHardwareInventoryReport -- Exiting");
}

namespace {

// One row of the merged "Firmware" table: the instance and what its four
// cells show. A fixed name or maker text stands where the provider has no
// property for it.
struct TFirmwareRow {
    TInstancePtr instance;
    std::string nameProperty;
    std::string nameText;
    std::string maker;
};

// The name a Cardinal controller's firmware goes by: "<model> Firmware" for
// a MegaRAID controller, "LSI <model> Controller Firmware" for the others.
std::string ControllerFirmwareName(TWriter_vmwesxi& writer, const TInstancePtr& system, const TInstancePtr& package) {
    const std::string model = writer.GetPropertyValue(package, "Model", " ");
    if (model.empty()) return std::string();
    if (Contains(ClassNameOf(system), "LSIESG_MegaRAIDHBA")) return model + " Firmware";
    return "LSI " + model + " Controller Firmware";
}

}  // namespace

void TWriter_vmwesxi::WriteCustomFirmwareReport(TReportParametersBuilder_vmwesxi builder) {
    Trace("TWriter_vmwesxi::WriteCustomFirmwareReport -- Entering");
    TReportParameters params = builder.BuildFirmwareParams();
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + params.GetLinkName());
    WritePageHeader();
    WriteReportTitle(params.GetReportName(), "", "");
    const std::vector<TReportClass>& classes = params.GetClasses();
    bool hasData = false;

    // The rows of the "Firmware" table: the management controller and the
    // devices, then the RAID controllers and the adapters whose providers
    // keep their firmware apart.
    std::vector<TFirmwareRow> rows;
    auto add = [&rows](const TInstances& instances, const std::string& nameProperty, const std::string& maker) {
        for (const TInstancePtr& instance : instances) rows.push_back({instance, nameProperty, "", maker});
    };
    try {
        add(TWriterUtil::GetInstances(fNamespace, classes[0]), "Name", "");
        add(TWriterUtil::GetInstances(fNamespace, classes[1]), "ElementName", "");

        const TReportClass controllerFirmware = builder.BuildLsiControllerParams().GetClasses()[1];
        for (const TInstancePtr& system : InstancesOf(builder, "CIM_ComputerSystem")) {
            for (const TInstancePtr& package : Associated(system, "LSIESG_SystemPackaging", "CIM_PhysicalPackage")) {
                if (Contains(ClassNameOf(package), "LSIESG_EnclosureChassis")) continue;
                const std::string name = ControllerFirmwareName(*this, system, package);
                for (const TInstancePtr& identity :
                     Associated(system, controllerFirmware.GetAssocClass(), controllerFirmware.GetResultClass())) {
                    rows.push_back({identity, "", name, ""});
                }
            }
        }

        const TReportParameters emulex = builder.BuildEmulexParams();
        add(TWriterUtil::GetInstances(fNamespace, emulex.GetClasses()[0]), "Name", "Emulex");
        add(TWriterUtil::GetInstances(fNamespace, emulex.GetClasses()[4]), "Name", "Emulex");
        add(TWriterUtil::GetInstances(fNamespace, builder.BuildQlogicParams().GetClasses()[0]), "Name", "");
        for (const TInstancePtr& identity :
             TWriterUtil::GetInstances(fNamespace, builder.BuildBrocadeAdapterParams().GetClasses()[2])) {
            // Option ROM images go with the BIOS, not here.
            if (!Contains(GetPropertyValue(identity, "Description", " "), "BIOS")) {
                rows.push_back({identity, "Description", "", ""});
            }
        }
    } catch (...) {
        Trace("TWriter_vmwesxi::WriteCustomFirmwareReport -- Exception when gathering firmware");
    }

    if (!rows.empty()) {
        TCIMContext context;
        WriteFirmwareTableHeader(rows.front().instance->GetClass(context));
        hasData = true;
        const TReportProperty nameCell("Name", "25%", "", "", "", "");
        for (const TFirmwareRow& row : rows) {
            StartRow(true);
            if (row.nameProperty.empty()) {
                WriteTextCell(nameCell, row.nameText, "");
            } else {
                WriteValueCell(row.instance, TReportProperty(row.nameProperty, "25%", "", "", "", ""), "");
            }
            if (row.maker.empty()) {
                WriteValueCell(row.instance, TReportProperty("Manufacturer", "25%", "", "", "", ""), "");
            } else {
                WriteTextCell(TReportProperty("Manufacturer", "25%", "", "", "", ""), row.maker, "");
            }
            WriteValueCell(row.instance, TReportProperty("VersionString", "25%", "", "", "", ""), "");
            WriteValueCell(row.instance, TReportProperty("BuildNumber", "25%", "", "", "", ""), "");
            EndRow();
        }
        EndTable();
        WriteTableBreak();
    }

    // BIOS, memory and power supply VPD as declared.
    for (size_t i = 2; i < classes.size(); ++i) {
        try {
            TInstances instances = TWriterUtil::GetInstances(fNamespace, classes[i]);
            if (instances.empty()) continue;
            WriteTable(classes[i], instances, true, false, TContext());
            hasData = true;
        } catch (...) {
            Trace("TWriter_vmwesxi::WriteCustomFirmwareReport -- Exception when writting table of class " +
                  classes[i].GetClass());
        }
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(params.GetLinkName(), params.GetReportName(), hasData);
    Trace("TWriter_vmwesxi::WriteCustomFirmwareReport -- Exiting");
}

namespace {

// The controller's model as its product names it, else the package's Model.
std::string ControllerModel(TWriter_vmwesxi& writer, const TInstancePtr& package) {
    for (const TInstancePtr& product : Associated(package, "LSIESG_ProductPhysicalComponent", "")) {
        const std::string name = writer.GetPropertyValue(product, "Name", " ");
        if (!name.empty()) return name;
    }
    return writer.GetPropertyValue(package, "Model", " ");
}

// The first text of `property` on the instances `system` reaches through
// `assocClass` to `resultClass`; `fallback` without one.
std::string ViaText(TWriter_vmwesxi& writer, const TInstancePtr& system, const std::string& assocClass,
                    const std::string& resultClass, const std::string& property, const std::string& fallback) {
    for (const TInstancePtr& found : Associated(system, assocClass, resultClass)) {
        const std::string text = writer.GetPropertyValue(found, property, " ");
        if (!text.empty()) return text;
    }
    return fallback;
}

TReportClass DriveTable(const std::string& className, const std::string& title,
                        const std::vector<TReportProperty>& rows) {
    TReportClass cls;
    cls.SetClass(className);
    cls.SetTitle(title);
    cls.SetReportStyle(TReportClass::ROW_REPORT);
    cls.SetRowReportHeaderWidth("30%");
    cls.SetTableWidth("80%");
    cls.SetMaxInstancesPerTable(4);
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties(rows);
    return cls;
}

TReportProperty Row(const std::string& property, const std::string& label = "") {
    return TReportProperty(property, "", "", "", label, "");
}

TReportProperty RowVia(const std::string& property, const std::string& assocClass, const std::string& target,
                       const std::string& label) {
    return TReportProperty(property, "", assocClass, target, label, "");
}

}  // namespace

void TWriter_vmwesxi::WriteLSIReportWithCardinal() {
    Trace("TWriter_vmwesxi::WriteLSIReportWithCardinal -- Entering");
    TReportParametersBuilder_vmwesxi builder(fNamespace, fMode);
    TReportParameters params = builder.BuildLsiControllerParams();
    const TReportClass& bios = params.GetClasses()[0];
    const TReportClass& firmware = params.GetClasses()[1];
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + params.GetLinkName());
    WritePageHeader();
    WriteReportTitle(params.GetReportName(), "", "");

    const TReportClass volumes = DriveTable(
        "LSIESG_StorageVolume", "Logical drive information",
        {Row("Name", "VolumeName"), Row("OperationalStatus"),
         RowVia("ElementName", "LSIESG_ElementSettingData", "LSIESG_StorageVolumeSetting", "RAIDLevel"),
         RowVia("Name", "LSIESG_ConcreteDependency", "LSIESG_DiskExtent", "Disk extents")});
    const TReportClass drives = DriveTable(
        "LSIESG_DiskDrive", "Physical drive information",
        {Row("Name"), Row("ElementName"), Row("OperationalStatus"),
         RowVia("FRUNumber", "LSIESG_Realizes", "LSIESG_PhysicalDrive", "FRU Number"),
         RowVia("BlockSize", "LSIESG_MediaPresent", "LSIESG_DiskExtent", ""),
         RowVia("NumberOfBlocks", "LSIESG_MediaPresent", "LSIESG_DiskExtent", ""),
         RowVia("Vendor", "LSIESG_Realizes", "LSIESG_PhysicalDrive", "Manufacturer"),
         RowVia("VersionString", "LSIESG_ElementSoftwareIdentity", "LSIESG_DriveFirmwareIdentity",
                "Firmware version")});

    bool noCard = true;
    for (const TInstancePtr& system : InstancesOf(builder, "CIM_ComputerSystem")) {
        for (const TInstancePtr& package : Associated(system, "LSIESG_SystemPackaging", "CIM_PhysicalPackage")) {
            if (Contains(ClassNameOf(package), "LSIESG_EnclosureChassis")) continue;
            noCard = false;
            try {
                std::vector<std::pair<std::string, std::string>> info = {
                    {"Model", ControllerModel(*this, package)},
                    {"Name", GetPropertyValue(system, "ElementName", " ")},
                    {"BIOS Version",
                     ViaText(*this, system, bios.GetAssocClass(), bios.GetResultClass(), "VersionString", "")},
                    {"Firmware Version",
                     ViaText(*this, system, firmware.GetAssocClass(), firmware.GetResultClass(), "VersionString",
                             "N/A")}};
                if (ClassNameOf(system) == "LSIESG_MegaRAIDHBA") {
                    info.push_back({"FW Package Build version",
                                    ViaText(*this, system, "LSIESG_ElementSoftwareIdentity",
                                            "LSIESG_FirmwarePackageIdentity", "VersionString", "N/A")});
                }
                WriteTableTitle("Controller Information", false, false);
                TTable grid = PropertyGrid(info, "50%", "40%");
                WriteTableGrid(grid);
                WriteTableBreak();

                for (const TReportClass* table : {&volumes, &drives}) {
                    TInstances found = Associated(system, "LSIESG_SystemDevice", table->GetClass());
                    if (found.empty()) continue;
                    TWriterUtil::SortInstances(found, table->GetInstanceSorter(), true);
                    WriteTable(*table, found, true, false, TContext());
                }
            } catch (...) {
                Trace("TWriter_vmwesxi::WriteLSIReportWithCardinal -- Exception when process " +
                      GetPropertyValue(system, "ElementName", " "));
            }
        }
    }
    if (noCard) {
        TTable message(1, 1, false);
        message.fColumnHeaders = false;
        message.fColumnWidths[0] = 100;
        message.Cell(0, 0).text = "No LSI RAID card detected\n";
        WriteTableGrid(message);
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(params.GetLinkName(), params.GetReportName(), !noCard);
    Trace("TWriter_vmwesxi::WriteLSIReportWithCardinal -- Exiting");
}

}  // namespace braigrion
