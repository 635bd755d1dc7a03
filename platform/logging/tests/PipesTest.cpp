// A pipe that nobody reads must not end the process, and signals stay as the process wants them.

#include "LoggerTest.h"

#include "testing/WithoutPrivileges.h"

#include <csignal>
#include <cstddef>
#include <cstdlib>
#include <string>
#include <thread>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <termios.h>
#include <unistd.h>

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

using Pipes = LoggerTest;

/// Makes a descriptor the end of a pipe that nobody reads.
void breakPipe(int descriptor)
{
    int ends[2] = {-1, -1};
    ASSERT_EQ(pipe(ends), 0);
    ASSERT_EQ(dup2(ends[1], descriptor), descriptor);
    close(ends[0]);
    close(ends[1]);
}

bool isPending(int signal)
{
    sigset_t pending;
    sigpending(&pending);
    return sigismember(&pending, signal) == 1;
}

bool isBlocked(int signal)
{
    sigset_t blocked;
    pthread_sigmask(SIG_BLOCK, nullptr, &blocked);
    return sigismember(&blocked, signal) == 1;
}

TEST_F(Pipes, aBrokenStandardErrorEndsNothing)
{
    EXPECT_THAT(standardErrorOf([] {
                    std::signal(SIGPIPE, SIG_DFL);
                    breakPipe(STDERR_FILENO);
                    log(6000, "first");
                    log(6000, "second");
                    EXPECT_FALSE(isPending(SIGPIPE));
                    EXPECT_FALSE(isBlocked(SIGPIPE));
                    EXPECT_EQ(std::signal(SIGPIPE, SIG_IGN), SIG_DFL);
                    log(6000, "third");
                }),
                IsEmpty());
}

TEST_F(Pipes, aSignalThatWaitsAlreadyIsLeftWaiting)
{
    EXPECT_THAT(standardErrorOf([] {
                    sigset_t signals;
                    sigemptyset(&signals);
                    sigaddset(&signals, SIGPIPE);
                    pthread_sigmask(SIG_BLOCK, &signals, nullptr);
                    raise(SIGPIPE);
                    breakPipe(STDERR_FILENO);
                    log(6000, "first");
                    EXPECT_TRUE(isPending(SIGPIPE));
                    EXPECT_TRUE(isBlocked(SIGPIPE));
                }),
                IsEmpty());
}

TEST_F(Pipes, oneThatIsReadNoMoreIsComplainedOfOnce)
{
    const std::string pipe = directory.path("pipe");
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    file.set(pipe);
    EXPECT_THAT(standardErrorOf([&] {
                    std::signal(SIGPIPE, SIG_DFL);
                    const int reader = open(pipe.c_str(), O_RDONLY | O_NONBLOCK);
                    log(6000, "read");
                    close(reader);
                    log(6000, "lost");
                    log(6000, "lost too");
                }),
                ElementsAre(HasSubstr("a log line is lost: cannot write to " + pipe + ": Broken pipe")));
}

TEST_F(Pipes, oneThatIsFullIsComplainedOfOnce)
{
    const std::string pipe = directory.path("pipe");
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    file.set(pipe);
    EXPECT_THAT(standardErrorOf([&] {
                    const int reader = open(pipe.c_str(), O_RDONLY | O_NONBLOCK);
                    for (int line = 0; line < 2000; ++line)
                        log(6000, std::string(100, '.'));
                    close(reader);
                }),
                ElementsAre(HasSubstr("Resource temporarily unavailable")));
}

/// 4,000 lines of two threads, more than any pipe or socket holds.
void writeMuch()
{
    std::vector<std::thread> threads(2);
    for (std::thread& thread : threads)
        thread = std::thread([] {
            for (int line = 0; line < 2000; ++line)
                log(6000, std::string(1000, '.'));
        });
    for (std::thread& thread : threads)
        thread.join();
}

/// Puts one end in the place of standard error and leaves the other to nobody; the descriptors stay open.
void fill(int unread, int written)
{
    alarm(30); // in vain where lines are waited for without end
    ASSERT_EQ(dup2(written, STDERR_FILENO), STDERR_FILENO);
    writeMuch();

    const int flags = fcntl(STDERR_FILENO, F_GETFL);
    EXPECT_EQ(flags & O_NONBLOCK, 0) << "as others that write there want it";

    std::string lines(std::size_t{8} * 1024 * 1024, '\0');
    ssize_t size = 0;
    ASSERT_EQ(fcntl(unread, F_SETFL, O_NONBLOCK), 0);
    EXPECT_GT(read(unread, lines.data(), lines.size()), 0);
    while ((size = read(unread, lines.data(), lines.size())) > 0)
        ;
    log(6000, "read again");
    size = read(unread, lines.data(), lines.size());
    ASSERT_GT(size, 0);
    EXPECT_THAT(lines.substr(0, static_cast<std::size_t>(size)), HasSubstr(": read again\n"));
}

TEST_F(Pipes, anUnreadStandardErrorStopsNobody)
{
    standardErrorOf([] {
        int ends[2] = {-1, -1};
        ASSERT_EQ(pipe(ends), 0);
        fill(ends[0], ends[1]);
    });
}

TEST_F(Pipes, anUnreadStandardErrorOfAnotherUserStopsNobody)
{
    standardErrorOf([] {
        int ends[2] = {-1, -1};
        ASSERT_EQ(pipe(ends), 0);
        const Testing::WithoutPrivileges nobody;
        fill(ends[0], ends[1]);
    });
}

TEST_F(Pipes, anUnreadSocketAsStandardErrorStopsNobody)
{
    standardErrorOf([] {
        int ends[2] = {-1, -1};
        ASSERT_EQ(socketpair(AF_UNIX, SOCK_STREAM, 0, ends), 0);
        fill(ends[0], ends[1]);
    });
}

TEST_F(Pipes, anUnreadTerminalAsStandardErrorStopsNobody)
{
    standardErrorOf([] {
        const int terminal = posix_openpt(O_RDWR | O_NOCTTY);
        ASSERT_GE(terminal, 0);
        ASSERT_EQ(grantpt(terminal), 0);
        ASSERT_EQ(unlockpt(terminal), 0);
        const int shown = open(ptsname(terminal), O_RDWR | O_NOCTTY);
        ASSERT_GE(shown, 0);
        termios settings{};
        ASSERT_EQ(tcgetattr(shown, &settings), 0);
        cfmakeraw(&settings);
        ASSERT_EQ(tcsetattr(shown, TCSANOW, &settings), 0);
        fill(terminal, shown);
    });
}

} // namespace
