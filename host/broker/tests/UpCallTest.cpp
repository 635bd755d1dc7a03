// What providers ask of the broker.

#include "BrokerFixture.h"

namespace cimhost {

namespace {

using testing::ElementsAre;

Registration registrationOfBoth()
{
    Registration classes = sampleRegistration({"Thing", "Asking"});
    classes.classes[0].association = true;
    return classes;
}

TEST(UpCallRequestTest, ReachTheOtherProvider)
{
    Broker broker(registrationOfBoth(), {SAMPLE_DIRECTORY});
    const cim::Answer answer = broker.enumerateInstanceNames(classPath("TEST_Asking"));
    EXPECT_EQ(answer.status.code, CMPI_RC_OK);
    EXPECT_THAT(answer.paths, ElementsAre(thingPath("one"), thingPath("three")));
}

TEST(UpCallRequestTest, HandOnTheStatus)
{
    Broker broker(sampleRegistration({"Asking"}), {SAMPLE_DIRECTORY});
    const cim::Answer answer = broker.enumerateInstanceNames(classPath("TEST_Asking"));
    EXPECT_EQ(answer.status.code, CMPI_RC_ERR_INVALID_CLASS);
    EXPECT_EQ(answer.status.message, "no provider is registered for the class TEST_Thing in root/test");
}

class UpCallTest : public BrokerFixture
{
protected:
    UpCallTest() : BrokerFixture(registrationOfBoth()) {}

    /// The texts of the names in an enumeration of paths or instances.
    std::vector<std::string> names(const CMPIEnumeration* enumeration)
    {
        std::vector<std::string> found;
        while (enumeration->ft->hasNext(enumeration, nullptr) != 0) {
            const CMPIData data = enumeration->ft->getNext(enumeration, nullptr);
            const cim::ObjectPath path =
                data.type == CMPI_ref ? *read(data.value.ref) : read(data.value.inst)->path;
            found.push_back(std::get<std::string>(cim::findKey(path, "Name")->items[0]));
        }
        return found;
    }

    [[nodiscard]] const CMPIBrokerFT& bft() const { return *mb()->bft; }

