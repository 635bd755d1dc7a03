#include "MessageCatalogue.h"

#include <cstddef>
#include <cstdint>
#include <string>

#include <utf8proc.h>

namespace Tavro {
namespace {

// The format is described in the manual of GNU gettext, "The Format of GNU MO Files".
constexpr std::uint32_t magic = 0x950412DE;
constexpr std::size_t numberSize = 4;
constexpr std::size_t entrySize = 2 * numberSize; ///< length and offset of a string
constexpr std::size_t revisionAt = 4;
constexpr std::size_t countAt = 8;
constexpr std::size_t idTableAt = 12;
constexpr std::size_t textTableAt = 16;

[[noreturn]] void fail(std::size_t offset, const std::string& expected)
{
    throw CatalogueError("byte " + std::to_string(offset) + ": expected " + expected);
}

class Reader
{
public:
    explicit Reader(std::string_view content) : content_(content)
    {
        if (number(0) == magic)
            return;
        isBigEndian_ = true;
        if (number(0) != magic)
            fail(0, "the mark of a message catalogue");
    }

    [[nodiscard]] std::uint32_t number(std::size_t offset) const
    {
        const std::string_view bytes = part(offset, numberSize);
        std::uint32_t value = 0;
        for (std::size_t i = 0; i < numberSize; ++i) {
            const auto byte = static_cast<unsigned char>(bytes[isBigEndian_ ? i : numberSize - 1 - i]);
            value = value << 8U | byte;
        }
        return value;
    }

    /// The string that an entry of a table tells of.
    [[nodiscard]] std::string_view string(std::size_t entry) const
    {
        return part(number(entry + numberSize), number(entry));
    }

    /// Where that string begins.
    [[nodiscard]] std::size_t offsetOf(std::size_t entry) const { return number(entry + numberSize); }

private:
    [[nodiscard]] std::string_view part(std::size_t offset, std::size_t size) const
    {
        if (offset > content_.size() || size > content_.size() - offset)
            fail(offset,
                 std::to_string(size) + " bytes, found the end at byte " + std::to_string(content_.size()));
        return content_.substr(offset, size);
    }

    std::string_view content_;
    bool isBigEndian_ = false;
};

/// In UTF-8. \param offset  of the text in the catalogue, for errors
std::wstring wide(std::string_view text, std::size_t offset)
{
    std::wstring characters;
    characters.reserve(text.size());
    std::size_t done = 0;
    while (done < text.size()) {
        utf8proc_int32_t character = 0;
        const auto* const next = reinterpret_cast<const utf8proc_uint8_t*>(text.data() + done);
        const utf8proc_ssize_t size =
            utf8proc_iterate(next, static_cast<utf8proc_ssize_t>(text.size() - done), &character);
        if (size <= 0)
            fail(offset + done, "text in UTF-8");
        characters += static_cast<wchar_t>(character);
        done += static_cast<std::size_t>(size);
    }
    return characters;
}

} // namespace

Messages readMessages(std::string_view content)
{
    const Reader reader(content);
    const std::uint32_t revision = reader.number(revisionAt);
    if (revision >> 16U != 0)
        fail(revisionAt, "revision 0 of the format, found " + std::to_string(revision >> 16U));

    const std::size_t count = reader.number(countAt);
    std::size_t idEntry = reader.number(idTableAt);
    std::size_t textEntry = reader.number(textTableAt);
    std::size_t left = content.size();
    Messages messages;
    for (std::size_t i = 0; i < count; ++i, idEntry += entrySize, textEntry += entrySize) {
        const std::string_view id = reader.string(idEntry);
        const std::string_view text = reader.string(textEntry);
        // A small file whose entries all tell of one long text would fill the memory.
        if (id.size() + text.size() > left)
            fail(textEntry, "texts that do not overlap");
        left -= id.size() + text.size();
        if (!text.empty())
            messages.insert_or_assign(std::string(id), wide(text, reader.offsetOf(textEntry)));
    }
    return messages;
}

} // namespace Tavro
