// Strings, arrays, contexts, argument lists, datetimes and errors.

#include "BrokerFixture.h"

namespace cimhost {

namespace {

class ObjectsTest : public RequestFixture
{};

TEST_F(ObjectsTest, StringsGiveTheirCharacters)
{
    CMPIString* const string = newString("text");
    EXPECT_STREQ(string->ft->getCharPtr(string, &rc_), "text");
    EXPECT_EQ(code(), CMPI_RC_OK);
    CMPIString* const copy = string->ft->clone(string, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(string->ft->release(string), CMPI_RC_OK);
    EXPECT_STREQ(copy->ft->getCharPtr(copy, nullptr), "text");
}

TEST_F(ObjectsTest, ArraysHaveASizeAndAType)
{
    CMPIArray* const array = mb()->eft->newArray(mb(), 2, CMPI_chars, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(array->ft->getSize(array, &rc_), 2U);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(array->ft->getSimpleType(array, &rc_), CMPI_string);
    EXPECT_EQ(code(), CMPI_RC_OK);
}

TEST_F(ObjectsTest, ArraysHoldElements)
{
    CMPIArray* const array = mb()->eft->newArray(mb(), 2, CMPI_string, nullptr);
    EXPECT_EQ(array->ft->setElementAt(array, 1, chars("x"), CMPI_chars), CMPI_RC_OK);
    const CMPIData element = array->ft->getElementAt(array, 1, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(element.type, CMPI_string);
    EXPECT_EQ(textOf(element.value.string), "x");
    EXPECT_EQ(array->ft->getElementAt(array, 0, nullptr).state, CMPI_nullValue);

    CMPIArray* const copy = array->ft->clone(array, nullptr);
    EXPECT_EQ(array->ft->setElementAt(array, 1, nullptr, CMPI_null), CMPI_RC_OK);
    EXPECT_EQ(array->ft->getElementAt(array, 1, nullptr).state, CMPI_nullValue);
    EXPECT_EQ(textOf(copy->ft->getElementAt(copy, 1, nullptr).value.string), "x");
    EXPECT_EQ(array->ft->release(array), CMPI_RC_OK);
}

TEST_F(ObjectsTest, ArraysEnd)
{
    CMPIArray* const array = mb()->eft->newArray(mb(), 1, CMPI_uint8, nullptr);
    CMPIValue value{};
    EXPECT_EQ(array->ft->getElementAt(array, 1, &rc_).state, CMPI_notFound);
    EXPECT_EQ(code(), CMPI_RC_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(array->ft->setElementAt(array, 1, &value, CMPI_uint8), CMPI_RC_ERR_NO_SUCH_PROPERTY);
    CMPIArray* const none = mb()->eft->newArray(mb(), 0, CMPI_uint8, nullptr);
    EXPECT_EQ(none->ft->setElementAt(none, 0, &value, CMPI_uint8), CMPI_RC_ERR_NO_SUCH_PROPERTY);
    expectNoMisuse();
}

TEST_F(ObjectsTest, ArraysRefuseElementsOfAnotherType)
{
    CMPIArray* const array = mb()->eft->newArray(mb(), 1, CMPI_uint8, nullptr);
    CMPIValue value{};
    EXPECT_EQ(array->ft->setElementAt(array, 0, &value, CMPI_uint16), CMPI_RC_ERR_TYPE_MISMATCH);
    expectMisuse("CMPIArrayFT.setElementAt: an element of the type uint16 for an array of the type uint8");
}

TEST_F(ObjectsTest, ContextsHoldEntries)
{
    const CMPIContext* const context = request_.context();
    EXPECT_EQ(context->ft->addEntry(context, "Mine", chars("x"), CMPI_chars), CMPI_RC_OK);
    EXPECT_EQ(textOf(context->ft->getEntry(context, "mine", &rc_).value.string), "x");
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(context->ft->getEntryCount(context, &rc_), 3U);
    EXPECT_EQ(code(), CMPI_RC_OK);
    CMPIString* name = nullptr;
    EXPECT_EQ(textOf(context->ft->getEntryAt(context, 2, &name, &rc_).value.string), "x");
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(textOf(name), "Mine");
    context->ft->getEntry(context, "Other", &rc_);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_FOUND);
    context->ft->getEntryAt(context, 3, &name, &rc_);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_FOUND);
    CMPIContext* const copy = context->ft->clone(context, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(copy->ft->getEntryCount(copy, nullptr), 3U);
    EXPECT_EQ(copy->ft->release(copy), CMPI_RC_OK);
}

TEST_F(ObjectsTest, ArgumentListsHoldArguments)
{
    CMPIArgs* const args = mb()->eft->newArgs(mb(), &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(args->ft->addArg(args, "Times", chars("two"), CMPI_chars), CMPI_RC_OK);
    CMPIValue value{};
    value.uint8 = 2;
    EXPECT_EQ(args->ft->addArg(args, "times", &value, CMPI_uint8), CMPI_RC_OK);
    EXPECT_EQ(args->ft->getArgCount(args, &rc_), 1U);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(args->ft->getArg(args, "TIMES", &rc_).value.uint8, 2);
    EXPECT_EQ(code(), CMPI_RC_OK);
    CMPIString* name = nullptr;
    EXPECT_EQ(args->ft->getArgAt(args, 0, &name, &rc_).type, CMPI_uint8);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(textOf(name), "Times");
    args->ft->getArg(args, "Other", &rc_);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_FOUND);
    args->ft->getArgAt(args, 1, nullptr, &rc_);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_FOUND);
    CMPIArgs* const copy = args->ft->clone(args, nullptr);
    EXPECT_EQ(args->ft->release(args), CMPI_RC_OK);
    EXPECT_EQ(copy->ft->getArgCount(copy, nullptr), 1U);
}

TEST_F(ObjectsTest, DateTimesConvert)
{
    CMPIDateTime* const point = mb()->eft->newDateTimeFromBinary(mb(), 1'000'002, 0, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(textOf(point->ft->getStringFormat(point, &rc_)), "19700101000001.000002+000");
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(point->ft->getBinaryFormat(point, &rc_), 1'000'002U);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(point->ft->isInterval(point, &rc_), 0);
    EXPECT_EQ(code(), CMPI_RC_OK);

    CMPIDateTime* const interval = mb()->eft->newDateTimeFromBinary(mb(), 1'000'002, 1, nullptr);
    EXPECT_EQ(textOf(interval->ft->getStringFormat(interval, nullptr)), "00000000000001.000002:000");
    EXPECT_EQ(interval->ft->isInterval(interval, nullptr), 1);
    CMPIDateTime* const copy = interval->ft->clone(interval, nullptr);
    EXPECT_EQ(interval->ft->release(interval), CMPI_RC_OK);
    EXPECT_EQ(copy->ft->isInterval(copy, nullptr), 1);
}

TEST_F(ObjectsTest, DateTimesOfARequestMayBeAnyText)
{
    cim::ObjectPath path = classPath("TEST_Thing");
    path.keys.push_back({"When", cim::textValue("yesterday", CMPI_dateTime)});
    CMPIObjectPath* const handle = request_.path(path);
    CMPIDateTime* const when = handle->ft->getKey(handle, "When", nullptr).value.dateTime;
    EXPECT_EQ(textOf(when->ft->getStringFormat(when, nullptr)), "yesterday");
    EXPECT_EQ(when->ft->getBinaryFormat(when, &rc_), 0U);
    EXPECT_EQ(code(), CMPI_RC_ERR_FAILED);
    EXPECT_EQ(when->ft->isInterval(when, &rc_), 0);
    EXPECT_EQ(code(), CMPI_RC_ERR_FAILED);
    expectNoMisuse();
}

class ErrorTest : public RequestFixture
{
protected:
    CMPIError* const error_ =
        mb()->eft->newCMPIError(mb(), "owner", "id", "message", static_cast<CMPIErrorSeverity>(1),
                                static_cast<CMPIErrorProbableCause>(1), CMPI_RC_ERR_ACCESS_DENIED, nullptr);
    const CMPIErrorFT& ft_ = *error_->ft;
};

TEST_F(ErrorTest, HasWhatItWasMadeWith)
{
    EXPECT_EQ(textOf(ft_.getOwningEntity(error_, &rc_)), "owner");
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(textOf(ft_.getMessageID(error_, &rc_)), "id");
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(textOf(ft_.getMessage(error_, &rc_)), "message");
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(ft_.getPerceivedSeverity(error_, &rc_), static_cast<CMPIErrorSeverity>(1));
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(ft_.getProbableCause(error_, &rc_), static_cast<CMPIErrorProbableCause>(1));
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(ft_.getCIMStatusCode(error_, &rc_), CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(code(), CMPI_RC_OK);
}

TEST_F(ErrorTest, HasWhatItIsGiven)
{
    EXPECT_EQ(ft_.setErrorType(error_, static_cast<CMPIErrorType>(1)), CMPI_RC_OK);
    EXPECT_EQ(ft_.getErrorType(error_, &rc_), static_cast<CMPIErrorType>(1));
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(ft_.setErrorSourceFormat(error_, static_cast<CMPIErrorSrcFormat>(1)), CMPI_RC_OK);
    EXPECT_EQ(ft_.getErrorSourceFormat(error_, &rc_), static_cast<CMPIErrorSrcFormat>(1));
    EXPECT_EQ(code(), CMPI_RC_OK);

    const auto expectText = [&](auto set, auto get, const char* text) {
        EXPECT_EQ((ft_.*set)(error_, text), CMPI_RC_OK);
        EXPECT_EQ(textOf((ft_.*get)(error_, &rc_)), text);
        EXPECT_EQ(code(), CMPI_RC_OK);
    };
    expectText(&CMPIErrorFT::setOtherErrorType, &CMPIErrorFT::getOtherErrorType, "type");
    expectText(&CMPIErrorFT::setProbableCauseDescription, &CMPIErrorFT::getProbableCauseDescription, "cause");
    expectText(&CMPIErrorFT::setErrorSource, &CMPIErrorFT::getErrorSource, "source");
    expectText(&CMPIErrorFT::setOtherErrorSourceFormat, &CMPIErrorFT::getOtherErrorSourceFormat, "format");
    expectText(&CMPIErrorFT::setCIMStatusCodeDescription, &CMPIErrorFT::getCIMStatusCodeDescription, "code");

    CMPIArray* const texts = mb()->eft->newArray(mb(), 1, CMPI_string, nullptr);
    texts->ft->setElementAt(texts, 0, chars("x"), CMPI_chars);
    const auto expectTexts = [&](auto set, auto get) {
        EXPECT_EQ((ft_.*set)(error_, texts), CMPI_RC_OK);
        CMPIArray* const kept = (ft_.*get)(error_, &rc_);
        EXPECT_EQ(code(), CMPI_RC_OK);
        EXPECT_EQ(textOf(kept->ft->getElementAt(kept, 0, nullptr).value.string), "x");
    };
    expectTexts(&CMPIErrorFT::setRecommendedActions, &CMPIErrorFT::getRecommendedActions);
    expectTexts(&CMPIErrorFT::setMessageArguments, &CMPIErrorFT::getMessageArguments);
    expectNoMisuse();
}

TEST_F(ErrorTest, RefusesNullTextsAndOtherArrays)
{
    EXPECT_EQ(ft_.setErrorSource(error_, nullptr), CMPI_RC_ERR_INVALID_PARAMETER);
    expectMisuse("CMPIErrorFT.setErrorSource: the text is null");
    CMPIArray* const numbers = mb()->eft->newArray(mb(), 1, CMPI_uint8, nullptr);
    EXPECT_EQ(ft_.setMessageArguments(error_, numbers), CMPI_RC_ERR_TYPE_MISMATCH);
    expectMisuse("CMPIErrorFT.setMessageArguments: the array does not hold strings");
}

TEST_F(ErrorTest, IsClonedAndReleased)
{
    CMPIError* const copy = ft_.clone(error_, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(ft_.release(error_), CMPI_RC_OK);
    EXPECT_EQ(textOf(ft_.getMessage(copy, nullptr)), "message");
}

} // namespace

} // namespace cimhost
