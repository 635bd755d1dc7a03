// What the stand-in does with a broker's services: when one fails, when one is missing, at the edges of the
// function table.

#include "ComputerSystemTest.h"

#include <new>

#include <dlfcn.h>

namespace {

using cimhost::FunctionTables;
using cimhost::Request;
using cimhost::cim::Answer;
using testing::HasSubstr;

using FactoryFunction = CMPIInstanceMI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);

class Services : public ComputerSystemTest
{
protected:
    ~Services() override { dlclose(library_); }

    CMPIInstanceMI* create(const CMPIBroker* cmpiBroker, CMPIStatus* status)
    {
        return create_(cmpiBroker, nullptr, status);
    }

private:
    void* library_ = dlopen(PROVIDER_FILE, RTLD_NOW | RTLD_LOCAL);
    FactoryFunction create_ =
        reinterpret_cast<FactoryFunction>(dlsym(library_, "TavroComputerSystemProvider_Create_InstanceMI"));
};

TEST_F(Services, NeedABroker)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    EXPECT_EQ(create(nullptr, &status), nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(create(nullptr, nullptr), nullptr);
}

TEST_F(Services, AreFoundThroughTheTableOfTheRecord)
{
    CMPIStatus status{CMPI_RC_ERR_FAILED, nullptr};
    CMPIInstanceMI* const provider = create(broker.cmpiBroker(), &status);
    ASSERT_NE(provider, nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(provider->ft->ftVersion, 200);
    EXPECT_EQ(provider->ft->miVersion, 200);
    EXPECT_STREQ(provider->ft->miName, "TavroComputerSystemProvider");
    EXPECT_EQ(create(broker.cmpiBroker(), nullptr), provider);
}

TEST_F(Services, EndWithCleanup)
{
    CMPIInstanceMI* const provider = create(broker.cmpiBroker(), nullptr);
    Request request(broker);
    const CMPIStatus status = provider->ft->cleanup(provider, request.context(), 1);
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(status.msg, nullptr);
}

TEST_F(Services, EndEachAnswerWithOneReturnDone)
{
    CMPIInstanceMI* const provider = create(broker.cmpiBroker(), nullptr);
    systems.set("alpha,beta");
    {
        Request request(broker);
        provider->ft->enumerateInstanceNames(provider, request.context(), request.result(),
                                             request.path(classPath()));
        EXPECT_EQ(request.doneCount(), 1);
    }
    {
        Request request(broker);
        provider->ft->enumerateInstances(provider, request.context(), request.result(),
                                         request.path(classPath()), nullptr);
        EXPECT_EQ(request.doneCount(), 1);
    }
    {
        Request request(broker);
        provider->ft->getInstance(provider, request.context(), request.result(),
                                  request.path(systemPath("beta")), nullptr);
        EXPECT_EQ(request.doneCount(), 1);
    }
}

TEST_F(Services, AreRefusedForNullArguments)
{
    CMPIInstanceMI* const provider = create(broker.cmpiBroker(), nullptr);
    Request request(broker);
    CMPIObjectPath* const path = request.path(systemPath("alpha"));
    const CMPIContext* const context = request.context();
    const CMPIResult* const result = request.result();
    const CMPIInstanceMIFT& table = *provider->ft;

    EXPECT_EQ(table.enumerateInstanceNames(provider, context, result, nullptr).rc,
              CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(table.enumerateInstanceNames(provider, context, nullptr, path).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(table.enumerateInstances(provider, context, result, nullptr, nullptr).rc,
              CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(table.enumerateInstances(provider, context, nullptr, path, nullptr).rc,
              CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(table.getInstance(provider, context, result, nullptr, nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(table.getInstance(provider, context, nullptr, path, nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);

    // A null list of properties, context or record is none of these.
    EXPECT_EQ(table.enumerateInstances(nullptr, nullptr, result, path, nullptr).rc, CMPI_RC_OK);
}

TEST_F(Services, WithoutStringsFailWithoutMessage)
{
    broker.tables().enc.newString = nullptr;
    const Answer answer = broker.getInstance(systemPath("omega"));
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_FALSE(answer.status.message);
}

// Each service that the operations use, missing or failing in turn.

struct Fault
{
    const char* service;
    void (*makeFail)(FunctionTables&);
    void (*remove)(FunctionTables&);
};

constexpr CMPIStatus refused = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};

template <class Object>
Object* refuse(CMPIStatus* rc)
{
    if (rc != nullptr)
        *rc = refused;
    return nullptr;
}

void PrintTo(const Fault& fault, std::ostream* stream)
{
    *stream << fault.service;
}

const std::vector<Fault> faultsOfPaths = {
    {"newObjectPath",
     [](FunctionTables& tables) {
         tables.enc.newObjectPath = [](const CMPIBroker*, const char*, const char*, CMPIStatus* rc) {
             return refuse<CMPIObjectPath>(rc);
         };
     },
     [](FunctionTables& tables) { tables.enc.newObjectPath = nullptr; }},
    {"getNameSpace",
     [](FunctionTables& tables) {
         tables.objectPath.getNameSpace = [](const CMPIObjectPath*, CMPIStatus* rc) {
             return refuse<CMPIString>(rc);
         };
     },
     [](FunctionTables& tables) { tables.objectPath.getNameSpace = nullptr; }},
    {"setHostname",
     [](FunctionTables& tables) {
         tables.objectPath.setHostname = [](const CMPIObjectPath*, const char*) { return refused; };
     },
     [](FunctionTables& tables) { tables.objectPath.setHostname = nullptr; }},
    {"addKey",
     [](FunctionTables& tables) {
         tables.objectPath.addKey = [](const CMPIObjectPath*, const char*, const CMPIValue*, CMPIType) {
             return refused;
         };
     },
     [](FunctionTables& tables) { tables.objectPath.addKey = nullptr; }},
    {"returnDone",
     [](FunctionTables& tables) { tables.result.returnDone = [](const CMPIResult*) { return refused; }; },
     [](FunctionTables& tables) { tables.result.returnDone = nullptr; }},
};

const std::vector<Fault> faultsOfInstances = {
    {"newInstance",
     [](FunctionTables& tables) {
         tables.enc.newInstance = [](const CMPIBroker*, const CMPIObjectPath*, CMPIStatus* rc) {
             return refuse<CMPIInstance>(rc);
         };
     },
     [](FunctionTables& tables) { tables.enc.newInstance = nullptr; }},
    {"newArray",
     [](FunctionTables& tables) {
         tables.enc.newArray = [](const CMPIBroker*, CMPICount, CMPIType, CMPIStatus* rc) {
             return refuse<CMPIArray>(rc);
         };
     },
     [](FunctionTables& tables) { tables.enc.newArray = nullptr; }},
    {"setElementAt",
     [](FunctionTables& tables) {
         tables.array.setElementAt = [](const CMPIArray*, CMPICount, const CMPIValue*, CMPIType) {
             return refused;
         };
     },
     [](FunctionTables& tables) { tables.array.setElementAt = nullptr; }},
    {"setPropertyFilter",
     [](FunctionTables& tables) {
         tables.instance.setPropertyFilter = [](const CMPIInstance*, const char**, const char**) {
             return refused;
         };
     },
     [](FunctionTables& tables) { tables.instance.setPropertyFilter = nullptr; }},
    {"setProperty",
     [](FunctionTables& tables) {
         tables.instance.setProperty = [](const CMPIInstance*, const char*, const CMPIValue*, CMPIType) {
             return refused;
         };
     },
     [](FunctionTables& tables) { tables.instance.setProperty = nullptr; }},
    {"returnInstance",
     [](FunctionTables& tables) {
         tables.result.returnInstance = [](const CMPIResult*, const CMPIInstance*) { return refused; };
     },
     [](FunctionTables& tables) { tables.result.returnInstance = nullptr; }},
};

const Fault faultOfReturnedPaths = {"returnObjectPath",
                                    [](FunctionTables& tables) {
                                        tables.result.returnObjectPath =
                                            [](const CMPIResult*, const CMPIObjectPath*) { return refused; };
                                    },
                                    [](FunctionTables& tables) { tables.result.returnObjectPath = nullptr; }};

void expectFailure(const Answer& answer, CMPIrc code, const char* service)
{
    EXPECT_EQ(answer.status.code, code);
    ASSERT_TRUE(answer.status.message);
    EXPECT_THAT(*answer.status.message, HasSubstr(service));
}

class PathServices : public ComputerSystemTest, public testing::WithParamInterface<Fault>
{};

TEST_P(PathServices, FailTheEnumerationOfNames)
{
    GetParam().makeFail(broker.tables());
    expectFailure(broker.enumerateInstanceNames(classPath()), CMPI_RC_ERR_ACCESS_DENIED, GetParam().service);
    GetParam().remove(broker.tables());
    expectFailure(broker.enumerateInstanceNames(classPath()), CMPI_RC_ERR_INVALID_HANDLE, GetParam().service);
}

INSTANTIATE_TEST_SUITE_P(Each, PathServices, testing::ValuesIn(faultsOfPaths));
INSTANTIATE_TEST_SUITE_P(Returned, PathServices, testing::Values(faultOfReturnedPaths));

class InstanceServices : public ComputerSystemTest, public testing::WithParamInterface<Fault>
{};

TEST_P(InstanceServices, FailTheEnumerationOfInstances)
{
    GetParam().makeFail(broker.tables());
    expectFailure(broker.enumerateInstances(classPath()), CMPI_RC_ERR_ACCESS_DENIED, GetParam().service);
    GetParam().remove(broker.tables());
    expectFailure(broker.enumerateInstances(classPath()), CMPI_RC_ERR_INVALID_HANDLE, GetParam().service);
}

TEST_P(InstanceServices, FailToGetAnInstance)
{
    GetParam().makeFail(broker.tables());
    expectFailure(broker.getInstance(systemPath("alpha")), CMPI_RC_ERR_ACCESS_DENIED, GetParam().service);
    GetParam().remove(broker.tables());
    expectFailure(broker.getInstance(systemPath("alpha")), CMPI_RC_ERR_INVALID_HANDLE, GetParam().service);
}

INSTANTIATE_TEST_SUITE_P(Each, InstanceServices, testing::ValuesIn(faultsOfInstances));
INSTANTIATE_TEST_SUITE_P(OfPaths, InstanceServices, testing::ValuesIn(faultsOfPaths));

TEST_F(Services, ThatMakeNothingFail)
{
    broker.tables().enc.newInstance = [](const CMPIBroker*, const CMPIObjectPath*, CMPIStatus* rc) {
        if (rc != nullptr)
            *rc = {CMPI_RC_OK, nullptr};
        return static_cast<CMPIInstance*>(nullptr);
    };
    expectFailure(broker.enumerateInstances(classPath()), CMPI_RC_ERR_FAILED, "newInstance");
}

TEST_F(Services, ThatRunOutOfMemoryFailTheOperation)
{
    CMPIInstanceMI* const provider = create(broker.cmpiBroker(), nullptr);
    broker.tables().enc.newInstance = [](const CMPIBroker*, const CMPIObjectPath*,
                                         CMPIStatus*) -> CMPIInstance* { throw std::bad_alloc(); };
    Request request(broker);
    CMPIStatus status{CMPI_RC_OK, nullptr};
    EXPECT_NO_THROW(status = provider->ft->enumerateInstances(provider, request.context(), request.result(),
                                                              request.path(classPath()), nullptr));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
}

TEST_F(Services, WithoutTextOfTheNamespaceFail)
{
    broker.tables().string.getCharPtr = [](const CMPIString*, CMPIStatus*) -> const char* { return nullptr; };
    EXPECT_EQ(broker.enumerateInstanceNames(classPath()).status.code, CMPI_RC_ERR_INVALID_NAMESPACE);
}

} // namespace
