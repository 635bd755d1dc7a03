#include "cim/RegularFile.h"
#include "testing/TemporaryDirectory.h"

#include <filesystem>
#include <fstream>

#include <gtest/gtest.h>
#include <sys/stat.h>

using namespace cimhost::cim;

namespace {

class RegularFiles : public testing::Test
{
protected:
    const Testing::TemporaryDirectory temporary;
    const std::filesystem::path& directory = temporary.path();
};

std::string errorOf(const std::string& name, std::size_t mostBytes)
{
    try {
        return "no error: " + RegularFile(name).read(mostBytes);
    } catch (const FileError& error) {
        return error.what();
    }
}

TEST_F(RegularFiles, areReadUpToTheLimit)
{
    const std::string name = directory / "file";
    const std::string content(200000, 'x');
    std::ofstream(name) << content;
    EXPECT_EQ(RegularFile(name).read(content.size()), content);
    EXPECT_EQ(errorOf(name, content.size() - 1), "expected at most 199999 bytes, found more");
    std::ofstream(name) << "";
    EXPECT_EQ(RegularFile(name).read(0), "");
}

TEST_F(RegularFiles, areToldFromEverythingElse)
{
    const std::string pipe = directory / "pipe";
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_EQ(errorOf(pipe, 1), "expected a regular file, found a pipe");
    EXPECT_EQ(errorOf(directory, 1), "expected a regular file, found a directory");
    EXPECT_EQ(errorOf("/dev/zero", 1), "expected a regular file, found a device");
    EXPECT_EQ(errorOf("/dev/null", 1), "expected a regular file, found a device");
    EXPECT_EQ(errorOf(directory / "none", 1), "No such file or directory");
}

} // namespace
