// How requests find their providers and what becomes of the answers.

#include "BrokerFixture.h"

namespace cimhost {

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

Registration registration()
{
    Registration classes = sampleRegistration({"Thing", "Throwing", "Keeping", "Setup", "Recursing"});
    classes.classes[0].association = true;
    classes.classes[0].nameSpaces = {testNameSpace, "root/other"};
    RegisteredClass link{"TEST_Link", "Thing", "CimhostSample", false, true, {testNameSpace}};
    classes.classes.push_back(link);
    return classes;
}

class RoutingTest : public BrokerFixture
{
protected:
    RoutingTest() : BrokerFixture(registration()) {}
};

TEST_F(RoutingTest, EnumeratesNamesThroughTheProvider)
{
    const cim::Answer answer = broker_.enumerateInstanceNames(classPath("TEST_Thing"));
    EXPECT_EQ(answer.status.code, CMPI_RC_OK);
    EXPECT_EQ(answer.status.message, std::nullopt);
    EXPECT_THAT(answer.paths, ElementsAre(thingPath("one"), thingPath("three")));
    EXPECT_THAT(answer.instances, IsEmpty());
    expectNoMisuse();
}

TEST_F(RoutingTest, EnumeratesInstancesWithAndWithoutPropertyList)
{
    const cim::Answer all = broker_.enumerateInstances(classPath("TEST_Thing"));
    ASSERT_EQ(all.instances.size(), 2U);
    EXPECT_EQ(all.instances[1].path, thingPath("three"));
    EXPECT_EQ(*cim::findProperty(all.instances[1], "Size"), cim::unsignedValue(5, CMPI_uint32));

    const cim::Answer keysOnly =
        broker_.enumerateInstances(classPath("TEST_Thing"), std::vector<std::string>());
    ASSERT_EQ(keysOnly.instances.size(), 2U);
    EXPECT_EQ(cim::findProperty(keysOnly.instances[1], "Size"), nullptr);
    EXPECT_EQ(*cim::findProperty(keysOnly.instances[1], "Name"), cim::textValue("three"));
    expectNoMisuse();
}

TEST_F(RoutingTest, GetsOneInstance)
{
    const cim::Answer found = broker_.getInstance(thingPath("one"), {{"sIZE"}});
    ASSERT_EQ(found.instances.size(), 1U);
    EXPECT_EQ(found.instances[0].path, thingPath("one"));
    EXPECT_EQ(*cim::findProperty(found.instances[0], "Size"), cim::unsignedValue(3, CMPI_uint32));
}

TEST_F(RoutingTest, HandsOnTheProvidersStatusAndMessage)
{
    const cim::Answer answer = broker_.getInstance(thingPath("four"));
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(answer.status.message, "no such thing");
    EXPECT_THAT(answer.instances, IsEmpty());
}

TEST_F(RoutingTest, TakesNoInstanceWithoutAnErrorForNotFound)
{
    const cim::Answer answer = broker_.getInstance(thingPath("nothing"));
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(answer.status.message, std::nullopt);
}

TEST_F(RoutingTest, ServesWritingAsTheProviderDoes)
{
    const cim::Instance instance{thingPath("new"), {{"Size", cim::unsignedValue(3, CMPI_uint32)}}};
    EXPECT_THAT(broker_.createInstance(classPath("TEST_Thing"), instance).paths,
                ElementsAre(thingPath("new")));
    EXPECT_EQ(broker_.modifyInstance(thingPath("one"), instance, {{"Size"}}).status.code, CMPI_RC_OK);
    EXPECT_EQ(traces_.back(), "1 Sample: modify 1 Size");
    const cim::Answer removed = broker_.deleteInstance(thingPath("one"));
    EXPECT_EQ(removed.status.code, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(removed.status.message, "things stay");
    EXPECT_EQ(broker_.execQuery(classPath("TEST_Thing"), "select *", "WQL").instances.size(), 1U);
    EXPECT_EQ(traces_.back(), "1 Sample: WQL select *");
    EXPECT_EQ(broker_.createInstance(classPath("TEST_Setup"), instance).status.code,
              CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(RoutingTest, FindsClassesAndNamespacesIgnoringLetterCase)
{
    cim::ObjectPath path = classPath("test_THING");
    path.nameSpace = "Root/TEST";
    EXPECT_EQ(broker_.enumerateInstanceNames(path).paths.size(), 2U);
    path.nameSpace = "root/other";
    EXPECT_EQ(broker_.enumerateInstanceNames(path).paths.size(), 2U);
}

TEST_F(RoutingTest, RefusesWhatNobodyServes)
{
    const cim::Answer unknown = broker_.enumerateInstanceNames(classPath("TEST_Unknown"));
    EXPECT_EQ(unknown.status.code, CMPI_RC_ERR_INVALID_CLASS);
    EXPECT_EQ(unknown.status.message, "no provider is registered for the class TEST_Unknown in root/test");

    cim::ObjectPath elsewhere = classPath("TEST_Throwing");
    elsewhere.nameSpace = "root/other"; // a namespace, but not one of this class
    EXPECT_EQ(broker_.enumerateInstanceNames(elsewhere).status.code, CMPI_RC_ERR_INVALID_CLASS);

    elsewhere.nameSpace = "root/nowhere";
    const cim::Answer nowhere = broker_.enumerateInstanceNames(elsewhere);
    EXPECT_EQ(nowhere.status.code, CMPI_RC_ERR_INVALID_NAMESPACE);
    EXPECT_EQ(nowhere.status.message, "no registration names the namespace root/nowhere");

    elsewhere.nameSpace = "";
    EXPECT_EQ(broker_.enumerateInstanceNames(elsewhere).status.message, "the path names no namespace");

    const cim::Answer link = broker_.enumerateInstanceNames(classPath("TEST_Link"));
    EXPECT_EQ(link.status.code, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(link.status.message, "no instance provider is registered for the class TEST_Link");
}

TEST_F(RoutingTest, AsksTheProviderOfTheAssociationClass)
{
    const Traversal traversal{"TEST_Link", "TEST_Thing", "Left", "Right"};
    EXPECT_EQ(broker_.associators(thingPath("one"), traversal, {{"Size"}}).instances.size(), 1U);
    EXPECT_EQ(traces_.back(), "1 Sample: associators TEST_Link TEST_Thing Left Right Size");
    EXPECT_THAT(broker_.associatorNames(thingPath("one"), traversal).paths, ElementsAre(thingPath("one")));
    EXPECT_EQ(traces_.back(), "1 Sample: associatorNames TEST_Link TEST_Thing Left Right");

    const Traversal toLink{{}, "TEST_Link", "Left", {}};
    EXPECT_EQ(broker_.references(thingPath("one"), toLink).instances.size(), 1U);
    EXPECT_EQ(traces_.back(), "1 Sample: references TEST_Link Left");
    EXPECT_THAT(broker_.referenceNames(thingPath("one"), toLink).paths, ElementsAre(thingPath("three")));
    EXPECT_EQ(traces_.back(), "1 Sample: referenceNames TEST_Link Left");
}

TEST_F(RoutingTest, AsksEachAssociationProviderOnceWithoutAClass)
{
    const cim::Answer answer = broker_.associatorNames(thingPath("one"), {});
    EXPECT_THAT(answer.paths, ElementsAre(thingPath("one")));
    EXPECT_EQ(traces_.back(), "1 Sample: associatorNames null null null null");
    EXPECT_EQ(broker_.references(thingPath("one"), {}).instances.size(), 1U);
    EXPECT_EQ(traces_.back(), "1 Sample: references null null");
}

TEST_F(RoutingTest, RefusesTraversalsThatNobodyServes)
{
    const Traversal unknown{"TEST_Unknown", {}, {}, {}};
    EXPECT_EQ(broker_.associators(thingPath("one"), unknown).status.code, CMPI_RC_ERR_INVALID_CLASS);
    const Traversal noAssociation{"TEST_Throwing", {}, {}, {}};
    EXPECT_EQ(broker_.associators(thingPath("one"), noAssociation).status.code, CMPI_RC_ERR_NOT_SUPPORTED);
    cim::ObjectPath nowhere = thingPath("one");
    nowhere.nameSpace = "root/nowhere";
    EXPECT_EQ(broker_.associators(nowhere, {}).status.code, CMPI_RC_ERR_INVALID_NAMESPACE);
}

TEST_F(RoutingTest, JoinsAnswersAndTellsTheFirstError)
{
    Registration both = registration();
    both.classes.push_back({"TEST_Broken", "NullSlot", "CimhostSample", false, true, {testNameSpace}});
    both.classes.push_back({"TEST_Missing", "Missing", "CimhostSample", false, true, {testNameSpace}});
    Broker broker(both, {SAMPLE_DIRECTORY});
    const cim::Answer answer = broker.associatorNames(thingPath("one"), {});
    EXPECT_THAT(answer.paths, ElementsAre(thingPath("one")));
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_FAILED);
    EXPECT_THAT(answer.status.message.value_or(""), HasSubstr("NullSlot"));
}

TEST_F(RoutingTest, TurnsExceptionsOfAProviderIntoErrors)
{
    const cim::Answer answer = broker_.enumerateInstanceNames(classPath("TEST_Throwing"));
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(answer.status.message, "the provider threw an exception: too much");
    expectMisuse("enumerateInstanceNames: the provider threw an exception: too much");

    EXPECT_EQ(broker_.enumerateInstances(classPath("TEST_Throwing")).status.message,
              "the provider threw something that is not an exception");
    expectMisuse("enumerateInstances: the provider threw something that is not an exception");
}

TEST_F(RoutingTest, ReportsAnObjectOfAnEarlierRequest)
{
    EXPECT_EQ(broker_.enumerateInstanceNames(classPath("TEST_Keeping")).paths.size(), 1U);
    expectNoMisuse();
    const cim::Answer later = broker_.enumerateInstanceNames(classPath("TEST_Keeping"));
    EXPECT_EQ(later.status.code, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_THAT(later.paths, IsEmpty());
    expectMisuse("CMPIResultFT.returnObjectPath: the object path belongs to a request that has ended");
}

TEST_F(RoutingTest, EndsAProviderThatAsksItself)
{
    const cim::Answer answer = broker_.enumerateInstanceNames(classPath("TEST_Recursing"));
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(answer.status.message, "up-calls are nested too deep");
    expectMisuse("up-calls are nested too deep");
}

TEST_F(RoutingTest, KeepsWhatAFactoryFunctionMade)
{
    for (int i = 0; i < 2; ++i) {
        const cim::Answer answer = broker_.enumerateInstanceNames(classPath("TEST_Setup"));
        EXPECT_EQ(traces_.back(), "1 Sample: set up for root/test");
        EXPECT_EQ(answer.status.message, "root/test");
    }
    expectNoMisuse();
}

TEST_F(RoutingTest, CallsAFactoryFunctionOnce)
{
    broker_.enumerateInstanceNames(classPath("TEST_Thing"));
    broker_.enumerateInstanceNames(classPath("TEST_Thing"));
    EXPECT_EQ(std::count(traces_.begin(), traces_.end(), "1 Sample: create Thing"), 1);
}

TEST_F(RoutingTest, KnowsItsRegistration)
{
    EXPECT_EQ(broker_.registration().classes.size(), 6U);
}

TEST(BrokerEndTest, CleansUpWhatWasUsed)
{
    std::vector<std::string> traces;
    {
        Registration things = sampleRegistration({"Thing", "Asking"});
        things.classes[0].association = true;
        Broker broker(things, {SAMPLE_DIRECTORY},
                      {[&](const TraceRecord& record) { traces.push_back(record.text); }, {}, {}});
        broker.enumerateInstanceNames(classPath("TEST_Thing"));
        broker.referenceNames(thingPath("one"), {});
        traces.clear();
    }
    EXPECT_THAT(traces, ElementsAre("cleanup terminating", "cleanup association"));
}

} // namespace

} // namespace cimhost
