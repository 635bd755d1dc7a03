// The library beside the floor: time, allocations and heap of every operation at several sizes, as a table.
//
//   --guard    only sizes 1 and 1,000, briefly, and without the table: fails when a ratio is at more than
//   twice
//              its target, twice in succession
//
// All other options are those of the benchmark library; --benchmark_filter takes rows by their names.

#include "Bed.h"
#include "GlimmarkFactory.h"
#include "InventoryCollection.h"
#include "Pairs.h"
#include "Trace.h"

#include "testing/Allocations.h"

#include <algorithm>
#include <cstdio>
#include <iterator>
#include <string>
#include <vector>

#include <benchmark/benchmark.h>
#include <malloc.h>

namespace {

using namespace bench;

double timeOf(Bed& bed, const Task& task, Side side)
{
    double seconds = 0;
    bed.run(task, side, [&](const auto&, const auto*, const auto& run) { seconds = secondsOf(run); });
    return seconds;
}

Allocations::Use useOf(Bed& bed, const Task& task, Side side)
{
    Allocations::Use use;
    bed.run(task, side, [&](const auto&, const auto*, const auto& run) {
        Allocations::startCounting();
        run();
        use = Allocations::stopCounting();
    });
    return use;
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
    comparePairs(
        state, [&] { return timeOf(bed, task, Side::library); },
        [&] { return timeOf(bed, task, Side::floor); });
    const Allocations::Use library = useOf(bed, task, Side::library);
    const Allocations::Use floor = useOf(bed, task, Side::floor);
    state.counters["indicators"] = static_cast<double>(indicators);
    state.counters["library_allocations"] = static_cast<double>(library.count);
    state.counters["floor_allocations"] = static_cast<double>(floor.count);
    state.counters["library_peak"] = static_cast<double>(library.peak);
    state.counters["floor_peak"] = static_cast<double>(floor.peak);
}

/// Compares two runs of something, told for each of the indicators. \param first, second  called with the bed
template <class First, class Second>
void measure(benchmark::State& state, std::size_t indicators, First first, Second second)
{
    Bed& bed = bedWith(indicators);
    comparePairs(
        state, [&] { return first(bed); }, [&] { return second(bed); });
    state.counters["indicators"] = static_cast<double>(indicators);
}

double timeOfCollecting(Bed& /*bed*/)
{
    return secondsOf([] {
        std::vector<Tavro::GlimmarkProvider::Glimmark> records;
        Tavro::GlimmarkProvider::getGlimmarkInstances(records);
    });
}

double timeOfFloorCollecting(Bed& bed)
{
    return secondsOf([&] { bed.collectAtFloor(); });
}

double timeOfMappedCollecting(Bed& /*bed*/)
{
    return secondsOf([] { const Tavro::GlimmarkProvider::GlimmarkFactory factory(true, false); });
}

constexpr int tracePoints = 1000;

double timeOfTracePoints(Bed& /*bed*/)
{
    static const std::string category("Mavrel.GlimmarkProvider");
    static const Tavro::TraceModule module{"GlimmarkProvider.cpp", category};
    const int object = 0;
    return secondsOf([&] {
        for (int i = 0; i < tracePoints; ++i)
            Tavro::FunctionTrace(module, "Glimmark_EnumInstanceNames", [&] {
                return Tavro::parameterList(" mi=", &object, " ctx=", &object, " result=", &object,
                                            " ref=", &object);
            });
    });
}

double timeOfFloorTracePoints(Bed& /*bed*/)
{
    return secondsOf([] {
        for (int i = 0; i < tracePoints; ++i)
            traceOnly();
    });
}

constexpr std::size_t sizes[] = {1, 10, 100, 1000, 10000, 65535};

/// So many that the median is steady, and so few that the table comes within minutes.
benchmark::IterationCount pairsAt(std::size_t indicators, bool brief)
{
    if (indicators <= 100)
        return brief ? 51 : 201;
    if (indicators <= 1000)
        return brief ? 11 : 51;
    return indicators <= 10000 ? 9 : 3;
}

std::vector<std::size_t> sizesOf(bool brief)
{
    return brief ? std::vector<std::size_t>{1, 1000}
                 : std::vector<std::size_t>(std::begin(sizes), std::end(sizes));
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

void registerOperations(bool brief)
{
    for (const Task& task : tasks()) {
        for (const std::size_t size : sizesOf(brief)) {
            benchmark::RegisterBenchmark(
                (task.operation.name + "/" + std::to_string(size)).c_str(),
                [&task, size](benchmark::State& state) { measureOperation(state, task, size); })
                ->UseManualTime()
                ->Iterations(pairsAt(size, brief));
        }
    }
}

/// Rows that compare other things than an operation with its floor.
void registerParts()
{
    using Time = double (*)(Bed&);
    const auto add = [](const std::string& name, std::size_t size, Time first, Time second) {
        benchmark::RegisterBenchmark((name + "/" + std::to_string(size)).c_str(),
                                     [=](benchmark::State& state) { measure(state, size, first, second); })
            ->UseManualTime()
            ->Iterations(pairsAt(size, false));
    };
    static const Task& get = taskOf("TAVRO_Glimmark_GetInstance_ByIdentifier");
    for (const std::size_t size : {std::size_t{1000}, std::size_t{10000}}) {
        add("collecting_into_records_beside_its_floor", size, timeOfCollecting, timeOfFloorCollecting);
        add("collecting_into_the_map_beside_collecting_into_records", size, timeOfMappedCollecting,
            timeOfCollecting);
        add(
            "GetInstance_ByIdentifier_beside_collecting_into_records", size,
            [](Bed& bed) { return timeOf(bed, get, Side::library); }, timeOfCollecting);
    }
    add("a_thousand_trace_points_beside_their_floor", 1, timeOfTracePoints, timeOfFloorTracePoints);
}

/// Rows as a table, each number beside the floor's.
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

/// Keeps memory that was freed in the process, as it stays in a broker that runs for long: otherwise every
/// request gets its pages anew from the kernel, which costs more than either side.
void keepFreedMemory()
{
    mallopt(M_TRIM_THRESHOLD, -1);
    mallopt(M_MMAP_MAX, 0);
}

/// What an operation's ratio is to be at most at 1 and at 1,000 indicators.
double targetOf(const std::string& row)
{
    const auto has = [&](const char* part) { return row.find(part) != std::string::npos; };
    if (has("/1/"))
        return 2.5;
    // These make nothing for most of the indicators: all that is left is collecting them, from an inventory
    // that is in memory, and the records that are made of it.
    const bool collectsOnly = has("From_TAVRO_Glimmark/") || has("GetInstance_ByIdentifier") ||
                              has("TAVRO_GlimmarkCapabilities_GetInstance_ByPath");
    return collectsOnly ? 4.0 : 1.5;
}

/// Keeps the rows whose ratio is at more than twice its target.
class Guard : public benchmark::BenchmarkReporter
{
public:
    bool ReportContext(const Context&) override { return true; }
    void ReportRuns(const std::vector<Run>& runs) override
    {
        for (const Run& run : runs) {
            const std::string row = run.benchmark_name();
            const double ratio = run.counters.at("ratio");
            ++seen;
            if (ratio <= 2 * targetOf(row))
                continue;
            std::printf("%s: %.2f times the floor, more than twice %.1f\n", row.c_str(), ratio,
                        targetOf(row));
            lost.push_back(row);
        }
    }

    int seen = 0;
    std::vector<std::string> lost;
};

/// \return the process's exit status
int guard()
{
    Guard first;
    benchmark::RunSpecifiedBenchmarks(&first);
    int lost = first.seen == 0 ? 1 : 0;
    for (const std::string& row : first.lost) {
        Guard again;
        benchmark::RunSpecifiedBenchmarks(&again, "^" + row + "$");
        if (again.seen != 1 || !again.lost.empty())
            ++lost;
    }
    std::printf("%d of %d ratios are lost\n", lost, first.seen);
    return lost == 0 ? 0 : 1;
}

bool isGuard(int argc, char** argv)
{
    return argc == 2 && std::string(argv[1]) == "--guard";
}

} // namespace

int main(int argc, char** argv)
{
    keepFreedMemory();
    const bool brief = isGuard(argc, argv);
    if (!brief) {
        benchmark::Initialize(&argc, argv);
        if (benchmark::ReportUnrecognizedArguments(argc, argv))
            return 2;
    }
    registerOperations(brief);
    if (brief)
        return guard();
    registerParts();
    TableReporter table;
    benchmark::RunSpecifiedBenchmarks(&table);
    return 0;
}
