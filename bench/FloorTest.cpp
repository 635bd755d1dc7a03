// Replaying a tape makes the library's calls, all of them, in the same order with the same arguments; a call
// that a tape cannot hold is no secret; and what the library holds on top of what the broker and the support
// libraries do.

#include "Bed.h"

#include "testing/Allocations.h"
#include "testing/RecordedLog.h"
#include "testing/RecordingBroker.h"

#include <algorithm>
#include <cstddef>
#include <cstdio>
#include <memory>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

#include <dlfcn.h>
#include <gtest/gtest.h>

namespace bench {

void PrintTo(const Task& task, std::ostream* stream)
{
    *stream << task.operation.name;
}

namespace {

using Calls = std::vector<std::string>;

/// What one run has called: as a tape has it, and as two witnesses do that know nothing of tapes.
struct Seen
{
    Tape tape;
    Calls ofBroker; ///< those inside the support libraries too
    Calls ofLog;
};

Calls loggedCalls()
{
    Calls calls = RecordedLog::insertions();
    for (const RecordedLog::Line& line : RecordedLog::lines()) {
        std::ostringstream call;
        call << (line.channel == RecordedLog::Channel::log ? "log " : "trace ") << line.function << ' '
             << line.file << ' ' << line.line << ' ' << line.category << ' ' << line.level << ' '
             << line.reservedIsNull << ' ' << line.first << ' ' << line.second << ' ' << line.text;
        calls.push_back(call.str());
    }
    return calls;
}

/// \param run  called with the request and a function that runs the library's operation
template <class Run>
Seen seenWhile(Bed& bed, const Task& task, Run run)
{
    Seen seen;
    RecordingBroker witness(bed.host);
    bed.run(task, [&](const TapeRequest& request, const auto& operation) {
        witness.name(request.ctx, "ctx");
        witness.name(request.ref, "ref");
        witness.clear();
        RecordedLog::clear();
        seen.tape = record(bed.host, request, [&] { run(request, operation); });
    });
    seen.ofBroker = witness.calls();
    seen.ofLog = loggedCalls();
    return seen;
}

/// The two sequences side by side from a little before the place where they part.
std::string difference(const Calls& library, const Calls& floor)
{
    constexpr std::ptrdiff_t shown = 3;
    const auto parted = std::mismatch(library.begin(), library.end(), floor.begin(), floor.end());
    const auto place = parted.first - library.begin();
    std::string text = "they part at call " + std::to_string(place) + ":\n";
    const auto show = [&](const char* side, const Calls& calls) {
        const auto end = std::min(place + shown, static_cast<std::ptrdiff_t>(calls.size()));
        for (auto i = std::max(place - shown, std::ptrdiff_t{0}); i < end; ++i)
            text += side + calls[static_cast<std::size_t>(i)] + '\n';
    };
    show("  library  ", library);
    show("  floor    ", floor);
    return text;
}

class FloorTest : public ::testing::TestWithParam<Task>
{};

TEST_P(FloorTest, MakesTheCallsOfTheLibrary)
{
    Bed bed;
    for (const std::size_t count : {1U, 2U, 10U}) {
        bed.setIndicators(count);
        Seen library = seenWhile(bed, GetParam(),
                                 [](const TapeRequest& /*request*/, const auto& operation) { operation(); });
        const Seen floor =
            seenWhile(bed, GetParam(), [&](const TapeRequest& request, const auto& /*operation*/) {
                library.tape.replay(request);
            });
        const auto expectEqual = [&](const char* calls, const Calls& expected, const Calls& actual) {
            EXPECT_FALSE(expected.empty()) << calls;
            EXPECT_TRUE(expected == actual)
                << calls << ", " << count << " indicators " << difference(expected, actual);
        };
        expectEqual("the tape", library.tape.calls(), floor.tape.calls());
        expectEqual("the broker", library.ofBroker, floor.ofBroker);
        expectEqual("the log", library.ofLog, floor.ofLog);
    }
}

/// What the library has allocated itself, at its peak: neither in a call of the broker nor in one of the
/// support libraries, but for the texts that those return to it.
std::ptrdiff_t heldBy(Bed& bed, const Task& task, std::size_t indicators)
{
    Allocations::Use use;
    bed.setIndicators(indicators);
    bed.run(task, [&](const TapeRequest& request, const auto& operation) {
        record(bed.host, request, [&] {
            Allocations::startCounting();
            operation();
            use = Allocations::stopCounting();
        });
    });
    return use.peak;
}

TEST_P(FloorTest, HoldsAtMostSevenHundredBytesForAnIndicator)
{
    // The list of records has just doubled its place: it is never less filled.
    constexpr std::size_t count = 129;
    Bed bed;
    heldBy(bed, GetParam(), 1); // what is allocated once
    const std::ptrdiff_t each = heldBy(bed, GetParam(), count) / static_cast<std::ptrdiff_t>(count);
    RecordProperty("bytes_for_an_indicator", std::to_string(each));
    EXPECT_LE(each, 700);
}

INSTANTIATE_TEST_SUITE_P(AllOperations, FloorTest, ::testing::ValuesIn(allTasks()),
                         [](const auto& task) { return task.param.operation.name; });

/// Records a run on the path of a request. \param run  called with that path
template <class Run>
void recordOnPath(Run run)
{
    Bed bed;
    bed.run(allTasks().front(), [&](const TapeRequest& request, const auto& /*operation*/) {
        record(bed.host, request, [&] { run(request.ref); });
    });
}

TEST(TapeTest, RefusesWhatItCannotRecord)
{
    EXPECT_NO_THROW(recordOnPath([](const auto* path) { path->ft->getClassName(path, nullptr); }));
    const auto unknownService = [](const auto* path) { path->ft->getHostname(path, nullptr); };
    EXPECT_THROW(recordOnPath(unknownService), std::logic_error);
    const auto unknownObject = [](const auto* path) {
        const CMPIObjectPath other = *path;
        path->ft->getClassName(&other, nullptr);
    };
    EXPECT_THROW(recordOnPath(unknownObject), std::logic_error);
    const auto unknownType = [](const auto* path) {
        const CMPIValue value{};
        path->ft->addKey(path, "Key", &value, CMPI_real32);
    };
    EXPECT_THROW(recordOnPath(unknownType), std::logic_error);
}

TEST(TapeTest, TellsOfARefusalThatTheLibraryHasCaught)
{
    const auto caught = [](const auto* path) {
        try {
            path->ft->getHostname(path, nullptr);
        } catch (const std::exception&) {
        }
    };
    EXPECT_THROW(recordOnPath(caught), std::logic_error);
}

/// The file that a function lies in.
std::string fileOf(const void* function)
{
    Dl_info info{};
    return dladdr(function, &info) != 0 ? info.dli_fname : "no file";
}

TEST(TapeTest, KnowsEveryFunctionOfTheSupportLibrariesThatTheLibraryCalls)
{
    const std::string command = "nm -D --undefined-only --format=posix " TEST_PROVIDER_LIBRARY;
    const std::unique_ptr<FILE, int (*)(FILE*)> names(::popen(command.c_str(), "r"), ::pclose);
    std::string executable = fileOf(reinterpret_cast<const void*>(&fileOf));
    int count = 0;
    for (char name[1024]; std::fscanf(names.get(), "%1023s%*[^\n]", name) == 1;) {
        const std::string symbol(name);
        if (symbol.find("5Tavro") == std::string::npos && symbol.find("5MVLog") == std::string::npos)
            continue;
        EXPECT_EQ(fileOf(dlsym(RTLD_DEFAULT, name)), executable) << "SupportCalls.cpp lacks " << symbol;
        ++count;
    }
    EXPECT_GT(count, 0);
}

} // namespace

} // namespace bench
