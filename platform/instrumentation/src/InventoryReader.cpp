#include "InventoryReader.h"

#include "NodeKinds.h"
#include "QuickParser.h"
#include "QuotedNames.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <limits>
#include <optional>
#include <string_view>
#include <utility>

#include <nlohmann/json.hpp>

namespace Tavro {
namespace {

using Json = nlohmann::json;

constexpr unsigned int largestNumber = std::numeric_limits<unsigned int>::max();
constexpr std::size_t longestNameShown = 64;
constexpr std::size_t longestDetailShown = 200;
constexpr std::size_t longestRun = 65536;

enum class Field
{
    none,
    schema,
    nodes,
    sources,
    kind,
    description,
    path,
    status,
    alarmState
};

struct KnownField
{
    Field field;
    std::string_view name;
    bool isRequired;
};

constexpr std::array inventoryFields = {KnownField{Field::schema, "$schema", false},
                                        KnownField{Field::nodes, "nodes", false},
                                        KnownField{Field::sources, "sources", false}};
constexpr std::array nodeFields = {
    KnownField{Field::kind, "kind", true}, KnownField{Field::description, "description", true},
    KnownField{Field::path, "path", true}, KnownField{Field::status, "status", true},
    KnownField{Field::alarmState, "alarmState", false}};

/// Some of the fields.
class FieldSet
{
public:
    [[nodiscard]] bool has(Field field) const { return (bits_ & bit(field)) != 0; }
    /// \return whether it was not among them
    bool add(Field field)
    {
        const bool isNew = !has(field);
        bits_ |= bit(field);
        return isNew;
    }

private:
    static unsigned int bit(Field field) { return 1U << static_cast<unsigned int>(field); }

    unsigned int bits_ = 0;
};

template <class Items>
auto findCalled(const Items& items, std::string_view name)
{
    return std::find_if(items.begin(), items.end(), [name](const auto& item) { return item.name == name; });
}

std::string inQuotes(std::string_view text)
{
    return '"' + std::string(text) + '"';
}

/// Cut where a character of UTF-8 ends.
std::string shortened(const std::string& text, std::size_t longest = longestNameShown)
{
    if (text.size() <= longest)
        return text;
    std::size_t length = longest;
    while (length > 0 && (static_cast<unsigned char>(text[length]) & 0xC0) == 0x80)
        --length;
    return text.substr(0, length) + "...";
}

/// A text of the file as JSON writes it, shortened: nothing in it ends the message or drives a terminal.
std::string escaped(std::string_view text)
{
    const std::string literal = Json(shortened(std::string(text))).dump();
    return literal.substr(1, literal.size() - 2);
}

/// Such as "line 3, column 5", both counted from 1, the column in bytes.
/// \param position  how many bytes the parser had read
std::string lineAndColumn(std::string_view text, std::size_t position)
{
    const std::string_view before = text.substr(0, position == 0 ? 0 : position - 1);
    const auto lines = std::count(before.begin(), before.end(), '\n');
    const std::size_t lineStart = before.rfind('\n') + 1; // npos + 1 is the start of the text
    return "line " + std::to_string(lines + 1) + ", column " + std::to_string(before.size() - lineStart + 1);
}

/// The parser's message without its identifier, its own account of the place, and the token that it
/// read last, which may be of any length and no valid UTF-8.
std::string parserDetail(std::string message, const std::string& lastToken)
{
    const std::string token = "; last read: '" + lastToken + '\'';
    if (const std::size_t found = message.find(token); found != std::string::npos)
        message.erase(found, token.size());
    message.erase(0, message.find("] ") + 2);
    if (message.rfind("parse error", 0) == 0)
        message.erase(0, message.find(": ") + 2);
    return shortened(message, longestDetailShown);
}

/// The parser copies a text, a number or blanks several times over, escaped too, for the message about a fault behind
/// them: refuses those that would take many times the memory of the file.
void refuseLongRuns(std::string_view text)
{
    bool isInText = false;
    std::size_t begin = 0; // of the text, or of whatever stands between two texts, marks or both
    for (std::size_t i = 0; i < text.size(); ++i) {
        const char character = text[i];
        if (character == '"' ||
            (!isInText && std::string_view("{}[],:").find(character) != std::string_view::npos)) {
            isInText = isInText != (character == '"');
            begin = i + 1;
        } else if (i - begin >= longestRun) {
            throw InventoryError(lineAndColumn(text, begin + 1) +
                                 ": expected JSON: a text, a number or blanks of more than " +
                                 std::to_string(longestRun) + " bytes");
        } else if (isInText && character == '\\') {
            ++i; // a quote there ends nothing
        }
    }
}

/// How many nodes stand in a text, if it is one of an inventory; more only where braces stand in texts too. No node is
/// shorter than the shortest.
std::size_t mostNodesIn(std::string_view text)
{
    constexpr std::string_view shortest = R"({"kind":0,"path":"","status":0,"description":""})";
    std::size_t braces = 0;
    for (std::size_t i = text.find('{'); i != std::string_view::npos; i = text.find('{', i + 1))
        ++braces;
    return std::min(braces, text.size() / shortest.size());
}

/// Takes the file in as the parser comes along, and so stops at the first fault: what is nested where
/// nothing may be is never read, and a field given twice does not go unnoticed.
class InventoryHandler
{
public:
    explicit InventoryHandler(std::string_view text) : text_(text)
    {
        inventory_.nodes.reserve(mostNodesIn(text));
    }

