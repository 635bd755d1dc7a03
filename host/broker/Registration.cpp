#include "broker/Registration.h"

#include "cim/RegularFile.h"
#include "cim/Utf8.h"
#include "cim/Values.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <set>
#include <string_view>
#include <utility>

namespace cimhost {

namespace {

constexpr std::string_view blanks = " \t\r\v\f";
constexpr std::array<const char*, 4> entryNames{"provider", "location", "type", "namespace"};

std::string_view trimmed(std::string_view text)
{
    const std::size_t first = text.find_first_not_of(blanks);
    if (first == std::string_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

std::vector<std::string> words(std::string_view text)
{
    std::vector<std::string> found;
    for (text = trimmed(text); !text.empty(); text = trimmed(text)) {
        const std::size_t length = std::min(text.find_first_of(blanks), text.size());
        found.emplace_back(text.substr(0, length));
        text.remove_prefix(length);
    }
    return found;
}

/// Text from a file as part of a message.
std::string shown(std::string_view text)
{
    return '"' + cim::excerpt(text) + '"';
}

bool isLetter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_';
}

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

/// What a class and the entry points of a provider can be called.
bool isIdentifier(std::string_view text)
{
    return !text.empty() && !isDigit(text.front()) &&
           std::all_of(text.begin(), text.end(), [](char c) { return isLetter(c) || isDigit(c); });
}

/// What can stand between "lib" and ".so" in the name of a file.
bool isLocation(std::string_view text)
{
    return !text.empty() && std::all_of(text.begin(), text.end(), [](char c) {
        return isLetter(c) || isDigit(c) || std::strchr("-.+", c) != nullptr;
    });
}

bool isNameSpace(std::string_view text)
{
    return text.front() != '/' && text.back() != '/' && std::all_of(text.begin(), text.end(), [](char c) {
               return isLetter(c) || isDigit(c) || std::strchr("/-.", c) != nullptr;
           });
}

/// Reads line by line; every function that takes text takes it from the current line.
class Parser
{
public:
    explicit Parser(const std::string& name) : name_(cim::printable(name)) {}

    Registration parse(std::string_view text)
    {
        while (!text.empty()) {
            const std::size_t length = std::min(text.find('\n'), text.size());
            ++line_;
            readLine(trimmed(text.substr(0, length)));
            text.remove_prefix(std::min(length + 1, text.size()));
        }
        closeSection();
        return std::move(registration_);
    }

private:
    [[noreturn]] void fail(std::size_t line, const std::string& what) const
    {
        throw RegistrationError(name_ + ":" + std::to_string(line) + ": " + what);
    }

    [[noreturn]] void expected(const std::string& what, std::string_view found) const
    {
        fail(line_, "expected " + what + ", found " + shown(found));
    }

    void readLine(std::string_view line)
    {
        if (line.empty() || line.front() == '#')
            return;
        if (line.front() == '[') {
            closeSection();
            openSection(line);
        } else {
            readEntry(line);
        }
    }

    void openSection(std::string_view line)
    {
        const std::string_view name = trimmed(line.substr(1, line.size() - 2));
        if (line.size() < 2 || line.back() != ']' || !isIdentifier(name))
            expected("a section [CLASS]", line);
        section_ = RegisteredClass();
        section_.className = name;
        sectionLine_ = line_;
        entries_.clear();
    }

    void readEntry(std::string_view line)
    {
        if (sectionLine_ == 0)
            expected("a section [CLASS] first", line);
        const std::size_t colon = line.find(':');
        if (colon == std::string_view::npos)
            expected("an entry NAME: VALUE", line);
        const std::string entry(trimmed(line.substr(0, colon)));
        if (std::find(entryNames.begin(), entryNames.end(), entry) == entryNames.end())
            expected("provider:, location:, type: or namespace:", line);
        if (!entries_.insert(entry).second)
            fail(line_, "the entry " + entry + ": stands twice in the section [" + section_.className + "]");
        readValue(entry, trimmed(line.substr(colon + 1)));
    }

    void readValue(const std::string& entry, std::string_view value)
    {
        if (entry == "provider") {
            if (!isIdentifier(value))
                expected("the name of a provider", value);
            section_.provider = value;
        } else if (entry == "location") {
            if (!isLocation(value))
                expected(R"(the name of a library without "lib" and ".so")", value);
            section_.location = value;
        } else if (entry == "type") {
            readTypes(value);
        } else {
            readNameSpaces(value);
        }
    }

    void readTypes(std::string_view value)
    {
        for (const std::string& type : words(value)) {
            if (type == "instance")
                section_.instance = true;
            else if (type == "association")
                section_.association = true;
            else
                expected("the type instance or association", type);
        }
        if (!section_.instance && !section_.association)
            expected("the type instance or association", value);
    }

    void readNameSpaces(std::string_view value)
    {
        section_.nameSpaces = words(value);
        if (section_.nameSpaces.empty())
            expected("a namespace such as root/cimv2", value);
        for (const std::string& nameSpace : section_.nameSpaces)
            if (!isNameSpace(nameSpace))
                expected("a namespace such as root/cimv2", nameSpace);
    }

    void closeSection()
    {
        if (sectionLine_ == 0)
            return;
        for (const char* const entry : entryNames)
            if (entries_.count(entry) == 0)
                fail(sectionLine_,
                     "the section [" + section_.className + "] has no entry " + entry + std::string(":"));
        for (std::size_t i = 0; i < registration_.classes.size(); ++i) {
            const RegisteredClass& earlier = registration_.classes[i];
            if (cim::sameName(earlier.className, section_.className) && earlier.provider == section_.provider)
                fail(sectionLine_, "the class " + section_.className + " and the provider " +
                                       section_.provider + " are registered in line " +
                                       std::to_string(lines_[i]) + " already");
        }
        registration_.classes.push_back(section_);
        lines_.push_back(sectionLine_);
    }

    std::string name_;
    std::size_t line_ = 0;
    Registration registration_;
    std::vector<std::size_t> lines_; ///< of each class's section
    RegisteredClass section_;
    std::size_t sectionLine_ = 0;   ///< of the section being read; 0: none yet
    std::set<std::string> entries_; ///< read so far in the section
};

} // namespace

bool isRegisteredIn(const RegisteredClass& entry, const std::string& nameSpace)
{
    return std::any_of(entry.nameSpaces.begin(), entry.nameSpaces.end(),
                       [&](const std::string& name) { return cim::sameName(name, nameSpace); });
}

Registration parseRegistration(const std::string& text, const std::string& name)
{
    return Parser(name).parse(text);
}

Registration readRegistrationFile(const std::string& fileName)
{
    std::string text;
    try {
        text = cim::RegularFile(fileName).read(maxRegistrationLength);
    } catch (const cim::FileError& error) {
        throw RegistrationError(cim::printable(fileName) + ": cannot be read: " + error.what());
    }
    return parseRegistration(text, fileName);
}

} // namespace cimhost
