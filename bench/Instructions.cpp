// Runs operations for callgrind, which counts the instructions of each run apart; count_instructions.py starts this
// program and says what was counted.
//
//   bench-instructions [--floor] NAMES INDICATORS...
//
// NAMES is a regular expression for the operations' names. --floor: replays each operation's tape too. Without callgrind
// nothing is counted.

#include "Bed.h"

#include <cstddef>
#include <cstdio>
#include <regex>
#include <string>
#include <vector>

#include <malloc.h>
#include <valgrind/callgrind.h>

namespace {

using namespace bench;

/// Collects what `run` costs into a file of its own, which says what it is of.
template <class Run>
void count(const std::string& what, Run run)
{
    CALLGRIND_START_INSTRUMENTATION;
    run();
    CALLGRIND_STOP_INSTRUMENTATION;
    CALLGRIND_DUMP_STATS_AT(what.c_str());
}

std::string nameOf(const Task& task, const Bed& bed)
{
    return task.operation.name + '/' + std::to_string(bed.indicatorCount());
}

void countLibrary(Bed& bed, const Task& task)
{
    // Once before: memory then lies as the operation itself has left it, whatever ran earlier.
    bed.run(task, [](const TapeRequest& /*request*/, const auto& run) { run(); });
    bed.run(task, [&](const TapeRequest& /*request*/, const auto& run) {
        count(nameOf(task, bed) + " library", run);
    });
}

void countFloor(Bed& bed, const Task& task)
{
    Tape floor = bed.record(task);
    bed.run(task, [&](const TapeRequest& request, const auto& /*run*/) { floor.replay(request); });
    bed.run(task, [&](const TapeRequest& request, const auto& /*run*/) {
        count(nameOf(task, bed) + " floor", [&] { floor.replay(request); });
    });
}

/// Counts something at every number of indicators.
template <class Count>
void countAtEach(const std::vector<std::string>& sizes, const std::vector<Task>& tasks, Bed& bed,
                 Count countOne)
{
    for (const std::string& size : sizes) {
        bed.setIndicators(std::stoul(size));
        for (const Task& task : tasks)
            countOne(bed, task);
    }
}

std::vector<Task> tasksCalled(const std::string& names)
{
    const std::regex pattern(names);
    std::vector<Task> tasks;
    for (Task& task : allTasks())
        if (std::regex_search(task.operation.name, pattern))
            tasks.push_back(std::move(task));
    return tasks;
}

} // namespace

// What is thrown ends the program. NOLINTNEXTLINE(bugprone-exception-escape)
int main(int argc, char** argv)
{
    std::vector<std::string> arguments(argv + 1, argv + argc);
    const bool withFloor = !arguments.empty() && arguments.front() == "--floor";
    if (withFloor)
        arguments.erase(arguments.begin());
    if (arguments.size() < 2) {
        std::fputs("usage: bench-instructions [--floor] NAMES INDICATORS...\n", stderr);
        return 2;
    }
    mallopt(M_MMAP_MAX, 0); // large pieces as small ones: from memory that the process keeps
    mallopt(M_TRIM_THRESHOLD, -1);
    mallopt(M_MXFAST, 0); // pieces are joined by who frees them, and not by whoever comes along later

    const std::vector<Task> tasks = tasksCalled(arguments.front());
    const std::vector<std::string> sizes(arguments.begin() + 1, arguments.end());
    Bed bed;
    countAtEach(sizes, tasks, bed, countLibrary);
    // Behind all of them: the library's figures are the same with floors and without.
    if (withFloor)
        countAtEach(sizes, tasks, bed, countFloor);
    return 0;
}
