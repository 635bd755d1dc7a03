// What a broker makes of knowing its classes.

#include "BrokerFixture.h"

#include "broker/Habits.h"
#include "schema/MofReader.h"

namespace cimhost {

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

schema::Classes classes()
{
    return schema::Classes(schema::readMof(R"(class TEST_Base {};
                                              class TEST_Thing : TEST_Base { [Key] string Name; };
                                              class TEST_Keeping : TEST_Base {};
                                              class TEST_Lonely {};
                                              [Association] class TEST_Tie {
                                                  [Key] TEST_Base REF Left; [Key] TEST_Base REF Right; };
                                              [Association] class TEST_Link : TEST_Tie {};)",
                                           "test.mof")
                               .classes);
}

Registration registered()
{
    Registration all = sampleRegistration({"Thing", "Keeping"});
    all.classes.push_back({"TEST_Link", "Thing", "CimhostSample", false, true, {testNameSpace}});
    return all;
}

class Superclass : public BrokerFixture
{
protected:
    explicit Superclass(const Habits* habits = nullptr)
        : BrokerFixture(registered(), {SAMPLE_DIRECTORY}, habits, classes())
    {}
};

TEST_F(Superclass, IsEnumeratedByTheProvidersOfWhatDerivesFromIt)
{
    const cim::Answer answer = broker_.enumerateInstanceNames(classPath("test_base"));
    EXPECT_EQ(answer.status.code, CMPI_RC_OK);
    EXPECT_THAT(answer.paths, ElementsAre(thingPath("one"), thingPath("three"), thingPath("kept")));
    EXPECT_EQ(traces_.back(), "1 Sample: keeping TEST_Keeping");
}

