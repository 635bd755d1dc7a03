// The log to a daemon: syslog and the systemd journal, whose sockets are the test's own.

#include "LoggerTest.h"

#include <cstring>
#include <optional>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

namespace {

using testing::ContainsRegex;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;

/// Listens on a datagram socket as a log daemon does.
class Daemon
{
public:
    explicit Daemon(std::string path) : path_(std::move(path)), socket_(socket(AF_UNIX, SOCK_DGRAM, 0))
    {
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        std::strncpy(&address.sun_path[0], path_.c_str(), sizeof address.sun_path - 1);
        EXPECT_EQ(bind(socket_, reinterpret_cast<const sockaddr*>(&address), sizeof address), 0);
    }
    ~Daemon()
    {
        close(socket_);
        unlink(path_.c_str());
    }
    Daemon(const Daemon&) = delete;
    Daemon& operator=(const Daemon&) = delete;

    /// What was sent since.
    [[nodiscard]] std::vector<std::string> take() const
    {
        std::vector<std::string> datagrams;
        std::string datagram(300000, '\0');
        for (ssize_t size = 0; (size = recv(socket_, datagram.data(), datagram.size(), MSG_DONTWAIT)) >= 0;)
            datagrams.push_back(datagram.substr(0, static_cast<std::size_t>(size)));
        return datagrams;
    }

private:
    std::string path_;
    int socket_;
};

class Daemons : public LoggerTest
{
protected:
    const std::string socketPath = directory.path("socket");
};

TEST_F(Daemons, syslogGetsSeverityTimeProgramAndText)
{
    const Daemon daemon(socketPath);
    output.set("syslog:" + socketPath);
    level.set("0");
    EXPECT_THAT(standardErrorOf([] {
                    log(6000, "an\nerror");
                    log(3000, "flow");
                    log(4500, "between");
                }),
                IsEmpty());
    EXPECT_THAT(daemon.take(),
                ElementsAre(ContainsRegex("^<27>[JFMASOND][a-z][a-z] [ 123][0-9] [0-9]{2}:[0-9]{2}:[0-9]{2} "
                                          "mvlog-tests\\[[0-9]+\\]: 6000 log Mavrel\\.Test function\\(\\) "
                                          "File\\.cpp:12: an\\\\nerror$"),
                            HasSubstr("<31>"), HasSubstr("<30>")));
}

TEST_F(Daemons, theJournalGetsFields)
{
    const Daemon daemon(socketPath);
    output.set("journal:" + socketPath);
    EXPECT_THAT(standardErrorOf([] { log(6000, "an error"); }), IsEmpty());
    EXPECT_THAT(daemon.take(), ElementsAre("MESSAGE=6000 log Mavrel.Test function() File.cpp:12: an error\n"
                                           "PRIORITY=3\n"
                                           "SYSLOG_IDENTIFIER=mvlog-tests\n"
                                           "CODE_FILE=File.cpp\n"
                                           "CODE_LINE=12\n"
                                           "CODE_FUNC=function\n"
                                           "MVLOG_CATEGORY=Mavrel.Test\n"));
}

TEST_F(Daemons, noTextMakesAFieldOfItsOwn)
{
    const Daemon daemon(socketPath);
    output.set("journal:" + socketPath);
    EXPECT_THAT(standardErrorOf([] {
                    MVLog::MVLogger::logLevelMessage("f\nA=1", "F\nB=1", 1, "C\nD=1", 6000, nullptr, 0, 0,
                                                     "text\nE=1");
                }),
                IsEmpty());
    const std::vector<std::string> datagrams = daemon.take();
    ASSERT_EQ(datagrams.size(), 1U);
    EXPECT_EQ(linesOf(datagrams.front()).size(), 7U);
}

TEST_F(Daemons, theTraceMayGoToAnother)
{
    const Daemon daemon(socketPath);
    traceLevel.set("6000");
    traceOutput.set("journal:" + socketPath);
    EXPECT_THAT(standardErrorOf([] {
                    log(6000, "to the log");
                    trace(6000, "to the trace");
                }),
                ElementsAre(EndsWith("to the log")));
    EXPECT_THAT(daemon.take(), ElementsAre(HasSubstr("MESSAGE=6000 trace ")));
}

TEST_F(Daemons, oneThatIsNotThereIsComplainedOfOnceAndStandardErrorTaken)
{
    for (const std::string& path :
         {directory.path("missing"), directory.path(std::string(200, 'x')), directory.path("")}) {
        output.set("syslog:" + path);
        EXPECT_THAT(standardErrorOf([] {
                        log(6000, "first");
                        log(6000, "second");
                    }),
                    ElementsAre(testing::AllOf(HasSubstr("MVLOG_OUTPUT: cannot connect to " + path + ": "),
                                               EndsWith(", expected a log daemon's socket; taking standard "
                                                        "error")),
                                EndsWith(": first"), EndsWith(": second")));
    }
}

TEST_F(Daemons, oneThatIsStartedAnewIsFound)
{
    output.set("journal:" + socketPath);
    EXPECT_THAT(standardErrorOf([&] {
                    std::optional<Daemon> daemon(socketPath);
                    log(6000, "before");
                    daemon.reset();
                    daemon.emplace(socketPath);
                    log(6000, "after");
                    EXPECT_THAT(daemon->take(), ElementsAre(HasSubstr(": after\n")));
                }),
                IsEmpty());
}

TEST_F(Daemons, oneThatIsGoneIsComplainedOfOnceAndLookedForAgain)
{
    output.set("journal:" + socketPath);
    EXPECT_THAT(standardErrorOf([&] {
                    std::optional<Daemon> daemon(socketPath);
                    log(6000, "before");
                    daemon.reset();
                    log(6000, "lost");
                    log(6000, "lost too");
                    daemon.emplace(socketPath);
                    log(6000, "after");
                    EXPECT_THAT(daemon->take(), ElementsAre(HasSubstr(": after\n")));
                }),
                ElementsAre(EndsWith("a log line is lost: cannot send to " + socketPath +
                                     ": No such file or directory")));
}

TEST_F(Daemons, oneThatDoesNotReadIsComplainedOfOnceAndUsedWhenItReadsAgain)
{
    output.set("journal:" + socketPath);
    EXPECT_THAT(standardErrorOf([&] {
                    const Daemon daemon(socketPath);
                    for (int line = 0; line < 5000; ++line)
                        log(6000, "text");
                    const std::vector<std::string> first = daemon.take();
                    EXPECT_THAT(first, testing::Not(IsEmpty()));
                    EXPECT_LT(first.size(), 5000U);
                    log(6000, "after");
                    EXPECT_THAT(daemon.take(), ElementsAre(HasSubstr(": after\n")));
                }),
                ElementsAre(HasSubstr("Resource temporarily unavailable")));
}

TEST_F(Daemons, aLineThatIsTooLongIsComplainedOf)
{
    const Daemon daemon(socketPath);
    output.set("journal:" + socketPath);
    EXPECT_THAT(standardErrorOf([] {
                    log(6000, std::string(1000000, 'x'));
                    log(6000, "after");
                }),
                ElementsAre(HasSubstr("Message too long")));
    EXPECT_THAT(daemon.take(), ElementsAre(HasSubstr(": after\n")));
}

} // namespace
