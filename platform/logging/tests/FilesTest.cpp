// The log in a file.

#include "LoggerTest.h"

#include <algorithm>
#include <filesystem>
#include <string>
#include <thread>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/resource.h>

namespace {

using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;

class Files : public LoggerTest
{
protected:
    Files() { file.set(directory.path("log")); }
};

TEST_F(Files, oneThatIsMovedAwayIsMadeAnew)
{
    EXPECT_THAT(standardErrorOf([&] {
                    log(6000, "before");
                    std::filesystem::rename(directory.path("log"), directory.path("log.1"));
                    log(6000, "after");
                    log(6000, "later");
                }),
                IsEmpty());
    EXPECT_THAT(linesIn("log.1"), ElementsAre(EndsWith(": before")));
    EXPECT_THAT(linesIn("log"), ElementsAre(EndsWith(": after"), EndsWith(": later")));
}

TEST_F(Files, oneThatIsReplacedIsFollowed)
{
    EXPECT_THAT(standardErrorOf([&] {
                    log(6000, "before");
                    std::filesystem::rename(directory.path("log"), directory.path("log.1"));
                    const std::string made = directory.file("log", "made by the rotation\n");
                    log(6000, "after");
                }),
                IsEmpty());
    EXPECT_THAT(linesIn("log"), ElementsAre("made by the rotation", EndsWith(": after")));
}

TEST_F(Files, aSymbolicLinkIsNotFollowed)
{
    const std::string other = directory.file("other", "");
    std::filesystem::create_symlink(other, directory.path("log"));
    EXPECT_THAT(standardErrorOf([] { log(6000, "text"); }),
                ElementsAre(HasSubstr("MVLOG_FILE: cannot open " + directory.path("log") +
                                      ": Too many levels of symbolic links"),
                            EndsWith(": text")));
    EXPECT_THAT(linesIn("other"), IsEmpty());
}

TEST_F(Files, aSymbolicLinkThatTakesItsPlaceIsNotFollowed)
{
    const std::string other = directory.file("other", "");
    EXPECT_THAT(standardErrorOf([&] {
                    log(6000, "before");
                    std::filesystem::rename(directory.path("log"), directory.path("log.1"));
                    std::filesystem::create_symlink(other, directory.path("log"));
                    log(6000, "after");
                }),
                ElementsAre(HasSubstr("log lines go on into the file that was moved away")));
    EXPECT_THAT(linesIn("other"), IsEmpty());
    EXPECT_THAT(linesIn("log.1"), ElementsAre(EndsWith(": before"), EndsWith(": after")));
}

TEST_F(Files, oneThatIsRemovedIsMadeAnew)
{
    EXPECT_THAT(standardErrorOf([&] {
                    log(6000, "before");
                    std::filesystem::remove(directory.path("log"));
                    log(6000, "after");
                }),
                IsEmpty());
    EXPECT_THAT(linesIn("log"), ElementsAre(EndsWith(": after")));
}

TEST_F(Files, oneThatIsEmptiedIsGoneOnWith)
{
    EXPECT_THAT(standardErrorOf([&] {
                    log(6000, "before");
                    std::filesystem::resize_file(directory.path("log"), 0);
                    log(6000, "after");
                }),
                IsEmpty());
    EXPECT_THAT(linesIn("log"), ElementsAre(EndsWith(": after")));
}

TEST_F(Files, aRelativeNameIsThatOfTheBeginning)
{
    file.set("log");
    std::filesystem::create_directory(directory.path("other"));
    EXPECT_THAT(standardErrorOf([&] {
                    std::filesystem::current_path(directory.path(""));
                    log(6000, "before");
                    std::filesystem::current_path(directory.path("other"));
                    std::filesystem::rename(directory.path("log"), directory.path("log.1"));
                    log(6000, "after");
                }),
                IsEmpty());
    EXPECT_THAT(linesIn("log"), ElementsAre(EndsWith(": after")));
}

TEST_F(Files, withoutAnotherTheOneMovedAwayIsGoneOnWith)
{
    std::filesystem::create_directory(directory.path("logs"));
    file.set(directory.path("logs/log"));
    EXPECT_THAT(standardErrorOf([&] {
                    log(6000, "one");
                    std::filesystem::rename(directory.path("logs"), directory.path("moved"));
                    log(6000, "two");
                    log(6000, "three");
                    std::filesystem::create_directory(directory.path("logs"));
                    log(6000, "four");
                }),
                ElementsAre(EndsWith("log lines go on into the file that was moved away: cannot open " +
                                     directory.path("logs/log") + ": No such file or directory")));
    EXPECT_THAT(linesIn("moved/log"), ElementsAre(EndsWith(": one"), EndsWith(": two"), EndsWith(": three")));
    EXPECT_THAT(linesIn("logs/log"), ElementsAre(EndsWith(": four")));
}

TEST_F(Files, aLineThatIsCutOffByAFullFileStaysALineOfItsOwn)
{
    EXPECT_THAT(standardErrorOf([] {
                    rlimit limit{};
                    getrlimit(RLIMIT_FSIZE, &limit);
                    const rlim_t unlimited = limit.rlim_cur;
                    log(6000, "first");
                    limit.rlim_cur = 150; // in the middle of the second line, and of the complaint
                    setrlimit(RLIMIT_FSIZE, &limit);
                    log(6000, "second");
                    log(6000, "lost");
                    limit.rlim_cur = unlimited;
                    setrlimit(RLIMIT_FSIZE, &limit);
                    log(6000, "third");
                    log(6000, "fourth");
                }),
                ElementsAre(HasSubstr("a log line is lost: cannot write to ")));
    const std::vector<std::string> lines = linesIn("log");
    EXPECT_THAT(lines, ElementsAre(EndsWith(": first"), testing::Not(HasSubstr("second")),
                                   EndsWith(": third"), EndsWith(": fourth")));
}

TEST_F(Files, linesOfThreadsStayWholeWhileItIsRotated)
{
    constexpr int threadCount = 8;
    constexpr int lineCount = 200;
    constexpr int rotationCount = 20;
    const std::string filling(300, '.');
    EXPECT_THAT(standardErrorOf([&] {
                    log(6000, "begin");
                    std::vector<std::thread> threads;
                    threads.reserve(threadCount);
                    for (int number = 0; number < threadCount; ++number)
                        threads.emplace_back([&] {
                            for (int line = 0; line < lineCount; ++line)
                                log(6000, filling + "end");
                        });
                    for (int number = 0; number < rotationCount; ++number) {
                        std::error_code mayBeGone;
                        std::filesystem::rename(directory.path("log"),
                                                directory.path("log." + std::to_string(number)), mayBeGone);
                    }
                    for (std::thread& thread : threads)
                        thread.join();
                }),
                IsEmpty());

    std::vector<std::string> lines;
    for (const auto& entry : std::filesystem::directory_iterator(directory.path("")))
        for (const std::string& line : linesIn(entry.path().filename().string()))
            lines.push_back(line);
    EXPECT_EQ(lines.size(), threadCount * lineCount + 1U);
    EXPECT_EQ(std::count_if(lines.begin(), lines.end(),
                            [&](const std::string& line) {
                                const std::string::size_type position = line.find("] 6000 log ");
                                return position != std::string::npos &&
                                       line.substr(position) ==
                                           "] 6000 log Mavrel.Test function() File.cpp:12: " + filling +
                                               "end";
                            }),
              threadCount * lineCount);
}

} // namespace
