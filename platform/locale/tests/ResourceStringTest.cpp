#include <Tavro/Locale.h>

#include <string>
#include <type_traits>

#include <gtest/gtest.h>

namespace {

using Tavro::ResourceString;
using Tavro::Locale::getResourceLibrary;

static_assert(sizeof(ResourceString) == sizeof(void*));
static_assert(!std::is_copy_constructible_v<ResourceString> && !std::is_copy_assignable_v<ResourceString>);
static_assert(!std::is_polymorphic_v<ResourceString>);
static_assert(std::is_same_v<decltype(getResourceLibrary), std::wstring(int, const std::string&)>);

constexpr const wchar_t* captionId = L"MSGID_ALARMDEVICE_CAPTION";

std::wstring textIn(int library, const std::string& language, const std::wstring& messageId)
{
    return ResourceString(getResourceLibrary(library, language), messageId);
}

TEST(ResourceString, isTheTextOfTheMessage)
{
    EXPECT_EQ(textIn(2, "en_US", captionId), L"Diagnostic Indicator");
}

TEST(ResourceString, isEnglishWhereTheLanguageHasNoText)
{
    for (const char* const language : {"en", "en_GB", "tlh", "", "a/b", "\xFF", "2"})
        EXPECT_EQ(textIn(2, language, captionId), L"Diagnostic Indicator") << language;
}

TEST(ResourceString, isTheMessageIdWhereNobodyHasAText)
{
    EXPECT_EQ(textIn(2, "en_US", L"MSGID_OTHER"), L"MSGID_OTHER");
    EXPECT_EQ(textIn(2, "en_US", L"msgid_alarmdevice_caption"), L"msgid_alarmdevice_caption");
    EXPECT_EQ(textIn(2, "en_US", L""), L"");
}

TEST(ResourceString, belongsToItsLibrary)
{
    for (const int library : {-2, 0, 1, 3, 22})
        EXPECT_EQ(textIn(library, "en_US", captionId), captionId) << library;
}

TEST(ResourceString, isTheMessageIdWhereTheLibraryIsNone)
{
    for (const wchar_t* const library : {L"", L"2", L"/", L"/2", L"x/en_US", L"02/en_US"})
        EXPECT_EQ(std::wstring(ResourceString(library, captionId)), captionId) << library;
}

TEST(ResourceString, canBeReadMoreThanOnce)
{
    const ResourceString text(getResourceLibrary(2, "en_US"), captionId);
    const std::wstring first = text;
    const std::wstring second = text;
    EXPECT_EQ(first, L"Diagnostic Indicator");
    EXPECT_EQ(second, first);
}

TEST(ResourceString, outlivesWhatItWasMadeFrom)
{
    auto messageId = std::make_unique<std::wstring>(L"MSGID_SOMETHING_LONG_ENOUGH_FOR_THE_HEAP");
    const ResourceString text(L"", *messageId);
    messageId.reset();
    EXPECT_EQ(std::wstring(text), L"MSGID_SOMETHING_LONG_ENOUGH_FOR_THE_HEAP");
}

} // namespace
