#include "Generators.h"

#include <algorithm>
#include <cctype>
#include <cstddef>
#include <utility>

using MadeInventory::Node;

namespace MadeInventory {

void showValue(const Node& node, std::ostream& stream)
{
    rc::show(std::make_tuple(node.kind, node.description, node.path, node.status), stream);
    stream << (node.alarmState ? " alarm state " + std::to_string(*node.alarmState) : " without alarm state");
}

} // namespace MadeInventory

namespace Generators {

namespace gen = rc::gen;

namespace {

constexpr unsigned int indicatorKind = 36;
constexpr std::size_t veryLong = 5000;

rc::Gen<char> bytes()
{
    return gen::map(gen::inRange(1, 256), [](int byte) { return static_cast<char>(byte); });
}

rc::Gen<unsigned int> numbers(unsigned int beyondTheLast)
{
    return gen::oneOf(gen::inRange(0U, beyondTheLast), gen::inRange(0x10000U, 0x10000U + beyondTheLast),
                      gen::arbitrary<unsigned int>(), gen::element(0x7FFFFFFFU, 0x80000000U, 0xFFFFFFFFU));
}

/// Description and path.
using Place = std::pair<std::string, std::string>;

/// Nodes at one of the places, with blanks around that make no difference.
rc::Gen<Node> nodesAt(const std::vector<Place>& places)
{
    const auto kinds =
        gen::weightedOneOf<unsigned int>({{9, gen::just(indicatorKind)}, {1, gen::inRange(0U, 60U)}});
    const auto blanks = gen::element<std::string>("", " ", "  ");
    const auto node = [](const Place& place, const std::string& before, const std::string& after,
                         unsigned int status, std::optional<unsigned int> alarmState, unsigned int kind) {
        return Node{before + place.first, place.second + after, status, alarmState, kind};
    };
    return gen::apply(node, gen::elementOf(places), blanks, blanks, Generators::statuses(),
                      Generators::alarmStates(), kinds);
}

std::string inOtherCase(std::string name)
{
    for (char& letter : name) {
        const auto code = static_cast<unsigned char>(letter);
        letter = static_cast<char>(std::islower(code) != 0 ? std::toupper(code) : std::tolower(code));
    }
    return name;
}

} // namespace

rc::Gen<std::string> texts()
{
    return gen::oneOf(
        gen::element<std::string>("a", " a", "a ", "  a  ", "b", "A", "a b", " ", "   ", "a:/b", ":", "/"),
        gen::element<std::string>("\"", "'", "\\", "a\\\"b,c=d;", "\t", "\r\n", "\x1b[31m", "TAVRO_Glimmark"),
        gen::element<std::string>("ö", "診断", "🚨", "\xff", "\xc3", "\xed\xa0\x80", "\xc0\x80", "\xa0"),
        gen::element(std::string(veryLong, 'x'), std::string(veryLong, ' ') + "x"),
        gen::nonEmpty(gen::container<std::string>(bytes())));
}

rc::Gen<unsigned int> statuses()
{
    return numbers(30);
}

rc::Gen<std::optional<unsigned int>> alarmStates()
{
    return gen::oneOf(gen::just(std::optional<unsigned int>()),
                      gen::map(numbers(6), [](unsigned int state) { return std::optional(state); }));
}

rc::Gen<std::vector<Node>> inventories()
{
    const auto places =
        gen::nonEmpty(gen::scale(0.1, gen::container<std::vector<Place>>(gen::pair(texts(), texts()))));
    return gen::mapcat(places, [](const std::vector<Place>& some) {
        return gen::scale(0.25, gen::container<std::vector<Node>>(nodesAt(some)));
    });
}

rc::Gen<std::vector<std::string>> computerSystems()
{
    return gen::scale(0.03, gen::unique<std::vector<std::string>>(
                                gen::element<std::string>("one", "two", "srv.example", "ö", "a b")));
}

rc::Gen<std::vector<std::string>> propertyLists(const std::vector<std::string>& known)
{
    std::vector<std::string> others{"", " ", "x", "Antecedent", "Dependent", "\xff"};
    for (const std::string& name : known) {
        others.push_back(inOtherCase(name));
        others.push_back(name + " ");
    }
    return gen::scale(0.15, gen::container<std::vector<std::string>>(
                                gen::oneOf(gen::elementOf(known), gen::elementOf(others))));
}

} // namespace Generators
