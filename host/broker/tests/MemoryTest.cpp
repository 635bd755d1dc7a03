// The memory services: marks, blocks of memory, and freeing objects.

#include "BrokerFixture.h"

#include <cstring>
#include <limits>

namespace cimhost {

namespace {

class MemoryTest : public RequestFixture
{
protected:
    const CMPIBrokerMemFT& mft_ = *mb()->mft;
    static constexpr const char* notOurs = "the memory is not the broker's, or was freed before";
};

TEST_F(MemoryTest, ReleasesWhatWasMadeSinceAMark)
{
    CMPIString* const before = newString("before");
    CMPIGcStat* const mark = mft_.mark(mb(), &rc_);
    EXPECT_EQ(code(), CMPI_RC_OK);
    CMPIString* const since = newString("since");
    CMPIGcStat* const inner = mft_.mark(mb(), nullptr);
    EXPECT_EQ(mft_.release(mb(), mark), CMPI_RC_OK);
    EXPECT_EQ(read(before), "before");
    EXPECT_EQ(read(since), std::nullopt);
    EXPECT_EQ(since->ft->getCharPtr(since, nullptr), nullptr);
    expectMisuse("CMPIStringFT.getCharPtr: the string was released before");
    EXPECT_EQ(read(newString("after")), "after");

    EXPECT_EQ(mft_.release(mb(), inner), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIBrokerMemFT.release: the mark was released before");
}

TEST_F(MemoryTest, RefusesMarksThatAreNone)
{
    EXPECT_EQ(mft_.release(mb(), nullptr), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIBrokerMemFT.release: the mark is null");
    EXPECT_EQ(mft_.release(mb(), newString("text")), CMPI_RC_ERR_INVALID_HANDLE);
    expectMisuse("CMPIBrokerMemFT.release: the mark is a CMPIString, not a CMPIGcStat");
}

TEST_F(MemoryTest, GivesMemoryThatGoesWithTheRequest)
{
    auto* const block = static_cast<char*>(mft_.cmpiMalloc(mb(), 100));
    ASSERT_NE(block, nullptr);
    std::memset(block, 1, 100);
    EXPECT_NE(mft_.cmpiMalloc(mb(), 0), nullptr);
    const auto* const zeroes = static_cast<char*>(mft_.cmpiCalloc(mb(), 10, 10));
    ASSERT_NE(zeroes, nullptr);
    EXPECT_EQ(std::string(zeroes, 100), std::string(100, '\0'));
    EXPECT_STREQ(mft_.cmpiStrDup(mb(), "text"), "text");
    expectNoMisuse();
    // That nothing is left is for the leak detector to see.
}

TEST_F(MemoryTest, FreesMemoryOnce)
{
    void* const block = mft_.cmpiMalloc(mb(), 1);
    mft_.cmpiFree(mb(), block);
    expectNoMisuse();
    mft_.cmpiFree(mb(), block);
    expectMisuse(std::string("CMPIBrokerMemFT.cmpiFree: ") + notOurs);
    mft_.cmpiFree(mb(), nullptr);
    expectNoMisuse();
    int local = 0;
    mft_.cmpiFree(mb(), &local);
    expectMisuse(std::string("CMPIBrokerMemFT.cmpiFree: ") + notOurs);
}

TEST_F(MemoryTest, ReallocatesWithItsContent)
{
    char* const text = mft_.cmpiStrDup(mb(), "a text");
    auto* const grown = static_cast<char*>(mft_.cmpiRealloc(mb(), text, 1000));
    EXPECT_STREQ(grown, "a text");
    std::memset(grown, 1, 1000);
    auto* const shrunk = static_cast<char*>(mft_.cmpiRealloc(mb(), grown, 1));
    EXPECT_EQ(shrunk[0], 1);
    EXPECT_NE(mft_.cmpiRealloc(mb(), nullptr, 1), nullptr);
    expectNoMisuse();
    EXPECT_EQ(mft_.cmpiRealloc(mb(), grown, 1), nullptr);
    expectMisuse(std::string("CMPIBrokerMemFT.cmpiRealloc: ") + notOurs);
}

TEST_F(MemoryTest, HasNoMemoryForTooMuch)
{
    EXPECT_EQ(mft_.cmpiCalloc(mb(), std::numeric_limits<std::size_t>::max() / 2, 3), nullptr);
    EXPECT_EQ(mft_.cmpiStrDup(mb(), nullptr), nullptr);
    expectMisuse("CMPIBrokerMemFT.cmpiStrDup: the text is null");
}

TEST_F(MemoryTest, AnOuterRequestsMemoryMayBeFreedInAnInnerOne)
{
    void* const block = mft_.cmpiMalloc(mb(), 1);
    const Request inner(broker_);
    mft_.cmpiFree(mb(), block);
    expectNoMisuse();
}

TEST_F(MemoryTest, AMarkReleasesMemory)
{
    CMPIGcStat* const mark = mft_.mark(mb(), nullptr);
    void* const block = mft_.cmpiMalloc(mb(), 1);
    mft_.release(mb(), mark);
    mft_.cmpiFree(mb(), block);
    expectMisuse(std::string("CMPIBrokerMemFT.cmpiFree: ") + notOurs);
}

TEST_F(MemoryTest, FreesObjectsOfEveryKind)
{
    CMPIObjectPath* const path = newPath();
    CMPIInstance* const instance = mb()->eft->newInstance(mb(), path, nullptr);
    CMPIString* const string = newString("text");
    CMPIArgs* const args = mb()->eft->newArgs(mb(), nullptr);
    CMPIArray* const array = mb()->eft->newArray(mb(), 1, CMPI_uint8, nullptr);
    CMPIDateTime* const dateTime = mb()->eft->newDateTime(mb(), nullptr);

    mft_.freeObjectPath(mb(), path);
    mft_.freeInstance(mb(), instance);
    mft_.freeString(mb(), string);
    mft_.freeArgs(mb(), args);
    mft_.freeArray(mb(), array);
    mft_.freeDateTime(mb(), dateTime);
    expectNoMisuse();

    mft_.freeObjectPath(mb(), path);
    expectMisuse("CMPIBrokerMemFT.freeObjectPath: the object was released before");
    mft_.freeInstance(mb(), instance);
    expectMisuse("CMPIBrokerMemFT.freeInstance: the object was released before");
    mft_.freeString(mb(), string);
    expectMisuse("CMPIBrokerMemFT.freeString: the object was released before");
    mft_.freeArgs(mb(), args);
    expectMisuse("CMPIBrokerMemFT.freeArgs: the object was released before");
    mft_.freeArray(mb(), array);
    expectMisuse("CMPIBrokerMemFT.freeArray: the object was released before");
    mft_.freeDateTime(mb(), dateTime);
    expectMisuse("CMPIBrokerMemFT.freeDateTime: the object was released before");
    CMPISelectExp* const none = nullptr;
    mft_.freeSelectExp(mb(), none);
    expectMisuse("CMPIBrokerMemFT.freeSelectExp: the select expression was not made by this broker");
}

class LastingMemoryTest : public BrokerFixture
{};

TEST_F(LastingMemoryTest, OutsideOfRequestsMemoryLastsAsLongAsTheBroker)
{
    void* const kept = mb()->mft->cmpiMalloc(mb(), 10);
    void* const freed = mb()->mft->cmpiMalloc(mb(), 10);
    ASSERT_NE(kept, nullptr);
    mb()->mft->cmpiFree(mb(), freed);
    {
        const Request request(broker_);
        std::memset(kept, 1, 10);
    }
    mb()->mft->cmpiFree(mb(), kept);
    expectNoMisuse();
}

TEST_F(LastingMemoryTest, OutsideOfRequestsThereAreNoMarks)
{
    CMPIStatus rc = untouched();
    EXPECT_EQ(mb()->mft->mark(mb(), &rc), nullptr);
    EXPECT_EQ(rc, CMPI_RC_ERR_NOT_SUPPORTED);
    expectMisuse("CMPIBrokerMemFT.mark: called outside of any request");
}

} // namespace

} // namespace cimhost
