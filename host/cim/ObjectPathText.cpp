#include "cim/ObjectPathText.h"

#include "cim/Literal.h"
#include "cim/Number.h"
#include "cim/Utf8.h"
#include "cim/Values.h"

#include <algorithm>
#include <cctype>
#include <charconv>
#include <utility>

namespace cimhost::cim {

namespace {

/// A reference that is nested deeper than is read: an error also where a string would be welcome.
class NestingError : public ParseError
{
public:
    using ParseError::ParseError;
};

bool isDigit(char byte)
{
    return byte >= '0' && byte <= '9';
}

bool isNameByte(char byte)
{
    const auto code = static_cast<unsigned char>(byte);
    return code >= 0x80 || std::isalnum(code) != 0 || byte == '_';
}

bool isHostByte(char byte)
{
    return isNameByte(byte) || std::string_view("-.~%[]:").find(byte) != std::string_view::npos;
}

bool isNumberByte(char byte)
{
    return isDigit(byte) || std::string_view("+-.eE").find(byte) != std::string_view::npos;
}

bool hasSchemaPrefix(const std::string& className)
{
    const std::size_t underscore = className.find('_');
    return underscore != std::string::npos && underscore > 0 && underscore + 1 < className.size();
}

std::size_t countCharacters(std::string_view text)
{
    std::size_t count = 0;
    for (; !text.empty(); ++count)
        takeCharacter(text);
    return count;
}

/// A quoted value as it stands in the text.
struct Quoted
{
    std::string content;
    bool isString; ///< it has an escape that makes it a string whatever the content
};

/// Reads one path; a reference among its keys is read by a reader of its own.
class Reader
{
public:
    Reader(std::string_view text, int depth) : text_(text), depth_(depth) {}

    ObjectPath readPath();

    /// The path, if the whole text is what a reference looks like.
    std::optional<ObjectPath> readReference();

    /// Refuses what no part of a path may hold.
    void checkText();

private:
    std::string readHost();
    void readClass(ObjectPath& path);
    void readKeys(std::vector<Key>& keys);
    std::string readKeyName(const std::vector<Key>& keys);
    Value readValue();
    Value readNumber();
    Value readBoolean();
    Value readQuotedValue();
    Quoted readQuoted();
    char32_t readEscape();
    char32_t readNumericEscape(std::size_t start);
    std::string readName(const char* expected);

    [[nodiscard]] bool atEnd() const { return position_ == text_.size(); }
    [[nodiscard]] char peek() const { return atEnd() ? '\0' : text_[position_]; }
    bool take(char byte);
    bool takePrefix(std::string_view prefix);
    template <typename Belongs>
    std::string_view takeWhile(Belongs belongs);

    [[noreturn]] void failHere(std::string expected) const;
    [[noreturn]] void fail(std::size_t offset, std::string found, std::string expected) const;
    [[nodiscard]] std::string describe(std::size_t offset) const;

