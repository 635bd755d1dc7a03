// What the broker does otherwise with the habits of a real one.

#include "BrokerFixture.h"

#include "broker/Habits.h"

#include <array>

#include <unistd.h>

namespace cimhost {

namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::EndsWith;
using testing::IsEmpty;
using testing::SizeIs;

Registration traversableThings()
{
    Registration registration = sampleRegistration({"Thing"});
    registration.classes[0].association = true;
    return registration;
}

class HabitsFixture : public BrokerFixture
{
protected:
    explicit HabitsFixture(const Habits& habits)
        : BrokerFixture(traversableThings(), {SAMPLE_DIRECTORY}, &habits)
    {}

    CMPIEnumeration* things()
    {
        return mb()->bft->enumerateInstanceNames(mb(), request_.context(), newPath(), nullptr);
    }

    /// Of a path with the key Name.
    CMPIData key(const char* name)
    {
        const CMPIObjectPath* const path = request_.path(thingPath("one"));
        return path->ft->getKey(path, name, &rc_);
    }

    CMPIInstance* newThing(const char** properties, const char** keys)
    {
        CMPIInstance* const instance = mb()->eft->newInstance(mb(), newPath("TEST_Association"), nullptr);
        EXPECT_EQ(instance->ft->setPropertyFilter(instance, properties, keys), CMPI_RC_OK);
        return instance;
    }

    static CMPIStatus refer(CMPIInstance* instance, const char* property, CMPIObjectPath* path)
    {
        CMPIValue value;
        value.ref = path;
        return instance->ft->setProperty(instance, property, &value, CMPI_ref);
    }

    /// What a client gets of an instance.
    cim::Instance returned(const CMPIInstance* instance)
    {
        const CMPIResult* const result = request_.result();
        EXPECT_EQ(result->ft->returnInstance(result, instance), CMPI_RC_OK);
        return request_.answer({CMPI_RC_OK, nullptr}).instances.back();
    }

    template <class Named>
    static std::vector<std::string> namesOf(const std::vector<Named>& list)
    {
        std::vector<std::string> names;
        names.reserve(list.size());
        for (const Named& named : list)
            names.push_back(named.name);
        return names;
    }

    Request request_{broker_};
    CMPIStatus rc_ = untouched();
};

/// An empty property list, not a missing one.
const cim::PropertyList noProperties = std::vector<std::string>();

/// A reference to a path with a host, in a path with a host.
cim::ObjectPath pathWithReference()
{
    cim::ObjectPath thing = thingPath("one");
    thing.host = "far";
    cim::ObjectPath path = classPath("TEST_Thing");
    path.host = "near";
    path.keys.push_back({"Of", {CMPI_ref, false, {std::make_shared<const cim::ObjectPath>(thing)}}});
    return path;
}

const cim::ObjectPath& referredTo(const std::vector<cim::Key>& keys)
{
    return *std::get<std::shared_ptr<const cim::ObjectPath>>(keys.at(0).value.items.at(0));
}

class Sfcb : public HabitsFixture
{
protected:
    Sfcb() : HabitsFixture(sfcbHabits()) {}
};

class Pegasus : public HabitsFixture
{
protected:
    Pegasus() : HabitsFixture(pegasusHabits()) {}
};

} // namespace

TEST(HabitsTest, AreFoundByTheirNames)
{
    EXPECT_EQ(findHabits("sfcb"), &sfcbHabits());
    EXPECT_EQ(findHabits("pegasus"), &pegasusHabits());
    EXPECT_EQ(findHabits("Pegasus"), nullptr);
    EXPECT_THAT(namesOfHabits(), ElementsAre("sfcb", "pegasus"));
}

TEST(HabitsTest, AreFactsEachSeenInAVersion)
{
    for (const Habits* habits : {&sfcbHabits(), &pegasusHabits()}) {
        EXPECT_THAT(habits->rows, testing::Not(IsEmpty()));
        for (const Habit& habit : habits->rows) {
            EXPECT_STRNE(habit.fact, "");
            EXPECT_THAT(habit.seenIn, testing::ContainsRegex(" [0-9]+\\.[0-9]+\\.[0-9]+$")) << habit.fact;
        }
    }
}

