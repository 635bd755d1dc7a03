// A pipe that nobody reads must not end the process, and signals stay as the process wants them.

#include "LoggerTest.h"

#include <csignal>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/stat.h>
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

TEST_F(Pipes, oneThatIsFullIsComplainedOfOnceAndNotWaitedFor)
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

} // namespace
