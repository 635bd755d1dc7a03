#include "Tavro/Common.h"

#include <algorithm>
#include <optional>
#include <utility>
#include <variant>
#include <vector>

namespace Tavro {
namespace {

// Everything is read through function tables of some broker's making: a call that fails, a slot that
// is empty or an object that is null makes the path unreadable, which is an empty optional below.
// Pointers are to non-const objects, since older CMPI headers declare the tables so.

/// Of references within references; a path that contains itself must come to an end.
constexpr int deepestNesting = 8;

/// How values of keys are compared.
enum class Comparison
{
    ByType,
    ByText
};

using Integer = std::pair<bool, unsigned long long>; ///< whether it is negative; its bits
using Null = std::monostate;
using Scalar = std::variant<Null, bool, CMPIChar16, Integer, double, std::string>;

struct Key
{
    std::string name; ///< in lower case
    CMPIData value;
};

struct Path
{
    std::string className; ///< in lower case
    std::vector<Key> keys; ///< in the order of their names
};

std::optional<std::string> readText(CMPIString* string)
{
    if (string == nullptr || string->hdl == nullptr || string->ft == nullptr ||
        string->ft->getCharPtr == nullptr)
        return std::nullopt;
    CMPIStatus status{CMPI_RC_OK, nullptr};
    const char* const text = string->ft->getCharPtr(string, &status);
    if (status.rc != CMPI_RC_OK || text == nullptr)
        return std::nullopt;
    return text;
}

std::optional<std::string> readDateTime(CMPIDateTime* dateTime)
{
    if (dateTime == nullptr || dateTime->hdl == nullptr || dateTime->ft == nullptr ||
        dateTime->ft->getStringFormat == nullptr)
        return std::nullopt;
    CMPIStatus status{CMPI_RC_OK, nullptr};
    CMPIString* const text = dateTime->ft->getStringFormat(dateTime, &status);
    return status.rc == CMPI_RC_OK ? readText(text) : std::nullopt;
}

std::string inLowerCase(std::string name)
{
    // Not std::tolower: names do not change with the locale of the broker's process.
    for (char& letter : name)
        if (letter >= 'A' && letter <= 'Z')
            letter = static_cast<char>(letter - 'A' + 'a');
    return name;
}

std::optional<std::string> readClassName(CMPIObjectPath* path)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    const std::optional<std::string> name = readText(path->ft->getClassName(path, &status));
    if (status.rc != CMPI_RC_OK || !name)
        return std::nullopt;
    return inLowerCase(*name);
}

std::optional<Key> readKey(CMPIObjectPath* path, CMPICount index)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    CMPIString* nameString = nullptr;
    const CMPIData value = path->ft->getKeyAt(path, index, &nameString, &status);
    if (status.rc != CMPI_RC_OK || (value.state & (CMPI_notFound | CMPI_badValue)) != 0)
        return std::nullopt;
    const std::optional<std::string> name = readText(nameString);
    if (!name)
        return std::nullopt;
    return Key{inLowerCase(*name), value};
}

std::optional<std::vector<Key>> readKeys(CMPIObjectPath* path)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    const CMPICount count = path->ft->getKeyCount(path, &status);
    if (status.rc != CMPI_RC_OK)
        return std::nullopt;

    std::vector<Key> keys;
    for (CMPICount index = 0; index < count; ++index) {
        std::optional<Key> key = readKey(path, index);
        if (!key)
            return std::nullopt;
        keys.push_back(*std::move(key));
    }
    std::stable_sort(keys.begin(), keys.end(), [](const Key& a, const Key& b) { return a.name < b.name; });
    return keys;
}

std::optional<Path> readPath(CMPIObjectPath* path)
{
    if (path == nullptr || path->hdl == nullptr || path->ft == nullptr || path->ft->getClassName == nullptr ||
        path->ft->getKeyCount == nullptr || path->ft->getKeyAt == nullptr)
        return std::nullopt;
    std::optional<std::string> className = readClassName(path);
    if (!className)
        return std::nullopt;
    std::optional<std::vector<Key>> keys = readKeys(path);
    if (!keys)
        return std::nullopt;
    return Path{*std::move(className), *std::move(keys)};
}

Integer unsignedInteger(unsigned long long number)
{
    return {false, number};
}

