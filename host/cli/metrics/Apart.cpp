#include "cli/metrics/Apart.h"

#include "cim/Descriptor.h"
#include "cli/metrics/WriteAll.h"

#include <array>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <exception>
#include <optional>
#include <system_error>

#include <fcntl.h>
#include <poll.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

namespace cimhost::cli {

namespace {

/// The last byte that a child writes says what came before it. Without it, the child did not come to its end.
constexpr char isResult = 'r';
constexpr char isMessage = 'm';

[[noreturn]] void failWithErrno(const char* what)
{
    throw ApartError(std::string(what) + ": " + std::generic_category().message(errno));
}

/// The child's life. Nothing that the parent began is ended or written here.
[[noreturn]] void live(const std::function<std::string()>& work, int descriptor)
{
    prctl(PR_SET_PDEATHSIG, SIGKILL); // nobody else would end it
    std::string text;
    try {
        text = work() + isResult;
    } catch (const std::exception& error) {
        text = std::string(error.what()) + isMessage;
    } catch (...) {
        text = std::string("an exception of an unknown kind") + isMessage;
    }
    _exit(writeAll(descriptor, text) ? 0 : 1);
}

/// What it writes until its end.
/// \return nothing: that does not come in time
std::optional<std::string> readUntil(std::chrono::steady_clock::time_point end, int descriptor)
{
    std::string text;
    std::array<char, 65536> part{};
    while (true) {
        const auto left =
            std::chrono::ceil<std::chrono::milliseconds>(end - std::chrono::steady_clock::now()).count();
        pollfd waiting{descriptor, POLLIN, 0};
        const int ready = left > 0 ? poll(&waiting, 1, static_cast<int>(left)) : 0;
        if (ready == 0)
            return std::nullopt;
        const ssize_t count = ready > 0 ? ::read(descriptor, part.data(), part.size()) : -1;
        if (count < 0 && errno != EINTR)
            failWithErrno("cannot read from the process that asks");
        if (count == 0)
            return text;
        if (count > 0)
            text.append(part.data(), static_cast<std::size_t>(count));
    }
}

std::string endOf(pid_t process)
{
    int status = 0;
    while (waitpid(process, &status, 0) < 0)
        if (errno != EINTR)
            return "its end is not known";
    if (WIFSIGNALED(status))
        return "signal " + std::to_string(WTERMSIG(status)) + " (" + strsignal(WTERMSIG(status)) + ')';
    return "exit status " + std::to_string(WEXITSTATUS(status));
}

} // namespace

std::string doApart(const std::function<std::string()>& work, std::chrono::milliseconds limit)
{
    const std::chrono::steady_clock::time_point end = std::chrono::steady_clock::now() + limit;
    std::array<int, 2> ends{-1, -1};
    if (pipe2(ends.data(), O_CLOEXEC) != 0)
        failWithErrno("cannot make a pipe");
    const cim::Descriptor reading(ends[0]);
    std::optional<cim::Descriptor> writing(std::in_place, ends[1]);
    const pid_t process = fork();
    if (process < 0)
        failWithErrno("cannot start a process");
    if (process == 0)
        live(work, writing->number());
    writing.reset();

    std::optional<std::string> text = readUntil(end, reading.number());
    if (!text)
        kill(process, SIGKILL);
    const std::string ending = endOf(process);
    if (!text)
        throw ApartError("there was no answer within " + std::to_string(limit.count()) + " ms");
    const char kind = text->empty() ? '\0' : text->back();
    if (kind != isResult && kind != isMessage)
        throw ApartError("the process that asked the provider ended with " + ending);
    text->pop_back();
    if (kind == isMessage)
        throw ApartError(*text);
    return *text;
}

} // namespace cimhost::cli