    std::string_view text_;
    std::size_t position_ = 0;
    int depth_;
};

void Reader::checkText()
{
    if (text_.size() > maxPathLength)
        fail(0, std::to_string(text_.size()) + " bytes", "at most " + std::to_string(maxPathLength));
    std::string_view rest = text_;
    while (!rest.empty()) {
        const std::size_t offset = text_.size() - rest.size();
        const std::optional<char32_t> character = takeCharacter(rest);
        if (!character)
            fail(offset, "a byte that is not UTF-8", "text in UTF-8");
        if (*character == 0)
            fail(offset, "a null character", "text without null characters");
    }
}

ObjectPath Reader::readPath()
{
    ObjectPath path;
    path.host = readHost();
    readClass(path);
    if (take('.'))
        readKeys(path.keys);
    if (!atEnd())
        failHere(path.keys.empty() ? "\".\" and a key, or the end" : "\",\" and a key, or the end");
    return path;
}

std::optional<ObjectPath> Reader::readReference()
{
    try {
        ObjectPath path = readPath();
        if (hasSchemaPrefix(path.className) && !path.keys.empty())
            return path;
    } catch (const NestingError&) {
        throw;
    } catch (const ParseError&) {
        // Not a path, then: a string.
    }
    return std::nullopt;
}

std::string Reader::readHost()
{
    if (!takePrefix("//") && !takePrefix("http://") && !takePrefix("https://"))
        return {};
    const std::string_view host = takeWhile(isHostByte);
    if (host.empty())
        failHere("a host name");
    if (!take('/'))
        failHere("\"/\" after the host");
    return std::string(host);
}

void Reader::readClass(ObjectPath& path)
{
    std::string name = readName("a namespace or a class name");
    if (peek() == '/' || peek() == ':') {
        while (take('/'))
            name += '/' + readName("a name of the namespace");
        if (!take(':'))
            failHere("\":\" and a class name");
        path.nameSpace = std::exchange(name, readName("a class name"));
    }
    path.className = std::move(name);
}

void Reader::readKeys(std::vector<Key>& keys)
{
    do {
        std::string name = readKeyName(keys);
        if (!take('='))
            failHere("\"=\" and the key's value");
        if (depth_ > maxPathDepth)
            throw NestingError(text_, position_, "a reference inside of references",
                               "at most " + std::to_string(maxPathDepth) + " of them");
        keys.push_back({std::move(name), readValue()});
    } while (take(','));
}

std::string Reader::readKeyName(const std::vector<Key>& keys)
{
    const std::size_t start = position_;
    std::string name = readName("a key name");
    const bool repeated =
        std::any_of(keys.begin(), keys.end(), [&](const Key& key) { return sameName(key.name, name); });
    if (repeated)
        fail(start, "the key " + excerpt(name) + " again", "each key once");
    return name;
}

Value Reader::readValue()
{
    const char byte = peek();
    if (byte == '"')
        return readQuotedValue();
    if (isDigit(byte) || byte == '+' || byte == '-' || byte == '.')
        return readNumber();
    if (isNameByte(byte))
        return readBoolean();
    failHere("a quoted text, a number, TRUE or FALSE");
}

Value Reader::readNumber()
{
    const std::size_t start = position_;
    const std::string_view token = takeWhile(isNumberByte);
    if (std::optional<Value> number = parseNumber(token))
        return std::move(*number);
    fail(start, '"' + excerpt(token) + '"', "a decimal number of 64 bits");
}

Value Reader::readBoolean()
{
    const std::size_t start = position_;
    const std::string_view word = takeWhile(isNameByte);
    if (sameName(word, "TRUE"))
        return booleanValue(true);
    if (sameName(word, "FALSE"))
        return booleanValue(false);
    fail(start, '"' + excerpt(word) + '"', "a quoted text, a number, TRUE or FALSE");
}

Value Reader::readQuotedValue()
{
    const std::size_t start = position_;
    Quoted quoted = readQuoted();
    if (quoted.isString)
        return textValue(std::move(quoted.content));
    try {
        std::optional<ObjectPath> path = Reader(quoted.content, depth_ + 1).readReference();
        return path ? referenceValue(std::move(*path)) : textValue(std::move(quoted.content));
    } catch (const NestingError& error) {
        throw NestingError(text_, start, error.found(), error.expected());
    }
}

Quoted Reader::readQuoted()
{
    take('"');
    Quoted quoted{"", false};
    while (!take('"')) {
        if (atEnd())
            failHere("the closing quote");
        if (peek() != '\\')
            quoted.content += text_[position_++];
        else {
            quoted.isString = quoted.isString || text_.substr(position_, 2) == "\\x";
            appendCharacter(quoted.content, readEscape());
        }
    }
    return quoted;
}

char32_t Reader::readEscape()
{
    const std::size_t start = position_;
    take('\\');
    const char byte = peek();
    const std::string_view letters = "\"'\\btnfr";
    const std::string_view characters = "\"'\\\b\t\n\f\r";
    const std::size_t index = atEnd() ? std::string_view::npos : letters.find(byte);
    if (index != std::string_view::npos) {
        ++position_;
        return static_cast<char32_t>(characters[index]);
    }
    if (take('x') || take('X'))
        return readNumericEscape(start);
    fail(start, "a backslash before " + describe(position_), R"(one of \" \\ \' \b \t \n \f \r \x0000)");
}

char32_t Reader::readNumericEscape(std::size_t start)
{
    const std::string_view digits = text_.substr(position_, 4);
    std::uint32_t code = 0;
    const char* const end = std::from_chars(digits.data(), digits.data() + digits.size(), code, 16).ptr;
    const bool isSurrogate = code >= 0xD800 && code <= 0xDFFF;
    position_ += static_cast<std::size_t>(end - digits.data());
    if (code == 0 || isSurrogate)
        fail(start, '"' + std::string(text_.substr(start, position_ - start)) + '"',
             "\\x and the hexadecimal number of a character");
    return code;
}

std::string Reader::readName(const char* expected)
{
    if (isDigit(peek()))
        failHere(expected);
    const std::string_view name = takeWhile(isNameByte);
    if (name.empty())
        failHere(expected);
    return std::string(name);
}

bool Reader::take(char byte)
{
    const bool there = !atEnd() && text_[position_] == byte;
    position_ += there ? 1 : 0;
    return there;
}

bool Reader::takePrefix(std::string_view prefix)
{
    const bool there = sameName(text_.substr(position_, prefix.size()), prefix);
    position_ += there ? prefix.size() : 0;
    return there;
}

template <typename Belongs>
std::string_view Reader::takeWhile(Belongs belongs)
{
    const std::size_t start = position_;
    while (!atEnd() && belongs(text_[position_]))
        ++position_;
    return text_.substr(start, position_ - start);
}

void Reader::failHere(std::string expected) const
{
    fail(position_, describe(position_), std::move(expected));
}

void Reader::fail(std::size_t offset, std::string found, std::string expected) const
{
    throw ParseError(text_, offset, std::move(found), std::move(expected));
}

std::string Reader::describe(std::size_t offset) const
{
    std::string_view rest = text_.substr(offset);
    if (rest.empty())
        return "the end";
    const std::string_view character = rest;
    takeCharacter(rest);
    return '"' + printable(character.substr(0, character.size() - rest.size())) + '"';
}

std::string describeError(std::size_t column, const std::string& found, const std::string& expected)
{
    return "column " + std::to_string(column) + ": found " + found + ", expected " + expected;
}

bool readsAsReference(const std::string& content)
{
    try {
        return Reader(content, 1).readReference().has_value();
    } catch (const NestingError&) {
        return true;
    }
}

/// A string key, with an escape that keeps it a string where it would be read as a reference.
std::string stringKeyText(const std::string& content)
{
    std::string text = inQuotes(content);
    if (readsAsReference(content))
        text.replace(text.find('='), 1, "\\x003D");
    return text;
}

std::string keyText(const Value& value)
{
    const bool isString = value.type == CMPI_string && value.items.size() == 1;
    const std::string* content = isString ? std::get_if<std::string>(&value.items.front()) : nullptr;
    return content != nullptr ? stringKeyText(*content) : literal(value);
}

} // namespace

ParseError::ParseError(std::string_view text, std::size_t offset, std::string found, std::string expected)
    : std::runtime_error(describeError(countCharacters(text.substr(0, offset)) + 1, found, expected)),
      offset_(offset),
      column_(countCharacters(text.substr(0, offset)) + 1),
      found_(std::move(found)),
      expected_(std::move(expected))
{}

ObjectPath parseObjectPath(std::string_view text)
{
    Reader reader(text, 0);
    reader.checkText();
    return reader.readPath();
}

std::string toText(const ObjectPath& path)
{
    std::string text;
    if (!path.host.empty())
        text += "//" + printable(path.host) + '/';
    if (!path.nameSpace.empty())
        text += printable(path.nameSpace) + ':';
    text += printable(path.className);
    char separator = '.';
    for (const Key& key : path.keys) {
        text += separator + printable(key.name) + '=' + keyText(key.value);
        separator = ',';
    }
    return text;
}

} // namespace cimhost::cim
