// How long objects live, and that every service notices one that does not.

#include "BrokerFixture.h"

#include "broker/HandleSpace.h"

#include <functional>
#include <string>
#include <type_traits>
#include <typeinfo>

namespace cimhost {

namespace {

using testing::ElementsAre;

class LifetimeTest : public RequestFixture
{};

TEST_F(LifetimeTest, ObjectsEndWithTheirRequest)
{
    CMPIString* string = nullptr;
    {
        const Request inner(broker_);
        string = newString("text");
    }
    EXPECT_EQ(string->ft->getCharPtr(string, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIStringFT.getCharPtr: the string belongs to a request that has ended");
}

TEST_F(LifetimeTest, ClonesOutliveTheirRequest)
{
    CMPIString* copy = nullptr;
    {
        const Request inner(broker_);
        CMPIString* const string = newString("text");
        copy = string->ft->clone(string, nullptr);
    }
    EXPECT_EQ(textOf(copy), "text");
    EXPECT_EQ(copy->ft->release(copy), CMPI_RC_OK);
    EXPECT_EQ(copy->ft->release(copy), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIStringFT.release: the object was released before");
}

TEST_F(LifetimeTest, EmbeddedObjectsOutliveWhatTheyWereTakenFrom)
{
    CMPIObjectPath* const path = newPath();
    CMPIValue value{};
    value.ref = request_.path(thingPath("one"));
    path->ft->addKey(path, "End", &value, CMPI_ref);
    CMPIObjectPath* const end = path->ft->getKey(path, "End", nullptr).value.ref;
    path->ft->release(path);
    value.ref->ft->release(value.ref);
    EXPECT_EQ(read(end), thingPath("one"));
}

TEST_F(LifetimeTest, DeadObjectsAreKnownForLong)
{
    CMPIString* string = nullptr;
    {
        const Request inner(broker_);
        string = newString("text");
    }
    for (std::size_t i = 0; i + 1 < HandleSpace::quarantinedBlocks; ++i)
        const Request later(broker_);
    EXPECT_EQ(string->ft->getCharPtr(string, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(LifetimeTest, ManyRequestsDoNotUseUpTheHandles)
{
    for (std::size_t i = 0; i < 3 * HandleSpace::quarantinedBlocks; ++i) {
        const Request later(broker_);
        EXPECT_EQ(textOf(newString("text")), "text");
    }
}

TEST_F(LifetimeTest, AnObjectMayBeCopiedBytewise)
{
    const CMPIString copy = *newString("text");
    EXPECT_STREQ(copy.ft->getCharPtr(&copy, nullptr), "text");
}

TEST(LastingTest, ObjectsMadeOutsideOfRequestsLiveAsLongAsTheBroker)
{
    CMPIString* string = nullptr;
    {
        Broker broker({}, {});
        const CMPIBroker* const mb = broker.cmpiBroker();
        string = mb->eft->newString(mb, "text", nullptr);
        {
            const Request request(broker);
            EXPECT_EQ(read(string), "text");
        }
        EXPECT_EQ(read(string), "text");
    }
    EXPECT_EQ(read(string), std::nullopt);
}

/// One service, to be called with any object in the place of its own.
struct Service
{
    std::string name;
    const char* role;           ///< what the report calls the object
    const std::type_info* type; ///< of the object's envelope
    std::function<CMPIStatus(const void*)> call;
};

/// The tables to call through, also for objects that have none that could be called.
const FunctionTables& served()
{
    static Broker broker({}, {});
    return broker.tables();
}

/// What the reports call the tables and the objects of a kind.
template <class Object>
const char* tableName();
template <class Object>
const char* roleName();

#define NAMES(Object, role)                                                                                  \
    template <>                                                                                              \
    const char* tableName<Object>()                                                                          \
    {                                                                                                        \
        return #Object "FT.";                                                                                \
    }                                                                                                        \
    template <>                                                                                              \
    const char* roleName<Object>()                                                                           \
    {                                                                                                        \
        return role;                                                                                         \
    }

NAMES(CMPIObjectPath, "the object path")
NAMES(CMPIInstance, "the instance")
NAMES(CMPIString, "the string")
NAMES(CMPIArray, "the array")
NAMES(CMPIEnumeration, "the enumeration")
NAMES(CMPIContext, "the context")
NAMES(CMPIResult, "the result")
NAMES(CMPIArgs, "the argument list")
NAMES(CMPIDateTime, "the datetime")
NAMES(CMPIError, "the error")

#undef NAMES

/// \param arguments  what the slot takes between the object and the status pointer
template <class Table, class Result, class Object, class... Parameters, class... Arguments>
Service service(const char* name, Table FunctionTables::*table,
                Result (*Table::*slot)(Object*, Parameters...), Arguments... arguments)
{
    using Envelope = std::remove_const_t<Object>;
    const bool common = std::string(name) == "release" || std::string(name) == "clone";
    const bool isResult = std::is_same_v<Envelope, CMPIResult>;
    return {tableName<Envelope>() + std::string(name),
            common && !isResult ? "the object" : roleName<Envelope>(), &typeid(Envelope),
            [=](const void* object) {
                auto* const own = static_cast<Envelope*>(const_cast<void*>(object));
                const auto function = (served().*table).*slot;
                if constexpr (std::is_same_v<Result, CMPIStatus>) {
                    return function(own, arguments...);
                } else {
                    CMPIStatus rc = untouched();
                    function(own, arguments..., &rc);
                    return rc;
                }
            }};
}

std::vector<Service> services()
{
    using F = FunctionTables;
    return {
        service("release", &F::objectPath, &CMPIObjectPathFT::release),
        service("clone", &F::objectPath, &CMPIObjectPathFT::clone),
        service("setNameSpace", &F::objectPath, &CMPIObjectPathFT::setNameSpace, "x"),
        service("getNameSpace", &F::objectPath, &CMPIObjectPathFT::getNameSpace),
        service("setHostname", &F::objectPath, &CMPIObjectPathFT::setHostname, "x"),
        service("getHostname", &F::objectPath, &CMPIObjectPathFT::getHostname),
        service("setClassName", &F::objectPath, &CMPIObjectPathFT::setClassName, "x"),
        service("getClassName", &F::objectPath, &CMPIObjectPathFT::getClassName),
        service("addKey", &F::objectPath, &CMPIObjectPathFT::addKey, "x", chars("x"), CMPIType{CMPI_chars}),
        service("getKey", &F::objectPath, &CMPIObjectPathFT::getKey, "x"),
        service("getKeyAt", &F::objectPath, &CMPIObjectPathFT::getKeyAt, 0U, nullptr),
        service("getKeyCount", &F::objectPath, &CMPIObjectPathFT::getKeyCount),
        service("setNameSpaceFromObjectPath", &F::objectPath, &CMPIObjectPathFT::setNameSpaceFromObjectPath,
                nullptr),
        service("setHostAndNameSpaceFromObjectPath", &F::objectPath,
                &CMPIObjectPathFT::setHostAndNameSpaceFromObjectPath, nullptr),
        service("getClassQualifier", &F::objectPath, &CMPIObjectPathFT::getClassQualifier, "x"),
        service("getPropertyQualifier", &F::objectPath, &CMPIObjectPathFT::getPropertyQualifier, "x", "x"),
        service("getMethodQualifier", &F::objectPath, &CMPIObjectPathFT::getMethodQualifier, "x", "x"),
        service("getParameterQualifier", &F::objectPath, &CMPIObjectPathFT::getParameterQualifier, "x", "x",
                "x"),
        service("toString", &F::objectPath, &CMPIObjectPathFT::toString),
        service("release", &F::instance, &CMPIInstanceFT::release),
        service("clone", &F::instance, &CMPIInstanceFT::clone),
        service("getProperty", &F::instance, &CMPIInstanceFT::getProperty, "x"),
        service("getPropertyAt", &F::instance, &CMPIInstanceFT::getPropertyAt, 0U, nullptr),
        service("getPropertyCount", &F::instance, &CMPIInstanceFT::getPropertyCount),
        service("setProperty", &F::instance, &CMPIInstanceFT::setProperty, "x", chars("x"),
                CMPIType{CMPI_chars}),
        service("getObjectPath", &F::instance, &CMPIInstanceFT::getObjectPath),
        service("setPropertyFilter", &F::instance, &CMPIInstanceFT::setPropertyFilter, nullptr, nullptr),
        service("setObjectPath", &F::instance, &CMPIInstanceFT::setObjectPath, nullptr),
        service("setPropertyWithOrigin", &F::instance, &CMPIInstanceFT::setPropertyWithOrigin, "x",
                chars("x"), CMPIType{CMPI_chars}, "x"),
        service("release", &F::string, &CMPIStringFT::release),
        service("clone", &F::string, &CMPIStringFT::clone),
        service("getCharPtr", &F::string, &CMPIStringFT::getCharPtr),
        service("release", &F::array, &CMPIArrayFT::release),
        service("clone", &F::array, &CMPIArrayFT::clone),
        service("getSize", &F::array, &CMPIArrayFT::getSize),
        service("getSimpleType", &F::array, &CMPIArrayFT::getSimpleType),
        service("getElementAt", &F::array, &CMPIArrayFT::getElementAt, 0U),
        service("setElementAt", &F::array, &CMPIArrayFT::setElementAt, 0U, nullptr, CMPIType{CMPI_null}),
        service("release", &F::enumeration, &CMPIEnumerationFT::release),
        service("clone", &F::enumeration, &CMPIEnumerationFT::clone),
        service("getNext", &F::enumeration, &CMPIEnumerationFT::getNext),
        service("hasNext", &F::enumeration, &CMPIEnumerationFT::hasNext),
        service("toArray", &F::enumeration, &CMPIEnumerationFT::toArray),
        service("release", &F::context, &CMPIContextFT::release),
        service("clone", &F::context, &CMPIContextFT::clone),
        service("getEntry", &F::context, &CMPIContextFT::getEntry, "x"),
        service("getEntryAt", &F::context, &CMPIContextFT::getEntryAt, 0U, nullptr),
        service("getEntryCount", &F::context, &CMPIContextFT::getEntryCount),
        service("addEntry", &F::context, &CMPIContextFT::addEntry, "x", chars("x"), CMPIType{CMPI_chars}),
        service("release", &F::result, &CMPIResultFT::release),
        service("clone", &F::result, &CMPIResultFT::clone),
        service("returnData", &F::result, &CMPIResultFT::returnData, nullptr, CMPIType{CMPI_chars}),
        service("returnInstance", &F::result, &CMPIResultFT::returnInstance, nullptr),
        service("returnObjectPath", &F::result, &CMPIResultFT::returnObjectPath, nullptr),
        service("returnDone", &F::result, &CMPIResultFT::returnDone),
        service("returnError", &F::result, &CMPIResultFT::returnError, nullptr),
        service("release", &F::args, &CMPIArgsFT::release),
        service("clone", &F::args, &CMPIArgsFT::clone),
        service("addArg", &F::args, &CMPIArgsFT::addArg, "x", chars("x"), CMPIType{CMPI_chars}),
        service("getArg", &F::args, &CMPIArgsFT::getArg, "x"),
        service("getArgAt", &F::args, &CMPIArgsFT::getArgAt, 0U, nullptr),
        service("getArgCount", &F::args, &CMPIArgsFT::getArgCount),
        service("release", &F::dateTime, &CMPIDateTimeFT::release),
        service("clone", &F::dateTime, &CMPIDateTimeFT::clone),
        service("getBinaryFormat", &F::dateTime, &CMPIDateTimeFT::getBinaryFormat),
        service("getStringFormat", &F::dateTime, &CMPIDateTimeFT::getStringFormat),
        service("isInterval", &F::dateTime, &CMPIDateTimeFT::isInterval),
        service("release", &F::error, &CMPIErrorFT::release),
        service("clone", &F::error, &CMPIErrorFT::clone),
        service("getErrorType", &F::error, &CMPIErrorFT::getErrorType),
        service("getOtherErrorType", &F::error, &CMPIErrorFT::getOtherErrorType),
        service("getOwningEntity", &F::error, &CMPIErrorFT::getOwningEntity),
        service("getMessageID", &F::error, &CMPIErrorFT::getMessageID),
        service("getMessage", &F::error, &CMPIErrorFT::getMessage),
        service("getPerceivedSeverity", &F::error, &CMPIErrorFT::getPerceivedSeverity),
        service("getProbableCause", &F::error, &CMPIErrorFT::getProbableCause),
        service("getProbableCauseDescription", &F::error, &CMPIErrorFT::getProbableCauseDescription),
        service("getRecommendedActions", &F::error, &CMPIErrorFT::getRecommendedActions),
        service("getErrorSource", &F::error, &CMPIErrorFT::getErrorSource),
        service("getErrorSourceFormat", &F::error, &CMPIErrorFT::getErrorSourceFormat),
        service("getOtherErrorSourceFormat", &F::error, &CMPIErrorFT::getOtherErrorSourceFormat),
        service("getCIMStatusCode", &F::error, &CMPIErrorFT::getCIMStatusCode),
        service("getCIMStatusCodeDescription", &F::error, &CMPIErrorFT::getCIMStatusCodeDescription),
        service("getMessageArguments", &F::error, &CMPIErrorFT::getMessageArguments),
        service("setErrorType", &F::error, &CMPIErrorFT::setErrorType, CMPIErrorType{}),
        service("setOtherErrorType", &F::error, &CMPIErrorFT::setOtherErrorType, "x"),
        service("setProbableCauseDescription", &F::error, &CMPIErrorFT::setProbableCauseDescription, "x"),
        service("setRecommendedActions", &F::error, &CMPIErrorFT::setRecommendedActions, nullptr),
        service("setErrorSource", &F::error, &CMPIErrorFT::setErrorSource, "x"),
        service("setErrorSourceFormat", &F::error, &CMPIErrorFT::setErrorSourceFormat, CMPIErrorSrcFormat{}),
        service("setOtherErrorSourceFormat", &F::error, &CMPIErrorFT::setOtherErrorSourceFormat, "x"),
        service("setCIMStatusCodeDescription", &F::error, &CMPIErrorFT::setCIMStatusCodeDescription, "x"),
        service("setMessageArguments", &F::error, &CMPIErrorFT::setMessageArguments, nullptr)};
}

class MisuseTest : public BrokerFixture
{
protected:
    MisuseTest() : BrokerFixture(sampleRegistration({"Thing"})) {}

    /// A new object of that type, in the innermost request, which is the one given.
    const void* make(const std::type_info& type, Request& request)
    {
        const CMPIBrokerEncFT& eft = *mb()->eft;
        if (type == typeid(CMPIObjectPath))
            return newPath();
        if (type == typeid(CMPIInstance))
            return eft.newInstance(mb(), newPath(), nullptr);
        if (type == typeid(CMPIString))
            return newString("text");
        if (type == typeid(CMPIArray))
            return eft.newArray(mb(), 1, CMPI_uint8, nullptr);
        if (type == typeid(CMPIEnumeration))
            return mb()->bft->enumerateInstanceNames(mb(), request.context(), newPath(), nullptr);
        if (type == typeid(CMPIContext))
            return request.context();
        if (type == typeid(CMPIResult))
            return request.result();
        if (type == typeid(CMPIArgs))
            return eft.newArgs(mb(), nullptr);
        if (type == typeid(CMPIDateTime))
            return eft.newDateTime(mb(), nullptr);
        return eft.newCMPIError(mb(), "", "", "", {}, {}, CMPI_RC_OK, nullptr);
    }

    /// Calls every service with what `object` gives for it; the report must end in `why`.
    template <class MakeObject>
    void expectRefused(const MakeObject& object, const std::string& why)
    {
        for (const Service& service : services()) {
            const void* const passed = object(service);
            misuses_.clear();
            EXPECT_EQ(service.call(passed), CMPI_RC_ERR_INVALID_HANDLE) << service.name;
            EXPECT_THAT(misuses_, ElementsAre(service.name + ": " + service.role + " " + why));
        }
    }

    Request request_{broker_};
};

TEST_F(MisuseTest, NullObjects)
{
    expectRefused([](const Service&) { return nullptr; }, "is null");
}

TEST_F(MisuseTest, NullHandles)
{
    const CMPIString nothing{nullptr, nullptr};
    expectRefused([&](const Service&) { return &nothing; }, "has a null handle");
}

TEST_F(MisuseTest, ForeignObjects)
{
    const CMPIString foreign{this, nullptr};
    expectRefused([&](const Service&) { return &foreign; }, "was not made by this broker");
    int content = 0;
    const CMPIString wild{&content, nullptr};
    expectRefused([&](const Service&) { return &wild; }, "was not made by this broker");
}

TEST_F(MisuseTest, ReleasedObjects)
{
    expectRefused(
        [this](const Service& service) {
            // A mark takes every object with it that was made since, also those without a release.
            CMPIGcStat* const mark = mb()->mft->mark(mb(), nullptr);
            const bool ofRequest =
                *service.type == typeid(CMPIContext) || *service.type == typeid(CMPIResult);
            const void* object = make(ofRequest ? typeid(CMPIString) : *service.type, request_);
            mb()->mft->release(mb(), mark);
            return object;
        },
        "was released before");
}

TEST_F(MisuseTest, ObjectsOfAnEarlierRequest)
{
    expectRefused(
        [this](const Service& service) {
            Request earlier(broker_);
            return make(*service.type, earlier);
        },
        "belongs to a request that has ended");
}

TEST_F(MisuseTest, ObjectsOfAnotherKind)
{
    const void* const path = newPath();
    const void* const string = newString("text");
    for (const Service& service : services()) {
        misuses_.clear();
        const bool wantsPath = *service.type == typeid(CMPIObjectPath);
        EXPECT_EQ(service.call(wantsPath ? string : path), CMPI_RC_ERR_INVALID_HANDLE) << service.name;
        const std::string expected = service.name + ": " + service.role + " is a " +
                                     (wantsPath ? "CMPIString" : "CMPIObjectPath") + ", not a CMPI";
        EXPECT_THAT(misuses_, ElementsAre(testing::StartsWith(expected)));
    }
}

TEST_F(MisuseTest, ObjectsOfADeadBroker)
{
    CMPIString* string = nullptr;
    {
        Broker other({}, {});
        string = other.cmpiBroker()->eft->newString(other.cmpiBroker(), "text", nullptr);
    }
    EXPECT_EQ(served().string.getCharPtr(string, nullptr), nullptr);
    expectMisuse("CMPIStringFT.getCharPtr: the string belongs to a request that has ended");
}

TEST_F(MisuseTest, EveryServiceTakesANullStatusPointer)
{
    EXPECT_EQ(served().string.getCharPtr(nullptr, nullptr), nullptr);
    expectMisuse("CMPIStringFT.getCharPtr: the string is null");
}

} // namespace

} // namespace cimhost
