// A memory that lets any single allocation fail, of C++, of C and of the loader, in a broker that loads the library with
// its real support libraries and logs every line: the process goes on, and the next request is whole.

#include "broker/ProviderLibrary.h"
#include "broker/Registration.h"
#include "testing/Allocations.h"
#include "testing/Operations.h"
#include "testing/RecordingBroker.h"

#include <cstddef>
#include <cstdlib>
#include <iostream>
#include <new>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include <sys/wait.h>
#include <unistd.h>

namespace {

/// Said once in a process: the library reads most of it only once.
bool setEnvironment()
{
    setenv("TAVRO_INVENTORY", INVENTORY, 1);
    setenv("TAVRO_COMPUTER_SYSTEMS", "one", 1);
    setenv("LC_ALL", "de_DE", 1);
    setenv("MVLOG_LEVEL", "0", 1);
    setenv("MVLOG_TRACE_LEVEL", "0", 1);
    setenv("MVLOG_FILE", "/dev/null", 1);
    return true;
}

const EntryPoints& loadedEntryPoints()
{
    static const bool isSet = setEnvironment();
    static const cimhost::ProviderLibrary library("GlimmarkProvider", {PROVIDER_DIRECTORY});
    using Instances = std::remove_pointer_t<EntryPoints::CreateInstanceMI>;
    using Associations = std::remove_pointer_t<EntryPoints::CreateAssociationMI>;
    static const EntryPoints all{
        library.function<Instances>("GlimmarkProfileProvider_Create_InstanceMI"),
        library.function<Instances>("GlimmarkCapabilitiesProvider_Create_InstanceMI"),
        library.function<Instances>("GlimmarkElementCapabilitiesProvider_Create_InstanceMI"),
        library.function<Associations>("GlimmarkElementCapabilitiesProvider_Create_AssociationMI"),
        library.function<Instances>("GlimmarkSystemDeviceProvider_Create_InstanceMI"),
        library.function<Associations>("GlimmarkSystemDeviceProvider_Create_AssociationMI")};
    EXPECT_TRUE(isSet);
    return all;
}

class RealLibraries : public testing::Test
{
protected:
    /// Runs an operation in a request of its own. \param nth  the allocation that fails \return whether so many came
    bool runWithout(std::size_t nth, const Operation& operation)
    {
        cimhost::Request request(host);
        const auto path = [&](const cimhost::cim::ObjectPath& wanted) {
            const Allocations::Pause pause;
            cimhost::cim::ObjectPath inNameSpace = wanted;
            inNameSpace.nameSpace = "root/cimv2";
            return request.path(inNameSpace);
        };
        Allocations::failNth(nth);
        bool isThrown = false;
        try {
            operation.run({host.cmpiBroker(), request.context(), request.result(), path});
        } catch (const std::bad_alloc&) {
            isThrown = true;
        }
        const bool hasFailed = Allocations::stop();
        EXPECT_TRUE(hasFailed || !isThrown);
        return hasFailed;
    }

    cimhost::Broker host{cimhost::readRegistrationFile(COMPUTER_SYSTEM_REGISTRATION), {PROVIDER_DIRECTORY}};
    RecordingBroker broker{host}; ///< so that the broker's own allocations do not fail
};

class EveryOperation : public RealLibraries, public testing::WithParamInterface<Operation>
{};

INSTANTIATE_TEST_SUITE_P(All, EveryOperation, testing::ValuesIn(allOperations(loadedEntryPoints())),
                         [](const auto& suite) { return suite.param.name; });

} // namespace

// A thread of its own each time: what the loader allocates for a thread, it allocates at the first use.
TEST_P(EveryOperation, OutlivesAnyAllocationThatFailsInAThread)
{
    const Outcome whole = ask(host, GetParam());
    std::size_t nth = 0;
    for (bool hasFailed = true; hasFailed;) {
        ++nth;
        std::thread([&] { hasFailed = runWithout(nth, GetParam()); }).join();
    }
    EXPECT_EQ(ask(host, GetParam()), whole);
    std::cout << nth - 1 << " runs with one failing allocation each\n";
}

// A process of its own each time: the log is opened and the catalogues are read in the first request.
TEST_F(RealLibraries, outliveAnyAllocationThatFailsInTheFirstRequest)
{
    const std::vector<Operation> all = allOperations(loadedEntryPoints());
    const Operation& enumeration = all.at(1);
    ASSERT_EQ(enumeration.name, "TAVRO_Glimmark_EnumInstances");
    std::size_t nth = 0;
    for (bool hasFailed = true; hasFailed;) {
        ++nth;
        const pid_t child = fork();
        if (child == 0) {
            const bool failed = runWithout(nth, enumeration);
            const Outcome next = ask(host, enumeration);
            _exit(next == ask(host, enumeration) && !next.answer.instances.empty() ? failed : 2);
        }
        int status = -1;
        ASSERT_EQ(waitpid(child, &status, 0), child);
        ASSERT_TRUE(WIFEXITED(status)) << "allocation " << nth << ", signal " << WTERMSIG(status);
        ASSERT_LT(WEXITSTATUS(status), 2) << "allocation " << nth;
        hasFailed = WEXITSTATUS(status) == 1;
    }
    EXPECT_GT(nth, 100U);
    std::cout << nth - 1 << " runs with one failing allocation each\n";
}
