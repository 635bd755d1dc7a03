#include <Tavro/Locale.h>

#include "testing/Environment.h"

#include <clocale>
#include <optional>
#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace {

using Tavro::Locale::getLanguageId;
using Testing::Environment;

class Language : public testing::Test
{
protected:
    Environment all{"LC_ALL", std::nullopt};
    Environment messages{"LC_MESSAGES", std::nullopt};
    Environment lang{"LANG", std::nullopt};
};

TEST_F(Language, isEnglishWhereNothingIsSaid)
{
    EXPECT_EQ(getLanguageId(), "en_US");
}

TEST_F(Language, isTakenFromTheFirstVariableThatSaysOne)
{
    lang.set("de");
    EXPECT_EQ(getLanguageId(), "de");
    messages.set("fr_FR");
    EXPECT_EQ(getLanguageId(), "fr_FR");
    all.set("ja_JP");
    EXPECT_EQ(getLanguageId(), "ja_JP");
}

TEST_F(Language, emptyVariablesSayNothing)
{
    all.set("");
    messages.set("");
    lang.set("de_DE");
    EXPECT_EQ(getLanguageId(), "de_DE");
    lang.set("");
    EXPECT_EQ(getLanguageId(), "en_US");
}

TEST_F(Language, aVariableThatSaysCHidesTheOthers)
{
    all.set("C");
    lang.set("de_DE");
    EXPECT_EQ(getLanguageId(), "en_US");
}

TEST_F(Language, otherVariablesTakeNoPart)
{
    const Environment language("LANGUAGE", "sv:nl");
    const Environment time("LC_TIME", "nl_NL");
    EXPECT_EQ(getLanguageId(), "en_US");
}

TEST_F(Language, followsTheEnvironmentFromCallToCall)
{
    lang.set("de");
    EXPECT_EQ(getLanguageId(), "de");
    lang.set("fr");
    EXPECT_EQ(getLanguageId(), "fr");
}

TEST_F(Language, leavesTheLocaleOfTheProcessAlone)
{
    const std::string before = std::setlocale(LC_ALL, nullptr);
    all.set("C.UTF-8");
    getLanguageId();
    EXPECT_EQ(std::setlocale(LC_ALL, nullptr), before);
}

struct Case
{
    const char* variable;
    const char* language;
};

class LanguageOf : public Language, public testing::WithParamInterface<Case>
{};

TEST_P(LanguageOf, isTheNameWithoutEncodingAndModifier)
{
    lang.set(GetParam().variable);
    EXPECT_EQ(getLanguageId(), GetParam().language);
}

INSTANTIATE_TEST_SUITE_P(
    Names, LanguageOf,
    testing::Values(Case{"de_DE.UTF-8", "de_DE"}, Case{"de_DE@euro", "de_DE"},
                    Case{"de_DE.ISO-8859-15@euro", "de_DE"}, Case{"sr@latin.UTF-8", "sr"}, Case{"de", "de"},
                    Case{"zh-Hant", "zh-Hant"}, Case{"C", "en_US"}, Case{"POSIX", "en_US"},
                    Case{"C.UTF-8", "en_US"}, Case{"POSIX@x", "en_US"}, Case{".UTF-8", "en_US"},
                    Case{"@euro", "en_US"}, Case{"../../etc", "en_US"}, Case{"de/DE", "en_US"},
                    Case{"de DE", "en_US"}, Case{"d\xC3\xA9", "en_US"}, Case{"de_DE\n", "en_US"}));

} // namespace