TEST_F(Sfcb, TellsOldVersions)
{
    EXPECT_EQ(mb()->bft->brokerVersion, 0);
    EXPECT_EQ(mb()->eft->ftVersion, 1);
    EXPECT_EQ(mb()->xft->ftVersion, 200);
    EXPECT_EQ(newPath()->ft->ftVersion, 1);
    EXPECT_EQ(newString("x")->ft->ftVersion, 1);
    EXPECT_EQ(request_.result()->ft->ftVersion, 1);
    EXPECT_EQ(request_.context()->ft->ftVersion, 1);
}

TEST_F(Sfcb, LacksServices)
{
    EXPECT_EQ(mb()->mft, nullptr);
    EXPECT_EQ(mb()->eft->openMessageFile, nullptr);
    EXPECT_EQ(mb()->eft->getMessage2, nullptr);
    EXPECT_EQ(mb()->xft->joinThread, nullptr);
    EXPECT_EQ(request_.result()->ft->returnError, nullptr);
    EXPECT_EQ(newPath()->ft->getClassQualifier, nullptr);
    EXPECT_NE(newPath()->ft->getPropertyQualifier, nullptr);
}

TEST_F(Sfcb, WritesNoTrace)
{
    EXPECT_EQ(mb()->eft->trace(mb(), CMPI_LEV_INFO, "c", "text", nullptr), CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(mb()->eft->logMessage(mb(), CMPI_SEV_INFO, "id", "text", nullptr), CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_THAT(traces_, IsEmpty());
    EXPECT_THAT(logs_, IsEmpty());
}

TEST_F(Sfcb, GoesBeyondTheEnd)
{
    CMPIEnumeration* const found = things();
    const CMPIData first = found->ft->getNext(found, &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(first.state, CMPI_goodValue);
    EXPECT_EQ(read(first.value.ref), thingPath("one"));
    found->ft->getNext(found, nullptr);
    const CMPIData beyond = found->ft->getNext(found, &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(beyond.type, CMPI_ref);
    EXPECT_EQ(beyond.state, CMPI_badValue);
    EXPECT_EQ(beyond.value.ref, nullptr);

    const CMPIArray* const array = mb()->eft->newArray(mb(), 1, CMPI_uint16, nullptr);
    EXPECT_EQ(array->ft->getElementAt(array, 0, &rc_).type, CMPI_uint16);
    rc_ = untouched();
    const CMPIData element = array->ft->getElementAt(array, 1, &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(element.type, CMPI_uint16);
    EXPECT_EQ(element.state, CMPI_badValue);
    expectNoMisuse();
}

TEST_F(Sfcb, StillReportsMisuse)
{
    EXPECT_EQ(mb()->bft->brokerVersion, 0);
    const CMPIEnumerationFT& table = broker_.tables().enumeration;
    EXPECT_EQ(table.getNext(nullptr, &rc_).state, CMPI_badValue);
    EXPECT_EQ(rc_, CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIEnumerationFT.getNext: the enumeration is null");
}

TEST_F(Sfcb, TellsKeysAsValues)
{
    EXPECT_EQ(key("Name").state, CMPI_goodValue);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(key("Other").state, CMPI_notFound);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NOT_FOUND);
    const CMPIObjectPath* const path = request_.path(thingPath("one"));
    EXPECT_EQ(path->ft->getKeyAt(path, 0, nullptr, &rc_).state, CMPI_goodValue);
    EXPECT_EQ(rc_, CMPI_RC_OK);
}

TEST_F(Sfcb, MissesPropertiesAndEntries)
{
    const CMPIInstance* const instance = mb()->eft->newInstance(mb(), newPath(), nullptr);
    EXPECT_EQ(instance->ft->getProperty(instance, "Size", &rc_).state, CMPI_notFound);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NOT_FOUND);
    const CMPIContext* const context = request_.context();
    EXPECT_EQ(context->ft->getEntry(context, "CMPIInvocationFlags", &rc_).state, CMPI_goodValue);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(context->ft->getEntry(context, "Other", &rc_).state, CMPI_nullValue);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

TEST_F(Sfcb, TakesFiltersLiterally)
{
    const char* properties[] = {"Size", "Left", nullptr};
    const char* keys[] = {"Middle", nullptr};
    CMPIInstance* const instance = newThing(properties, keys);
    CMPIValue size;
    size.uint32 = 3;
    EXPECT_EQ(instance->ft->setProperty(instance, "Size", &size, CMPI_uint32), CMPI_RC_OK);
    for (const char* property : {"Left", "Middle", "Right"})
        EXPECT_EQ(refer(instance, property, newPath()), CMPI_RC_OK);
    EXPECT_EQ(instance->ft->getProperty(instance, "Right", nullptr).state, CMPI_notFound);
    const cim::Instance seen = returned(instance);
    EXPECT_THAT(namesOf(seen.properties), ElementsAre("Size", "Left"));
    EXPECT_THAT(namesOf(seen.path.keys), ElementsAre("Middle", "Left"));
    expectNoMisuse();
}

TEST_F(Sfcb, ForgetsWhatALaterFilterDoesNotLetPass)
{
    CMPIInstance* const instance = newThing(nullptr, nullptr);
    refer(instance, "Left", newPath());
    const char* nothing[] = {nullptr};
    EXPECT_EQ(instance->ft->setPropertyFilter(instance, nothing, nothing), CMPI_RC_OK);
    EXPECT_THAT(returned(instance).path.keys, IsEmpty());
}

TEST_F(Sfcb, TakesAnEmptyPropertyListForNone)
{
    const cim::Answer answer = broker_.enumerateInstances(classPath("TEST_Thing"), noProperties);
    ASSERT_THAT(answer.instances, SizeIs(2));
    EXPECT_THAT(namesOf(answer.instances[0].properties), ElementsAre("Name", "Size"));
}

TEST_F(Sfcb, TraversesFromInstancesOnly)
{
    for (const Traversal& traversal : {Traversal{}, Traversal{"TEST_Thing", {}, {}, {}}}) {
        const cim::Answer refused = broker_.associatorNames(classPath("TEST_Thing"), traversal);
        EXPECT_EQ(refused.status.code, CMPI_RC_ERR_NOT_SUPPORTED);
        EXPECT_EQ(refused.status.message, "a traversal starts at an instance, not at the class TEST_Thing");
        EXPECT_THAT(refused.paths, IsEmpty());
        EXPECT_THAT(broker_.associatorNames(thingPath("three"), traversal).paths, SizeIs(1));
    }
    EXPECT_EQ(broker_.enumerateInstanceNames(classPath("TEST_Thing")).status.code, CMPI_RC_OK);
}

TEST_F(Sfcb, RefersWithoutHosts)
{
    const cim::Property reference{"Of", pathWithReference().keys[0].value};
    cim::Answer answer{{}, {pathWithReference()}, {{pathWithReference(), {reference}}}};
    shape(&sfcbHabits(), answer, OperationRequest());
    EXPECT_EQ(answer.paths[0].host, "near");
    EXPECT_EQ(referredTo(answer.paths[0].keys).host, "");
    EXPECT_EQ(referredTo(answer.paths[0].keys).nameSpace, testNameSpace);
    EXPECT_EQ(referredTo(answer.instances[0].path.keys).host, "");
    EXPECT_EQ(referredTo({{"Of", answer.instances[0].properties[0].value}}).host, "");
}

TEST_F(Pegasus, LacksServices)
{
    EXPECT_EQ(mb()->mft, nullptr);
    EXPECT_EQ(request_.result()->ft->clone, nullptr);
    EXPECT_EQ(request_.context()->ft->clone, nullptr);
    EXPECT_EQ(newPath()->ft->getPropertyQualifier, nullptr);
    EXPECT_EQ(mb()->bft->brokerVersion, 200);
}

TEST_F(Pegasus, TellsItemsAsNull)
{
    CMPIEnumeration* const found = things();
    const CMPIData first = found->ft->getNext(found, &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(first.type, CMPI_ref);
    EXPECT_EQ(first.state, CMPI_nullValue);
    EXPECT_EQ(read(first.value.ref), thingPath("one"));
    found->ft->getNext(found, nullptr);
    const CMPIData beyond = found->ft->getNext(found, &rc_);
    EXPECT_EQ(rc_.rc, 18);
    EXPECT_EQ(beyond.type, CMPI_ref);
    EXPECT_EQ(beyond.state, CMPI_nullValue);
    EXPECT_EQ(beyond.value.ref, nullptr);
    expectNoMisuse();
}

TEST_F(Pegasus, TellsWhatIsNotThereAsNull)
{
    EXPECT_EQ(key("Name").state, CMPI_keyValue);
    EXPECT_EQ(key("Other").state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NOT_FOUND);
    const CMPIObjectPath* const path = newPath();
    EXPECT_EQ(path->ft->getKeyAt(path, 0, nullptr, &rc_).state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    const CMPIInstance* const instance = mb()->eft->newInstance(mb(), path, nullptr);
    EXPECT_EQ(instance->ft->getProperty(instance, "Size", &rc_).state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    const CMPIContext* const context = request_.context();
    EXPECT_EQ(context->ft->getEntry(context, "Other", &rc_).state, CMPI_nullValue | CMPI_notFound);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    const CMPIArray* const array = mb()->eft->newArray(mb(), 0, CMPI_uint16, nullptr);
    EXPECT_EQ(array->ft->getElementAt(array, 0, &rc_).state, CMPI_nullValue);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

TEST_F(Pegasus, FiltersAnswersAlone)
{
    const char* properties[] = {"Left", nullptr};
    CMPIInstance* const instance = newThing(properties, nullptr);
    refer(instance, "Left", newPath());
    refer(instance, "Right", newPath());
    EXPECT_EQ(instance->ft->getProperty(instance, "Right", &rc_).type, CMPI_ref);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_THAT(namesOf(returned(instance).path.keys), ElementsAre("Left", "Right"));
}

TEST_F(Pegasus, AnswersWhatWasAskedForAlone)
{
    const auto propertiesOf = [&](const cim::PropertyList& wanted) {
        return namesOf(
            broker_.enumerateInstances(classPath("TEST_Thing"), wanted).instances.at(0).properties);
    };
    EXPECT_THAT(propertiesOf({}), ElementsAre("Name", "Size"));
    EXPECT_THAT(propertiesOf({{"size"}}), ElementsAre("Size"));
    EXPECT_THAT(propertiesOf(noProperties), IsEmpty());
    EXPECT_THAT(broker_.enumerateInstances(classPath("TEST_Thing"), {{"Size"}}).instances.at(0).path.keys,
                SizeIs(1));
}

TEST_F(Pegasus, HandsInItsHost)
{
    std::array<char, 256> name{};
    ASSERT_EQ(gethostname(name.data(), name.size() - 1), 0);
    OperationRequest question{Operation::enumerateInstanceNames, classPath("TEST_Thing")};
    shape(&pegasusHabits(), question, broker_.registration().classes[0]);
    EXPECT_EQ(question.target.host, name.data());
    question.target.host = "elsewhere";
    shape(&pegasusHabits(), question, broker_.registration().classes[0]);
    EXPECT_EQ(question.target.host, "elsewhere");
}

TEST_F(Pegasus, SetsTheAssociationClassAndDropsEmptyRoles)
{
    broker_.associatorNames(thingPath("one"), {});
    broker_.associators(thingPath("one"), {"test_thing", "TEST_Result", "", "To"});
    broker_.referenceNames(thingPath("one"), {{}, {}, "From", {}});
    broker_.references(thingPath("one"), {{}, "TEST_THING", "", {}});
    EXPECT_THAT(traces_, Contains(EndsWith("associatorNames TEST_Thing null null null")));
    EXPECT_THAT(traces_, Contains(EndsWith("associators TEST_Thing TEST_Result null To null")));
    EXPECT_THAT(traces_, Contains(EndsWith("referenceNames TEST_Thing From")));
    EXPECT_THAT(traces_, Contains(EndsWith("references TEST_Thing null")));
}

TEST(PegasusRequestTest, AsksAProviderForEachOfItsAssociations)
{
    Registration registration = traversableThings();
    registration.classes.push_back(registration.classes[0]);
    registration.classes[1].className = "TEST_Other";
    EXPECT_THAT(Broker(registration, {SAMPLE_DIRECTORY}).associatorNames(thingPath("one"), {}).paths,
                SizeIs(1));
    EXPECT_THAT(Broker(registration, {SAMPLE_DIRECTORY}, {}, &pegasusHabits())
                    .associatorNames(thingPath("one"), {})
                    .paths,
                SizeIs(2));
}

} // namespace cimhost
