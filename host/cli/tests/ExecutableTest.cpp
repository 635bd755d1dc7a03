// The executable as a shell runs it: what only a process of its own has.

#include "testing/TemporaryDirectory.h"

#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/wait.h>

using testing::HasSubstr;
using Testing::TemporaryDirectory;

namespace {

std::string readFile(const std::filesystem::path& file)
{
    std::ostringstream content;
    content << std::ifstream(file).rdbuf();
    return content.str();
}

class Executable : public testing::Test
{
protected:
    void SetUp() override
    {
        setenv("CIMHOST", CIMHOST_EXECUTABLE, 1);
        setenv("CIMHOST_PROVIDER_DIR", SAMPLE_PROVIDER_DIRECTORY, 1);
        setenv("CIMHOST_REGISTRATION", SAMPLE_REGISTRATION, 1);
    }

    void TearDown() override
    {
        unsetenv("CIMHOST_PROVIDER_DIR");
        unsetenv("CIMHOST_REGISTRATION");
    }

    /// Runs a line of the shell, in which $CIMHOST is the program.
    /// \return its exit status
    [[nodiscard]] int shell(const std::string& line) const
    {
        const std::string out = (directory.path() / "out").string();
        const std::string err = (directory.path() / "err").string();
        const int status = std::system(("{ " + line + "; } >" + out + " 2>" + err).c_str());
        return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    }

    [[nodiscard]] std::string out() const { return readFile(directory.path() / "out"); }
    [[nodiscard]] std::string err() const { return readFile(directory.path() / "err"); }

    TemporaryDirectory directory;
};

TEST_F(Executable, answersWithStatusZero)
{
    EXPECT_EQ(shell("$CIMHOST ein CIMT_RackSystem"), 0);
    EXPECT_EQ(out(), "root/cimv2:CIMT_RackSystem.Name=\"rack-1\"\n");
    EXPECT_EQ(err(), "");
}

TEST_F(Executable, takesTheNamesThatItPrints)
{
    EXPECT_EQ(shell("$CIMHOST ein CIMT_Lamp | while read -r path; do $CIMHOST gi \"$path\" Name; done"), 0);
    EXPECT_THAT(out(), HasSubstr("  Name = \"Fan 1\"\n"));
    EXPECT_THAT(out(), HasSubstr("  Name = \"Lüfter 2\"\n"));
    EXPECT_EQ(err(), "");
}

TEST_F(Executable, answersErrorsWithStatusOne)
{
    EXPECT_EQ(shell("$CIMHOST gi CIMT_Lamp"), 1);
    EXPECT_EQ(out(), "");
    EXPECT_EQ(err(), "cimhost: CMPI_RC_ERR_FAILED (1): At least one key should be passed\n");
}

TEST_F(Executable, answersWrongUsageWithStatusTwo)
{
    EXPECT_EQ(shell("$CIMHOST ei"), 2);
    EXPECT_EQ(out(), "");
    EXPECT_THAT(err(), HasSubstr("cimhost: "));
}

TEST_F(Executable, endsQuietlyIfNobodyReadsItsOutput)
{
    const std::string pipe = (directory.path() / "pipe").string();
    EXPECT_EQ(
        shell("mkfifo " + pipe + "; exec 3<>" + pipe + " 4>" + pipe + " 3<&-; $CIMHOST ein CIMT_Lamp >&4"),
        1);
    EXPECT_EQ(err(), "") << "a reader that has seen enough needs no message";
}

TEST_F(Executable, saysIfNobodyReadsTheGraphToItsEnd)
{
    const std::string pipe = (directory.path() / "pipe").string();
    EXPECT_EQ(shell("mkfifo " + pipe + "; exec 3<>" + pipe + " 4>" + pipe +
                    " 3<&-; $CIMHOST graph -n root/other >&4"),
              1);
    EXPECT_EQ(err(), "cimhost: nobody read the graph to its end\n");
}

TEST_F(Executable, saysWhatToDoIfItsPortIsTaken)
{
    EXPECT_EQ(shell("$CIMHOST serve --port 0 2>" + directory.path("first") +
                    " & server=$!; "
                    "until port=$(sed -n 's/.*:\\([0-9]*\\),.*/\\1/p' " +
                    directory.path("first") +
                    ") && [ -n \"$port\" ]; do sleep 0.05; done; "
                    "$CIMHOST serve --port \"$port\"; status=$?; kill $server; exit $status"),
              1);
    EXPECT_THAT(err(), HasSubstr("Address already in use; --port chooses another port\n"));
}

TEST_F(Executable, leavesAFileOfMetricsWhereTheNewOneDoesNotFit)
{
    const std::string file = directory.path("lamps.prom");
    EXPECT_EQ(shell("echo old >" + file + "; ulimit -f 1; $CIMHOST metrics CIMT_Lamp --output " + file), 1);
    EXPECT_EQ(err(), "cimhost: cannot write " + file + ": File too large\n");
    EXPECT_EQ(readFile(file), "old\n");
}

TEST_F(Executable, saysIfItsOutputDoesNotFit)
{
    EXPECT_EQ(shell("$CIMHOST ein CIMT_Lamp >/dev/full"), 1);
    EXPECT_EQ(err(), "cimhost: cannot write to standard output: No space left on device\n");
}

TEST_F(Executable, saysIfItsOutputIsClosed)
{
    EXPECT_EQ(shell("$CIMHOST ein CIMT_Lamp >&-"), 1);
    EXPECT_EQ(err(), "cimhost: cannot write to standard output: Bad file descriptor\n");
}

TEST_F(Executable, findsProvidersAndRegistrationsBesideItself)
{
    std::filesystem::create_directory_symlink(SAMPLE_PROVIDER_DIRECTORY, directory.path() / "lib");
    const std::string program = directory.folder("bin") + "/cimhost";
    std::filesystem::copy_file(CIMHOST_EXECUTABLE, program);
    std::filesystem::create_directories(directory.path() / "bin" / CIMHOST_SCHEMADIR_FROM_BIN);
    std::filesystem::copy_file(SAMPLE_REGISTRATION,
                               directory.path() / "bin" / CIMHOST_SCHEMADIR_FROM_BIN / "sample.reg");
    TearDown();
    EXPECT_EQ(shell(program + " ein CIMT_RackSystem"), 0);
    EXPECT_EQ(out(), "root/cimv2:CIMT_RackSystem.Name=\"rack-1\"\n");
    EXPECT_EQ(err(), "");
}

} // namespace
