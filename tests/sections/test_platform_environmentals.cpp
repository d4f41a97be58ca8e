// The "Environmentals" page: which sensors are listed, how a reading is
// scaled, and when the service processor's sensors stand in.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "report/EngineFixture.h"
#include "report/ExpectedPage.h"
#include "sections/PlatformRepo.h"

namespace braigrion {
namespace {

using testing::TEngineRun;
using testing::TRepoBuilder;

struct TPage {
    std::string transcript;
    std::vector<std::string> grids;
    std::vector<std::string> log;
};

TPage WriteEnvironmentals(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, bool kmc = false) {
    TEngineRun<> run(ns, "html", "default", kmc);
    run.writer.WriteEnvironmentalsReport(boost::make_shared<TReportParametersBuilder>(ns, "default", kmc), "");
    return TPage{run.Transcript(), run.Grids(), run.log.Messages()};
}

boost::shared_ptr<NORVTKR20::ICIMNamespace> Repo(const std::string& text) {
    TRepoBuilder repo;
    repo.Parse(text);
    return repo.Namespace();
}

// The reading times ten to the modifier, in six significant digits.
TEST(Environmentals, ScalesTheReadingByItsModifier) {
    struct TCase {
        const char* reading;
        const char* modifier;
        const char* shown;
    };
    const TCase cases[] = {{"sint32:255", "sint32:-1", "\"25.5\""},
                           {"sint32:42", "sint32:0", "\"42\""},
                           {"sint32:2375", "sint32:-2", "\"23.75\""},
                           {"sint32:12", "sint32:3", "\"12000\""},
                           {"sint32:1234567", "sint32:0", "\"1.23457e+06\""},
                           {"sint32:5", "null:sint32", "\"\""}};
    for (const TCase& c : cases) {
        const TPage page = WriteEnvironmentals(Repo(std::string("CIM_NumericSensor SensorDescription=\"Ambient\" ") +
                                                    "CurrentReading=" + c.reading + " UnitModifier=" + c.modifier +
                                                    " BaseUnits=\"Degrees C\""));
        ASSERT_EQ(1u, page.grids.size()) << page.transcript;
        EXPECT_NE(std::string::npos, page.grids[0].find(std::string("| \"Ambient\" ") + c.shown + " \"Degrees C\""))
            << c.reading << " " << c.modifier << "\n" << page.grids[0];
    }
}

// Sensors without a name or in state "Unknown" are left out; the others are
// sorted by node, then name. Under KMC the name is the element name.
TEST(Environmentals, ListsNamedSensorsInOrder) {
    const std::string sensors = R"(
        ORVSG_ComputerSystem Name="srv" SystemNodes=uint8:2
        CIM_NumericSensor SensorDescription="Fan 2" ElementName="FAN2" SourceNode="Node 2" NodeID="2" CurrentReading=sint32:5400 UnitModifier=sint32:0 BaseUnits="RPM" OperationalStatus="OK"
        CIM_NumericSensor SensorDescription="Fan 1" ElementName="" SourceNode="Node 1" NodeID="1" CurrentReading=sint32:5300 UnitModifier=sint32:0 BaseUnits="RPM"
        CIM_NumericSensor SensorDescription="Planar 3.3V" ElementName="3V3" SourceNode="Node 1" NodeID="1" CurrentReading=sint32:331 UnitModifier=sint32:-2 BaseUnits="Volts"
        CIM_NumericSensor SensorDescription="" ElementName="PSU" SourceNode="Node 1" NodeID="1" CurrentReading=sint32:1 UnitModifier=sint32:0
        CIM_NumericSensor SensorDescription="CPU 1 Temp" ElementName="CPU1" SourceNode="Node 1" NodeID="1" CurrentReading=sint32:45 UnitModifier=sint32:0 OperationalStatus="Unknown"
    )";
    const TPage plain = WriteEnvironmentals(Repo(sensors));
    const TPage kmc = WriteEnvironmentals(Repo(sensors), true);
    const std::string both = plain.transcript + "-- KMC --\n" + kmc.transcript;
    EXPECT_EQ(testing::ExpectedPage("platform/environmentals-sensors.txt", both), both);
}

// A repository without numeric sensors has the page with its heading only,
// even when the service processor has sensors; so has one whose sensors are
// all in state "Unknown".
TEST(Environmentals, EmptyPageWithoutUsableSensors) {
    const std::string spSensor =
        "ORVSG_SP_NumericSensor SensorDescription=\"Ambient\" CurrentReading=sint32:22 UnitModifier=sint32:0\n";
    for (const std::string& text :
         {spSensor, std::string("CIM_NumericSensor SensorDescription=\"Ambient\" OperationalStatus=\"Unknown\"\n")}) {
        const TPage page = WriteEnvironmentals(Repo(text));
        EXPECT_TRUE(page.grids.empty()) << page.transcript;
        EXPECT_NE(std::string::npos,
                  page.transcript.find("WriteIndexEntry(\"Environmentals\", \"Environmentals\", false)"))
            << page.transcript;
        EXPECT_EQ(std::string::npos, page.transcript.find("WriteSensorCell")) << page.transcript;
    }
}

// When the numeric sensors cannot be read at all, the service processor's
// sensors are listed instead, unsorted, each reading through the back-end's
// sensor cell; without them there is no page, only the index line.
TEST(Environmentals, FallsBackToTheServiceProcessorSensors) {
    const std::string spSensors = R"(
        ORVSG_SP_NumericSensor SensorDescription="Planar Temp" SourceNode="Node 1" CurrentReading=sint32:2375 UnitModifier=sint32:-2 BaseUnits="Degrees C"
        ORVSG_SP_NumericSensor SensorDescription="Ambient Temp" SourceNode="Node 1" CurrentReading=sint32:22 UnitModifier=sint32:0 BaseUnits="Degrees C"
    )";
    auto broken = [](const std::string& text) {
        return boost::make_shared<testing::TBrokenClassNamespace>(Repo(text), "CIM_NumericSensor");
    };
    const TPage single = WriteEnvironmentals(broken(spSensors));
    const TPage multi = WriteEnvironmentals(broken("ORVSG_ComputerSystem Name=\"srv\" SystemNodes=uint8:2\n" + spSensors));
    const TPage none = WriteEnvironmentals(broken("class ORVSG_SP_NumericSensor\n"));
    const std::string all = single.transcript + "-- multi-node --\n" + multi.transcript + "-- no sensors --\n" +
                            none.transcript;
    EXPECT_EQ(testing::ExpectedPage("platform/environmentals-backup.txt", all), all);
    for (const TPage* page : {&single, &multi, &none}) {
        EXPECT_EQ(1, std::count(page->log.begin(), page->log.end(),
                                "TWriter::WriteEnvironmentalsReport --Exception when nvoking WriteEnvironmentalsPreferred"));
    }
    EXPECT_EQ(1, std::count(none.log.begin(), none.log.end(),
                            "TWriter::WriteEnvironmentalsBackup -- Exiting due to empty instance vector"));
}

}  // namespace
}  // namespace braigrion