TEST_F(Superclass, HasTheFirstErrorOfItsProviders)
{
    // Keeping serves no instances.
    const cim::Answer answer = broker_.enumerateInstances(classPath("TEST_Base"));
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(Superclass, ThatNobodyServesIsEmpty)
{
    const cim::Answer answer = broker_.enumerateInstanceNames(classPath("TEST_Lonely"));
    EXPECT_EQ(answer.status.code, CMPI_RC_OK);
    EXPECT_THAT(answer.paths, IsEmpty());
    EXPECT_EQ(broker_.enumerateInstances(classPath("TEST_None")).status.code, CMPI_RC_ERR_INVALID_CLASS);
    cim::ObjectPath elsewhere = classPath("TEST_Lonely");
    elsewhere.nameSpace = "root/none";
    EXPECT_EQ(broker_.enumerateInstances(elsewhere).status.code, CMPI_RC_ERR_INVALID_NAMESPACE);
}

TEST_F(Superclass, HasNoInstancesOfItsOwnToGet)
{
    cim::ObjectPath path = thingPath("one");
    path.className = "TEST_Base";
    const cim::Answer answer = broker_.getInstance(path);
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(answer.status.message, "no instance provider is registered for the class TEST_Base");
}

TEST_F(Superclass, OfAssociationsIsResolved)
{
    broker_.associatorNames(thingPath("one"), {"TEST_Tie", "TEST_Thing", "Left", "Right"});
    EXPECT_THAT(traces_, ElementsAre("1 Sample: associatorNames TEST_Link TEST_Thing Left Right"));
    broker_.referenceNames(thingPath("one"), {{}, "test_tie", "Left", {}});
    EXPECT_EQ(traces_.back(), "1 Sample: referenceNames TEST_Link Left");
    broker_.referenceNames(thingPath("one"), {{}, "test_LINK", "Left", {}});
    EXPECT_EQ(traces_.back(), "1 Sample: referenceNames test_LINK Left") << "the client's own spelling";
    const cim::Answer none = broker_.associatorNames(thingPath("one"), {"TEST_Lonely", {}, {}, {}});
    EXPECT_EQ(none.status.code, CMPI_RC_OK);
    EXPECT_THAT(none.paths, IsEmpty());
}

TEST_F(Superclass, OfResultsIsKeptFromTheProviderAndChoosesInTheAnswer)
{
    const auto found = [&](const char* resultClass) {
        return broker_.associators(thingPath("one"), {"TEST_Link", resultClass, {}, {}}).instances.size();
    };
    EXPECT_EQ(found("TEST_Base"), 1U);
    EXPECT_EQ(traces_.back(), "1 Sample: associators TEST_Link null null null null");
    EXPECT_EQ(found("TEST_Lonely"), 0U);
    EXPECT_EQ(found("TEST_Unknown"), 1U);
    EXPECT_EQ(traces_.back(), "1 Sample: associators TEST_Link TEST_Unknown null null null");
}

class SuperclassInSfcb : public Superclass
{
protected:
    SuperclassInSfcb() : Superclass(findHabits("sfcb"))
    {
        told().clear();
        // That of SFCB tells nothing.
        broker_.tables().enc.trace = [](const CMPIBroker*, CMPILevel, const char*, const char* text,
                                        const CMPIString*) {
            told().emplace_back(text);
            return CMPIStatus{CMPI_RC_OK, nullptr};
        };
    }

    static std::vector<std::string>& told()
    {
        static std::vector<std::string> lines;
        return lines;
    }
};

TEST_F(SuperclassInSfcb, OfAssociationsIsHandedInAsItIs)
{
    broker_.associatorNames(thingPath("one"), {"TEST_Tie", "TEST_Base", "Left", "Right"});
    EXPECT_THAT(told(), ElementsAre("associatorNames TEST_Tie TEST_Base Left Right"));
}

class SuperclassInPegasus : public Superclass
{
protected:
    SuperclassInPegasus() : Superclass(findHabits("pegasus")) {}
};

TEST_F(SuperclassInPegasus, OfAssociationsIsResolvedAndThatOfResultsIsNot)
{
    broker_.associatorNames(thingPath("one"), {"TEST_Tie", "TEST_Base", "Left", "Right"});
    ASSERT_FALSE(traces_.empty());
    EXPECT_THAT(traces_.back(), testing::HasSubstr("associatorNames TEST_Link TEST_Base Left Right"));
}

/// Inside of a request.
class KnownClass : public Superclass
{
protected:
    Request request_{broker_};
    const CMPIInstance* newInstance(const char* className)
    {
        return mb()->eft->newInstance(mb(), newPath(className), nullptr);
    }
    cim::ObjectPath pathOf(const CMPIInstance* instance)
    {
        return *read(instance->ft->getObjectPath(instance, nullptr));
    }
};

TEST_F(KnownClass, DerivesFromItsSuperclasses)
{
    const auto isA = [&](const char* name) {
        return mb()->eft->classPathIsA(mb(), newPath("TEST_Thing"), name, nullptr) != 0;
    };
    EXPECT_TRUE(isA("test_base"));
    EXPECT_TRUE(isA("TEST_Thing"));
    EXPECT_FALSE(isA("TEST_Keeping"));
}

TEST_F(KnownClass, TellsTheKeysOfItsInstances)
{
    const CMPIInstance* const thing = newInstance("TEST_Thing");
    thing->ft->setProperty(thing, "Size", chars("3"), CMPI_chars);
    thing->ft->setProperty(thing, "Name", chars("one"), CMPI_chars);
    EXPECT_EQ(pathOf(thing), thingPath("one"));

    // Of a known class references alone make no keys.
    const CMPIInstance* const keeping = newInstance("TEST_Lonely");
    CMPIValue reference;
    reference.ref = newPath();
    keeping->ft->setProperty(keeping, "Other", &reference, CMPI_ref);
    EXPECT_EQ(pathOf(keeping).keys.size(), 1U) << "of a class without keys they do";

    const CMPIInstance* const link = newInstance("TEST_Link");
    link->ft->setProperty(link, "Other", &reference, CMPI_ref);
    link->ft->setProperty(link, "Right", &reference, CMPI_ref);
    ASSERT_EQ(pathOf(link).keys.size(), 1U);
    EXPECT_EQ(pathOf(link).keys[0].name, "Right");
}

} // namespace

} // namespace cimhost
