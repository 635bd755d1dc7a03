// Loading the library and calling its six factory functions, beside loading an empty C++ library. Each load
// happens in a process of its own, forked from this one, which has neither.

#include "Pairs.h"

#include <cstdio>
#include <cstdlib>

#include <benchmark/benchmark.h>
#include <dlfcn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

using Create = void* (*)(const void* broker, const void* context, void* status);

constexpr const char* factoryFunctions[] = {
    "GlimmarkProfileProvider_Create_InstanceMI",
    "GlimmarkCapabilitiesProvider_Create_InstanceMI",
    "GlimmarkElementCapabilitiesProvider_Create_InstanceMI",
    "GlimmarkElementCapabilitiesProvider_Create_AssociationMI",
    "GlimmarkSystemDeviceProvider_Create_InstanceMI",
    "GlimmarkSystemDeviceProvider_Create_AssociationMI",
};

/// \return whether it could be loaded
bool load(const char* file, bool callFactories)
{
    void* const library = dlopen(file, RTLD_NOW | RTLD_LOCAL);
    if (library == nullptr) {
        std::fprintf(stderr, "%s\n", dlerror());
        return false;
    }
    if (callFactories) {
        for (const char* name : factoryFunctions)
            reinterpret_cast<Create>(dlsym(library, name))(nullptr, nullptr, nullptr);
    }
    return true;
}

/// Seconds that loading takes in a process of its own.
double secondsToLoad(const char* file, bool callFactories)
{
    int ends[2];
    if (pipe(ends) != 0)
        std::abort();
    const pid_t child = fork();
    if (child == 0) {
        const double begin = bench::threadSeconds();
        const bool loaded = load(file, callFactories);
        const double seconds = bench::threadSeconds() - begin;
        _exit(loaded && write(ends[1], &seconds, sizeof seconds) == sizeof seconds ? 0 : 1);
    }
    close(ends[1]); // so that a child that fails ends the read
    double seconds = 0;
    const bool told = read(ends[0], &seconds, sizeof seconds) == sizeof seconds;
    close(ends[0]);
    waitpid(child, nullptr, 0);
    if (!told)
        std::exit(1);
    return seconds;
}

void loading(benchmark::State& state)
{
    bench::comparePairs(
        state, [] { return secondsToLoad(BENCH_PROVIDER_LIBRARY, true); },
        [] { return secondsToLoad(BENCH_EMPTY_LIBRARY, false); });
}
BENCHMARK(loading)->UseManualTime()->Iterations(51);

} // namespace

int main(int argc, char** argv)
{
    return bench::runAndTell(argc, argv, [](const benchmark::UserCounters& counters) {
        const double library = counters.at("first_ns") / 1e6;
        const double empty = counters.at("second_ns") / 1e6;
        std::printf("loading the library and six factory functions: %.2f ms; an empty C++ library: %.2f ms; "
                    "difference %.2f ms\n",
                    library, empty, library - empty);
    });
}
