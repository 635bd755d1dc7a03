#include "InventoryReader.h"

#include "NodeKinds.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <iterator>
#include <limits>
#include <set>
#include <string_view>
#include <utility>

#include <nlohmann/json.hpp>

namespace Tavro {
namespace {

using Json = nlohmann::json;

constexpr unsigned int largestNumber = std::numeric_limits<unsigned int>::max();
constexpr std::size_t longestNameShown = 64;
constexpr std::size_t longestDetailShown = 200;

struct Field
{
    std::string_view name;
    bool isRequired;
};

constexpr std::array inventoryFields = {Field{"$schema", false}, Field{"nodes", true}};
constexpr std::array nodeFields = {Field{"kind", true}, Field{"description", true}, Field{"path", true},
                                   Field{"status", true}, Field{"alarmState", false}};

std::string inQuotes(std::string_view text)
{
    return '"' + std::string(text) + '"';
}

template <class Fields>
std::string listOf(const Fields& fields)
{
    std::string list;
    for (const Field& field : fields)
        list += (list.empty() ? "" : ", ") + inQuotes(field.name);
    return list;
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
std::string escaped(const std::string& text)
{
    const std::string literal = Json(shortened(text)).dump();
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

/// Takes the file in as the parser comes along, and so stops at the first fault: what is nested where
/// nothing may be is never read, and a field given twice does not go unnoticed.
class InventoryHandler
{
public:
    explicit InventoryHandler(std::string_view text) : text_(text) {}

    std::vector<Node> takeNodes() { return std::move(nodes_); }

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
        if (isAt("kind"))
            nodes_.back().kind = number;
        else if (isAt("status"))
            nodes_.back().status = number;
        else if (isAt("alarmState"))
            nodes_.back().alarmState = number;
        else
            refuse(std::to_string(value));
        return true;
    }

    bool string(const std::string& value)
    {
        if (isAt("kind"))
            nodes_.back().kind = kindCalled(value);
        else if (isAt("description"))
            nodes_.back().description = checkedText(value);
        else if (isAt("path"))
            nodes_.back().path = checkedText(value);
        else if (level_ != Level::Inventory || field_ != "$schema")
            refuse(inQuotes(escaped(value)));
        return true;
    }

    bool start_object(std::size_t)
    {
        if (level_ == Level::Outside) {
            level_ = Level::Inventory;
        } else if (level_ == Level::NodeList) {
            level_ = Level::Node;
            nodes_.emplace_back();
            fieldsOfNode_.clear();
        } else {
            refuse("an object");
        }
        return true;
    }

    bool key(const std::string& name)
    {
        field_ = name;
        if (level_ == Level::Inventory)
            enterField(inventoryFields, fieldsOfInventory_);
        else
            enterField(nodeFields, fieldsOfNode_);
        return true;
    }

    bool end_object()
    {
        field_.clear();
        if (level_ == Level::Node) {
            checkComplete(nodeFields, fieldsOfNode_);
            level_ = Level::NodeList;
        } else {
            checkComplete(inventoryFields, fieldsOfInventory_);
            level_ = Level::Outside;
        }
        return true;
    }

    bool start_array(std::size_t)
    {
        if (level_ != Level::Inventory || field_ != "nodes")
            refuse("a list");
        level_ = Level::NodeList;
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
        Node
    };
    using Names = std::set<std::string, std::less<>>;

    [[nodiscard]] bool isAt(std::string_view nodeField) const
    {
        return level_ == Level::Node && field_ == nodeField;
    }

    template <class Fields>
    void enterField(const Fields& known, Names& seen)
    {
        if (std::none_of(std::begin(known), std::end(known),
                         [this](const Field& f) { return f.name == field_; }))
            throw InventoryError(place() + ": unknown field, expected one of " + listOf(known));
        if (!seen.insert(field_).second)
            throw InventoryError(place() + ": field given twice, expected it once");
    }

    template <class Fields>
    void checkComplete(const Fields& known, const Names& seen) const
    {
        for (const Field& field : known)
            if (field.isRequired && seen.find(field.name) == seen.end())
                throw InventoryError(place() + ": expected the field " + inQuotes(field.name) +
                                     ", found none");
    }

    [[nodiscard]] unsigned int kindCalled(const std::string& name) const
    {
        const std::optional<unsigned int> kind = findNodeKind(name);
        if (!kind)
            refuse(inQuotes(escaped(name)));
        return *kind;
    }

    /// Texts go through interfaces in which a null character ends them.
    [[nodiscard]] const std::string& checkedText(const std::string& text) const
    {
        if (text.find('\0') != std::string::npos)
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
            pointer = pointer / "nodes" / nodes_.size();
        else if (level_ == Level::Node)
            pointer = pointer / "nodes" / (nodes_.size() - 1);
        if (level_ != Level::NodeList && !field_.empty())
            pointer /= escaped(field_);
        return pointer.empty() ? "the whole file" : pointer.to_string();
    }

    [[nodiscard]] std::string expected() const
    {
        if (level_ == Level::Outside)
            return "an object with the field \"nodes\"";
        if (level_ == Level::NodeList)
            return "a node, which is an object";
        if (field_ == "nodes")
            return "a list of nodes";
        std::string number = "a whole number from 0 to " + std::to_string(largestNumber);
        if (field_ == "kind")
            return number + " or one of " + listNodeKinds();
        if (field_ == "status" || field_ == "alarmState")
            return number;
        return "a text";
    }

    std::string_view text_;
    Level level_ = Level::Outside;
    std::string field_; ///< that was named last in the object the parser is in
    Names fieldsOfInventory_;
    Names fieldsOfNode_;
    std::vector<Node> nodes_;
};

} // namespace

std::vector<Node> readInventory(const std::string& json)
{
    InventoryHandler handler(json);
    Json::sax_parse(json, &handler);
    return handler.takeNodes();
}

} // namespace Tavro
