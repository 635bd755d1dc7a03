// A walk over the LEDs and drive slots of a large server beside reading the same files and nothing else, the
// names known before: the time per indicator of both.

#include "Pairs.h"

#include <Tavro/Instrumentation.h>

#include "testing/Environment.h"
#include "testing/TemporaryDirectory.h"

#include <array>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <vector>

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;

constexpr int indicatorCount = 2400; ///< of 2000 LEDs and of 200 slots with two each

[[noreturn]] void fail(const char* what)
{
    std::fprintf(stderr, "%s\n", what);
    std::exit(1); // NOLINT(concurrency-mt-unsafe)
}

/// A tree like sysfs, for as long as the process runs.
const std::string& largeServer()
{
    static const Testing::TemporaryDirectory directory;
    static const std::string tree = [] {
        std::string made = directory.path("sys");
        const std::string command = MAKE_TREE " large " + made + " 2000 200 >/dev/null";
        if (std::system(command.c_str()) != 0) // NOLINT(cert-env33-c)
            fail("The tree of a large server cannot be made.");
        return made;
    }();
    return tree;
}

/// By their paths among the devices of their classes, as the walk finds them.
std::vector<std::string> attributesOf(const std::string& tree)
{
    std::vector<std::string> files;
    for (const fs::directory_entry& led : fs::directory_iterator(tree + "/class/leds"))
        for (const char* const name : {"trigger", "brightness"})
            files.push_back(led.path() / name);
    for (const fs::directory_entry& enclosure : fs::directory_iterator(tree + "/class/enclosure"))
        for (const fs::directory_entry& slot : fs::directory_iterator(enclosure.path()))
            if (slot.is_directory() && !slot.is_symlink())
                for (const char* const name : {"status", "fault", "locate"})
                    files.push_back(slot.path() / name);
    return files;
}

void walk()
{
    int found = 0;
    Tavro::Instrumentation cursor;
    for (cursor.selectNode(Tavro::NodeLexicon::DiagnosticIndicator); cursor; ++cursor) {
        unsigned int alarmState = 0;
        benchmark::DoNotOptimize(cursor.getNodeDescription());
        benchmark::DoNotOptimize(cursor.convertPathToString(cursor.getPathToNode()));
        benchmark::DoNotOptimize(cursor.getNodeStatus());
        benchmark::DoNotOptimize(cursor.getProperty(Tavro::NodeLexicon::AlarmState, alarmState));
        ++found;
    }
    if (found != indicatorCount)
        fail("The walk does not find every indicator.");
}

void readFiles(const std::vector<std::string>& files)
{
    std::array<char, 4096> page{};
    for (const std::string& file : files) {
        const int descriptor = open(file.c_str(), O_RDONLY | O_CLOEXEC);
        if (read(descriptor, page.data(), page.size()) <= 0)
            fail("A file cannot be read.");
        benchmark::DoNotOptimize(page);
        close(descriptor);
    }
}

void walkBesideReading(benchmark::State& state)
{
    const Testing::Environment inventory("TAVRO_INVENTORY", "sysfs");
    const Testing::Environment root("TAVRO_SYSFS_ROOT", largeServer());
    const std::vector<std::string> files = attributesOf(largeServer());
    bench::comparePairs(
        state, [] { return bench::secondsOf(walk); },
        [&files] { return bench::secondsOf([&files] { readFiles(files); }); });
}
BENCHMARK(walkBesideReading)->UseManualTime()->Iterations(51);

} // namespace

int main(int argc, char** argv)
{
    return bench::runAndTell(argc, argv, [](const benchmark::UserCounters& counters) {
        std::printf(
            "reading sysfs with 2000 LEDs and 200 drive slots: %.1f µs for an indicator; the same files "
            "and nothing else: %.1f µs; ratio %.2f\n",
            counters.at("first_ns") / 1e3 / indicatorCount, counters.at("second_ns") / 1e3 / indicatorCount,
            counters.at("ratio").value);
    });
}
