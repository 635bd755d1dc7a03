// The library beside the floor: time, allocations and heap of every operation at several sizes, as a table.
// The options are those of the benchmark library; --benchmark_filter takes rows by their names.

#include "Bed.h"
#include "GlimmarkFactory.h"
#include "InventoryCollection.h"
#include "Pairs.h"
#include "Trace.h"

#include "testing/Allocations.h"

#include <algorithm>
#include <cstdio>
#include <string>
#include <vector>

#include <benchmark/benchmark.h>
#include <malloc.h>

namespace {

using namespace bench;

double timeOf(Bed& bed, const Task& task)
{
    double seconds = 0;
    bed.run(task, [&](const TapeRequest& /*request*/, const auto& run) { seconds = secondsOf(run); });
    return seconds;
}

double timeOf(Bed& bed, const Task& task, Tape& floor)
{
    double seconds = 0;
    bed.run(task, [&](const TapeRequest& request, const auto& /*run*/) {
        seconds = secondsOf([&] { floor.replay(request); });
    });
    return seconds;
}

template <class Run>
Allocations::Use useOf(Run run)
{
    Allocations::startCounting();
    run();
    return Allocations::stopCounting();
}

Bed& bedWith(std::size_t indicators)
{
    static Bed bed;
    if (bed.indicatorCount() != indicators)
        bed.setIndicators(indicators);
    return bed;
}

void measureOperation(benchmark::State& state, const Task& task, std::size_t indicators)
{
    Bed& bed = bedWith(indicators);
    Tape tape = bed.record(task);
    comparePairs(
        state, [&] { return timeOf(bed, task); }, [&] { return timeOf(bed, task, tape); });
    Allocations::Use library;
    Allocations::Use floor;
    bed.run(task, [&](const TapeRequest& /*request*/, const auto& run) { library = useOf(run); });
    bed.run(task, [&](const TapeRequest& request, const auto& /*run*/) {
        floor = useOf([&] { tape.replay(request); });
    });
    state.counters["indicators"] = static_cast<double>(indicators);
    state.counters["library_allocations"] = static_cast<double>(library.count);
    state.counters["floor_allocations"] = static_cast<double>(floor.count);
    state.counters["library_peak"] = static_cast<double>(library.peak);
    state.counters["floor_peak"] = static_cast<double>(floor.peak);
}

/// Runs a part of a request, or all of one. \return seconds
using Part = double (*)(Bed&);

/// Compares a part with another, or with its own floor. \param other  null: the floor of `part`, which calls
/// nothing of the broker then
void measurePart(benchmark::State& state, std::size_t indicators, Part part, Part other)
{
    Bed& bed = bedWith(indicators);
    Tape floor = other != nullptr ? Tape() : bed.record([&] { part(bed); });
    comparePairs(
        state, [&] { return part(bed); },
        [&] { return other != nullptr ? other(bed) : secondsOf([&] { floor.replay({}); }); });
    state.counters["indicators"] = static_cast<double>(indicators);
}

double collect(Bed& /*bed*/)
{
    return secondsOf([] {
        std::vector<Tavro::GlimmarkProvider::Glimmark> records;
        Tavro::GlimmarkProvider::getGlimmarkInstances(records);
    });
}

double collectIntoMap(Bed& /*bed*/)
{
    return secondsOf([] { const Tavro::GlimmarkProvider::GlimmarkFactory factory(true, false); });
}

double traceAThousandTimes(Bed& /*bed*/)
{
    static const std::string category("Mavrel.GlimmarkProvider");
    static const Tavro::TraceModule module{"GlimmarkProvider.cpp", category};
    constexpr int tracePoints = 1000;
    const int object = 0;
    return secondsOf([&] {
        for (int i = 0; i < tracePoints; ++i)
            Tavro::FunctionTrace(module, "Glimmark_EnumInstanceNames", [&] {
                return Tavro::parameterList(" mi=", &object, " ctx=", &object, " result=", &object,
                                            " ref=", &object);
            });
    });
}

constexpr std::size_t sizes[] = {1, 10, 100, 1000, 10000, 65535};

/// Enough pairs for a steady median, few enough for a table within minutes.
benchmark::IterationCount pairsAt(std::size_t indicators)
{
    if (indicators <= 100)
        return 201;
    if (indicators <= 1000)
        return 51;
    return indicators <= 10000 ? 9 : 3;
}

const std::vector<Task>& tasks()
{
    static const std::vector<Task> all = allTasks();
    return all;
}

const Task& taskOf(const std::string& name)
{
    return *std::find_if(tasks().begin(), tasks().end(),
                         [&](const Task& task) { return task.operation.name == name; });
}

void registerOperations()
{
    for (const Task& task : tasks()) {
        for (const std::size_t size : sizes) {
            benchmark::RegisterBenchmark(
                (task.operation.name + "/" + std::to_string(size)).c_str(),
                [&task, size](benchmark::State& state) { measureOperation(state, task, size); })
                ->UseManualTime()
                ->Iterations(pairsAt(size));
        }
    }
}

/// Rows that compare other things than an operation with its floor.
void registerParts()
{
    const auto add = [](const std::string& name, std::size_t size, Part part, Part other) {
        benchmark::RegisterBenchmark((name + "/" + std::to_string(size)).c_str(),
                                     [=](benchmark::State& state) { measurePart(state, size, part, other); })
            ->UseManualTime()
            ->Iterations(pairsAt(size));
    };
    static const Task& get = taskOf("TAVRO_Glimmark_GetInstance_ByIdentifier");
    for (const std::size_t size : {std::size_t{1000}, std::size_t{10000}}) {
        add("collecting_into_records_beside_its_floor", size, collect, nullptr);
        add("collecting_into_the_map_beside_collecting_into_records", size, collectIntoMap, collect);
        add(
            "GetInstance_ByIdentifier_beside_collecting_into_records", size,
            [](Bed& bed) { return timeOf(bed, get); }, collect);
    }
    add("a_thousand_trace_points_beside_their_floor", 1, traceAThousandTimes, nullptr);
}

/// Prints the rows as a table, the library's numbers beside the floor's.
class TableReporter : public benchmark::BenchmarkReporter
{
public:
    bool ReportContext(const Context&) override
    {
        std::printf("%-84s %28s %6s %22s %26s\n", "", "time for an indicator, ns", "", "allocations",
                    "peak heap, bytes");
        std::printf("%-84s %14s %13s %6s %11s %10s %14s %11s\n", "operation/indicators", "library", "floor",
                    "ratio", "library", "floor", "library", "floor");
        return true;
    }

    void ReportRuns(const std::vector<Run>& runs) override
    {
        for (const Run& run : runs) {
            const auto number = [&](const char* name) {
                const auto found = run.counters.find(name);
                return found == run.counters.end() ? 0.0 : static_cast<double>(found->second);
            };
            const double n = std::max(1.0, number("indicators"));
            std::printf("%-84s %14.0f %13.0f %6.2f %11.1f %10.1f %14.0f %11.0f\n",
                        run.run_name.function_name.c_str(), number("first_ns") / n, number("second_ns") / n,
                        number("ratio"), number("library_allocations") / n, number("floor_allocations") / n,
                        number("library_peak") / n, number("floor_peak") / n);
            std::fflush(stdout);
        }
    }
};

/// Keeps freed memory in the process, as a broker does that has run for a while: otherwise every request gets
/// its pages anew from the kernel, which costs more than either side.
void keepFreedMemory()
{
    mallopt(M_TRIM_THRESHOLD, -1);
    mallopt(M_MMAP_MAX, 0);
}

} // namespace

int main(int argc, char** argv)
{
    keepFreedMemory();
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 2;
    registerOperations();
    registerParts();
    TableReporter table;
    benchmark::RunSpecifiedBenchmarks(&table);
    return 0;
}
