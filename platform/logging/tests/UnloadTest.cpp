#include "testing/Environment.h"
#include "testing/TemporaryDirectory.h"

#include <algorithm>
#include <string>

#include <dlfcn.h>
#include <gtest/gtest.h>

#include <sys/wait.h>
#include <unistd.h>

namespace {

using Testing::contentOf;
using Testing::Environment;
using Testing::TemporaryDirectory;

using LogFunction = void(const char*, const char*, int, const std::string&, int, const char*, int, int,
                         const std::string&);

constexpr const char* logLevelMessage =
#ifdef _LIBCPP_VERSION
    "_ZN5MVLog8MVLogger15logLevelMessageEPKcS2_iRKNSt3__112basic_stringIcNS3_11char_traitsIcEENS3_9allocatorIcEEEEiS2_iiSB_";
#else
    "_ZN5MVLog8MVLogger15logLevelMessageEPKcS2_iRKNSt7__cxx1112basic_stringIcSt11char_traitsIcESaIcEEEiS2_iiSA_";
#endif

std::ptrdiff_t lineCount(const std::string& file)
{
    const std::string content = contentOf(file);
    return std::count(content.begin(), content.end(), '\n');
}

void loadLogUnload(const std::string& text)
{
    void* const library = dlopen(MVLOG_LIBRARY, RTLD_NOW | RTLD_LOCAL);
    ASSERT_NE(library, nullptr) << dlerror();
    auto* const log = reinterpret_cast<LogFunction*>(dlsym(library, logLevelMessage));
    ASSERT_NE(log, nullptr) << dlerror();
    log("function", "File.cpp", 1, "Mavrel.Test", 6000, nullptr, 0, 0, text);
    ASSERT_EQ(dlclose(library), 0) << dlerror();
}

bool isLoaded()
{
    void* const library = dlopen(MVLOG_LIBRARY, RTLD_NOW | RTLD_NOLOAD);
    if (library != nullptr)
        dlclose(library);
    return library != nullptr;
}

TEST(Unload, theLibraryGoesAndComesBack)
{
    const TemporaryDirectory directory;
    for (const char* const name : {"first", "second", "third"}) {
        const Environment file("MVLOG_FILE", directory.path(name));
        loadLogUnload("text");
        EXPECT_FALSE(isLoaded());
        EXPECT_EQ(lineCount(directory.path(name)), 1);
    }
}

TEST(Unload, theLogFileIsClosed)
{
    const TemporaryDirectory directory;
    const Environment file("MVLOG_FILE", directory.path("log"));
    const auto openFiles = [] {
        const std::filesystem::directory_iterator files("/proc/self/fd");
        return std::distance(begin(files), end(files));
    };
    const auto before = openFiles();
    loadLogUnload("text");
    EXPECT_EQ(openFiles(), before);
}

TEST(Unload, nothingOfItRunsInAForkAfterwards)
{
    const TemporaryDirectory directory;
    const Environment file("MVLOG_FILE", directory.path("log"));
    loadLogUnload("text");
    ASSERT_FALSE(isLoaded());
    const pid_t child = fork();
    if (child == 0)
        _exit(0);
    int status = -1;
    EXPECT_EQ(waitpid(child, &status, 0), child);
    EXPECT_EQ(status, 0);
}

} // namespace
