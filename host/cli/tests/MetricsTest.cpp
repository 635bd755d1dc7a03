// Alarm devices for Prometheus: the text, the process that asks, the file that is replaced, and the command.

#include "cli/Metrics.h"
#include "cim/Values.h"
#include "cli/Program.h"
#include "cli/metrics/AlarmDevices.h"
#include "cli/metrics/Apart.h"
#include "cli/metrics/Exposition.h"
#include "cli/metrics/ReplaceFile.h"

#include "Lamp.h"
#include "testing/TemporaryDirectory.h"

#include <array>
#include <csignal>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <utility>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <poll.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

using namespace cimhost;
using namespace cimhost::cli;
using testing::ContainsRegex;
using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;
using Testing::TemporaryDirectory;

namespace {

// The text

std::string gaugeWith(const std::string& value)
{
    Exposition exposition;
    exposition.begin("n", "h");
    exposition.gauge({{"l", value}}, "1");
    return exposition.text();
}

TEST(Exposition, escapesLabelsAsTheFormatWants)
{
    const std::string head = "# HELP n h\n# TYPE n gauge\n";
    EXPECT_EQ(gaugeWith("Fan 1"), head + "n{l=\"Fan 1\"} 1\n");
    EXPECT_EQ(gaugeWith("a\"b\\c\nd"), head + "n{l=\"a\\\"b\\\\c\\nd\"} 1\n");
    EXPECT_EQ(gaugeWith("L\u00fcfter\t{2}, #"), head + "n{l=\"L\u00fcfter\t{2}, #\"} 1\n");
    EXPECT_EQ(gaugeWith("\xff\xc3"), head + "n{l=\"\uFFFD\uFFFD\"} 1\n")
        << "Prometheus refuses all of a text "
           "that is not UTF-8";
}

TEST(Exposition, writesGaugesWithAndWithoutLabels)
{
    Exposition exposition;
    exposition.begin("one", "First.");
    exposition.gauge({}, "0.5");
    exposition.begin("two", "Second.");
    exposition.gauge({{"a", "x"}, {"b", "y"}}, "2");
    EXPECT_EQ(exposition.text(), "# HELP one First.\n# TYPE one gauge\none 0.5\n"
                                 "# HELP two Second.\n# TYPE two gauge\ntwo{a=\"x\",b=\"y\"} 2\n");
}

// The gauges

cim::Answer lampsAnswer(std::initializer_list<cim::Instance> instances)
{
    return {{}, {}, instances};
}

cim::Instance lampWithStatus(const std::vector<cim::Value::Scalar>& status)
{
    cim::Instance instance = lamp("L:/1", 10, 3);
    for (cim::Property& property : instance.properties)
        if (property.name == "OperationalStatus")
            property.value = cim::arrayValue(CMPI_uint16, status);
    return instance;
}

// The whole text: names and labels are an interface from the first release on.
TEST(AlarmDeviceGauges, areAnInterface)
{
    EXPECT_EQ(
        alarmDeviceGauges(
            lampsAnswer({lampWithStatus({std::uint64_t{3}, std::uint64_t{5}}), lamp("L:/2", 5, 1)})),
        R"(# HELP cim_alarm_device_alarm_state What the device shows: 0 unknown, 1 off, 2 steady, 3 alternating.
# TYPE cim_alarm_device_alarm_state gauge
cim_alarm_device_alarm_state{id="L:/1",name="L"} 3
cim_alarm_device_alarm_state{id="L:/2",name="L"} 1
# HELP cim_alarm_device_health_state Health of the part that the device belongs to: 0 unknown, 5 OK, 10 degraded, 15 minor, 20 major, 25 critical failure, 30 non-recoverable error.
# TYPE cim_alarm_device_health_state gauge
cim_alarm_device_health_state{id="L:/1",name="L"} 10
cim_alarm_device_health_state{id="L:/2",name="L"} 5
# HELP cim_alarm_device_operational_status 1 for each status that the part has which the device belongs to.
# TYPE cim_alarm_device_operational_status gauge
cim_alarm_device_operational_status{id="L:/1",name="L",status="Degraded"} 1
cim_alarm_device_operational_status{id="L:/1",name="L",status="Predictive Failure"} 1
cim_alarm_device_operational_status{id="L:/2",name="L",status="OK"} 1
# HELP cim_alarm_devices How many alarm devices there are.
# TYPE cim_alarm_devices gauge
cim_alarm_devices 2
)");
}

TEST(CollectionGauges, areAnInterface)
{
    using namespace std::chrono;
    const Collection failed{false, milliseconds(1250), system_clock::time_point(milliseconds(1700000000125))};
    EXPECT_EQ(
        collectionGauges(failed),
        R"(# HELP cim_alarm_device_collection_success Whether the alarm devices were collected; if not, none is here.
# TYPE cim_alarm_device_collection_success gauge
cim_alarm_device_collection_success 0
# HELP cim_alarm_device_collection_duration_seconds How long collecting them took.
# TYPE cim_alarm_device_collection_duration_seconds gauge
cim_alarm_device_collection_duration_seconds 1.250000
# HELP cim_alarm_device_collection_timestamp_seconds When that ended, in seconds since 1970.
# TYPE cim_alarm_device_collection_timestamp_seconds gauge
cim_alarm_device_collection_timestamp_seconds 1700000000.125
)");
    EXPECT_THAT(collectionGauges({true, {}, {}}), HasSubstr("\ncim_alarm_device_collection_success 1\n"));
}

TEST(AlarmDeviceGauges, haveEachStatusOnce)
{
    const std::string text = alarmDeviceGauges(
        lampsAnswer({lampWithStatus({std::uint64_t{3}, std::uint64_t{3}, std::uint64_t{40000}})}));
    EXPECT_THAT(
        text, HasSubstr("status=\"Degraded\"} 1\n"
                        "cim_alarm_device_operational_status{id=\"L:/1\",name=\"L\",status=\"40000\"} 1\n"));
    EXPECT_THAT(text, Not(ContainsRegex("Degraded.*\n.*Degraded")));
    EXPECT_THAT(alarmDeviceGauges(lampsAnswer({lampWithStatus({})})), Not(HasSubstr("status=")));
}

TEST(AlarmDeviceGauges, showWhatIsMissingAsUnknown)
{
    cim::Instance bare = lamp("L:/1");
    bare.properties.clear();
    bare.properties.push_back({"HealthState", cim::nullValue(CMPI_uint16)});
    const std::string text = alarmDeviceGauges(lampsAnswer({bare}));
    EXPECT_THAT(text, HasSubstr("alarm_state{id=\"L:/1\",name=\"\"} 0\n"));
    EXPECT_THAT(text, HasSubstr("health_state{id=\"L:/1\",name=\"\"} 0\n"));
}

std::string refusalOf(const cim::Answer& answer)
{
    try {
        return alarmDeviceGauges(answer);
    } catch (const NoPicture& error) {
        return error.what();
    }
}

TEST(AlarmDeviceGauges, areNoneWithoutAPicture)
{
    cim::Answer failed = lampsAnswer({lamp("L:/1")});
    failed.status = {CMPI_RC_ERR_FAILED, "no hardware"};
    EXPECT_EQ(refusalOf(failed), "CMPI_RC_ERR_FAILED (1): no hardware");
    EXPECT_EQ(refusalOf({}), "there is no alarm device, or what has them cannot be read");
    EXPECT_EQ(refusalOf(lampsAnswer({lamp("L:/1"), lamp("L:/2"), lamp("L:/1")})),
              "two alarm devices have the DeviceID \"L:/1\"");
    EXPECT_EQ(refusalOf(lampsAnswer({lamp("\xff"), lamp("\xfe")})),
              "two alarm devices have the DeviceID \"\uFFFD\"");
    EXPECT_EQ(refusalOf(lampsAnswer({lamp("")})), "an alarm device has no DeviceID");
}

// The process that asks

std::string failureOf(const std::function<std::string()>& work,
                      std::chrono::milliseconds limit = std::chrono::seconds(30))
{
    try {
        return "no failure: " + doApart(work, limit);
    } catch (const ApartError& error) {
        return error.what();
    }
}

TEST(Apart, returnsWhatTheWorkReturns)
{
    EXPECT_EQ(doApart([] { return std::string(); }, std::chrono::seconds(30)), "");
    const std::string large(1000000, 'm');
    EXPECT_EQ(doApart([&] { return std::string(large); }, std::chrono::seconds(30)), large);
    const pid_t here = getpid();
    EXPECT_EQ(
        doApart([&] { return std::string(getpid() == here ? "here" : "apart"); }, std::chrono::seconds(30)),
        "apart");
}

TEST(Apart, tellsWhatBecameOfTheWork)
{
    EXPECT_EQ(failureOf([]() -> std::string { throw std::runtime_error("why"); }), "why");
    EXPECT_EQ(failureOf([]() -> std::string { throw 1; }), "an exception of an unknown kind");
    EXPECT_THAT(failureOf([]() -> std::string {
                    raise(SIGKILL);
                    return "";
                }),
                StartsWith("the process that asked the provider ended with signal 9 ("));
    EXPECT_EQ(failureOf([]() -> std::string { _exit(7); }),
              "the process that asked the provider ended with exit status 7");
}

TEST(Apart, endsWorkThatTakesTooLong)
{
    const auto sleepForever = []() -> std::string {
        while (true)
            pause();
    };
    EXPECT_EQ(failureOf(sleepForever, std::chrono::milliseconds(50)), "there was no answer within 50 ms");
}

TEST(Apart, endsTheWorkWhereThisProcessEnds)
{
    std::array<int, 2> ends{-1, -1};
    ASSERT_EQ(pipe(ends.data()), 0);
    const auto writeAndSleep = [&]() -> std::string {
        static_cast<void>(write(ends[1], "x", 1));
        sleep(60); // longer than is waited for below
        return "";
    };
    const pid_t process = fork();
    if (process == 0) {
        doApart(writeAndSleep, std::chrono::hours(1));
        _exit(0);
    }
    close(ends[1]);
    char byte = 0;
    EXPECT_EQ(::read(ends[0], &byte, 1), 1);
    kill(process, SIGKILL);
    waitpid(process, nullptr, 0);
    pollfd left{ends[0], POLLIN, 0};
    EXPECT_EQ(poll(&left, 1, 20000), 1) << "nobody has the pipe any more";
    close(ends[0]);
}

// The file that is replaced

std::string contentOf(const std::string& file)
{
    std::ostringstream content;
    content << std::ifstream(file).rdbuf();
    return content.str();
}

std::ptrdiff_t filesIn(const std::filesystem::path& directory)
{
    return std::distance(std::filesystem::directory_iterator(directory), {});
}

std::string complaintAbout(const std::string& file, const std::string& content)
{
    try {
        replaceFile(file, content);
        return "";
    } catch (const ReplaceError& error) {
        return error.what();
    }
}

TEST(ReplaceFile, makesAndReplacesWithTheMode)
{
    const TemporaryDirectory directory;
    const std::string file = directory.path("f.prom");
    const mode_t before = umask(077);
    replaceFile(file, "one");
    EXPECT_EQ(contentOf(file), "one");
    struct stat first
    {};
    ASSERT_EQ(stat(file.c_str(), &first), 0);
    EXPECT_EQ(first.st_mode & 07777U, 0644U);
    const std::ifstream reader(file);
    replaceFile(file, "two");
    umask(before);
    std::ostringstream read;
    read << reader.rdbuf();
    EXPECT_EQ(read.str(), "one") << "who reads the old one reads all of it";
    EXPECT_EQ(contentOf(file), "two");
    EXPECT_EQ(filesIn(directory.path()), 1);
}

TEST(ReplaceFile, leavesTheOldOneWhereTheNewOneDoesNotFit)
{
    const TemporaryDirectory directory;
    const std::string file = directory.path("f.prom");
    replaceFile(file, "old");
    rlimit before{};
    ASSERT_EQ(getrlimit(RLIMIT_FSIZE, &before), 0);
    const rlimit small{1000, before.rlim_max};
    const auto handler = std::signal(SIGXFSZ, SIG_IGN);
    ASSERT_EQ(setrlimit(RLIMIT_FSIZE, &small), 0);
    const std::string complaint = complaintAbout(file, std::string(2000, 'n'));
    setrlimit(RLIMIT_FSIZE, &before);
    std::signal(SIGXFSZ, handler);
    EXPECT_EQ(complaint, "cannot write " + file + ": File too large");
    EXPECT_EQ(contentOf(file), "old");
    EXPECT_EQ(filesIn(directory.path()), 1) << "what was begun is gone";
}

TEST(ReplaceFile, saysWhereItCannot)
{
    const TemporaryDirectory directory;
    EXPECT_EQ(complaintAbout(directory.path("none/f"), "x"),
              "cannot write " + directory.path("none/f") + ": No such file or directory");
    std::filesystem::create_directory(directory.path("folder"));
    EXPECT_EQ(complaintAbout(directory.path("folder"), "x"),
              "cannot write " + directory.path("folder") + ": Is a directory");
    EXPECT_EQ(filesIn(directory.path()), 1);
}

// The command

struct MetricsOutcome
{
    int status;
    std::string out;
    std::string err;
};

MetricsOutcome runMetrics(std::vector<std::string> arguments)
{
    const Surroundings surroundings{"/nowhere/bin", SAMPLE_PROVIDER_DIRECTORY, SAMPLE_REGISTRATION};
    arguments.insert(arguments.begin(), "metrics");
    std::ostringstream out;
    std::ostringstream err;
    const int status = cimhost::cli::run(arguments, surroundings, std::nullopt, out, err).status;
    return {status, out.str(), err.str()};
}

void expectFailure(const MetricsOutcome& outcome, const std::string& why)
{
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.err, EndsWith("cimhost: no metrics: " + why + '\n'));
    EXPECT_THAT(outcome.out, HasSubstr("\ncim_alarm_device_collection_success 0\n"));
    EXPECT_THAT(outcome.out, Not(HasSubstr("state"))) << "no device looks healthy";
    EXPECT_THAT(outcome.out, Not(HasSubstr("cim_alarm_devices")));
}