    Request request_{broker_};
    const CMPIContext* context_ = request_.context();
    CMPIStatus rc_ = untouched();
};

TEST_F(UpCallTest, EnumerateNames)
{
    CMPIEnumeration* const found = bft().enumerateInstanceNames(mb(), context_, newPath(), &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_THAT(names(found), ElementsAre("one", "three"));
}

TEST_F(UpCallTest, EnumerateInstancesWithAPropertyList)
{
    const char* wanted[] = {"Size", nullptr};
    CMPIEnumeration* const found = bft().enumerateInstances(mb(), context_, newPath(), wanted, &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_THAT(names(found), ElementsAre("one", "three"));
}

TEST_F(UpCallTest, EnumerationsEnd)
{
    CMPIEnumeration* const found = bft().enumerateInstanceNames(mb(), context_, newPath(), nullptr);
    names(found);
    EXPECT_EQ(found->ft->hasNext(found, &rc_), 0);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    const CMPIData beyond = found->ft->getNext(found, &rc_);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(beyond.state, CMPI_notFound);
    expectNoMisuse();
}

TEST_F(UpCallTest, EnumerationsBecomeArrays)
{
    CMPIEnumeration* const found = bft().enumerateInstanceNames(mb(), context_, newPath(), nullptr);
    found->ft->getNext(found, nullptr);
    CMPIArray* const array = found->ft->toArray(found, &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(array->ft->getSimpleType(array, nullptr), CMPI_ref);
    ASSERT_EQ(array->ft->getSize(array, nullptr), 2U);
    EXPECT_EQ(read(array->ft->getElementAt(array, 1, nullptr).value.ref), thingPath("three"));
}

TEST_F(UpCallTest, EnumerationsAreClonedWhereTheyStand)
{
    CMPIEnumeration* const found = bft().enumerateInstanceNames(mb(), context_, newPath(), nullptr);
    found->ft->getNext(found, nullptr);
    CMPIEnumeration* const copy = found->ft->clone(found, &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(found->ft->release(found), CMPI_RC_OK);
    EXPECT_THAT(names(copy), ElementsAre("three"));
}

TEST_F(UpCallTest, GetAnInstance)
{
    CMPIInstance* const found =
        bft().getInstance(mb(), context_, request_.path(thingPath("three")), nullptr, &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(found->ft->getProperty(found, "Size", nullptr).value.uint32, 5U);
}

TEST_F(UpCallTest, GetNoInstance)
{
    EXPECT_EQ(bft().getInstance(mb(), context_, request_.path(thingPath("four")), nullptr, &rc_), nullptr);
    EXPECT_EQ(rc_.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(textOf(rc_.msg), "no such thing");

    // A provider that answers with no error and no instance.
    EXPECT_EQ(bft().getInstance(mb(), context_, request_.path(thingPath("nothing")), nullptr, &rc_), nullptr);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NOT_FOUND);
}

TEST_F(UpCallTest, GetAProperty)
{
    CMPIObjectPath* const path = request_.path(thingPath("three"));
    const CMPIData size = bft().getProperty(mb(), context_, path, "size", &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(size.type, CMPI_uint32);
    EXPECT_EQ(size.value.uint32, 5U);
    EXPECT_EQ(bft().getProperty(mb(), context_, path, "Colour", &rc_).state, CMPI_notFound);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    bft().getProperty(mb(), context_, request_.path(thingPath("four")), "Size", &rc_);
    EXPECT_EQ(rc_.rc, CMPI_RC_ERR_NOT_FOUND);
}

TEST_F(UpCallTest, Write)
{
    CMPIInstance* const instance = mb()->eft->newInstance(mb(), request_.path(thingPath("new")), nullptr);
    CMPIObjectPath* const made = bft().createInstance(mb(), context_, newPath(), instance, &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(read(made), thingPath("new"));
    CMPIObjectPath* const one = request_.path(thingPath("one"));
    EXPECT_EQ(bft().modifyInstance(mb(), context_, one, instance, nullptr), CMPI_RC_OK);
    EXPECT_EQ(traces_.back(), "1 Sample: modify 0 null");
    const CMPIStatus removed = bft().deleteInstance(mb(), context_, one);
    EXPECT_EQ(removed.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(textOf(removed.msg), "things stay");
    CMPIEnumeration* const found = bft().execQuery(mb(), context_, newPath(), "select *", "WQL", &rc_);
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_THAT(names(found), ElementsAre("one"));
}

TEST_F(UpCallTest, Traverse)
{
    CMPIObjectPath* const one = request_.path(thingPath("one"));
    EXPECT_THAT(names(bft().associators(mb(), context_, one, "TEST_Thing", "R", "a", "b", nullptr, &rc_)),
                ElementsAre("one"));
    EXPECT_EQ(rc_, CMPI_RC_OK);
    EXPECT_EQ(traces_.back(), "1 Sample: associators TEST_Thing R a b null");
    EXPECT_THAT(names(bft().associatorNames(mb(), context_, one, nullptr, nullptr, nullptr, nullptr, &rc_)),
                ElementsAre("one"));
    EXPECT_EQ(traces_.back(), "1 Sample: associatorNames null null null null");
    EXPECT_THAT(names(bft().references(mb(), context_, one, "TEST_Thing", "a", nullptr, &rc_)),
                ElementsAre("three"));
    EXPECT_EQ(traces_.back(), "1 Sample: references TEST_Thing a");
    EXPECT_THAT(names(bft().referenceNames(mb(), context_, one, nullptr, nullptr, &rc_)),
                ElementsAre("three"));
    EXPECT_EQ(traces_.back(), "1 Sample: referenceNames null null");
    expectNoMisuse();
}

TEST_F(UpCallTest, AnswerCode7ForWhatIsNotServed)
{
    CMPIObjectPath* const path = newPath();
    EXPECT_EQ(bft().setProperty(mb(), context_, path, "Size", nullptr, CMPI_uint32),
              CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(bft().invokeMethod(mb(), context_, path, "Blink", nullptr, nullptr, &rc_).state, CMPI_notFound);
    EXPECT_EQ(rc_, CMPI_RC_ERR_NOT_SUPPORTED);
    CMPIInstance* const indication = mb()->eft->newInstance(mb(), path, nullptr);
    EXPECT_EQ(bft().deliverIndication(mb(), context_, testNameSpace, indication), CMPI_RC_ERR_NOT_SUPPORTED);
    expectNoMisuse();
}

TEST_F(UpCallTest, ComeWithBrokerContextAndPath)
{
    EXPECT_EQ(bft().enumerateInstanceNames(nullptr, context_, newPath(), &rc_), nullptr);
    EXPECT_EQ(rc_, CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIBrokerFT.enumerateInstanceNames: the broker is null");
    EXPECT_EQ(bft().enumerateInstanceNames(mb(), nullptr, newPath(), &rc_), nullptr);
    EXPECT_EQ(rc_, CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIBrokerFT.enumerateInstanceNames: the context is null");
    EXPECT_EQ(bft().enumerateInstanceNames(mb(), context_, nullptr, &rc_), nullptr);
    EXPECT_EQ(rc_, CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIBrokerFT.enumerateInstanceNames: the object path is null");
    EXPECT_EQ(bft().execQuery(mb(), context_, newPath(), nullptr, "WQL", &rc_), nullptr);
    EXPECT_EQ(rc_, CMPI_RC_ERR_INVALID_PARAMETER);
    expectMisuse("CMPIBrokerFT.execQuery: the query is null");
}

TEST_F(UpCallTest, SayWhatTheBrokerIs)
{
    EXPECT_EQ(bft().brokerVersion, 200);
    EXPECT_STREQ(bft().brokerName, "cimhost");
    EXPECT_EQ(bft().brokerCapabilities & CMPI_MB_AssociationTraversal,
              static_cast<unsigned>(CMPI_MB_AssociationTraversal));
    EXPECT_EQ(bft().brokerCapabilities & 0x80U, 0U); // no indications
}

} // namespace

} // namespace cimhost