    Inventory takeInventory() { return std::move(inventory_); }

    // What the parser calls. None of these returns false: a fault is thrown.

    bool null() { refuse("null"); }
    bool boolean(bool value) { refuse(value ? "true" : "false"); }
    bool number_integer(std::int64_t value) { refuse(std::to_string(value)); }
    bool number_float(double, const std::string& digits) { refuse(shortened(digits)); }
    bool binary(const Json::binary_t&) { refuse("binary data"); }

    bool number_unsigned(std::uint64_t value)
    {
        if (value > largestNumber)
            refuse(std::to_string(value));
        const auto number = static_cast<unsigned int>(value);
        if (field_ == Field::kind)
            node().kind = number;
        else if (field_ == Field::status)
            node().status = number;
        else if (field_ == Field::alarmState)
            node().alarmState = number;
        else
            refuse(std::to_string(value));
        return true;
    }

    bool string(std::string_view value)
    {
        if (field_ == Field::kind)
            node().kind = kindCalled(value);
        else if (field_ == Field::description)
            node().description = std::string(checkedText(value));
        else if (field_ == Field::path)
            node().path = std::string(checkedText(value));
        else if (level_ == Level::SourceList)
            inventory_.sources.push_back(sourceCalled(value));
        else if (field_ != Field::schema)
            refuse(inQuotes(escaped(value)));
        return true;
    }

    bool start_object(std::size_t)
    {
        if (level_ == Level::Outside) {
            level_ = Level::Inventory;
        } else if (level_ == Level::NodeList) {
            level_ = Level::Node;
            inventory_.nodes.emplace_back();
            fieldsOfNode_ = {};
        } else {
            refuse("an object");
        }
        return true;
    }

    bool key(std::string_view name)
    {
        if (level_ == Level::Inventory)
            enterField(name, inventoryFields, fieldsOfInventory_);
        else
            enterField(name, nodeFields, fieldsOfNode_);
        return true;
    }

    bool end_object()
    {
        leaveField();
        if (level_ == Level::Node) {
            checkNodeIsComplete();
            level_ = Level::NodeList;
        } else {
            if (!fieldsOfInventory_.has(Field::nodes) && !fieldsOfInventory_.has(Field::sources))
                throw InventoryError(place() + R"(: expected the field "nodes" or "sources", found none)");
            level_ = Level::Outside;
        }
        return true;
    }

    bool start_array(std::size_t)
    {
        if (level_ != Level::Inventory || field_ == Field::schema)
            refuse("a list");
        level_ = field_ == Field::nodes ? Level::NodeList : Level::SourceList;
        leaveField();
        return true;
    }

    bool end_array()
    {
        level_ = Level::Inventory;
        return true;
    }

    [[noreturn]] bool parse_error(std::size_t position, const std::string& lastToken,
                                  const Json::exception& error)
    {
        throw InventoryError(lineAndColumn(text_, position) +
                             ": expected JSON: " + parserDetail(error.what(), lastToken));
    }

private:
    enum class Level
    {
        Outside,
        Inventory,
        NodeList,
        Node,
        SourceList
    };

    [[nodiscard]] const std::vector<Node>& nodes() const { return inventory_.nodes; }

    /// The node that the parser is in.
    Node& node() { return inventory_.nodes.back(); }

