#include "schema/MofReader.h"

#include "cim/RegularFile.h"
#include "cim/Utf8.h"
#include "cim/Values.h"

#include <algorithm>
#include <array>
#include <string_view>
#include <utility>

namespace cimhost::schema {
namespace {

using cim::sameName;

constexpr std::array intrinsicTypes = {"boolean", "char16", "datetime", "real32", "real64",
                                       "sint16",  "sint32", "sint64",   "sint8",  "string",
                                       "uint16",  "uint32", "uint64",   "uint8"};

bool isLetter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_';
}

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

/// Both counted from 1, the column in bytes.
struct Place
{
    int line = 1;
    int column = 1;
};

struct Token
{
    enum Kind
    {
        End,
        Name,
        Number,
        Text,
        Sign
    };
    Kind kind = End;
    std::string text; ///< of a Text: what it says
    Place place;
};

/// Cuts MOF into tokens.
class Scanner
{
public:
    Scanner(std::string_view text, const std::string& fileName) : rest_(text), fileName_(fileName) {}

    Token next()
    {
        skipBlanksAndComments();
        const Place place = place_;
        if (rest_.empty())
            return {Token::End, "the end of the file", place};
        if (rest_.front() == '"')
            return {Token::Text, takeText(), place};
        if (isLetter(rest_.front()))
            return {Token::Name, takeWhile([](char c) { return isLetter(c) || isDigit(c); }), place};
        if (isDigit(rest_.front()) || rest_.front() == '-')
            return {Token::Number, takeNumber(), place};
        return {Token::Sign, take(), place};
    }

    [[noreturn]] void fail(Place place, const std::string& what) const
    {
        throw MofError(cim::printable(fileName_) + ':' + std::to_string(place.line) + ':' +
                       std::to_string(place.column) + ": " + what);
    }

private:
    void skipBlanksAndComments()
    {
        while (!rest_.empty()) {
            if (rest_.find_first_of(" \t\r\n") == 0)
                take();
            else if (startsWith("//"))
                takeWhile([](char c) { return c != '\n'; });
            else if (startsWith("/*"))
                skipLongComment();
            else
                return;
        }
    }

    void skipLongComment()
    {
        const Place place = place_;
        take();
        take();
        while (!startsWith("*/"))
            if (rest_.empty())
                fail(place, "the comment has no end");
            else
                take();
        take();
        take();
    }

    std::string takeText()
    {
        const Place place = place_;
        take();
        std::string text;
        for (;;) {
            if (rest_.empty() || rest_.front() == '\n')
                fail(place, "the text has no closing quote on its line");
            const std::string c = take();
            if (c == "\"")
                return text;
            text += c == "\\" ? takeEscaped() : c;
        }
    }

    std::string takeEscaped()
    {
        if (rest_.empty() || (rest_.front() != '"' && rest_.front() != '\\'))
            fail(place_, R"(expected \" or \\ after a backslash)");
        return take();
    }

    std::string takeNumber()
    {
        const std::string signOrDigit = take();
        return signOrDigit + takeWhile(isDigit);
    }

    [[nodiscard]] bool startsWith(std::string_view start) const
    {
        return rest_.substr(0, start.size()) == start;
    }

    std::string take()
    {
        const char c = rest_.front();
        place_ = c == '\n' ? Place{place_.line + 1, 1} : Place{place_.line, place_.column + 1};
        rest_.remove_prefix(1);
        return {c};
    }

    template <class Predicate>
    std::string takeWhile(Predicate predicate)
    {
        std::string taken;
        while (!rest_.empty() && predicate(rest_.front()))
            taken += take();
        return taken;
    }

    std::string_view rest_;
    const std::string& fileName_;
    Place place_;
};

/// Reads the grammar; `token_` is the one that comes next.
class Parser
{
public:
    Parser(std::string_view text, const std::string& fileName) : scanner_(text, fileName) { advance(); }

    Declarations parse()
    {
        Declarations read;
        while (token_.kind != Token::End) {
            if (isSign("#"))
                skipPragma();
            else if (isWord("instance"))
                read.instances.push_back(parseInstance());
            else
                add(read.classes, "class", [this] { return parseClass(); });
        }
        return read;
    }

private:
    void advance() { token_ = scanner_.next(); }

    bool isSign(const char* sign) const { return token_.kind == Token::Sign && token_.text == sign; }
    bool isWord(const char* word) const { return token_.kind == Token::Name && sameName(token_.text, word); }

    [[noreturn]] void expected(const std::string& what) const
    {
        scanner_.fail(token_.place, "expected " + what + ", found " + found(token_));
    }

    static std::string found(const Token& token)
    {
        return token.kind == Token::End ? token.text : '"' + cim::excerpt(token.text) + '"';
    }

    std::string take(Token::Kind kind, const char* what)
    {
        if (token_.kind != kind)
            expected(what);
        std::string text = std::move(token_.text);
        advance();
        return text;
    }

    void takeSign(const char* sign)
    {
        if (!isSign(sign))
            expected(sign);
        advance();
    }

    bool takeSignIfThere(const char* sign)
    {
        if (!isSign(sign))
            return false;
        advance();
        return true;
    }

    void takeWord(const char* word)
    {
        if (!isWord(word))
            expected(word);
        advance();
    }

    /// Appends what `parseOne` reads, unless there is one of its name already.
    template <class Named, class Parse>
    void add(std::vector<Named>& list, const char* kind, Parse parseOne)
    {
        const Place place = token_.place;
        Named read = parseOne();
        if (std::any_of(list.begin(), list.end(),
                        [&](const Named& other) { return sameName(other.name, read.name); }))
            scanner_.fail(place, std::string("there is already a ") + kind + " " + read.name);
        list.push_back(std::move(read));
    }

