// Which catalogue a text comes from.

#include <Tavro/Locale.h>

#include "MadeCatalogue.h"
#include "testing/Environment.h"
#include "testing/RecordedLog.h"
#include "testing/TemporaryDirectory.h"

#include <filesystem>
#include <string>
#include <thread>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/stat.h>

namespace {

using MadeCatalogue::catalogue;
using testing::ElementsAre;
using Testing::Environment;
using testing::IsEmpty;
using Testing::TemporaryDirectory;

constexpr const wchar_t* caption = L"MSGID_ALARMDEVICE_CAPTION";
constexpr const wchar_t* english = L"Diagnostic Indicator";

std::wstring captionIn(const std::string& language)
{
    return Tavro::ResourceString(Tavro::Locale::getResourceLibrary(2, language), caption);
}

std::string captions(const std::string& text)
{
    return catalogue({{"2\4MSGID_ALARMDEVICE_CAPTION", text}});
}

/// Catalogues are read once, so each test has a folder of its own.
class Catalogues : public testing::Test
{
protected:
    Catalogues() { RecordedLog::take(); }

    [[nodiscard]] std::string fileOf(const std::string& language) const
    {
        return directory.path(language + "/LC_MESSAGES/tavro.mo");
    }

    void write(const std::string& language, const std::string& content) const
    {
        std::filesystem::create_directories(directory.path(language + "/LC_MESSAGES"));
        const std::string file = directory.file(language + "/LC_MESSAGES/tavro.mo", content);
    }

    static std::vector<std::string> complaints()
    {
        std::vector<std::string> texts;
        for (const RecordedLog::Line& line : RecordedLog::take()) {
            EXPECT_EQ(line.channel, RecordedLog::Channel::log);
            EXPECT_EQ(line.category, "Mavrel.Locale");
            EXPECT_EQ(line.level, 6000);
            texts.push_back(line.text);
        }
        return texts;
    }

