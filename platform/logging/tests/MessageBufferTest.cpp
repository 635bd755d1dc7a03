#include <MVLog/MVMessageBuffer.h>

#include <cstdint>
#include <limits>
#include <sstream>
#include <string>
#include <type_traits>

#include <gtest/gtest.h>

namespace {

using MVLog::MVMessageBuffer;

static_assert(sizeof(MVMessageBuffer) == sizeof(void*));
static_assert(std::is_default_constructible_v<MVMessageBuffer>);
static_assert(!std::is_copy_constructible_v<MVMessageBuffer> && !std::is_copy_assignable_v<MVMessageBuffer>);
static_assert(!std::is_polymorphic_v<MVMessageBuffer>);

const void* address(std::uintptr_t number)
{
    // NOLINTNEXTLINE(performance-no-int-to-ptr): never followed, only printed
    return reinterpret_cast<const void*>(number);
}

TEST(MessageBuffer, isEmptyAtFirst)
{
    EXPECT_EQ(MVMessageBuffer().str(), "");
}

TEST(MessageBuffer, joinsWhatIsInserted)
{
    MVMessageBuffer buffer;
    buffer << " mi=" << address(0xBEEF) << std::string(" flag=") << true << false << "";
    EXPECT_EQ(buffer.str(), " mi=0xbeef flag=10");
    buffer << ".";
    EXPECT_EQ(buffer.str(), " mi=0xbeef flag=10.");
}

// But for null, which each standard library has a word of its own for.
TEST(MessageBuffer, printsAddressesAsAStreamDoes)
{
    const int object = 0;
    for (const void* const value : {address(1), address(std::numeric_limits<std::uintptr_t>::max()),
                                    static_cast<const void*>(&object)}) {
        std::ostringstream stream;
        stream << value;
        MVMessageBuffer buffer;
        buffer << value;
        EXPECT_EQ(buffer.str(), stream.str());
    }
}

TEST(MessageBuffer, printsANullAddressAndGoesOn)
{
    MVMessageBuffer buffer;
    buffer << address(0) << " after";
    EXPECT_EQ(buffer.str(), "0 after");
}

TEST(MessageBuffer, takesTypedPointersForAddresses)
{
    int object = 0;
    MVMessageBuffer typed;
    typed << &object;
    MVMessageBuffer untyped;
    untyped << static_cast<const void*>(&object);
    EXPECT_EQ(typed.str(), untyped.str());
}

TEST(MessageBuffer, writesNothingAfterANullText)
{
    MVMessageBuffer buffer;
    buffer << "before" << static_cast<const char*>(nullptr) << "text" << std::string("string") << address(1)
           << true;
    EXPECT_EQ(buffer.str(), "before");
}

TEST(MessageBuffer, keepsEveryByteOfAString)
{
    const std::string text("a\0b\n\xFF", 5);
    MVMessageBuffer buffer;
    buffer << text;
    EXPECT_EQ(buffer.str(), text);
}

TEST(MessageBuffer, holdsLongTexts)
{
    const std::string text(1000000, 'x');
    MVMessageBuffer buffer;
    buffer << text << text.c_str();
    EXPECT_EQ(buffer.str(), text + text);
}

} // namespace
