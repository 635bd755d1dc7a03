// The languages that are delivered.

#include <Tavro/Locale.h>

#include "MessageCatalogue.h"
#include "testing/Environment.h"
#include "testing/TemporaryDirectory.h"

#include <ReadFile.h>

#include <filesystem>
#include <map>
#include <optional>
#include <regex>
#include <set>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using Tavro::Messages;
using testing::Contains;
using Testing::Environment;
using testing::IsSubsetOf;

std::vector<std::string> languages()
{
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(CATALOGUES))
        names.push_back(entry.path().filename().string());
    return names;
}

Messages messagesIn(const std::string& language)
{
    return Tavro::readMessages(
        Tavro::readFile(std::string(CATALOGUES) + '/' + language + "/LC_MESSAGES/tavro.mo", 1UL << 20U));
}

/// Such as {0}, {name} and %1$s, in order of the alphabet, each as often as it is there.
std::multiset<std::wstring> placeholders(const std::wstring& text)
{
    static const std::wregex pattern(
        L"\\{[^{}]*\\}|%([0-9]+\\$)?[-+ #0]*[0-9]*(\\.[0-9]+)?[hlLjzt]*[a-zA-Z]");
    std::multiset<std::wstring> found;
    for (std::wsregex_iterator match(text.begin(), text.end(), pattern), end; match != end; ++match)
        found.insert(match->str());
    return found;
}

/// What of a language does not go with English, one line each.
std::vector<std::string> differences(const Messages& english, const Messages& translated)
{
    std::vector<std::string> found;
    for (const auto& [key, text] : english) {
        if (key.empty())
            continue;
        const auto translation = translated.find(key);
        if (translation == translated.end())
            found.push_back("no text: " + key);
        else if (placeholders(translation->second) != placeholders(text))
            found.push_back("other placeholders: " + key);
    }
    for (const auto& [key, text] : translated)
        if (english.count(key) == 0)
            found.push_back("not in English: " + key);
    return found;
}

TEST(Languages, areTheOnesPromised)
{
    EXPECT_THAT((std::vector<std::string>{"en", "de", "fr", "es", "it", "ja", "zh_CN"}),
                IsSubsetOf(languages()));
}

TEST(Languages, haveEveryMessageWithTheSamePlaceholders)
{
    const Messages english = messagesIn("en");
    EXPECT_THAT(english, Contains(testing::Key("2\4MSGID_ALARMDEVICE_CAPTION")));
    for (const std::string& language : languages())
        EXPECT_THAT(differences(english, messagesIn(language)), testing::IsEmpty()) << language;
}

TEST(Languages, thatDifferFromEnglishAreFound)
{
    const Messages english{
        {"", L"a"}, {"1", L"no"}, {"2", L"{0} of {1}"}, {"3", L"%d of %s"}, {"4", L"100 %"}};
    EXPECT_THAT(differences(english, english), testing::IsEmpty());
    EXPECT_THAT(differences(english, {{"1", L"nein"}, {"2", L"{1}: {0}"}, {"3", L"%s: %d"}, {"4", L"100%"}}),
                testing::IsEmpty());
    EXPECT_THAT(
        differences(english, {{"2", L"{0} von {0}"}, {"3", L"von %s"}, {"4", L"100 %"}, {"5", L"mehr"}}),
        testing::ElementsAre("no text: 1", "other placeholders: 2", "other placeholders: 3",
                             "not in English: 5"));
}

struct Caption
{
    const char* environment;
    const char* alarmDevice;
    const char* computerSystem;
};

class CaptionIn : public testing::TestWithParam<Caption>
{};

TEST_P(CaptionIn, isInTheLanguageOfTheEnvironment)
{
    const Environment all("LC_ALL", std::nullopt);
    const Environment messages("LC_MESSAGES", std::nullopt);
    const Environment lang("LANG", GetParam().environment);
    const auto caption = [](int library, const wchar_t* id) {
        return Tavro::make_string(Tavro::ResourceString(
            Tavro::Locale::getResourceLibrary(library, Tavro::Locale::getLanguageId()), id));
    };
    EXPECT_EQ(caption(2, L"MSGID_ALARMDEVICE_CAPTION"), GetParam().alarmDevice);
    EXPECT_EQ(caption(1, L"MSGID_COMPUTERSYSTEM_CAPTION"), GetParam().computerSystem);
}

INSTANTIATE_TEST_SUITE_P(
    Environments, CaptionIn,
    testing::Values(Caption{"de_AT.UTF-8", "Diagnoseanzeige", "Computersystem"},
                    Caption{"de", "Diagnoseanzeige", "Computersystem"},
                    Caption{"fr_CA", "Indicateur de diagnostic", "Système informatique"},
                    Caption{"es_MX.UTF-8", "Indicador de diagnóstico", "Sistema informático"},
                    Caption{"it_IT@euro", "Indicatore diagnostico", "Sistema informatico"},
                    Caption{"ja_JP.UTF-8", "診断インジケーター", "コンピューターシステム"},
                    Caption{"zh_CN.GB18030", "诊断指示灯", "计算机系统"},
                    Caption{"zh_TW.UTF-8", "Diagnostic Indicator", "Computer System"},
                    Caption{"tlh", "Diagnostic Indicator", "Computer System"},
                    Caption{"C", "Diagnostic Indicator", "Computer System"},
                    Caption{"en_GB.UTF-8", "Diagnostic Indicator", "Computer System"}));

} // namespace
