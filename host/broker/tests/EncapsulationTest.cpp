// The services of the broker's encapsulation table.

#include "BrokerFixture.h"

namespace cimhost {

namespace {

using testing::ElementsAre;

class EncapsulationTest : public RequestFixture
{
protected:
    const CMPIBrokerEncFT& eft_ = *mb()->eft;
};

TEST_F(EncapsulationTest, MakesPaths)
{
    EXPECT_EQ(read(eft_.newObjectPath(mb(), testNameSpace, "TEST_Thing", &rc_)), classPath("TEST_Thing"));
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(read(eft_.newObjectPath(mb(), nullptr, "TEST_Thing", &rc_))->nameSpace, "");
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(eft_.newObjectPath(mb(), testNameSpace, nullptr, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_PARAMETER);
    expectMisuse("CMPIBrokerEncFT.newObjectPath: the class name is null");
}

TEST_F(EncapsulationTest, MakesInstances)
{
    EXPECT_EQ(read(eft_.newInstance(mb(), request_.path(thingPath("one")), &rc_)),
              (cim::Instance{thingPath("one"), {}}));
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(eft_.newInstance(mb(), nullptr, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIBrokerEncFT.newInstance: the object path is null");
}

TEST_F(EncapsulationTest, MakesStrings)
{
    EXPECT_EQ(textOf(eft_.newString(mb(), "text", &rc_)), "text");
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(eft_.newString(mb(), nullptr, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_PARAMETER);
    expectMisuse("CMPIBrokerEncFT.newString: the text is null");
}

TEST_F(EncapsulationTest, MakesArraysOfEveryElementType)
{
    for (const auto type :
         std::vector<CMPIType>{CMPI_boolean, CMPI_char16, CMPI_uint8, CMPI_sint64, CMPI_real32, CMPI_string,
                               CMPI_dateTime, CMPI_ref, CMPI_instance}) {
        CMPIArray* const array = eft_.newArray(mb(), 1, type, &rc_);
        EXPECT_EQ(code(), CMPI_RC_OK);
        EXPECT_EQ(array->ft->getSimpleType(array, nullptr), type);
    }
}

TEST_F(EncapsulationTest, RefusesArraysThatCannotBe)
{
    EXPECT_EQ(eft_.newArray(mb(), 1, CMPI_ptr, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(eft_.newArray(mb(), 1, CMPI_uint8A, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_DATA_TYPE);
    misuses_.clear();
    EXPECT_EQ(eft_.newArray(mb(), ~CMPICount{0}, CMPI_uint8, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_PARAMETER);
    expectMisuse("CMPIBrokerEncFT.newArray: an array of 4294967295 elements; there may be 4194304");
}

TEST_F(EncapsulationTest, MakesDateTimes)
{
    CMPIDateTime* const now = eft_.newDateTime(mb(), &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(now->ft->isInterval(now, nullptr), 0);
    EXPECT_NE(now->ft->getBinaryFormat(now, nullptr), 0U);
    CMPIDateTime* const day = eft_.newDateTimeFromChars(mb(), "00000001000000.000000:000", &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(day->ft->getBinaryFormat(day, nullptr), 86'400'000'000U);
    EXPECT_EQ(eft_.newDateTimeFromChars(mb(), "tomorrow", &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(eft_.newDateTimeFromChars(mb(), nullptr, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(EncapsulationTest, KnowsAPathsOwnClassOnly)
{
    CMPIObjectPath* const path = newPath();
    EXPECT_EQ(eft_.classPathIsA(mb(), path, "test_thing", &rc_), 1);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(eft_.classPathIsA(mb(), path, "TEST_Base", &rc_), 0);
    EXPECT_EQ(code(), CMPI_RC_OK);
}

TEST_F(EncapsulationTest, KnowsTheTypesOfObjects)
{
    const std::vector<std::pair<const void*, const char*>> objects{
        {newPath(), "CMPIObjectPath"},
        {eft_.newInstance(mb(), newPath(), nullptr), "CMPIInstance"},
        {newString(""), "CMPIString"},
        {eft_.newArray(mb(), 1, CMPI_uint8, nullptr), "CMPIArray"},
        {eft_.newArgs(mb(), nullptr), "CMPIArgs"},
        {eft_.newDateTime(mb(), nullptr), "CMPIDateTime"},
        {request_.context(), "CMPIContext"},
        {request_.result(), "CMPIResult"},
        {eft_.newCMPIError(mb(), "", "", "", {}, {}, CMPI_RC_OK, nullptr), "CMPIError"}};
    for (const auto& [object, type] : objects) {
        EXPECT_EQ(textOf(eft_.getType(mb(), object, &rc_)), type);
        EXPECT_EQ(code(), CMPI_RC_OK);
        EXPECT_EQ(eft_.isOfType(mb(), object, type, &rc_), 1);
        EXPECT_EQ(code(), CMPI_RC_OK);
        EXPECT_EQ(eft_.isOfType(mb(), object, "CMPIEnumeration", &rc_), 0);
        EXPECT_EQ(code(), CMPI_RC_OK);
    }
    expectNoMisuse();
}

TEST_F(EncapsulationTest, TurnsObjectsIntoText)
{
    EXPECT_EQ(textOf(eft_.toString(mb(), request_.path(thingPath("one")), &rc_)),
              R"(root/test:TEST_Thing.Name="one")");
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(textOf(eft_.toString(mb(), newString("text"), nullptr)), "text");
    EXPECT_EQ(textOf(eft_.toString(mb(), eft_.newDateTimeFromBinary(mb(), 0, 0, nullptr), nullptr)),
              "19700101000000.000000+000");
    EXPECT_THAT(textOf(eft_.toString(mb(), eft_.newInstance(mb(), newPath(), nullptr), nullptr)),
                testing::HasSubstr("instance of TEST_Thing"));
    EXPECT_EQ(textOf(eft_.toString(mb(), request_.context(), nullptr)), "CMPIContext");
}

TEST_F(EncapsulationTest, GivesDefaultMessages)
{
    EXPECT_EQ(textOf(eft_.getMessage(mb(), "id", "the default", &rc_, 0)), "the default");
    EXPECT_EQ(code(), CMPI_RC_OK);
    CMPIMsgFileHandle file = this;
    EXPECT_EQ(eft_.openMessageFile(mb(), "messages", &file), CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(file, nullptr);
    EXPECT_EQ(textOf(eft_.getMessage2(mb(), "id", file, "the default", &rc_, 0)), "the default");
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(eft_.closeMessageFile(mb(), file), CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(EncapsulationTest, HasNoSelectExpressions)
{
    EXPECT_EQ(eft_.newSelectExp(mb(), "select *", "WQL", nullptr, &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(EncapsulationTest, TellsOfTracesAndLogs)
{
    EXPECT_EQ(eft_.trace(mb(), CMPI_LEV_WARNING, "part", "text", nullptr), CMPI_RC_OK);
    EXPECT_EQ(eft_.trace(mb(), CMPI_LEV_VERBOSE, nullptr, nullptr, newString("object")), CMPI_RC_OK);
    EXPECT_EQ(eft_.trace(mb(), CMPI_LEV_INFO, "part", nullptr, nullptr), CMPI_RC_OK);
    EXPECT_THAT(traces_, ElementsAre("2 part: text", "3 : object", "1 part: "));
    EXPECT_EQ(eft_.logMessage(mb(), CMPI_SEV_ERROR, "id", "text", nullptr), CMPI_RC_OK);
    EXPECT_EQ(eft_.logMessage(mb(), CMPI_DEV_DEBUG, nullptr, nullptr, newString("object")), CMPI_RC_OK);
    EXPECT_THAT(logs_, ElementsAre("1 id: text", "4 : object"));
    expectNoMisuse();
}

TEST_F(EncapsulationTest, NeedsNoListeners)
{
    Broker quiet({}, {});
    const CMPIBroker* const broker = quiet.cmpiBroker();
    EXPECT_EQ(broker->eft->trace(broker, CMPI_LEV_INFO, "part", "text", nullptr), CMPI_RC_OK);
    EXPECT_EQ(broker->eft->logMessage(broker, CMPI_SEV_INFO, "id", "text", nullptr), CMPI_RC_OK);
    EXPECT_EQ(broker->eft->newString(broker, nullptr, nullptr), nullptr);
}

TEST_F(EncapsulationTest, KnowsItsBrokers)
{
    EXPECT_EQ(eft_.newString(nullptr, "text", &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIBrokerEncFT.newString: the broker is null");
    const CMPIBroker stranger{this, nullptr, nullptr, nullptr, nullptr};
    EXPECT_EQ(eft_.newString(&stranger, "text", &rc_), nullptr);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIBrokerEncFT.newString: the broker is not one of this process");
    const CMPIBroker copy = *mb();
    EXPECT_EQ(textOf(eft_.newString(&copy, "text", nullptr)), "text");
}

} // namespace

} // namespace cimhost
