#include "cli/CheckingProgram.h"

#include "cim/Descriptor.h"
#include "cim/Utf8.h"

#include <array>
#include <cerrno>
#include <cstddef>

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace cimhost::cli {

namespace {

/// Until its end, which the program makes.
std::string readAll(int descriptor)
{
    std::string text;
    std::array<char, 4096> part{};
    ssize_t count = 0;
    while ((count = ::read(descriptor, part.data(), part.size())) > 0 || (count < 0 && errno == EINTR))
        if (count > 0)
            text.append(part.data(), static_cast<std::size_t>(count));
    return text;
}

int exitStatusOf(pid_t process)
{
    int status = 0;
    while (waitpid(process, &status, 0) < 0)
        if (errno != EINTR)
            return -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

} // namespace

std::string complaintOf(const std::string& program, const std::string& file)
{
    std::array<int, 2> ends{-1, -1};
    if (pipe2(ends.data(), O_CLOEXEC) != 0)
        return "";
    const cim::Descriptor reading(ends[0]);
    std::string name = program;
    std::string argument = file;
    const std::array<char*, 3> arguments{name.data(), argument.data(), nullptr};
    pid_t process = 0;
    posix_spawn_file_actions_t actions{};
    posix_spawn_file_actions_init(&actions);
    int error = 0;
    {
        const cim::Descriptor writing(ends[1]);
        posix_spawn_file_actions_adddup2(&actions, writing.number(), STDOUT_FILENO);
        error = posix_spawn(&process, name.c_str(), &actions, nullptr, arguments.data(), environ);
    }
    posix_spawn_file_actions_destroy(&actions);
    if (error != 0)
        return "";
    const std::string text = readAll(reading.number());
    return exitStatusOf(process) == 1 ? cim::printable(text.substr(0, text.find('\n'))) : "";
}

} // namespace cimhost::cli