class MetricsCommand : public testing::Test
{
protected:
    void TearDown() override { unsetenv("CIMT_INVENTORY"); }

    std::string inventory(const std::string& text)
    {
        std::ofstream(directory.path("inventory")) << text;
        return directory.path("inventory");
    }

    TemporaryDirectory directory;
};

TEST_F(MetricsCommand, showsTheDevices)
{
    const MetricsOutcome outcome = runMetrics({"CIMT_Lamp"});
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(outcome.err, "");
    EXPECT_THAT(outcome.out,
                HasSubstr("\ncim_alarm_device_alarm_state{id=\"L\u00fcfter \\\"2\\\", a=b\\\\c\","
                          "name=\"L\u00fcfter 2\"} 3\n"));
    EXPECT_THAT(outcome.out, HasSubstr("\ncim_alarm_devices 2\n"));
    EXPECT_THAT(outcome.out, HasSubstr("\ncim_alarm_device_collection_success 1\n"));
    EXPECT_THAT(outcome.out,
                ContainsRegex("\ncim_alarm_device_collection_duration_seconds [0-9]+\\.[0-9]{6}\n(#.*\n)+"
                              "cim_alarm_device_collection_timestamp_seconds [0-9]{10,}\\.[0-9]{3}\n$"));
}

TEST_F(MetricsCommand, asksForWhateverIsAnAlarmDevice)
{
    std::ofstream(directory.path("lamp.mof"))
        << "class CIM_AlarmDevice { [Key] string DeviceID; };\n"
           "class CIMT_Lamp : CIM_AlarmDevice { [Key] string CreationClassName; };\n";
    EXPECT_THAT(runMetrics({"--schema", directory.path("lamp.mof")}).out,
                HasSubstr("\ncim_alarm_devices 2\n"));
    expectFailure(runMetrics({}), "CMPI_RC_ERR_INVALID_CLASS (5): no provider is registered for the class "
                                  "CIM_AlarmDevice in root/cimv2");
}

