#include "BrokerFixture.h"

namespace cimhost {

namespace {

class ObjectPathTest : public RequestFixture
{
protected:
    CMPIObjectPath* const path_ = newPath();
    const CMPIObjectPathFT& ft_ = *path_->ft;

    CMPIStatus addUint32(const char* name, CMPIUint32 number)
    {
        CMPIValue value{};
        value.uint32 = number;
        return ft_.addKey(path_, name, &value, CMPI_uint32);
    }
};

TEST_F(ObjectPathTest, HasNamespaceHostAndClass)
{
    EXPECT_EQ(textOf(ft_.getNameSpace(path_, &rc_)), testNameSpace);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(textOf(ft_.getClassName(path_, &rc_)), "TEST_Thing");
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(textOf(ft_.getHostname(path_, &rc_)), ""); // not given
    EXPECT_EQ(code(), CMPI_RC_OK);

    EXPECT_EQ(ft_.setNameSpace(path_, "root/other"), CMPI_RC_OK);
    EXPECT_EQ(ft_.setHostname(path_, "server"), CMPI_RC_OK);
    EXPECT_EQ(ft_.setClassName(path_, "TEST_Other"), CMPI_RC_OK);
    EXPECT_EQ(read(path_), (cim::ObjectPath{"server", "root/other", "TEST_Other", {}}));

    EXPECT_EQ(ft_.setNameSpace(path_, nullptr), CMPI_RC_OK);
    EXPECT_EQ(textOf(ft_.getNameSpace(path_, nullptr)), "");
}

TEST_F(ObjectPathTest, FindsKeysIgnoringLetterCase)
{
    EXPECT_EQ(ft_.addKey(path_, "Name", chars("one"), CMPI_chars), CMPI_RC_OK);
    const CMPIData key = ft_.getKey(path_, "nAME", &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(key.type, CMPI_string);
    EXPECT_EQ(key.state, CMPI_keyValue);
    EXPECT_EQ(textOf(key.value.string), "one");
}

TEST_F(ObjectPathTest, SaysThatAKeyIsMissing)
{
    const CMPIData key = ft_.getKey(path_, "Name", &rc_);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(key.state, CMPI_notFound);
    const CMPIData beyond = ft_.getKeyAt(path_, 0, nullptr, &rc_);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(beyond.state, CMPI_notFound);
    expectNoMisuse();
}

TEST_F(ObjectPathTest, ListsKeysInTheirOrder)
{
    addUint32("Second", 2);
    addUint32("First", 1);
    EXPECT_EQ(ft_.getKeyCount(path_, &rc_), 2U);
    EXPECT_EQ(code(), CMPI_RC_OK);
    CMPIString* name = nullptr;
    const CMPIData key = ft_.getKeyAt(path_, 1, &name, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(textOf(name), "First");
    EXPECT_EQ(key.type, CMPI_uint32);
    EXPECT_EQ(key.state, CMPI_keyValue);
    EXPECT_EQ(key.value.uint32, 1U);
    EXPECT_EQ(ft_.getKeyAt(path_, 0, nullptr, nullptr).value.uint32, 2U);
}

TEST_F(ObjectPathTest, OverwritesAKeyOfTheSameType)
{
    addUint32("Number", 1);
    EXPECT_EQ(addUint32("NUMBER", 2), CMPI_RC_OK);
    EXPECT_EQ(ft_.getKeyCount(path_, nullptr), 1U);
    EXPECT_EQ(ft_.getKey(path_, "Number", nullptr).value.uint32, 2U);

    ft_.addKey(path_, "Text", chars("x"), CMPI_chars);
    CMPIValue value{};
    value.string = newString("y");
    EXPECT_EQ(ft_.addKey(path_, "Text", &value, CMPI_string), CMPI_RC_OK); // the same type by another name
    expectNoMisuse();
}

TEST_F(ObjectPathTest, RefusesAKeyTwiceWithAnotherType)
{
    addUint32("Number", 1);
    EXPECT_EQ(ft_.addKey(path_, "number", chars("x"), CMPI_chars), CMPI_RC_ERR_TYPE_MISMATCH);
    expectMisuse("CMPIObjectPathFT.addKey: the key number has the type uint32 already, not type 0x1700");
    EXPECT_EQ(ft_.getKey(path_, "Number", nullptr).value.uint32, 1U);
}

TEST_F(ObjectPathTest, TakesNullKeys)
{
    EXPECT_EQ(ft_.addKey(path_, "Name", nullptr, CMPI_string), CMPI_RC_OK);
    const CMPIData key = ft_.getKey(path_, "Name", &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    EXPECT_EQ(key.type, CMPI_string);
    EXPECT_EQ(key.state, CMPI_keyValue | CMPI_nullValue);
}

TEST_F(ObjectPathTest, NeedsAKeyName)
{
    EXPECT_EQ(ft_.addKey(path_, nullptr, chars("x"), CMPI_chars), CMPI_RC_ERR_INVALID_PARAMETER);
    expectMisuse("CMPIObjectPathFT.addKey: the name is null");
    EXPECT_EQ(ft_.getKey(path_, nullptr, &rc_).state, CMPI_badValue);
    EXPECT_EQ(code(), CMPI_RC_ERR_INVALID_PARAMETER);
    expectMisuse("CMPIObjectPathFT.getKey: the name is null");
}

TEST_F(ObjectPathTest, TakesNamespaceAndHostFromAnother)
{
    CMPIObjectPath* const source = newPath("TEST_Source", "root/source");
    ft_.setHostname(source, "server");
    ft_.setHostname(path_, "here");
    EXPECT_EQ(ft_.setNameSpaceFromObjectPath(path_, source), CMPI_RC_OK);
    EXPECT_EQ(read(path_), (cim::ObjectPath{"here", "root/source", "TEST_Thing", {}}));
    ft_.setNameSpace(source, "root/again");
    EXPECT_EQ(ft_.setHostAndNameSpaceFromObjectPath(path_, source), CMPI_RC_OK);
    EXPECT_EQ(read(path_), (cim::ObjectPath{"server", "root/again", "TEST_Thing", {}}));
    EXPECT_EQ(ft_.setNameSpaceFromObjectPath(path_, path_), CMPI_RC_OK); // from itself
    EXPECT_EQ(ft_.setNameSpaceFromObjectPath(path_, nullptr), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIObjectPathFT.setNameSpaceFromObjectPath: the source path is null");
}

TEST_F(ObjectPathTest, KeepsReferencesAsTheyWereWhenAdded)
{
    CMPIObjectPath* const end = request_.path(thingPath("one"));
    CMPIValue value{};
    value.ref = end;
    EXPECT_EQ(ft_.addKey(path_, "End", &value, CMPI_ref), CMPI_RC_OK);
    ft_.setNameSpace(end, "root/later");
    const CMPIData key = ft_.getKey(path_, "End", nullptr);
    EXPECT_EQ(key.type, CMPI_ref);
    EXPECT_EQ(read(key.value.ref), thingPath("one"));
    // What is read back is the reader's own.
    ft_.setNameSpace(key.value.ref, "root/mine");
    EXPECT_EQ(read(ft_.getKey(path_, "End", nullptr).value.ref), thingPath("one"));
}

TEST_F(ObjectPathTest, RefersToItself)
{
    CMPIValue value{};
    value.ref = path_;
    EXPECT_EQ(ft_.addKey(path_, "Self", &value, CMPI_ref), CMPI_RC_OK);
    EXPECT_EQ(read(ft_.getKey(path_, "Self", nullptr).value.ref), classPath("TEST_Thing"));
}

TEST_F(ObjectPathTest, HasNoQualifiers)
{
    EXPECT_EQ(ft_.getClassQualifier(path_, "Key", &rc_).state, CMPI_notFound);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_SUPPORTED);
    ft_.getPropertyQualifier(path_, "Name", "Key", &rc_);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_SUPPORTED);
    ft_.getMethodQualifier(path_, "Blink", "Static", &rc_);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_SUPPORTED);
    ft_.getParameterQualifier(path_, "Blink", "Times", "In", &rc_);
    EXPECT_EQ(code(), CMPI_RC_ERR_NOT_SUPPORTED);
    expectNoMisuse();
}

TEST_F(ObjectPathTest, ReadsAsText)
{
    ft_.addKey(path_, "Name", chars("a \"b\""), CMPI_chars);
    EXPECT_EQ(textOf(ft_.toString(path_, &rc_)), R"(root/test:TEST_Thing.Name="a \"b\"")");
    EXPECT_EQ(code(), CMPI_RC_OK);
}

TEST_F(ObjectPathTest, ClonesGoTheirOwnWay)
{
    CMPIObjectPath* const copy = ft_.clone(path_, &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    ft_.setNameSpace(copy, "root/copy");
    EXPECT_EQ(textOf(ft_.getNameSpace(path_, nullptr)), testNameSpace);
    EXPECT_EQ(ft_.release(path_), CMPI_RC_OK);
    EXPECT_EQ(textOf(ft_.getNameSpace(copy, nullptr)), "root/copy");
}

} // namespace

} // namespace cimhost