Integer signedInteger(long long number)
{
    return {number < 0, static_cast<unsigned long long>(number)};
}

std::optional<Scalar> scalar(std::optional<std::string> text)
{
    if (!text)
        return std::nullopt;
    return *std::move(text);
}

/// Nothing for a value that is unreadable or of a type that keys cannot have; not for references.
std::optional<Scalar> readScalar(const CMPIData& data)
{
    if ((data.state & CMPI_nullValue) != 0)
        return Null();
    switch (data.type) {
    case CMPI_boolean:
        return data.value.boolean != 0;
    case CMPI_char16:
        return data.value.char16;
    case CMPI_real32:
        return static_cast<double>(data.value.real32);
    case CMPI_real64:
        return data.value.real64;
    case CMPI_uint8:
        return unsignedInteger(data.value.uint8);
    case CMPI_uint16:
        return unsignedInteger(data.value.uint16);
    case CMPI_uint32:
        return unsignedInteger(data.value.uint32);
    case CMPI_uint64:
        return unsignedInteger(data.value.uint64);
    case CMPI_sint8:
        return signedInteger(data.value.sint8);
    case CMPI_sint16:
        return signedInteger(data.value.sint16);
    case CMPI_sint32:
        return signedInteger(data.value.sint32);
    case CMPI_sint64:
        return signedInteger(data.value.sint64);
    case CMPI_string:
        return scalar(readText(data.value.string));
    case CMPI_chars:
        return scalar(data.value.chars == nullptr ? std::nullopt
                                                  : std::optional<std::string>(data.value.chars));
    case CMPI_dateTime:
        return scalar(readDateTime(data.value.dateTime));
    default:
        return std::nullopt;
    }
}

/// How each kind of value is written in the text of a path; a null value has no text.
struct WriteText
{
    using Text = std::optional<std::string>;
    Text operator()(Null) const { return std::nullopt; }
    Text operator()(bool flag) const { return flag ? "TRUE" : "FALSE"; }
    Text operator()(CMPIChar16 character) const { return std::to_string(character); }
    Text operator()(double number) const { return std::to_string(number); }
    Text operator()(const std::string& text) const { return text; }
    Text operator()(const Integer& number) const
    {
        const auto [isNegative, bits] = number;
        return isNegative ? std::to_string(static_cast<long long>(bits)) : std::to_string(bits);
    }
};

bool areScalarsEqual(const CMPIData& a, const CMPIData& b, Comparison comparison)
{
    const std::optional<Scalar> left = readScalar(a);
    const std::optional<Scalar> right = readScalar(b);
    if (!left || !right)
        return false;
    if (comparison == Comparison::ByType)
        return *left == *right;
    return std::visit(WriteText(), *left) == std::visit(WriteText(), *right);
}

bool isReference(const CMPIData& data)
{
    return data.type == CMPI_ref && (data.state & CMPI_nullValue) == 0;
}

/// \param comparison           of the keys of these two paths
/// \param referenceComparison  of the keys of the paths that are keys of these
bool arePathsEqual(CMPIObjectPath* a, CMPIObjectPath* b, Comparison comparison,
                   Comparison referenceComparison, int nesting)
{
    if (nesting > deepestNesting)
        return false;
    const std::optional<Path> left = readPath(a);
    const std::optional<Path> right = readPath(b);
    if (!left || !right || left->className != right->className)
        return false;

    const auto areKeysEqual = [&](const Key& leftKey, const Key& rightKey) {
        if (leftKey.name != rightKey.name)
            return false;
        if (!isReference(leftKey.value) || !isReference(rightKey.value))
            return areScalarsEqual(leftKey.value, rightKey.value, comparison);
        return arePathsEqual(leftKey.value.value.ref, rightKey.value.value.ref, referenceComparison,
                             referenceComparison, nesting + 1);
    };
    return std::equal(left->keys.begin(), left->keys.end(), right->keys.begin(), right->keys.end(),
                      areKeysEqual);
}

} // namespace

bool isObjPathsEqual(const CMPIObjectPath* a, const CMPIObjectPath* b, bool deep)
{
    return arePathsEqual(const_cast<CMPIObjectPath*>(a), const_cast<CMPIObjectPath*>(b), Comparison::ByType,
                         deep ? Comparison::ByType : Comparison::ByText, 0);
}

} // namespace Tavro
