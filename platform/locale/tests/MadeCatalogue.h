/// \file
/// Help for tests that need message catalogues of their own.
#ifndef TAVRO_LOCALE_TESTS_MADECATALOGUE_H
#define TAVRO_LOCALE_TESTS_MADECATALOGUE_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

namespace MadeCatalogue {

enum class ByteOrder
{
    little,
    big,
};

inline std::string number(std::size_t value, ByteOrder order = ByteOrder::little)
{
    std::string bytes;
    for (unsigned int shift = 0; shift < 32; shift += 8)
        bytes.insert(order == ByteOrder::little ? bytes.end() : bytes.begin(),
                     static_cast<char>(value >> shift & 0xFFU));
    return bytes;
}

/// A catalogue in GNU gettext's binary format, of keys and their texts.
inline std::string catalogue(const std::vector<std::pair<std::string, std::string>>& messages,
                             ByteOrder order = ByteOrder::little, std::size_t revision = 0)
{
    constexpr std::size_t headerSize = 28;
    constexpr std::size_t entrySize = 8;
    const std::size_t texts = headerSize + messages.size() * entrySize;
    std::size_t end = texts + messages.size() * entrySize;

    std::string tables[2];
    std::string strings;
    const auto add = [&](std::string& table, const std::string& text) {
        table += number(text.size(), order) + number(end + strings.size(), order);
        strings += text + '\0';
    };
    for (const auto& [key, text] : messages) {
        add(tables[0], key);
        add(tables[1], text);
    }
    std::string header;
    for (const std::size_t value :
         {std::size_t{0x950412DE}, revision, messages.size(), headerSize, texts, std::size_t{0}, end})
        header += number(value, order);
    return header + tables[0] + tables[1] + strings;
}

} // namespace MadeCatalogue

#endif