    /// `#pragma name ( "text" )`
    void skipPragma()
    {
        takeSign("#");
        takeWord("pragma");
        take(Token::Name, "the name of a pragma");
        takeSign("(");
        parseText();
        takeSign(")");
    }

    Class parseClass()
    {
        Class result;
        result.qualifiers = parseQualifiers();
        takeWord("class");
        result.name = take(Token::Name, "the name of the class");
        if (takeSignIfThere(":"))
            result.superclass = take(Token::Name, "the name of the superclass");
        takeSign("{");
        while (!isSign("}"))
            add(result.properties, "property", [this] { return parseProperty(); });
        takeSign("}");
        takeSign(";");
        return result;
    }

    WrittenInstance parseInstance()
    {
        WrittenInstance result;
        takeWord("instance");
        takeWord("of");
        result.className = take(Token::Name, "the name of the class");
        takeSign("{");
        while (!isSign("}")) {
            const Place place = token_.place;
            const std::string name = take(Token::Name, "the name of the property");
            takeSign("=");
            if (!result.values.emplace(name, parseValue()).second)
                scanner_.fail(place, "there is already a value of " + name);
            takeSign(";");
        }
        takeSign("}");
        takeSign(";");
        return result;
    }

    WrittenValue parseValue()
    {
        WrittenValue result;
        if (isWord("null")) {
            advance();
            return result;
        }
        result.isArray = takeSignIfThere("{");
        do {
            const Place place = token_.place;
            const WrittenValue::Kind kind = parseElement(result.elements);
            if (result.elements.size() > 1 && kind != result.kind)
                scanner_.fail(place, "the elements of the array are of different kinds");
            result.kind = kind;
        } while (result.isArray && takeSignIfThere(","));
        if (result.isArray)
            takeSign("}");
        return result;
    }

    WrittenValue::Kind parseElement(std::vector<std::string>& elements)
    {
        if (token_.kind == Token::Text) {
            elements.push_back(parseText());
            return WrittenValue::Text;
        }
        if (token_.kind == Token::Number) {
            elements.push_back(take(Token::Number, "a number"));
            return WrittenValue::Number;
        }
        if (!isWord("true") && !isWord("false"))
            expected("a value");
        elements.push_back(cim::lowerCase(take(Token::Name, "TRUE or FALSE")));
        return WrittenValue::Flag;
    }

    Property parseProperty()
    {
        Property result;
        result.qualifiers = parseQualifiers();
        const Place place = token_.place;
        result.type = take(Token::Name, "the type of a property");
        result.isReference = isWord("ref");
        if (result.isReference)
            advance();
        else
            result.type = intrinsicType(result.type, place);
        result.name = take(Token::Name, "the name of the property");
        if (!result.isReference && takeSignIfThere("[")) {
            takeSign("]");
            result.isArray = true;
        }
        if (!result.isReference && takeSignIfThere("="))
            result.defaultValue = parseValue();
        takeSign(";");
        return result;
    }

    [[nodiscard]] std::string intrinsicType(const std::string& word, Place place) const
    {
        std::string type = cim::lowerCase(word);
        if (std::find(intrinsicTypes.begin(), intrinsicTypes.end(), type) == intrinsicTypes.end())
            scanner_.fail(place, "expected the type of a property, found \"" + cim::excerpt(word) + "\"");
        return type;
    }

    /// Those in square brackets; none where there are no brackets.
    std::vector<Qualifier> parseQualifiers()
    {
        std::vector<Qualifier> qualifiers;
        if (!takeSignIfThere("["))
            return qualifiers;
        do
            add(qualifiers, "qualifier", [this] { return parseQualifier(); });
        while (takeSignIfThere(","));
        takeSign("]");
        return qualifiers;
    }

    Qualifier parseQualifier()
    {
        Qualifier result;
        result.name = take(Token::Name, "the name of a qualifier");
        if (takeSignIfThere("(")) {
            parseScalar(result);
            takeSign(")");
        } else if (takeSignIfThere("{")) {
            result.kind = Parameter::Texts;
            do
                result.values.push_back(parseText());
            while (takeSignIfThere(","));
            takeSign("}");
        }
        return result;
    }

    void parseScalar(Qualifier& qualifier)
    {
        if (token_.kind == Token::Text) {
            qualifier.kind = Parameter::Text;
            qualifier.values = {parseText()};
        } else if (token_.kind == Token::Number) {
            qualifier.kind = Parameter::Number;
            qualifier.values = {take(Token::Number, "a number")};
        } else if (isWord("true") || isWord("false")) {
            qualifier.kind = Parameter::Flag;
            qualifier.values = {cim::lowerCase(take(Token::Name, "TRUE or FALSE"))};
        } else {
            expected("the value of the qualifier");
        }
    }

    /// One or more texts in quotes, which are one text.
    std::string parseText()
    {
        std::string text = take(Token::Text, "a text in quotes");
        while (token_.kind == Token::Text)
            text += take(Token::Text, "a text in quotes");
        return text;
    }

    Scanner scanner_;
    Token token_;
};

} // namespace

Declarations readMof(const std::string& text, const std::string& fileName)
{
    return Parser(text, fileName).parse();
}

Declarations readMofFile(const std::string& fileName)
{
    try {
        return readMof(cim::RegularFile(fileName).read(maxMofLength), fileName);
    } catch (const cim::FileError& error) {
        throw MofError(cim::printable(fileName) + ": cannot be read: " + error.what());
    }
}

} // namespace cimhost::schema
