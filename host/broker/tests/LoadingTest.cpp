// Every way in which a provider cannot be loaded, and what the client is told.

#include "BrokerFixture.h"

#include <filesystem>
#include <fstream>

#include <dlfcn.h>
#include <unistd.h>

namespace cimhost {

namespace {

using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

/// The message of a request to a provider of the sample library, or another.
std::string failureOf(const std::string& provider, const std::string& location = "CimhostSample",
                      const std::vector<std::string>& directories = {SAMPLE_DIRECTORY})
{
    Registration registration = sampleRegistration({provider});
    registration.classes[0].location = location;
    Broker broker(registration, directories);
    const cim::Answer answer = broker.enumerateInstanceNames(classPath("TEST_" + provider));
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_FAILED);
    return answer.status.message.value_or("(none)");
}

/// A folder of its own that goes with the test.
class Folder
{
public:
    Folder() : path_(testing::TempDir() + "cimhost-loading-test-" + std::to_string(getpid()))
    {
        std::filesystem::create_directories(path_);
    }
    ~Folder() { std::filesystem::remove_all(path_); }
    Folder(const Folder&) = delete;
    Folder& operator=(const Folder&) = delete;

    [[nodiscard]] const std::string& path() const { return path_; }

private:
    std::string path_;
};

TEST(LoadingTest, NamesTheFoldersThatLackTheLibrary)
{
    EXPECT_EQ(failureOf("Thing", "Nowhere", {"/one", "/two"}),
              "the provider Thing cannot be used: libNowhere.so was not found in /one, /two");
    EXPECT_EQ(
        failureOf("Thing", "Nowhere", {}),
        "the provider Thing cannot be used: libNowhere.so was not found: there is no provider directory");
}

TEST(LoadingTest, PassesOnWhatTheLoaderSays)
{
    const Folder folder;
    std::ofstream(folder.path() + "/libText.so") << "this is text";
    EXPECT_THAT(
        failureOf("Thing", "Text", {folder.path()}),
        AllOf(HasSubstr(folder.path() + "/libText.so cannot be loaded: "), HasSubstr("file too short")));
}

TEST(LoadingTest, ResolvesEverySymbolAtOnce)
{
    EXPECT_THAT(failureOf("Unresolved", "CimhostUnresolved"),
                AllOf(HasSubstr("libCimhostUnresolved.so cannot be loaded"),
                      HasSubstr("cimhostTestNobodyDefinesThis")));
}

TEST(LoadingTest, TakesTheFirstFolderThatHasTheLibrary)
{
    const Folder folder;
    std::ofstream(folder.path() + "/libCimhostSample.so") << "this is text";
    EXPECT_THAT(failureOf("Thing", "CimhostSample", {"/nowhere", folder.path(), SAMPLE_DIRECTORY}),
                HasSubstr(folder.path()));
}

TEST(LoadingTest, FindsALibraryInARelativeFolder)
{
    Broker broker(sampleRegistration({"Thing"}), {std::filesystem::relative(SAMPLE_DIRECTORY).string()});
    EXPECT_EQ(broker.enumerateInstanceNames(classPath("TEST_Thing")).paths.size(), 2U);
}

TEST(LoadingTest, NamesAMissingEntryPoint)
{
    EXPECT_THAT(failureOf("Missing"), AllOf(StartsWith("the provider Missing cannot be used: "),
                                            HasSubstr("has no entry point Missing_Create_InstanceMI")));
}

TEST(LoadingTest, PassesOnWhyAFactoryFunctionRefuses)
{
    EXPECT_EQ(failureOf("Refusing"),
              "the provider Refusing cannot be used: Refusing_Create_InstanceMI answered "
              "with no interface (status 2: not today)");
}

TEST(LoadingTest, SurvivesAFactoryFunctionThatThrows)
{
    EXPECT_EQ(
        failureOf("ThrowingFactory"),
        "the provider ThrowingFactory cannot be used: ThrowingFactory_Create_InstanceMI: the provider threw "
        "an exception: no start");
}

TEST(LoadingTest, ChecksTheFunctionTable)
{
    EXPECT_THAT(failureOf("NoTable"), HasSubstr("an interface without a function table"));
    EXPECT_THAT(failureOf("OldTable"), HasSubstr("a function table of version 99; expected 100 or newer"));
    EXPECT_THAT(failureOf("NullSlot"), HasSubstr("a function table whose slot getInstance is null"));
}

TEST(LoadingTest, ChecksTheFunctionTableOfAssociations)
{
    Registration registration = sampleRegistration({"NullSlot"});
    registration.classes[0].association = true;
    Broker broker(registration, {SAMPLE_DIRECTORY});
    EXPECT_THAT(broker.associatorNames(thingPath("one"), {}).status.message.value_or(""),
                HasSubstr("a function table whose slot references is null"));
}

TEST(LoadingTest, AnswersAProviderThatAsksForItselfTooEarly)
{
    std::vector<std::string> traces;
    Broker broker(sampleRegistration({"Eager"}), {SAMPLE_DIRECTORY},
                  {[&](const TraceRecord& record) { traces.push_back(record.text); }, {}, {}});
    EXPECT_EQ(broker.enumerateInstanceNames(classPath("TEST_Eager")).status.code, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_THAT(traces, ElementsAre("eager: 1"));
}

TEST(LoadingTest, RemembersAFailure)
{
    Broker broker(sampleRegistration({"Refusing"}), {SAMPLE_DIRECTORY});
    const auto first = broker.enumerateInstanceNames(classPath("TEST_Refusing")).status.message;
    EXPECT_EQ(broker.enumerateInstanceNames(classPath("TEST_Refusing")).status.message, first);
}

#ifndef GLIMMARK_SANITIZED

bool isLoaded()
{
    void* const handle = dlopen(SAMPLE_DIRECTORY "/libCimhostSample.so", RTLD_NOW | RTLD_NOLOAD);
    if (handle != nullptr)
        dlclose(handle);
    return handle != nullptr;
}

TEST(LoadingTest, UnloadsTheLibraryWithTheBroker)
{
    if (isLoaded())
        GTEST_SKIP() << "another test of this process keeps it loaded";
    {
        Broker broker(sampleRegistration({"Thing"}), {SAMPLE_DIRECTORY});
        EXPECT_FALSE(isLoaded()); // not before it is needed
        broker.enumerateInstanceNames(classPath("TEST_Thing"));
        EXPECT_TRUE(isLoaded());
    }
    EXPECT_FALSE(isLoaded());
}

TEST(LoadingTest, LeavesALibraryLoadedThatAsksForIt)
{
    {
        Broker broker(sampleRegistration({"Setup"}), {SAMPLE_DIRECTORY});
        broker.enumerateInstanceNames(classPath("TEST_Setup"));
    }
    EXPECT_TRUE(isLoaded());
}

#endif

} // namespace

} // namespace cimhost
