// Texts in pieces, the budget that they share, and slots.

#include "serve/Text.h"

#include "serve/Slots.h"

#include <memory>
#include <string>
#include <thread>

#include <gtest/gtest.h>

using namespace cimhost::serve;

namespace {

/// A text that looks different everywhere.
std::string counting(std::size_t size)
{
    std::string text;
    for (int i = 0; text.size() < size; ++i)
        text += std::to_string(i) + ' ';
    return text.substr(0, size);
}

TEST(Texts, areReadAsTheyWereWritten)
{
    for (const std::size_t size : {0U, 1U, 65535U, 65536U, 65537U, 200000U})
        for (const std::size_t most : {1U, 7U, 65536U, 300000U}) {
            const std::string expected = counting(size);
            Text text;
            for (std::size_t from = 0; from < size; from += 1000)
                text.append(std::string_view(expected).substr(from, 1000));
            EXPECT_EQ(text.whole(), expected);
            std::string found;
            std::string bytes(most, '\0');
            for (std::size_t count = 1; count > 0; found.append(bytes, 0, count))
                count = text.read(bytes.data(), most);
            EXPECT_EQ(found, expected) << most;
            EXPECT_EQ(text.size(), size);
        }
}

TEST(Texts, takeStringsAsTheyAre)
{
    Text text(std::string("abc"));
    EXPECT_EQ(text.size(), 3U);
    char first = 0;
    EXPECT_EQ(text.read(&first, 1), 1U);
    EXPECT_EQ(text.whole(), "bc");
    Text other(std::move(text));
    EXPECT_EQ(other.whole(), "bc");
    EXPECT_EQ(Text(std::string()).read(&first, 1), 0U);
}

TEST(Texts, shareABudget)
{
    const auto budget = std::make_shared<TextBudget>(200000);
    {
        Text first(budget);
        first.append(std::string(100000, 'a'));
        Text second(budget);
        EXPECT_THROW(second.append(std::string(100000, 'b')), TextTooLong);
        first = Text();
        EXPECT_NO_THROW(second.append(std::string(65536, 'b'))) << "the first has gone";
    }
    Text third(budget);
    EXPECT_NO_THROW(third.append(std::string(180000, 'c'))) << "all have gone";
    std::string bytes(180000, '\0');
    EXPECT_EQ(third.read(bytes.data(), 140000), 140000U);
    EXPECT_TRUE(budget->take(200000 - 65536)) << "what was read has gone";
    EXPECT_FALSE(budget->take(10000));
}

TEST(ASlot, isTakenByOne)
{
    Slots slots(2);
    const std::chrono::milliseconds now(0);
    auto first = slots.take(now);
    const auto second = slots.take(now);
    EXPECT_TRUE(first && second);
    EXPECT_FALSE(slots.take(now));
    first.reset();
    EXPECT_TRUE(slots.take(now));
    auto third = slots.take(now);
    std::thread waiting([&] { EXPECT_TRUE(slots.take(std::chrono::hours(1))); });
    third.reset();
    waiting.join();
}

} // namespace
