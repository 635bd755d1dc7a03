#include "Words.h"

#include <algorithm>
#include <array>
#include <cstddef>

#include <utf8proc.h>

namespace Tavro {
namespace {

struct SpecialWord
{
    std::string_view word; ///< in small letters
    std::string_view shown;
};

/// Words that a capital letter alone does not make readable, in the order of the alphabet. The names of functions are those
/// of the kernel's LED drivers; pfa, ica, ifa and idt are states of a drive in a PCI Express enclosure.
constexpr std::array specialWords = {
    SpecialWord{"bmc", "BMC"},
    SpecialWord{"capslock", "Caps Lock"},
    SpecialWord{"cpu", "CPU"},
    SpecialWord{"err", "Error"},
    SpecialWord{"fnlock", "Fn Lock"},
    SpecialWord{"hdd", "HDD"},
    SpecialWord{"hotspare", "Hot Spare"},
    SpecialWord{"ica", "In Critical Array"},
    SpecialWord{"id", "ID"},
    SpecialWord{"idt", "Invalid Device Type"},
    SpecialWord{"ifa", "In Failed Array"},
    SpecialWord{"ir", "Infrared"},
    SpecialWord{"kbd", "Keyboard"},
    SpecialWord{"lan", "LAN"},
    SpecialWord{"led", "LED"},
    SpecialWord{"micmute", "Microphone Mute"},
    SpecialWord{"mmc", "MMC"},
    SpecialWord{"mtd", "MTD"},
    SpecialWord{"nand", "NAND"},
    SpecialWord{"numlock", "Num Lock"},
    SpecialWord{"nvme", "NVMe"},
    SpecialWord{"ok", "OK"},
    SpecialWord{"pci", "PCI"},
    SpecialWord{"pcie", "PCIe"},
    SpecialWord{"pfa", "Predicted Failure"},
    SpecialWord{"psu", "PSU"},
    SpecialWord{"pwr", "Power"},
    SpecialWord{"rgb", "RGB"},
    SpecialWord{"rx", "RX"},
    SpecialWord{"sata", "SATA"},
    SpecialWord{"scrolllock", "Scroll Lock"},
    SpecialWord{"sd", "SD"},
    SpecialWord{"ssd", "SSD"},
    SpecialWord{"tx", "TX"},
    SpecialWord{"uid", "UID"},
    SpecialWord{"usb", "USB"},
    SpecialWord{"wan", "WAN"},
    SpecialWord{"wlan", "WLAN"},
    SpecialWord{"wps", "WPS"},
};

constexpr bool areInOrder()
{
    for (std::size_t i = 1; i < specialWords.size(); ++i)
        if (specialWords[i - 1].word >= specialWords[i].word)
            return false;
    return true;
}
static_assert(areInOrder());

// The characters of ASCII, whatever the process's locale.

bool isSmall(char c)
{
    return c >= 'a' && c <= 'z';
}

bool isCapital(char c)
{
    return c >= 'A' && c <= 'Z';
}

bool isLetter(char c)
{
    return isSmall(c) || isCapital(c);
}

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

bool isSeparator(char c)
{
    return c == ' ' || c == '_' || c == '-';
}

char small(char c)
{
    return isCapital(c) ? static_cast<char>(c - 'A' + 'a') : c;
}

char capital(char c)
{
    return isSmall(c) ? static_cast<char>(c - 'a' + 'A') : c;
}

std::string shown(std::string_view word)
{
    std::string text(word);
    std::transform(text.begin(), text.end(), text.begin(), small);
    const auto* const special = std::lower_bound(
        specialWords.begin(), specialWords.end(), text,
        [](const SpecialWord& known, const std::string& sought) { return known.word < sought; });
    if (special != specialWords.end() && special->word == text)
        return std::string(special->shown);
    text = word;
    text.front() = capital(text.front());
    return text;
}

void appendWord(std::string_view word, std::string& words)
{
    if (!words.empty())
        words += ' ';
    words += shown(word);
}

/// How much of "fan1" is the name that the number counts. One letter or a mixture is a name of its own:
/// r8169, enp2s0.
std::size_t lengthOfCounted(std::string_view word)
{
    const auto letters =
        static_cast<std::size_t>(std::find_if_not(word.begin(), word.end(), isLetter) - word.begin());
    const bool isNumbered =
        letters >= 2 && letters < word.size() && std::all_of(word.begin() + letters, word.end(), isDigit);
    return isNumbered ? letters : word.size();
}

/// Where the next word of "ArrayDevice" begins.
std::size_t lengthOfFirstWord(std::string_view name)
{
    std::size_t length = 0;
    while (length < name.size() && !isSeparator(name[length])) {
        if (length >= 2 && isCapital(name[length]) && isSmall(name[length - 1]) && isSmall(name[length - 2]))
            break;
        ++length;
    }
    return length;
}

/// Of ASCII, and shown as it stands. Not a function: a call for each character takes longer than what it does.
constexpr auto isPlain = [](char c) { return c >= ' ' && c <= '~' && c != '\\'; };

bool isVisible(utf8proc_int32_t character)
{
    switch (utf8proc_category(character)) {
    case UTF8PROC_CATEGORY_CC:
    case UTF8PROC_CATEGORY_CF:
    case UTF8PROC_CATEGORY_ZL:
    case UTF8PROC_CATEGORY_ZP:
        return false;
    default:
        return character != '\\';
    }
}

void appendEscaped(std::string_view bytes, std::string& text)
{
    constexpr std::string_view digits = "0123456789ABCDEF";
    for (const char byte : bytes) {
        const auto value = static_cast<unsigned char>(byte);
        text.append("\\x").append(1, digits[value >> 4U]).append(1, digits[value & 0xFU]);
    }
}

} // namespace

std::string printable(std::string_view text)
{
    if (std::all_of(text.begin(), text.end(), isPlain) && (text.empty() || text.back() != ' '))
        return std::string(text);
    std::string printed;
    printed.reserve(text.size());
    while (!text.empty()) {
        utf8proc_int32_t character = -1;
        const auto* const bytes = reinterpret_cast<const utf8proc_uint8_t*>(text.data());
        const utf8proc_ssize_t length =
            utf8proc_iterate(bytes, static_cast<utf8proc_ssize_t>(text.size()), &character);
        const std::string_view first = text.substr(0, length > 0 ? static_cast<std::size_t>(length) : 1);
        const bool isBlankAtEnd = character == ' ' && text.size() == 1;
        if (length > 0 && isVisible(character) && !isBlankAtEnd)
            printed += first;
        else
            appendEscaped(first, printed);
        text.remove_prefix(first.size());
    }
    return printed;
}

std::string inWords(std::string_view name)
{
    std::string words;
    while (!name.empty()) {
        const std::string_view word = name.substr(0, lengthOfFirstWord(name));
        if (!word.empty()) {
            const std::size_t counted = lengthOfCounted(word);
            appendWord(word.substr(0, counted), words);
            if (counted < word.size())
                appendWord(word.substr(counted), words);
        }
        name.remove_prefix(word.size());
        while (!name.empty() && isSeparator(name.front()))
            name.remove_prefix(1);
    }
    return printable(words);
}

} // namespace Tavro
