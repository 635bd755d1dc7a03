#include "MofReader.h"

#include "cim/Values.h"

#include <algorithm>
#include <array>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string_view>
#include <utility>

namespace schema {
namespace {

using cimhost::cim::sameName;

constexpr std::array intrinsicTypes = {"boolean", "char16", "datetime", "real32", "real64",
                                       "sint16",  "sint32", "sint64",   "sint8",  "string",
                                       "uint16",  "uint32", "uint64",   "uint8"};

/// Lower case, of ASCII.
std::string lowered(std::string text)
{
    for (char& c : text)
        if (c >= 'A' && c <= 'Z')
            c = static_cast<char>(c - 'A' + 'a');
    return text;
}

bool isLetter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_';
}

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

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
    int line = 0;
};

/// Cuts MOF into tokens.
class Scanner
{
public:
    Scanner(std::string_view text, const std::string& fileName) : rest_(text), fileName_(fileName) {}

    Token next()
    {
        skipBlanksAndComments();
        const int line = line_;
        if (rest_.empty())
            return {Token::End, "the end of the file", line};
        if (rest_.front() == '"')
            return {Token::Text, takeText(), line};
        if (isLetter(rest_.front()))
            return {Token::Name, takeWhile([](char c) { return isLetter(c) || isDigit(c); }), line};
        if (isDigit(rest_.front()) || rest_.front() == '-')
            return {Token::Number, takeNumber(), line};
        return {Token::Sign, take(), line};
    }

    [[noreturn]] void fail(int line, const std::string& what) const
    {
        throw MofError(fileName_ + ":" + std::to_string(line) + ": " + what);
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
        const int line = line_;
        take();
        take();
        while (!startsWith("*/"))
            if (rest_.empty())
                fail(line, "the comment has no end");
            else
                take();
        take();
        take();
    }

    std::string takeText()
    {
        const int line = line_;
        take();
        std::string text;
        for (;;) {
            if (rest_.empty() || rest_.front() == '\n')
                fail(line, "the text has no closing quote on its line");
            const std::string c = take();
            if (c == "\"")
                return text;
            text += c == "\\" ? takeEscaped() : c;
        }
    }

    std::string takeEscaped()
    {
        if (rest_.empty() || (rest_.front() != '"' && rest_.front() != '\\'))
            fail(line_, R"(expected \" or \\ after a backslash)");
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
        if (c == '\n')
            ++line_;
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
    int line_ = 1;
};

/// Reads the grammar; `token_` is the one that comes next.
class Parser
{
public:
    Parser(std::string_view text, const std::string& fileName) : scanner_(text, fileName) { advance(); }

    std::vector<Class> parse()
    {
        std::vector<Class> classes;
        while (token_.kind != Token::End) {
            if (isSign("#"))
                skipPragma();
            else
                add(classes, "class", [this] { return parseClass(); });
        }
        return classes;
    }

    std::vector<WrittenInstance> parseInstances()
    {
        std::vector<WrittenInstance> instances;
        while (token_.kind != Token::End)
            instances.push_back(parseInstance());
        return instances;
    }

private:
    void advance() { token_ = scanner_.next(); }

    bool isSign(const char* sign) const { return token_.kind == Token::Sign && token_.text == sign; }
    bool isWord(const char* word) const { return token_.kind == Token::Name && sameName(token_.text, word); }

    [[noreturn]] void expected(const std::string& what) const
    {
        const bool quoted = token_.kind != Token::End;
        scanner_.fail(token_.line,
                      "expected " + what + ", found " + (quoted ? "\"" + token_.text + "\"" : token_.text));
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
        const int line = token_.line;
        Named read = parseOne();
        if (std::any_of(list.begin(), list.end(),
                        [&](const Named& other) { return sameName(other.name, read.name); }))
            scanner_.fail(line, std::string("there is already a ") + kind + " " + read.name);
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
            const int line = token_.line;
            const std::string name = take(Token::Name, "the name of the property");
            takeSign("=");
            if (!result.values.emplace(name, parseValue()).second)
                scanner_.fail(line, "there is already a value of " + name);
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
            const int line = token_.line;
            const WrittenValue::Kind kind = parseElement(result.elements);
            if (result.elements.size() > 1 && kind != result.kind)
                scanner_.fail(line, "the elements of the array are of different kinds");
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
        elements.push_back(lowered(take(Token::Name, "TRUE or FALSE")));
        return WrittenValue::Flag;
    }

    Property parseProperty()
    {
        Property result;
        result.qualifiers = parseQualifiers();
        const int line = token_.line;
        result.type = take(Token::Name, "the type of a property");
        result.isReference = isWord("ref");
        if (result.isReference)
            advance();
        else
            result.type = intrinsicType(result.type, line);
        result.name = take(Token::Name, "the name of the property");
        if (!result.isReference && takeSignIfThere("[")) {
            takeSign("]");
            result.isArray = true;
        }
        takeSign(";");
        return result;
    }

    [[nodiscard]] std::string intrinsicType(const std::string& word, int line) const
    {
        std::string type = lowered(word);
        if (std::find(intrinsicTypes.begin(), intrinsicTypes.end(), type) == intrinsicTypes.end())
            scanner_.fail(line, "expected the type of a property, found \"" + word + "\"");
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
            qualifier.values = {lowered(take(Token::Name, "TRUE or FALSE"))};
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

std::string readText(const std::string& fileName)
{
    const std::ifstream file(fileName, std::ios::binary);
    if (!file || !std::filesystem::is_regular_file(fileName))
        throw MofError(fileName + ": cannot be read");
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

} // namespace

std::vector<Class> readMof(const std::string& text, const std::string& fileName)
{
    return Parser(text, fileName).parse();
}

std::vector<Class> readMofFile(const std::string& fileName)
{
    return readMof(readText(fileName), fileName);
}

std::vector<WrittenInstance> readMofInstances(const std::string& text, const std::string& fileName)
{
    return Parser(text, fileName).parseInstances();
}

std::vector<WrittenInstance> readMofInstancesFile(const std::string& fileName)
{
    return readMofInstances(readText(fileName), fileName);
}

} // namespace schema
