#include "MessageCatalogue.h"

#include "MadeCatalogue.h"

#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using namespace std::string_literals;
using MadeCatalogue::ByteOrder;
using MadeCatalogue::catalogue;
using MadeCatalogue::number;
using Tavro::CatalogueError;
using Tavro::readMessages;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;

/// What is wrong with the content; expects that something is.
std::string complaintAbout(const std::string& content)
{
    try {
        readMessages(content);
    } catch (const CatalogueError& error) {
        return error.what();
    }
    ADD_FAILURE() << "nothing was found wrong";
    return {};
}

std::string with(std::string content, std::size_t offset, const std::string& bytes)
{
    return content.replace(offset, bytes.size(), bytes);
}

TEST(MessageCatalogue, hasTheTextsOfItsMessages)
{
    EXPECT_THAT(readMessages(catalogue({{"2\4ID", "Anzeige"}, {"other", "\xE8\xA8\xBA \xF0\x9F\x9A\xA8"}})),
                ElementsAre(Pair("2\4ID", L"Anzeige"), Pair("other", L"\u8A3A \U0001F6A8")));
}

TEST(MessageCatalogue, mayHaveNoMessages)
{
    EXPECT_THAT(readMessages(catalogue({})), IsEmpty());
}

TEST(MessageCatalogue, isReadInBothByteOrders)
{
    EXPECT_THAT(readMessages(catalogue({{"id", "text"}}, ByteOrder::big)), ElementsAre(Pair("id", L"text")));
}

TEST(MessageCatalogue, leavesOutWhatHasNoText)
{
    EXPECT_THAT(readMessages(catalogue({{"empty", ""}, {"id", "text"}})), ElementsAre(Pair("id", L"text")));
}

TEST(MessageCatalogue, keepsNullCharacters)
{
    EXPECT_THAT(readMessages(catalogue({{"one\0more"s, "eins\0mehr"s}})),
                ElementsAre(Pair("one\0more"s, L"eins\0mehr"s)));
}

TEST(MessageCatalogue, mayHaveAnyMinorRevision)
{
    EXPECT_THAT(readMessages(catalogue({{"id", "text"}}, ByteOrder::little, 7)),
                ElementsAre(Pair("id", L"text")));
}

TEST(MessageCatalogue, isRefusedWithAnotherMajorRevision)
{
    EXPECT_EQ(complaintAbout(catalogue({}, ByteOrder::little, 0x20000)),
              "byte 4: expected revision 0 of the format, found 2");
}

TEST(MessageCatalogue, isRefusedWithoutItsMark)
{
    EXPECT_EQ(complaintAbout(with(catalogue({}), 0, "x")),
              "byte 0: expected the mark of a message catalogue");
    EXPECT_EQ(complaintAbout("msgid \"\"\n"), "byte 0: expected the mark of a message catalogue");
    EXPECT_EQ(complaintAbout(""), "byte 0: expected 4 bytes, found the end at byte 0");
}

TEST(MessageCatalogue, isRefusedWhereverItIsCutShort)
{
    const std::string whole = catalogue({{"2\4ID", "Anzeige"}, {"other", "text"}});
    const std::size_t hashTable = 20; // what begins there is not used, nor is the last text's null character
    for (std::size_t size = 0; size + 1 < whole.size(); ++size)
        EXPECT_THROW(readMessages(whole.substr(0, size)), CatalogueError) << size;
    EXPECT_NO_THROW(readMessages(catalogue({}).substr(0, hashTable)));
}

TEST(MessageCatalogue, isRefusedWhenATextLiesBeyondTheEnd)
{
    const std::string whole = catalogue({{"id", "text"}});
    const std::size_t textLength = 36;
    const std::size_t textOffset = 40;
    EXPECT_EQ(complaintAbout(with(whole, textLength, number(6))),
              "byte 47: expected 6 bytes, found the end at byte 52");
    EXPECT_EQ(complaintAbout(with(whole, textLength, number(0xFFFFFFFF))),
              "byte 47: expected 4294967295 bytes, found the end at byte 52");
    EXPECT_EQ(complaintAbout(with(whole, textOffset, number(0xFFFFFFFF))),
              "byte 4294967295: expected 4 bytes, found the end at byte 52");
}

TEST(MessageCatalogue, isRefusedWithMoreMessagesThanItHas)
{
    EXPECT_THROW(readMessages(with(catalogue({{"id", "text"}}), 8, number(0xFFFFFFFF))), CatalogueError);
}

TEST(MessageCatalogue, isRefusedWhenItsTextsOverlap)
{
    const std::string text(1000, 'x');
    std::string content = catalogue({{"", text}, {"", text}, {"", text}});
    const std::size_t lastText = 28 + 3 * 8 + 2 * 8;
    content.erase(content.size() - 2002); // the first text is left, and what the ids need
    for (const std::size_t entry : {lastText - 8, lastText})
        content = with(content, entry + 4, content.substr(lastText - 16 + 4, 4));
    EXPECT_EQ(complaintAbout(content), "byte 60: expected texts that do not overlap");
}

TEST(MessageCatalogue, isRefusedWhenATextIsNotUtf8)
{
    EXPECT_EQ(complaintAbout(catalogue({{"id", "L\xFC"
                                               "fter"}})),
              "byte 48: expected text in UTF-8");
    EXPECT_EQ(complaintAbout(catalogue({{"id", "cut \xE8\xA8"}})), "byte 51: expected text in UTF-8");
}

} // namespace