TEST_F(MetricsCommand, neverShowsAFailureAsHealth)
{
    expectFailure(runMetrics({"CIMT_Lamp", "--inventory", inventory("lamp a 5 1\nerror no hardware")}),
                  "CMPI_RC_ERR_FAILED (1): no hardware");
    expectFailure(runMetrics({"CIMT_Lamp", "--inventory", inventory("")}),
                  "there is no alarm device, or what has them cannot be read");
    expectFailure(runMetrics({"CIMT_Lamp", "--inventory", "/nowhere"}),
                  "cannot read the inventory /nowhere: No such file or directory");
    expectFailure(runMetrics({"CIMT_Lamp", "--registration", "/nowhere/r.reg"}),
                  "/nowhere/r.reg: cannot be read: No such file or directory");
    expectFailure(runMetrics({"CIMT_Lamp", "--inventory", inventory("lamp a 5 1\ncrash")}),
                  "the process that asked the provider ended with signal 6 (Aborted)");
    expectFailure(runMetrics({"CIMT_Lamp", "--limit", "1", "--inventory", inventory("lamp a 5 1\nhang")}),
                  "there was no answer within 1000 ms");
}

TEST(MetricsOfABroker, neverShowAFailureAsHealth)
{
    Broker broker({}, {});
    const std::string text = expositionOf({"", "root/cimv2", "CIM_AlarmDevice", {}}, broker);
    EXPECT_THAT(text, StartsWith("# HELP cim_alarm_device_collection_success"));
    EXPECT_THAT(text, HasSubstr("\ncim_alarm_device_collection_success 0\n"));
}

TEST_F(MetricsCommand, replacesTheFileWhateverItFinds)
{
    const std::string file = directory.path("lamps.prom");
    const MetricsOutcome good = runMetrics({"CIMT_Lamp", "--output", file});
    EXPECT_EQ(good.status, 0);
    EXPECT_EQ(good.out, "");
    EXPECT_THAT(contentOf(file), HasSubstr("\ncim_alarm_device_collection_success 1\n"));
    EXPECT_EQ(runMetrics({"CIMT_Broken", "--output", file}).status, 1);
    EXPECT_THAT(contentOf(file), StartsWith("# HELP cim_alarm_device_collection_success"))
        << "an old picture does not stay";
    EXPECT_THAT(contentOf(file), HasSubstr("\ncim_alarm_device_collection_success 0\n"));
}

TEST_F(MetricsCommand, saysIfTheFileCannotBeWritten)
{
    const MetricsOutcome outcome = runMetrics({"CIMT_Lamp", "--output", "/nowhere/f.prom"});
    EXPECT_EQ(outcome.status, 1);
    EXPECT_EQ(outcome.out, "");
    EXPECT_EQ(outcome.err, "cimhost: cannot write /nowhere/f.prom: No such file or directory\n");
}

} // namespace
