/// \file
/// Two things measured in turn. Each iteration of a benchmark is a pair: one run of the first thing and one
/// of the second. Reported are medians over the pairs: of both times, and of the ratio within a pair.
#ifndef BENCH_PAIRS_H
#define BENCH_PAIRS_H

#include <algorithm>
#include <cstddef>
#include <ctime>
#include <vector>

#include <benchmark/benchmark.h>

namespace bench {

inline double median(std::vector<double> values)
{
    const auto middle = values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2);
    std::nth_element(values.begin(), middle, values.end());
    return *middle;
}

/// The processor's time that this thread has had: what others do on the machine is not in it.
inline double threadSeconds()
{
    timespec time{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &time);
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * 1e-9;
}

template <class Run>
double secondsOf(Run run)
{
    const double begin = threadSeconds();
    run();
    return threadSeconds() - begin;
}

/// Runs a pair in each iteration of the benchmark and sets its counters. The two go first in turn.
/// \param first   runs once and returns seconds
/// \param second  does so too
template <class First, class Second>
void comparePairs(benchmark::State& state, First first, Second second)
{
    std::vector<double> firsts;
    std::vector<double> seconds;
    std::vector<double> ratios;
    first(); // both once before, for what is made only at first use
    second();
    bool firstGoesFirst = true;
    for ([[maybe_unused]] auto _ : state) {
        double a = 0;
        double b = 0;
        if (firstGoesFirst) {
            a = first();
            b = second();
        } else {
            b = second();
            a = first();
        }
        firstGoesFirst = !firstGoesFirst;
        firsts.push_back(a);
        seconds.push_back(b);
        ratios.push_back(a / b);
        state.SetIterationTime(a + b);
    }
    state.counters["first_ns"] = median(firsts) * 1e9;
    state.counters["second_ns"] = median(seconds) * 1e9;
    state.counters["ratio"] = median(ratios);
}

/// Runs a program's benchmarks. \param tell  prints one's result: is called with its benchmark::UserCounters
template <class Tell>
int runAndTell(int argc, char** argv, Tell tell)
{
    class Reporter : public benchmark::BenchmarkReporter
    {
    public:
        explicit Reporter(Tell& printer) : print(printer) {}
        bool ReportContext(const Context&) override { return true; }
        void ReportRuns(const std::vector<Run>& runs) override
        {
            for (const Run& run : runs)
                print(run.counters);
        }

    private:
        Tell& print;
    };
    benchmark::Initialize(&argc, argv);
    Reporter reporter(tell);
    benchmark::RunSpecifiedBenchmarks(&reporter);
    return 0;
}

} // namespace bench

#endif
