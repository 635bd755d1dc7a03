// Runs operations for callgrind, which counts the instructions of each run apart; count_instructions.py starts this
// program and says what it counted. Takes two files: what to run, as a regular expression for the operations' names, and
// the numbers of indicators.
//
//   bench-instructions [--floor] NAMES INDICATORS...
//
// --floor: replays each operation's tape too. Without callgrind nothing is counted.

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

void countOperation(Bed& bed, const Task& task, bool withFloor)
{
    const std::string what = task.operation.name + '/' + std::to_string(bed.indicatorCount());
    bed.run(task, [&](const TapeRequest& /*request*/, const auto& run) { count(what + " library", run); });
    if (!withFloor)
        return;
    Tape floor = bed.record(task);
    bed.run(task, [&](const TapeRequest& request, const auto& /*run*/) {
        count(what + " floor", [&] { floor.replay(request); });
    });
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

    const std::vector<Task> tasks = tasksCalled(arguments.front());
    Bed bed;
    // Once before, for what is made only at first use.
    bed.setIndicators(1);
    for (const Task& task : tasks)
        bed.run(task, [](const TapeRequest& /*request*/, const auto& run) { run(); });
    for (auto size = arguments.begin() + 1; size != arguments.end(); ++size) {
        bed.setIndicators(std::stoul(*size));
        for (const Task& task : tasks)
            countOperation(bed, task, withFloor);
    }
    return 0;
}
