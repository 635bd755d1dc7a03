// Every type of value on its way in and out, as a property.

#include "BrokerFixture.h"

#include <cstring>
#include <functional>
#include <limits>

namespace cimhost {

namespace {

class ValuesTest : public RequestFixture
{
protected:
    CMPIInstance* const instance_ = mb()->eft->newInstance(mb(), newPath(), nullptr);

    CMPIStatus set(const CMPIValue* value, CMPIType type)
    {
        return instance_->ft->setProperty(instance_, "P", value, type);
    }
    CMPIData get()
    {
        const CMPIData data = instance_->ft->getProperty(instance_, "P", &rc_);
        EXPECT_EQ(code(), CMPI_RC_OK);
        return data;
    }

    /// Sets a number and expects it back, and as that in the model.
    template <class Number>
    void expectKept(CMPIType type, Number CMPIValue::*member, Number number, const cim::Value& model)
    {
        CMPIValue value{};
        std::memset(&value, 0xA5, sizeof value); // beyond the type's width is what happened to be there
        value.*member = number;
        EXPECT_EQ(set(&value, type), CMPI_RC_OK);
        const CMPIData data = get();
        EXPECT_EQ(data.type, type);
        EXPECT_EQ(data.state, CMPI_goodValue);
        EXPECT_EQ(data.value.*member, number);
        EXPECT_EQ(*cim::findProperty(*read(instance_), "P"), model);
    }
};

TEST_F(ValuesTest, KeepNumbersOfEveryType)
{
    expectKept(CMPI_boolean, &CMPIValue::boolean, CMPIBoolean{1}, cim::booleanValue(true));
    expectKept(CMPI_boolean, &CMPIValue::boolean, CMPIBoolean{0}, cim::booleanValue(false));
    expectKept(CMPI_char16, &CMPIValue::char16, CMPIChar16{0xFFFF}, cim::unsignedValue(0xFFFF, CMPI_char16));
    expectKept(CMPI_uint8, &CMPIValue::uint8, CMPIUint8{255}, cim::unsignedValue(255, CMPI_uint8));
    expectKept(CMPI_uint16, &CMPIValue::uint16, CMPIUint16{65535}, cim::unsignedValue(65535, CMPI_uint16));
    expectKept(CMPI_uint32, &CMPIValue::uint32, CMPIUint32{4294967295U},
               cim::unsignedValue(4294967295U, CMPI_uint32));
    expectKept(CMPI_uint64, &CMPIValue::uint64, std::numeric_limits<CMPIUint64>::max(),
               cim::unsignedValue(std::numeric_limits<std::uint64_t>::max(), CMPI_uint64));
    expectKept(CMPI_sint8, &CMPIValue::sint8, CMPISint8{-128}, cim::signedValue(-128, CMPI_sint8));
    expectKept(CMPI_sint16, &CMPIValue::sint16, CMPISint16{-32768}, cim::signedValue(-32768, CMPI_sint16));
    expectKept(CMPI_sint32, &CMPIValue::sint32, std::numeric_limits<CMPISint32>::min(),
               cim::signedValue(std::numeric_limits<std::int32_t>::min(), CMPI_sint32));
    expectKept(CMPI_sint64, &CMPIValue::sint64, std::numeric_limits<CMPISint64>::min(),
               cim::signedValue(std::numeric_limits<std::int64_t>::min(), CMPI_sint64));
    expectKept(CMPI_real32, &CMPIValue::real32, 1.5F, cim::realValue(1.5, CMPI_real32));
    expectKept(CMPI_real64, &CMPIValue::real64, -1e300, cim::realValue(-1e300, CMPI_real64));
}

TEST_F(ValuesTest, KeepTheOrderOfANumbersBytes)
{
    expectKept(CMPI_char16, &CMPIValue::char16, CMPIChar16{0x98A8}, cim::unsignedValue(0x98A8, CMPI_char16));
    expectKept(CMPI_uint8, &CMPIValue::uint8, CMPIUint8{7}, cim::unsignedValue(7, CMPI_uint8));
    expectKept(CMPI_uint16, &CMPIValue::uint16, CMPIUint16{0x0102}, cim::unsignedValue(0x0102, CMPI_uint16));
    expectKept(CMPI_uint32, &CMPIValue::uint32, CMPIUint32{0x01020304},
               cim::unsignedValue(0x01020304, CMPI_uint32));
    expectKept(CMPI_uint64, &CMPIValue::uint64, CMPIUint64{0x0102030405060708},
               cim::unsignedValue(0x0102030405060708, CMPI_uint64));
    expectKept(CMPI_sint8, &CMPIValue::sint8, CMPISint8{-7}, cim::signedValue(-7, CMPI_sint8));
    expectKept(CMPI_sint16, &CMPIValue::sint16, CMPISint16{-0x0102}, cim::signedValue(-0x0102, CMPI_sint16));
    expectKept(CMPI_sint32, &CMPIValue::sint32, CMPISint32{-0x01020304},
               cim::signedValue(-0x01020304, CMPI_sint32));
    expectKept(CMPI_sint64, &CMPIValue::sint64, CMPISint64{-0x0102030405060708},
               cim::signedValue(-0x0102030405060708, CMPI_sint64));
}

TEST_F(ValuesTest, ReadCharactersBackAsStrings)
{
    EXPECT_EQ(set(chars("text"), CMPI_chars), CMPI_RC_OK);
    EXPECT_EQ(get().type, CMPI_string);
    EXPECT_EQ(textOf(get().value.string), "text");
    EXPECT_EQ(set(nullptr, CMPI_chars), CMPI_RC_OK);
    EXPECT_EQ(get().type, CMPI_string);
    EXPECT_EQ(get().state, CMPI_nullValue);
}

TEST_F(ValuesTest, KeepStringsAsTheyAreNow)
{
    CMPIValue value{};
    value.string = newString("text");
    EXPECT_EQ(set(&value, CMPI_string), CMPI_RC_OK);
    value.string->ft->release(value.string);
    EXPECT_EQ(textOf(get().value.string), "text");
}

TEST_F(ValuesTest, KeepDateTimes)
{
    CMPIValue value{};
    value.dateTime = mb()->eft->newDateTimeFromChars(mb(), "20240229123456.789012+060", nullptr);
    EXPECT_EQ(set(&value, CMPI_dateTime), CMPI_RC_OK);
    const CMPIData data = get();
    EXPECT_EQ(data.type, CMPI_dateTime);
    EXPECT_EQ(textOf(data.value.dateTime->ft->getStringFormat(data.value.dateTime, nullptr)),
              "20240229123456.789012+060");
}

TEST_F(ValuesTest, KnowNullInAllItsForms)
{
    EXPECT_EQ(set(nullptr, CMPI_uint32), CMPI_RC_OK);
    EXPECT_EQ(get().type, CMPI_uint32);
    EXPECT_EQ(get().state, CMPI_nullValue);

    CMPIValue value{};
    for (const auto type : std::vector<CMPIType>{CMPI_null, CMPI_string, CMPI_dateTime, CMPI_ref,
                                                 CMPI_instance, CMPI_stringA}) {
        EXPECT_EQ(set(&value, type), CMPI_RC_OK);
        EXPECT_EQ(get().type, type);
        EXPECT_EQ(get().state, CMPI_nullValue);
    }
    expectNoMisuse();
}

TEST_F(ValuesTest, KeepArraysAsTheyAreNow)
{
    CMPIArray* const array = mb()->eft->newArray(mb(), 3, CMPI_uint16, nullptr);
    CMPIValue element{};
    element.uint16 = 7;
    array->ft->setElementAt(array, 1, &element, CMPI_uint16);
    CMPIValue value{};
    value.array = array;
    EXPECT_EQ(set(&value, CMPI_uint16A), CMPI_RC_OK);
    element.uint16 = 8;
    array->ft->setElementAt(array, 1, &element, CMPI_uint16);

    const CMPIData data = get();
    EXPECT_EQ(data.type, CMPI_uint16A);
    const CMPIArray* const kept = data.value.array;
    EXPECT_EQ(kept->ft->getSize(kept, nullptr), 3U);
    EXPECT_EQ(kept->ft->getElementAt(kept, 1, nullptr).value.uint16, 7);
    EXPECT_EQ(kept->ft->getElementAt(kept, 2, nullptr).state, CMPI_nullValue);
}

TEST_F(ValuesTest, TakeArraysOfCharactersAsStrings)
{
    CMPIValue value{};
    value.array = mb()->eft->newArray(mb(), 1, CMPI_chars, nullptr);
    EXPECT_EQ(set(&value, CMPI_charsA), CMPI_RC_OK);
    EXPECT_EQ(get().type, CMPI_stringA);
    EXPECT_EQ(set(&value, CMPI_stringA), CMPI_RC_OK);
    expectNoMisuse();
}

TEST_F(ValuesTest, RefuseAnArrayOfAnotherType)
{
    CMPIValue value{};
    value.array = mb()->eft->newArray(mb(), 1, CMPI_uint16, nullptr);
    EXPECT_EQ(set(&value, CMPI_uint32A), CMPI_RC_ERR_TYPE_MISMATCH);
    expectMisuse(
        "CMPIInstanceFT.setProperty: the value is an array of the type uint16, passed as type uint32[]");
}

TEST_F(ValuesTest, RefuseTypesThatNoValueHas)
{
    CMPIValue value{};
    for (const auto type :
         std::vector<CMPIType>{CMPI_ptr, CMPI_args, CMPI_filter, CMPI_enumeration, CMPI_class, 1, 0x1080}) {
        EXPECT_EQ(set(&value, type), CMPI_RC_ERR_INVALID_DATA_TYPE) << type;
        EXPECT_THAT(misuses_.at(0), testing::HasSubstr("which no CIM value has"));
        misuses_.clear();
    }
    EXPECT_EQ(set(&value, CMPI_ptrA), CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(instance_->ft->getPropertyCount(instance_, nullptr), 0U);
}

TEST_F(ValuesTest, RefuseObjectsThatAreNone)
{
    CMPIValue value{};
    value.string = newString("gone");
    value.string->ft->release(value.string);
    EXPECT_EQ(set(&value, CMPI_string), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIInstanceFT.setProperty: the value was released before");
    value.ref = newPath();
    EXPECT_EQ(set(&value, CMPI_string), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIInstanceFT.setProperty: the value is a CMPIObjectPath, not a CMPIString");
}

} // namespace

} // namespace cimhost
