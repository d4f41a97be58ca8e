// Definitions of the adapter pages of outside vendors: firmware, boot code
// and driver tables of each vendor's own classes. The Emulex and QLogic pages
// are written by their sections, which put a raw-data page in front in LUZ
// mode; the Broadcom page goes straight to the generic page writer.
#include "CatalogueSupport.h"
#include "braigrion/TReportParametersBuilder.h"

namespace braigrion {

using namespace catalogue;

namespace {

// A firmware image of a QLogic function and the device it runs on.
TColumns QlogicFirmwareColumns() {
    return {Column("Name", "30%"), Column("Manufacturer", "20%"),
            Via("OtherIdentifyingInfo", "30%", "ORVSG_DeviceFirmware", "CIM_LogicalDevice", "Device"),
            Column("Version", "20%")};
}

TColumns NameAndVersion() {
    return {Column("Name", "50%"), Column("Version", "50%")};
}

}  // namespace

TReportParameters TReportParametersBuilder::BuildBroadcomParams() const {
    TTrace trace("TReportParametersBuilder::BuildBroadcomParams");
    TReportParameters params = Page("broadcom", "Broadcom");
    TReportClass cls;
    cls.SetClass("ORVSG_BcmDeviceFirmwareElement");
    cls.SetTitle("Broadcom Firmware");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties(NameAndVersion());
    params.SetClasses({cls});
    return params;
}

// One class object serves every table of the page: each table adds its sort
// key to those of the tables before it. The repeated "Name" keys leave the
// order as one key would.
TReportParameters TReportParametersBuilder::BuildQlogicParams() const {
    TTrace trace("TReportParametersBuilder::BuildQlogicParams");
    TReportParameters params = Page("Qlogic", "Qlogic");
    TClasses classes;
    TReportClass cls;
    struct TTableEntry {
        const char* cimClass;
        const char* title;
        bool firmware;  // firmware with its device; otherwise name and version
    };
    static const TTableEntry kTables[] = {
        {"ORVSG_QLogicFibreChannelFirmwareElement", "Qlogic Fibre Channel Firmware", true},
        {"ORVSG_QLogicFibreChannelBIOSElement", "Qlogic Fibre Channel BIOS", false},
        {"ORVSG_QLogicIScsiFirmwareElement", "Qlogic iSCSI Firmware", true},
        {"ORVSG_QLogicIScsiBIOSElement", "Qlogic iSCSI BIOS", false},
        {"ORVSG_QLogicCnaNICFirmwareElement", "Qlogic CNA Firmware", true},
        {"ORVSG_QLogicCnaNICBIOSElement", "Qlogic CNA Flash Package", false},
    };
    for (const TTableEntry& table : kTables) {
        cls.SetClass(table.cimClass);
        cls.SetTitle(table.title);
        cls.GetInstanceSorter().AddProperty("Name", true, false);
        cls.SetProperties(table.firmware ? QlogicFirmwareColumns() : NameAndVersion());
        classes.push_back(cls);
    }
    params.SetClasses(classes);
    return params;
}

TReportParameters TReportParametersBuilder::BuildEmulexParams() const {
    TTrace trace("TReportParametersBuilder::BuildEmulexParams");
    TReportParameters params = Page("emulex", "Emulex");
    TClasses classes;
    TReportClass cls;

    cls.SetClass("EMXCNA_Product");
    cls.SetTitle("EMXCNA Product");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties({Column("Name", "50%"), Column("IdentifyingNumber", "50%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("EMXCNA_FirmwareVersion");
    cls.SetTitle("EMXCNA Firmware");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties(NameAndVersion());
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("EMXCNA_SoftwareIdentity");
    cls.SetTitle("EMXCNA Driver");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties({Column("Name", "50%"), Column("VersionString", "50%")});
    classes.push_back(cls);

    // One activation record per table: the records are long and read one by one.
    cls.Reset();
    cls.SetClass("ELXUCNA_KoSIDData");
    cls.SetTitle("Emulex KoS Activation Information");
    RowReport(cls, "20%", "100%", 1);
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.GetInstanceSorter().AddProperty("InstanceID", true, false);
    cls.SetProperties({Labelled("InstanceID", "", "Instance ID"), Labelled("KoSId", "", "KoS ID"),
                       Labelled("KoSType", "", "Type"), Labelled("KoSState", "", "State"),
                       Labelled("ChangeableType", "", "Changeable Type")});
    classes.push_back(cls);

    params.SetClasses(classes);
    return params;
}

// The generic form of the Brocade page, each table holding what is reached
// from the port controller. Like the QLogic page it reuses one class object,
// so the sort keys add up and the table width of the first table stays.
TReportParameters TReportParametersBuilder::BuildBrocadeParams() const {
    TTrace trace("TReportParametersBuilder::BuildBrocadeParams");
    TReportParameters params = Page("brocade_adapter", "Brocade Adapter");
    TClasses classes;
    TReportClass cls;

    cls.SetClass("BROCADE_FCPort");
    cls.SetTitle("FC Port");
    cls.SetTableWidth("60%");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetAssociatorsFilter("BROCADE_ControlledBy", "BROCADE_FCPort", "", "");
    cls.SetProperties({Labelled("PortNumber", "10%", "Physical PortNumber"), Column("DeviceID", "30%"),
                       Column("Caption", "30%")});
    classes.push_back(cls);

    cls.SetClass("BROCADE_EthernetPort");
    cls.SetTitle("Ethernet Port");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetAssociatorsFilter("BROCADE_EthernetPortControlledBy", "BROCADE_EthernetPort", "", "");
    cls.SetProperties({Labelled("PortNumber", "8%", "Physical PortNumber"), Column("DeviceID", "20%"),
                       Column("PortType", "20%"), Column("ElementName", "20%"), Column("PermanentAddress", "20%"),
                       Column("NetworkAddresses", "20%")});
    classes.push_back(cls);

    cls.SetClass("BROCADE_AdapterSoftwareIdentity");
    cls.SetTitle("Adapter Software");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetAssociatorsFilter("BROCADE_AdapterElementSoftwareIdentity", "BROCADE_AdapterSoftwareIdentity", "", "");
    cls.SetProperties({Column("InstanceID", "30%"), Column("Description", "30%"),
                       Labelled("VersionString", "40%", "Version")});
    classes.push_back(cls);

    params.SetClasses(classes);
    return params;
}

}  // namespace braigrion
