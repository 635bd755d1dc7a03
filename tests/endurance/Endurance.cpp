// Asks the provider library, with the support libraries that it is built with, over and over, and holds that
// nothing adds up: memory, open descriptors, other answers. Usage: endurance REQUESTS

#include "testing/Operations.h"

#include <dirent.h>
#include <malloc.h>
#include <unistd.h>

#include <chrono>
#include <cstddef>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <string>
#include <vector>

namespace {

#ifdef GLIMMARK_SANITIZED
// A sanitizer keeps freed memory and finds leaks itself.
constexpr bool memoryIsMeasured = false;
#else
constexpr bool memoryIsMeasured = true;
#endif

// Requests before anything is measured. The host's broker does not use the handle of a dead object again
// before 262,144 others have died; until then its resident memory grows.
constexpr std::size_t warmUp = 20'000;

// What the process's memory may grow by from then on. One block lost in each round over all operations is
// more.
constexpr std::size_t heapAllowance = 4096;
constexpr std::size_t residentAllowance = 1024UL * 1024;

std::size_t openDescriptors()
{
    DIR* const folder = ::opendir("/proc/self/fd");
    if (folder == nullptr)
        return 0;
    std::size_t count = 0;
    while (::readdir(folder) != nullptr)
        ++count;
    ::closedir(folder);
    return count;
}

struct Usage
{
    std::size_t heap = 0;     ///< bytes allocated and not freed
    std::size_t resident = 0; ///< bytes of the process in memory
    std::size_t descriptors = 0;
};

Usage usage()
{
    const struct mallinfo2 heap = ::mallinfo2();
    std::size_t pages = 0;
    std::size_t residentPages = 0;
    std::ifstream("/proc/self/statm") >> pages >> residentPages;
    return {heap.uordblks + heap.hblkhd, residentPages * static_cast<std::size_t>(::getpagesize()),
            openDescriptors()};
}

std::string text(const Usage& usage)
{
    return std::to_string(usage.heap) + " bytes in use, " + std::to_string(usage.resident / 1024) +
           " KiB resident, " + std::to_string(usage.descriptors) + " descriptors\n";
}

bool hold(bool condition, const std::string& failure)
{
    if (!condition)
        std::cerr << "endurance: " << failure << '\n';
    return condition;
}

bool isFlat(const Usage& before, const Usage& after)
{
    const bool descriptors =
        hold(after.descriptors == before.descriptors, "descriptors are left open or were closed");
    if (!memoryIsMeasured)
        return descriptors;
    const bool heap = hold(after.heap <= before.heap + heapAllowance, "the heap has grown");
    const bool resident =
        hold(after.resident <= before.resident + residentAllowance, "the resident memory has grown");
    return descriptors && heap && resident;
}

/// The providers behind a broker, and all operations with the answers that they first got.
class Session
{
public:
    Session() : broker(cimhost::readRegistrationFile(COMPUTER_SYSTEM_REGISTRATION), {PROVIDER_DIRECTORY})
    {
        for (const Operation& operation : operations)
            first.push_back(ask(broker, operation));
    }

    /// Makes as many rounds over all operations as hold so many requests.
    /// \return how many requests were made; 0: an answer was not the first one
    std::size_t run(std::size_t requests)
    {
        std::size_t made = 0;
        while (made < requests) {
            for (std::size_t i = 0; i < operations.size(); ++i, ++made) {
                if (!hold(ask(broker, operations[i]) == first[i], operations[i].name + " changed its answer"))
                    return 0;
            }
        }
        return made;
    }

private:
    cimhost::Broker broker;
    std::vector<Operation> operations = allOperations();
    std::vector<Outcome> first;
};

int endure(std::size_t requests)
{
    const auto begin = std::chrono::steady_clock::now();
    Session session;
    usage(); // measuring allocates too, the first time
    if (session.run(warmUp) == 0)
        return EXIT_FAILURE;
    const Usage before = usage();
    const std::size_t half = session.run(requests / 2);
    const Usage between = usage();
    const std::size_t rest = session.run(requests - half);
    const Usage after = usage();
    if (half == 0 || rest == 0)
        return EXIT_FAILURE;

    const std::chrono::duration<double> seconds = std::chrono::steady_clock::now() - begin;
    std::cout << half + rest << " requests after " << warmUp << " to warm up, in "
              << static_cast<long>(seconds.count()) << " s; all answers as at first\n"
              << "before:   " << text(before) << "half way: " << text(between) << "after:    " << text(after);
    return isFlat(before, after) ? EXIT_SUCCESS : EXIT_FAILURE;
}

} // namespace

int main(int argc, char* argv[])
{
    const std::size_t requests = argc == 2 ? std::strtoull(argv[1], nullptr, 10) : 0;
    if (requests < 1'000) {
        std::cerr << "usage: endurance REQUESTS, a thousand at least\n";
        return EXIT_FAILURE;
    }
    ::setenv("TAVRO_INVENTORY", INVENTORY, 1);
    ::setenv("TAVRO_COMPUTER_SYSTEMS", "one", 1);
    return endure(requests);
}