    template <class Fields>
    void enterField(std::string_view name, const Fields& known, FieldSet& seen)
    {
        name_ = name;
        const auto* const found = findCalled(known, name);
        if (found == known.end())
            throw InventoryError(place() + ": unknown field, expected one of " + quotedNames(known));
        if (!seen.add(found->field))
            throw InventoryError(place() + ": field given twice, expected it once");
        field_ = found->field;
        name_ = found->name;
    }

    void leaveField()
    {
        field_ = Field::none;
        name_ = {};
    }

    void checkNodeIsComplete() const
    {
        for (const KnownField& known : nodeFields)
            if (known.isRequired && !fieldsOfNode_.has(known.field))
                throw InventoryError(place() + ": expected the field " + inQuotes(known.name) +
                                     ", found none");
    }

    [[nodiscard]] unsigned int kindCalled(std::string_view name) const
    {
        const auto* const kind = findCalled(namedKinds, name);
        if (kind == namedKinds.end())
            refuse(inQuotes(escaped(name)));
        return kind->kind;
    }

    [[nodiscard]] NodeSource sourceCalled(std::string_view name) const
    {
        const std::vector<NodeSource> all = nodeSources();
        const auto source = findCalled(all, name);
        if (source == all.end())
            refuse(inQuotes(escaped(name)));
        if (findCalled(inventory_.sources, name) != inventory_.sources.end())
            throw InventoryError(place() + ": source given twice, expected it once");
        return *source;
    }

    /// Texts go through interfaces in which a null character ends them.
    [[nodiscard]] std::string_view checkedText(std::string_view text) const
    {
        if (text.find('\0') != std::string_view::npos)
            refuse("a null character in it");
        return text;
    }

    [[noreturn]] void refuse(const std::string& found) const
    {
        throw InventoryError(place() + ": expected " + expected() + ", found " + found);
    }

    /// The JSON pointer to where the parser is.
    [[nodiscard]] std::string place() const
    {
        Json::json_pointer pointer;
        if (level_ == Level::NodeList)
            pointer = pointer / "nodes" / nodes().size();
        else if (level_ == Level::Node)
            pointer = pointer / "nodes" / (nodes().size() - 1);
        else if (level_ == Level::SourceList)
            pointer = pointer / "sources" / inventory_.sources.size();
        if ((level_ == Level::Inventory || level_ == Level::Node) && !name_.empty())
            pointer /= escaped(name_);
        return pointer.empty() ? "the whole file" : pointer.to_string();
    }

    [[nodiscard]] std::string expected() const
    {
        if (level_ == Level::Outside)
            return R"(an object with the field "nodes" or "sources")";
        if (level_ == Level::NodeList)
            return "a node, which is an object";
        if (level_ == Level::SourceList)
            return "one of " + quotedNames(nodeSources());
        if (field_ == Field::nodes)
            return "a list of nodes";
        if (field_ == Field::sources)
            return "a list of sources";
        std::string number = "a whole number from 0 to " + std::to_string(largestNumber);
        if (field_ == Field::kind)
            return number + " or one of " + quotedNames(namedKinds);
        if (field_ == Field::status || field_ == Field::alarmState)
            return number;
        return "a text";
    }

    std::string_view text_;
    Level level_ = Level::Outside;
    // Of what was named last in the object that the parser is in.
    Field field_ = Field::none;
    std::string_view name_;

    FieldSet fieldsOfInventory_;
    FieldSet fieldsOfNode_;
    Inventory inventory_;
};

/// Nothing: something is wrong with it, or may be.
std::optional<Inventory> readQuickly(const std::string& json)
{
    InventoryHandler handler(json);
    try {
        if (parseQuickly(json, handler, longestRun))
            return handler.takeInventory();
    } catch (const InventoryError&) {
        // It is found again, unless there is another one before it.
    }
    return std::nullopt;
}

/// Tells what is wrong, and where.
Inventory readClosely(const std::string& json)
{
    refuseLongRuns(json);
    InventoryHandler handler(json);
    Json::sax_parse(json, &handler);
    // Where a value may begin or the text end, a null character is the end for the parser.
    if (const std::size_t null = json.find('\0'); null != std::string::npos)
        throw InventoryError(lineAndColumn(json, null + 1) + ": expected JSON: a null character after it");
    return handler.takeInventory();
}

} // namespace

Inventory readInventory(const std::string& json)
{
    if (std::optional<Inventory> inventory = readQuickly(json))
        return *std::move(inventory);
    return readClosely(json);
}

} // namespace Tavro
