#include "ComputerSystemTest.h"

#include <Tavro/Common.h>

namespace {

using cimhost::cim::Answer;
using cimhost::cim::Instance;
using cimhost::cim::ObjectPath;
using cimhost::cim::Property;
using cimhost::cim::sameObject;
using cimhost::cim::textValue;
using cimhost::cim::unsignedValue;
using cimhost::cim::Value;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

using Operations = ComputerSystemTest;

Value stateList(std::uint64_t state)
{
    return cimhost::cim::arrayValue(CMPI_uint16, {state});
}

std::vector<std::string> propertyNames(const Instance& instance)
{
    std::vector<std::string> names;
    for (const Property& property : instance.properties)
        names.push_back(property.name);
    return names;
}

void expectValue(const Instance& instance, const char* name, const Value& expected)
{
    const Value* const value = cimhost::cim::findProperty(instance, name);
    ASSERT_NE(value, nullptr) << name;
    EXPECT_TRUE(*value == expected) << name;
}

void expectPathOf(const ObjectPath& path, const std::string& name)
{
    EXPECT_EQ(path.host, Tavro::getSystemName());
    EXPECT_EQ(path.nameSpace, "root/cimv2");
    EXPECT_EQ(path.className, "TAVRO_ComputerSystem");
    ASSERT_THAT(path.keys, SizeIs(2));
    EXPECT_EQ(path.keys[0].name, "CreationClassName");
    EXPECT_TRUE(path.keys[0].value == textValue("TAVRO_ComputerSystem"));
    EXPECT_EQ(path.keys[1].name, "Name");
    EXPECT_TRUE(path.keys[1].value == textValue(name));
}

void expectWholeInstanceOf(const Instance& instance, const std::string& name)
{
    expectPathOf(instance.path, name);
    EXPECT_THAT(propertyNames(instance),
                ElementsAre("CreationClassName", "Name", "Caption", "Description", "ElementName",
                            "OperationalStatus", "EnabledState", "Dedicated"));
    expectValue(instance, "CreationClassName", textValue("TAVRO_ComputerSystem"));
    expectValue(instance, "Name", textValue(name));
    expectValue(instance, "Caption", textValue("Computer System"));
    expectValue(instance, "Description", textValue("Computer system, served by a stand-in provider"));
    expectValue(instance, "ElementName", textValue(name));
    expectValue(instance, "OperationalStatus", stateList(2));
    expectValue(instance, "EnabledState", unsignedValue(2, CMPI_uint16));
    expectValue(instance, "Dedicated", stateList(1));
}

TEST_F(Operations, EnumerateNames)
{
    systems.set("alpha,beta");
    const Answer answer = broker.enumerateInstanceNames(classPath());
    EXPECT_EQ(answer.status.code, CMPI_RC_OK);
    ASSERT_THAT(answer.paths, SizeIs(2));
    expectPathOf(answer.paths[0], "alpha");
    expectPathOf(answer.paths[1], "beta");
}

TEST_F(Operations, EnumerateInstances)
{
    systems.set("alpha,beta");
    const Answer answer = broker.enumerateInstances(classPath());
    EXPECT_EQ(answer.status.code, CMPI_RC_OK);
    ASSERT_THAT(answer.instances, SizeIs(2));
    expectWholeInstanceOf(answer.instances[0], "alpha");
    expectWholeInstanceOf(answer.instances[1], "beta");
}

TEST_F(Operations, EnumerateWithThePropertiesAskedForAndTheKeys)
{
    const Answer answer = broker.enumerateInstances(classPath(), {{"Dedicated", "NoSuchProperty"}});
    ASSERT_THAT(answer.instances, SizeIs(1));
    EXPECT_THAT(propertyNames(answer.instances[0]), ElementsAre("CreationClassName", "Name", "Dedicated"));
}

TEST_F(Operations, EnumerateWithTheKeysOnlyForAnEmptyList)
{
    const Answer answer = broker.enumerateInstances(classPath(), {{}});
    ASSERT_THAT(answer.instances, SizeIs(1));
    EXPECT_THAT(propertyNames(answer.instances[0]), ElementsAre("CreationClassName", "Name"));
}

TEST_F(Operations, GetOneOfSeveral)
{
    systems.set("alpha,beta,gamma");
    const Answer answer = broker.getInstance(systemPath("beta"));
    EXPECT_EQ(answer.status.code, CMPI_RC_OK);
    ASSERT_THAT(answer.instances, SizeIs(1));
    expectWholeInstanceOf(answer.instances[0], "beta");
}

TEST_F(Operations, GetWithThePropertiesAskedForAndTheKeys)
{
    const Answer answer = broker.getInstance(systemPath("alpha"), {{"EnabledState"}});
    ASSERT_THAT(answer.instances, SizeIs(1));
    EXPECT_THAT(propertyNames(answer.instances[0]), ElementsAre("CreationClassName", "Name", "EnabledState"));
}

TEST_F(Operations, GetByKeysInAnyOrderAndLetterCaseOfNames)
{
    ObjectPath path = systemPath("alpha");
    path.className = "tavro_computersystem";
    path.keys = {{"NAME", textValue("alpha")}, {"creationclassname", textValue("TAVRO_ComputerSystem")}};
    EXPECT_THAT(broker.getInstance(path).instances, SizeIs(1));
}

void expectNotFound(const Answer& answer)
{
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(answer.status.message, "There is no TAVRO_ComputerSystem with these keys");
    EXPECT_THAT(answer.instances, IsEmpty());
}

TEST_F(Operations, FindNoSystemOfAnotherName)
{
    expectNotFound(broker.getInstance(systemPath("Alpha")));
}

TEST_F(Operations, FindNoSystemOfAnotherClass)
{
    ObjectPath path = systemPath("alpha");
    path.keys[0].value = textValue("CIM_ComputerSystem");
    expectNotFound(broker.getInstance(path));
}

TEST_F(Operations, FindNoSystemWithoutAllKeys)
{
    ObjectPath path = systemPath("alpha");
    path.keys.pop_back();
    expectNotFound(broker.getInstance(path));
    expectNotFound(broker.getInstance(classPath()));
}

TEST_F(Operations, FindNoSystemWhereNoneIsServed)
{
    systems.set("");
    expectNotFound(broker.getInstance(systemPath("alpha")));
}

TEST_F(Operations, EnumeratedPathsGetTheirInstances)
{
    systems.set(std::nullopt);
    const Answer names = broker.enumerateInstanceNames(classPath());
    ASSERT_THAT(names.paths, SizeIs(1));
    const Answer answer = broker.getInstance(names.paths[0]);
    ASSERT_THAT(answer.instances, SizeIs(1));
    EXPECT_TRUE(sameObject(answer.instances[0].path, names.paths[0]));
}

TEST_F(Operations, ThatChangeOrQueryAreNotSupported)
{
    const Instance instance{systemPath("alpha"), {{"ElementName", textValue("beta")}}};
    EXPECT_EQ(broker.createInstance(classPath(), instance).status.code, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(broker.modifyInstance(instance.path, instance).status.code, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(broker.deleteInstance(instance.path).status.code, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(broker.execQuery(classPath(), "SELECT * FROM TAVRO_ComputerSystem", "WQL").status.code,
              CMPI_RC_ERR_NOT_SUPPORTED);
}

} // namespace
