// Driving function tables by hand: what a request offers and what it brings.

#include "BrokerFixture.h"

namespace cimhost {

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class RequestTest : public RequestFixture
{};

TEST_F(RequestTest, ContextCarriesFlagsAndPrincipal)
{
    const CMPIContext* const context = request_.context();
    const CMPIData flags = context->ft->getEntry(context, "CMPIInvocationFlags", &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(flags.type, CMPI_uint32);
    EXPECT_EQ(flags.value.uint32, 0U);
    const CMPIData principal = context->ft->getEntry(context, "CMPIPrincipal", &rc_);
    EXPECT_EQ(principal.type, CMPI_string);
    EXPECT_EQ(textOf(principal.value.string), "cimhost");
    EXPECT_EQ(context->ft->getEntryCount(context, nullptr), 2U);
}

TEST_F(RequestTest, GivesHandlesForPathsAndInstances)
{
    CMPIObjectPath* const path = request_.path(thingPath("one"));
    EXPECT_EQ(read(path), thingPath("one"));
    const cim::Instance instance{thingPath("one"), {{"Size", cim::unsignedValue(3, CMPI_uint32)}}};
    CMPIInstance* const handle = request_.instance(instance);
    EXPECT_EQ(read(handle), instance);
    EXPECT_EQ(handle->ft->getProperty(handle, "Size", nullptr).value.uint32, 3U);
}

TEST_F(RequestTest, CollectsWhatIsReturnedAsItWasThen)
{
    const CMPIResult* const result = request_.result();
    CMPIObjectPath* const path = request_.path(thingPath("one"));
    EXPECT_EQ(result->ft->returnObjectPath(result, path), CMPI_RC_OK);
    path->ft->setNameSpace(path, "root/later");

    CMPIInstance* const instance = mb()->eft->newInstance(mb(), request_.path(thingPath("two")), nullptr);
    EXPECT_EQ(result->ft->returnInstance(result, instance), CMPI_RC_OK);
    instance->ft->setProperty(instance, "Later", chars("x"), CMPI_chars);

    EXPECT_EQ(request_.doneCount(), 0);
    EXPECT_EQ(result->ft->returnDone(result), CMPI_RC_OK);
    EXPECT_EQ(request_.doneCount(), 1);

    const cim::Answer answer = request_.answer({CMPI_RC_OK, nullptr});
    EXPECT_THAT(answer.paths, ElementsAre(thingPath("one")));
    EXPECT_THAT(answer.instances, ElementsAre(cim::Instance{thingPath("two"), {}}));
    expectNoMisuse();
}

TEST_F(RequestTest, SharesWhatIsReturned)
{
    const CMPIResult* const result = request_.result();
    result->ft->returnObjectPath(result, request_.path(thingPath("one")));
    result->ft->returnInstance(result,
                               mb()->eft->newInstance(mb(), request_.path(thingPath("two")), nullptr));
    const cim::Answer answer = request_.answer({CMPI_RC_OK, nullptr});
    const cim::Answer again = request_.answer({CMPI_RC_OK, nullptr});
    EXPECT_EQ(&answer.paths.at(0), &again.paths.at(0));
    EXPECT_EQ(&answer.instances.at(0), &again.instances.at(0));
}

TEST_F(RequestTest, KeepsResultsBesideAnErrorStatus)
{
    const CMPIResult* const result = request_.result();
    result->ft->returnObjectPath(result, request_.path(thingPath("one")));
    const cim::Answer answer = request_.answer({CMPI_RC_ERR_FAILED, newString("half way")});
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(answer.status.message, "half way");
    EXPECT_EQ(answer.paths.size(), 1U);
}

TEST_F(RequestTest, TakesNothingAfterReturnDone)
{
    const CMPIResult* const result = request_.result();
    result->ft->returnDone(result);
    EXPECT_EQ(result->ft->returnObjectPath(result, request_.path(thingPath("one"))),
              CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIResultFT.returnObjectPath: returnDone was called before");
    CMPIInstance* const instance = mb()->eft->newInstance(mb(), newPath(), nullptr);
    EXPECT_EQ(result->ft->returnInstance(result, instance), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIResultFT.returnInstance: returnDone was called before");
    EXPECT_EQ(result->ft->returnDone(result), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIResultFT.returnDone: returnDone was called before");
    EXPECT_EQ(request_.doneCount(), 2);
    EXPECT_THAT(request_.answer({CMPI_RC_OK, nullptr}).paths, IsEmpty());
}

TEST_F(RequestTest, TakesNoNullObjects)
{
    const CMPIResult* const result = request_.result();
    EXPECT_EQ(result->ft->returnObjectPath(result, nullptr), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIResultFT.returnObjectPath: the object path is null");
    EXPECT_EQ(result->ft->returnInstance(result, nullptr), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIResultFT.returnInstance: the instance is null");
    const cim::Answer answer = request_.answer({CMPI_RC_OK, nullptr});
    EXPECT_THAT(answer.paths, IsEmpty());
    EXPECT_THAT(answer.instances, IsEmpty());
}

TEST_F(RequestTest, ServesNoDataErrorsOrCopiesOfResults)
{
    const CMPIResult* const result = request_.result();
    const CMPIValue value{};
    EXPECT_EQ(result->ft->returnData(result, &value, CMPI_uint32), CMPI_RC_ERR_NOT_SUPPORTED);
    CMPIError* const error =
        mb()->eft->newCMPIError(mb(), "o", "i", "m", {}, {}, CMPI_RC_ERR_FAILED, nullptr);
    EXPECT_EQ(result->ft->returnError(result, error), CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(result->ft->clone(result, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_SUPPORTED);
    CMPIResult copy = *result;
    EXPECT_EQ(result->ft->release(&copy), CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(result->ft->returnDone(result), CMPI_RC_OK); // it is still there
    expectNoMisuse();
}

TEST_F(RequestTest, ReportsAMessageThatIsNone)
{
    CMPIString* const message = newString("gone");
    message->ft->release(message);
    const cim::Answer answer = request_.answer({CMPI_RC_ERR_FAILED, message});
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(answer.status.message, std::nullopt);
    expectMisuse("the operation's status: the message was released before");
}

TEST_F(RequestTest, Nests)
{
    CMPIObjectPath* inner = nullptr;
    CMPIObjectPath* const outer = newPath();
    {
        const Request nested(broker_);
        inner = newPath();
        EXPECT_NE(read(inner), std::nullopt);
    }
    EXPECT_EQ(read(inner), std::nullopt);
    EXPECT_NE(read(outer), std::nullopt);
    EXPECT_NE(read(newPath()), std::nullopt);
}

TEST_F(RequestTest, SeparatesBrokers)
{
    Broker other({}, {});
    const Request nested(other);
    // The innermost request is the other broker's; this one's objects do not go with it.
    CMPIObjectPath* const path = newPath();
    {
        const Request inner(other);
        EXPECT_NE(read(path), std::nullopt);
    }
    EXPECT_NE(read(path), std::nullopt);
    EXPECT_EQ(other.cmpiBroker()->eft->newInstance(other.cmpiBroker(), path, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(RequestTest, ReadsNothingFromWhatIsNoObject)
{
    EXPECT_EQ(read(static_cast<CMPIObjectPath*>(nullptr)), std::nullopt);
    const CMPIString foreign{this, nullptr};
    EXPECT_EQ(read(&foreign), std::nullopt);
    CMPIObjectPath* const path = newPath();
    const CMPIInstance disguised{path->hdl, nullptr};
    EXPECT_EQ(read(&disguised), std::nullopt);
    expectNoMisuse();
}

} // namespace

} // namespace cimhost