    TemporaryDirectory directory;
    Environment variable{"TAVRO_CATALOGUES", directory.path("")};
};

TEST_F(Catalogues, theLanguagesOwnComesFirst)
{
    write("de_AT", captions("Anzeigelamperl"));
    write("de", captions("Anzeige"));
    EXPECT_EQ(captionIn("de_AT"), L"Anzeigelamperl");
    EXPECT_EQ(captionIn("de"), L"Anzeige");
}

TEST_F(Catalogues, aRegionFallsBackToItsLanguage)
{
    write("de", captions("Anzeige"));
    write("zh_Hans", captions("\xE8\xAF\x8A"));
    EXPECT_EQ(captionIn("de_AT"), L"Anzeige");
    EXPECT_EQ(captionIn("de-CH"), L"Anzeige");
    EXPECT_EQ(captionIn("zh_Hans_CN"), L"\u8BCA");
    EXPECT_EQ(captionIn("zh_Hant_TW"), english);
}

TEST_F(Catalogues, aMessageThatTheRegionLacksComesFromItsLanguage)
{
    write("de_AT", catalogue({{"2\4MSGID_OTHER", "anderes"}, {"2\4MSGID_ALARMDEVICE_CAPTION", ""}}));
    write("de", captions("Anzeige"));
    EXPECT_EQ(captionIn("de_AT"), L"Anzeige");
}

TEST_F(Catalogues, aMessageThatTheLanguageLacksIsEnglish)
{
    write("de", catalogue({{"2\4MSGID_OTHER", "anderes"}, {"1\4MSGID_ALARMDEVICE_CAPTION", "anderswo"}}));
    EXPECT_EQ(captionIn("de"), english);
    EXPECT_THAT(complaints(), IsEmpty());
}

TEST_F(Catalogues, aLanguageMayHaveMessagesOfItsOwn)
{
    write("de", catalogue({{"2\4MSGID_OTHER", "anderes"}}));
    EXPECT_EQ(std::wstring(Tavro::ResourceString(L"2/de", L"MSGID_OTHER")), L"anderes");
    EXPECT_EQ(std::wstring(Tavro::ResourceString(L"2/en", L"MSGID_OTHER")), L"MSGID_OTHER");
}

TEST_F(Catalogues, anUnknownLanguageIsEnglish)
{
    for (const char* const language : {"tlh", "tlh_KX", "en", "en_US", "en_GB", "_", "__", "_de", ""})
        EXPECT_EQ(captionIn(language), english) << language;
    EXPECT_THAT(complaints(), IsEmpty());
}

TEST_F(Catalogues, whatIsNoLanguageNamesNoFile)
{
    write("de", captions("Anzeige"));
    const std::string roundabout =
        "../" + std::filesystem::path(directory.path("de")).parent_path().filename().string() + "/de";
    for (const std::string& language :
         {roundabout, std::string("./de"), std::string("de/"), std::string("d\xC3\xA9"),
          std::string("de\0", 3), std::string(100000, 'd')})
        EXPECT_EQ(captionIn(language), english) << language.substr(0, 100);
    EXPECT_THAT(complaints(), IsEmpty());
}

TEST_F(Catalogues, aFolderThatIsNotThereMeansEnglish)
{
    variable.set(directory.path("missing"));
    EXPECT_EQ(captionIn("de"), english);
    EXPECT_THAT(complaints(), IsEmpty());
}

TEST_F(Catalogues, aBrokenOneIsComplainedOfOnceAndEnglishTaken)
{
    write("de", "not a catalogue");
    for (const char* const language : {"de", "de_AT", "de", "de_DE"})
        EXPECT_EQ(captionIn(language), english) << language;
    EXPECT_THAT(complaints(),
                ElementsAre(directory.path("") + "/de/LC_MESSAGES/tavro.mo: byte 0: expected the "
                                                 "mark of a message catalogue"));
}

TEST_F(Catalogues, aBrokenOneOfARegionFallsBackToItsLanguage)
{
    write("de_AT", captions("Anzeige").substr(0, 40));
    write("de", captions("Anzeige"));
    EXPECT_EQ(captionIn("de_AT"), L"Anzeige");
    EXPECT_EQ(complaints().size(), 1U);
}

TEST_F(Catalogues, aBrokenOneInEnglishLeavesTheLibrarysOwnTexts)
{
    write("en", "");
    EXPECT_EQ(captionIn("en_US"), english);
    EXPECT_EQ(complaints().size(), 1U);
}

TEST_F(Catalogues, whatIsNoRegularFileIsComplainedOf)
{
    std::filesystem::create_directories(fileOf("de"));
    std::filesystem::create_directories(directory.path("fr/LC_MESSAGES"));
    ASSERT_EQ(mkfifo(fileOf("fr").c_str(), 0600), 0);
    std::filesystem::create_directories(directory.path("it/LC_MESSAGES"));
    std::filesystem::create_symlink("/dev/zero", fileOf("it"));
    for (const char* const language : {"de", "fr", "it"}) {
        EXPECT_EQ(captionIn(language), english);
        EXPECT_THAT(complaints(), ElementsAre(testing::HasSubstr("expected a regular file, found ")))
            << language;
    }
}

TEST_F(Catalogues, oneThatIsTooLongIsComplainedOf)
{
    write("de", captions(std::string(1024UL * 1024, 'x')));
    EXPECT_EQ(captionIn("de"), english);
    EXPECT_THAT(complaints(), ElementsAre(testing::HasSubstr("expected at most 1048576 bytes")));
}

TEST_F(Catalogues, manyThreadsGetTheSameTextsAndOneComplaint)
{
    write("de", captions("Anzeige"));
    write("fr", "broken");
    constexpr int threadCount = 8;
    std::vector<std::thread> threads;
    threads.reserve(threadCount);
    for (int number = 0; number < threadCount; ++number)
        threads.emplace_back([] {
            for (int time = 0; time < 100; ++time) {
                EXPECT_EQ(captionIn("de_AT"), L"Anzeige");
                EXPECT_EQ(captionIn("fr_FR"), english);
                EXPECT_EQ(captionIn("tlh"), english);
            }
        });
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(complaints().size(), 1U);
}

} // namespace
