// What holds for every object path there is: the reader gives back what the writer wrote.

#include "cim/ObjectPathText.h"
#include "cim/Utf8.h"
#include "cim/Values.h"
#include "cim/tests/Print.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

using namespace cimhost::cim;

namespace {

/// Characters that mean something in a path come up as often as all the others.
rc::Gen<char32_t> characters()
{
    const std::u32string special = U"\"\\'.,=:/_ \n\t\u001b\u009b\u202e\u98a8x1";
    return rc::gen::oneOf(rc::gen::elementOf(special),
                          rc::gen::cast<char32_t>(rc::gen::inRange<std::uint32_t>(1, 0xD800)),
                          rc::gen::cast<char32_t>(rc::gen::inRange<std::uint32_t>(0xE000, 0x110000)));
}

rc::Gen<std::string> texts()
{
    return rc::gen::map(rc::gen::container<std::u32string>(characters()), [](const std::u32string& text) {
        std::string result;
        for (const char32_t character : text)
            appendCharacter(result, character);
        return result;
    });
}

rc::Gen<std::string> names()
{
    return rc::gen::element<std::string>("Name", "CreationClassName", "N1", "k", "_x", "Größe", "root");
}

rc::Gen<std::string> classNames()
{
    return rc::gen::element<std::string>("CIM_A", "ACME_Long_Name", "A_B1");
}

rc::Gen<std::string> nameSpaces()
{
    return rc::gen::element<std::string>("", "root", "root/cimv2", "root/a/b_c");
}

rc::Gen<std::string> hosts()
{
    return rc::gen::element<std::string>("", "srv", "srv-1.example:5988", "[::1]");
}

rc::Gen<ObjectPath> paths(int depth);

/// A string that the writer must tell from a reference.
rc::Gen<std::string> misleadingTexts(int depth)
{
    return rc::gen::map(paths(depth - 1), [](const ObjectPath& path) { return toText(path); });
}

rc::Gen<Value> values(int depth)
{
    const auto string = rc::gen::map(texts(), [](std::string text) { return textValue(std::move(text)); });
    const auto natural =
        rc::gen::map(rc::gen::arbitrary<std::uint64_t>(), [](std::uint64_t n) { return unsignedValue(n); });
    const auto negative =
        rc::gen::map(rc::gen::negative<std::int64_t>(), [](std::int64_t n) { return signedValue(n); });
    const auto real = rc::gen::map(rc::gen::arbitrary<double>(), [](double n) { return realValue(n); });
    const auto boolean = rc::gen::map(rc::gen::arbitrary<bool>(), booleanValue);
    if (depth == 0)
        return rc::gen::oneOf(string, natural, negative, real, boolean);
    const auto misleading =
        rc::gen::map(misleadingTexts(depth), [](std::string text) { return textValue(std::move(text)); });
    const auto reference =
        rc::gen::map(paths(depth - 1), [](ObjectPath path) { return referenceValue(std::move(path)); });
    return rc::gen::oneOf(string, natural, negative, real, boolean, misleading, reference);
}

rc::Gen<Key> keys(int depth)
{
    return rc::gen::build<Key>(rc::gen::set(&Key::name, names()), rc::gen::set(&Key::value, values(depth)));
}

rc::Gen<ObjectPath> paths(int depth)
{
    const auto sameKey = [](const Key& key) { return key.name; };
    const auto keyLists = rc::gen::nonEmpty(rc::gen::uniqueBy<std::vector<Key>>(keys(depth), sameKey));
    return rc::gen::build<ObjectPath>(
        rc::gen::set(&ObjectPath::host, hosts()), rc::gen::set(&ObjectPath::nameSpace, nameSpaces()),
        rc::gen::set(&ObjectPath::className, classNames()), rc::gen::set(&ObjectPath::keys, keyLists));
}

RC_GTEST_PROP(ObjectPathProperties, theReaderGivesBackWhatTheWriterWrote, ())
{
    const ObjectPath path = *rc::gen::resize(8, paths(2));
    const std::string text = toText(path);
    RC_PRE(text.size() <= maxPathLength);
    RC_ASSERT(parseObjectPath(text) == path);
}

RC_GTEST_PROP(ObjectPathProperties, aWrittenPathHasNothingThatActsOnATerminal, ())
{
    const std::string text = toText(*rc::gen::resize(8, paths(2)));
    RC_ASSERT(printable(text) == text);
}

RC_GTEST_PROP(ObjectPathProperties, anyTextIsReadOrRefused, ())
{
    const std::string text = *texts();
    try {
        const ObjectPath path = parseObjectPath("CIM_A." + text);
        RC_ASSERT(parseObjectPath(toText(path)) == path);
    } catch (const ParseError& error) {
        RC_ASSERT(error.column() >= 1U);
    }
}

} // namespace
