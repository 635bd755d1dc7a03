/// \file
/// A parser of JSON for texts without a fault.
#ifndef TAVRO_QUICKPARSER_H
#define TAVRO_QUICKPARSER_H

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <new>
#include <string>
#include <string_view>
#include <utility>

#ifdef __SSE2__
#define RAPIDJSON_SSE2 // reads sixteen bytes at a time
#endif
// Its stack begins as null pointers and is compared with one of them plus what is to be put there: no room.
#ifdef __clang__
#pragma clang attribute push(__attribute__((no_sanitize("pointer-overflow"))), apply_to = function)
#endif
#include <rapidjson/reader.h>
#ifdef __clang__
#pragma clang attribute pop
#endif

#include <utf8proc.h>

namespace Tavro {

/// Memory for the parser, which follows whatever it is given: here none is std::bad_alloc.
class ParserMemory
{
public:
    static const bool kNeedFree = true;

    void* Malloc(std::size_t size) { return ::operator new(size); }
    void* Realloc(void* memory, std::size_t size, std::size_t newSize)
    {
        void* const larger = ::operator new(newSize);
        if (memory != nullptr)
            std::memcpy(larger, memory, std::min(size, newSize));
        Free(memory);
        return larger;
    }
    static void Free(void* memory) { ::operator delete(memory); }
};

inline bool isAscii(std::string_view text)
{
    constexpr std::uint64_t highBits = 0x8080808080808080;
    std::uint64_t bits = 0;
    std::size_t i = 0;
    for (std::uint64_t eight = 0; i + sizeof eight <= text.size(); i += sizeof eight) {
        std::memcpy(&eight, &text[i], sizeof eight);
        bits |= eight;
    }
    for (; i < text.size(); ++i)
        bits |= static_cast<unsigned char>(text[i]);
    return (bits & highBits) == 0;
}

inline bool isUtf8(std::string_view text)
{
    while (!text.empty()) {
        utf8proc_int32_t character = 0;
        const utf8proc_ssize_t length =
            utf8proc_iterate(reinterpret_cast<const utf8proc_uint8_t*>(text.data()),
                             static_cast<utf8proc_ssize_t>(text.size()), &character);
        if (length <= 0)
            return false;
        text.remove_prefix(static_cast<std::size_t>(length));
    }
    return true;
}

/// Hands what the parser comes along to a handler of nlohmann::json's kind. Where that has nothing for a value, it counts
/// as a fault.
template <class Handler>
class QuickHandler : public rapidjson::BaseReaderHandler<rapidjson::UTF8<>, QuickHandler<Handler>>
{
public:
    QuickHandler(Handler& next, const rapidjson::StringStream& text, std::size_t longestGap)
        : handler_(next),
          text_(text),
          longest_(longestGap)
    {}

    // What the parser calls, under its names. False is a fault.
    // NOLINTBEGIN(readability-identifier-naming)
    static bool Default() { return false; }
    bool Uint(unsigned int number) { return advances() && handler_.number_unsigned(number); }
    bool String(const char* text, rapidjson::SizeType length, bool /*copy*/)
    {
        return isText({text, length}) && advances() && handler_.string({text, length});
    }
    bool Key(const char* text, rapidjson::SizeType length, bool /*copy*/)
    {
        return isText({text, length}) && advances() && handler_.key({text, length});
    }
    bool StartObject() { return advances() && handler_.start_object(0); }
    bool EndObject(rapidjson::SizeType /*count*/) { return advances() && handler_.end_object(); }
    bool StartArray() { return advances() && handler_.start_array(0); }
    bool EndArray(rapidjson::SizeType /*count*/) { return advances() && handler_.end_array(); }
    // NOLINTEND(readability-identifier-naming)

    /// Whether the parser has come along less than the longest gap since it called last.
    bool advances()
    {
        const std::size_t before = std::exchange(place_, text_.Tell());
        return place_ - before < longest_;
    }

private:
    /// The parser does not look.
    static bool isText(std::string_view text) { return isAscii(text) || isUtf8(text); }

    Handler& handler_;
    const rapidjson::StringStream& text_;
    std::size_t longest_;
    std::size_t place_ = 0;
};

/// How much the parser reads at a time, behind the null character that ends a text too: it has so many of them.
constexpr std::size_t readAhead = 16;

/// Parses a text. \return false where it has a fault or so many bytes between two values, names, braces or brackets
/// that it is to be looked at closely; what the handler has been told up to there is of no use then
/// \param json  with `readAhead` null characters at its end \throw what the handler throws; std::bad_alloc
template <class Handler>
bool parseQuickly(const std::string& json, Handler& handler, std::size_t longestGap)
{
    rapidjson::StringStream text(json.c_str());
    QuickHandler<Handler> quick(handler, text, longestGap);
    rapidjson::GenericReader<rapidjson::UTF8<>, rapidjson::UTF8<>, ParserMemory> reader;
    return !reader.Parse(text, quick).IsError() && text.Tell() + readAhead == json.size() && quick.advances();
}

} // namespace Tavro

#endif
