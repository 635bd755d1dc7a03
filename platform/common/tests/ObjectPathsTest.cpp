#include <Tavro/Common.h>

#include "FakePath.h"

#include "testing/ForkUnderLoad.h"

#include <cmath>
#include <functional>
#include <limits>
#include <ostream>
#include <string>
#include <type_traits>
#include <vector>

#include <gtest/gtest.h>

namespace {

using Fake::Path;

static_assert(std::is_same_v<decltype(Tavro::isObjPathsEqual),
                             bool(const CMPIObjectPath*, const CMPIObjectPath*, bool)>);

/// Asks both ways round, which must not matter.
bool areEqual(const CMPIObjectPath* a, const CMPIObjectPath* b, bool deep)
{
    const bool answer = Tavro::isObjPathsEqual(a, b, deep);
    EXPECT_EQ(Tavro::isObjPathsEqual(b, a, deep), answer);
    return answer;
}

bool areEqual(const Path& a, const Path& b, bool deep = false)
{
    return areEqual(&a.object, &b.object, deep);
}

template <class Member, class Number>
CMPIValue valueOf(Member CMPIValue::*member, Number number)
{
    CMPIValue value{};
    value.*member = static_cast<Member>(number);
    return value;
}

// Paths as a whole.

TEST(ObjectPaths, withTheSameClassAndKeysAreEqual)
{
    Path a("TAVRO_Glimmark");
    a.add("DeviceID", "x").add("SystemName", "host");
    Path b("TAVRO_Glimmark");
    b.add("DeviceID", "x").add("SystemName", "host");
    EXPECT_TRUE(areEqual(a, b));
    EXPECT_TRUE(areEqual(a, a));
}

TEST(ObjectPaths, ofAClassAreEqual)
{
    EXPECT_TRUE(areEqual(Path("TAVRO_Glimmark"), Path("TAVRO_Glimmark")));
}

TEST(ObjectPaths, ofOtherClassesDiffer)
{
    EXPECT_FALSE(areEqual(Path("TAVRO_Glimmark"), Path("TAVRO_Glimmarks")));
    EXPECT_FALSE(areEqual(Path("TAVRO_Glimmark"), Path("")));
}

TEST(ObjectPaths, areEqualWhateverTheLetterCaseOfNames)
{
    Path a("TAVRO_Glimmark");
    a.add("DeviceID", "x").add("systemName", "y");
    Path b("tavro_GLIMMARK");
    b.add("DEVICEid", "x").add("SystemName", "y");
    EXPECT_TRUE(areEqual(a, b));
}

TEST(ObjectPaths, withValuesOfAnotherLetterCaseDiffer)
{
    Path a("C");
    a.add("K", "x");
    Path b("C");
    b.add("K", "X");
    EXPECT_FALSE(areEqual(a, b));
}

TEST(ObjectPaths, areEqualWhateverTheOrderOfKeys)
{
    Path a("C");
    a.add("a", "1").add("B", "2").add("c", "3");
    Path b("C");
    b.add("C", "3").add("A", "1").add("b", "2");
    EXPECT_TRUE(areEqual(a, b));
}

TEST(ObjectPaths, withOtherKeysDiffer)
{
    Path base("C");
    base.add("a", "1").add("b", "2");
    Path missing("C");
    missing.add("a", "1");
    Path renamed("C");
    renamed.add("a", "1").add("c", "2");
    Path additional("C");
    additional.add("a", "1").add("b", "2").add("c", "3");
    Path swapped("C");
    swapped.add("a", "2").add("b", "1");
    Path doubled("C");
    doubled.add("a", "1").add("a", "1");
    for (const Path* const other : {&missing, &renamed, &additional, &swapped, &doubled})
        EXPECT_FALSE(areEqual(base, *other));
}

// Values.

struct Value
{
    std::string label;
    CMPIType type = CMPI_null;
    CMPIValue value{};
};

std::ostream& operator<<(std::ostream& stream, const Value& value)
{
    return stream << value.label;
}

bool areValuesEqual(const Value& a, const Value& b)
{
    Path left("C");
    left.add("K", a.type, a.value);
    Path right("C");
    right.add("K", b.type, b.value);
    return areEqual(left, right);
}

/// The number seven in every integer type.
std::vector<Value> sevens()
{
    return {
        {"uint8", CMPI_uint8, valueOf(&CMPIValue::uint8, 7)},
        {"uint16", CMPI_uint16, valueOf(&CMPIValue::uint16, 7)},
        {"uint32", CMPI_uint32, valueOf(&CMPIValue::uint32, 7)},
        {"uint64", CMPI_uint64, valueOf(&CMPIValue::uint64, 7)},
        {"sint8", CMPI_sint8, valueOf(&CMPIValue::sint8, 7)},
        {"sint16", CMPI_sint16, valueOf(&CMPIValue::sint16, 7)},
        {"sint32", CMPI_sint32, valueOf(&CMPIValue::sint32, 7)},
        {"sint64", CMPI_sint64, valueOf(&CMPIValue::sint64, 7)},
    };
}

/// Minus one in every signed integer type.
std::vector<Value> minusOnes()
{
    return {
        {"-sint8", CMPI_sint8, valueOf(&CMPIValue::sint8, -1)},
        {"-sint16", CMPI_sint16, valueOf(&CMPIValue::sint16, -1)},
        {"-sint32", CMPI_sint32, valueOf(&CMPIValue::sint32, -1)},
        {"-sint64", CMPI_sint64, valueOf(&CMPIValue::sint64, -1)},
    };
}

TEST(ObjectPathValues, integersAreComparedAsNumbersWhateverTheirWidth)
{
    for (const Value& a : sevens())
        for (const Value& b : sevens())
            EXPECT_TRUE(areValuesEqual(a, b)) << a << ' ' << b;
    for (const Value& a : minusOnes())
        for (const Value& b : minusOnes())
            EXPECT_TRUE(areValuesEqual(a, b)) << a << ' ' << b;
}

TEST(ObjectPathValues, otherIntegersDiffer)
{
    for (const Value& seven : sevens()) {
        EXPECT_FALSE(areValuesEqual(seven, {"eight", CMPI_uint64, valueOf(&CMPIValue::uint64, 8)})) << seven;
        for (const Value& minusOne : minusOnes())
            EXPECT_FALSE(areValuesEqual(seven, minusOne)) << seven << ' ' << minusOne;
    }
}

TEST(ObjectPathValues, negativeIntegersDifferFromLargeOnesWithTheSameBits)
{
    const std::vector<Value> largest = {
        {"uint8", CMPI_uint8, valueOf(&CMPIValue::uint8, std::numeric_limits<CMPIUint8>::max())},
        {"uint16", CMPI_uint16, valueOf(&CMPIValue::uint16, std::numeric_limits<CMPIUint16>::max())},
        {"uint32", CMPI_uint32, valueOf(&CMPIValue::uint32, std::numeric_limits<CMPIUint32>::max())},
        {"uint64", CMPI_uint64, valueOf(&CMPIValue::uint64, std::numeric_limits<CMPIUint64>::max())},
    };
    for (const Value& large : largest)
        for (const Value& minusOne : minusOnes())
            EXPECT_FALSE(areValuesEqual(large, minusOne)) << large << ' ' << minusOne;
}

TEST(ObjectPathValues, eachTypeIsReadFromItsOwnMember)
{
    // Bits beyond the type's width are what happened to be there.
    for (Value seven : sevens()) {
        CMPIValue value{};
        value.uint64 = std::numeric_limits<CMPIUint64>::max();
        const Value noisy = [&] {
            switch (seven.type) {
            case CMPI_uint8:
                value.uint8 = 7;
                break;
            case CMPI_uint16:
                value.uint16 = 7;
                break;
            case CMPI_uint32:
                value.uint32 = 7;
                break;
            case CMPI_uint64:
                value.uint64 = 7;
                break;
            case CMPI_sint8:
                value.sint8 = 7;
                break;
            case CMPI_sint16:
                value.sint16 = 7;
                break;
            case CMPI_sint32:
                value.sint32 = 7;
                break;
            default:
                value.sint64 = 7;
                break;
            }
            return Value{seven.label, seven.type, value};
        }();
        EXPECT_TRUE(areValuesEqual(seven, noisy)) << seven;
    }
}

TEST(ObjectPathValues, nothingButItsOwnMemberTellsAFlagACharacterOrAReal)
{
    const auto noisy = [](auto member, auto number) {
        CMPIValue value = valueOf(&CMPIValue::uint64, std::numeric_limits<CMPIUint64>::max());
        value.*member = number;
        return value;
    };
    EXPECT_TRUE(areValuesEqual({"noisy", CMPI_boolean, noisy(&CMPIValue::boolean, CMPIBoolean{0})},
                               {"false", CMPI_boolean, valueOf(&CMPIValue::boolean, 0)}));
    EXPECT_TRUE(areValuesEqual({"noisy", CMPI_char16, noisy(&CMPIValue::char16, CMPIChar16{0x98A8})},
                               {"char16", CMPI_char16, valueOf(&CMPIValue::char16, 0x98A8)}));
    EXPECT_TRUE(areValuesEqual({"noisy", CMPI_real32, noisy(&CMPIValue::real32, 0.5F)},
                               {"real64", CMPI_real64, valueOf(&CMPIValue::real64, 0.5)}));
}

TEST(ObjectPathValues, booleansAreComparedAsTrueOrFalse)
{
    const Value no{"false", CMPI_boolean, valueOf(&CMPIValue::boolean, 0)};
    const Value yes{"true", CMPI_boolean, valueOf(&CMPIValue::boolean, 1)};
    const Value yesToo{"255", CMPI_boolean, valueOf(&CMPIValue::boolean, 255)};
    EXPECT_TRUE(areValuesEqual(no, no));
    EXPECT_TRUE(areValuesEqual(yes, yesToo));
    EXPECT_FALSE(areValuesEqual(yes, no));
}

TEST(ObjectPathValues, charactersAndRealsAreComparedByValue)
{
    const Value a{"char16", CMPI_char16, valueOf(&CMPIValue::char16, 97)};
    const Value b{"char16", CMPI_char16, valueOf(&CMPIValue::char16, 98)};
    EXPECT_TRUE(areValuesEqual(a, a));
    EXPECT_FALSE(areValuesEqual(a, b));
    const Value half{"real32", CMPI_real32, valueOf(&CMPIValue::real32, 0.5)};
    const Value halfToo{"real64", CMPI_real64, valueOf(&CMPIValue::real64, 0.5)};
    const Value third{"real64", CMPI_real64, valueOf(&CMPIValue::real64, 1.0 / 3.0)};
    const Value none{"real64", CMPI_real64, valueOf(&CMPIValue::real64, std::nan(""))};
    EXPECT_TRUE(areValuesEqual(half, halfToo));
    EXPECT_FALSE(areValuesEqual(half, third));
    EXPECT_FALSE(areValuesEqual(none, none));
}

TEST(ObjectPathValues, textsAreComparedWhicheverWayTheyAreCarried)
{
    Fake::String string("text");
    Fake::DateTime dateTime("text");
    std::string characters = "text";
    const std::vector<Value> texts = {
        {"string", CMPI_string, valueOf(&CMPIValue::string, &string.object)},
        {"chars", CMPI_chars, valueOf(&CMPIValue::chars, characters.data())},
        {"dateTime", CMPI_dateTime, valueOf(&CMPIValue::dateTime, &dateTime.object)},
    };
    Fake::String otherString("other");
    const Value other{"other", CMPI_string, valueOf(&CMPIValue::string, &otherString.object)};
    for (const Value& a : texts) {
        for (const Value& b : texts)
            EXPECT_TRUE(areValuesEqual(a, b)) << a << ' ' << b;
        EXPECT_FALSE(areValuesEqual(a, other)) << a;
    }
}

TEST(ObjectPathValues, valuesOfUnlikeTypesDiffer)
{
    Fake::String string("1");
    Path reference("C");
    const std::vector<Value> ones = {
        {"boolean", CMPI_boolean, valueOf(&CMPIValue::boolean, 1)},
        {"char16", CMPI_char16, valueOf(&CMPIValue::char16, 1)},
        {"uint16", CMPI_uint16, valueOf(&CMPIValue::uint16, 1)},
        {"real64", CMPI_real64, valueOf(&CMPIValue::real64, 1)},
        {"string", CMPI_string, valueOf(&CMPIValue::string, &string.object)},
        {"ref", CMPI_ref, valueOf(&CMPIValue::ref, &reference.object)},
    };
    for (const Value& a : ones)
        for (const Value& b : ones)
            EXPECT_EQ(areValuesEqual(a, b), a.label == b.label) << a << ' ' << b;
}

TEST(ObjectPathValues, whatCannotBeAKeyEqualsNothing)
{
    for (const int type : {CMPI_null, CMPI_instance, CMPI_args, CMPI_class, CMPI_filter, CMPI_enumeration,
                           CMPI_ptr, CMPI_uint16A, CMPI_stringA, CMPI_refA, 0xFFFF}) {
        const Value value{"", static_cast<CMPIType>(type), {}};
        EXPECT_FALSE(areValuesEqual(value, value)) << type;
    }
}

TEST(ObjectPathValues, nullsEqualNullsOnly)
{
    const auto pathWith = [](Path& path, CMPIType type, CMPIValueState state) -> Path& {
        return path.add("K", type, {}, state);
    };
    Path nullText("C");
    pathWith(nullText, CMPI_string, CMPI_nullValue | CMPI_keyValue);
    Path nullReference("C");
    pathWith(nullReference, CMPI_ref, CMPI_nullValue);
    Path zero("C");
    pathWith(zero, CMPI_uint16, CMPI_goodValue);
    Path emptyText("C");
    emptyText.add("K", "");
    Path reference("C");
    Path withReference("C");
    withReference.add("K", reference);
    EXPECT_TRUE(areEqual(nullText, nullText));
    EXPECT_TRUE(areEqual(nullText, nullReference));
    for (const Path* const other : {&zero, &emptyText, &withReference}) {
        EXPECT_FALSE(areEqual(nullText, *other));
        EXPECT_FALSE(areEqual(nullReference, *other));
    }
}

TEST(ObjectPathValues, whatTheBrokerMarksAsBadOrMissingEqualsNothing)
{
    for (const int state : {CMPI_notFound, CMPI_badValue, CMPI_badValue | CMPI_nullValue}) {
        Path path("C");
        path.add("K", CMPI_uint16, valueOf(&CMPIValue::uint16, 1), static_cast<CMPIValueState>(state));
        EXPECT_FALSE(areEqual(path, path)) << state;
    }
}

// References.

TEST(ObjectPathReferences, areEqualIfTheirClassesAndKeysAre)
{
    Path left("Device");
    left.add("ID", "x").add("Name", "y");
    Path right("DEVICE");
    right.add("name", "y").add("id", "x");
    Path a("Association");
    a.add("Part", left);
    Path b("Association");
    b.add("Part", right);
    for (const bool deep : {true, false})
        EXPECT_TRUE(areEqual(a, b, deep)) << deep;
}

TEST(ObjectPathReferences, toOtherObjectsDiffer)
{
    Path base("Device");
    base.add("ID", "x");
    Path otherClass("Devices");
    otherClass.add("ID", "x");
    Path otherKey("Device");
    otherKey.add("Name", "x");
    Path otherValue("Device");
    otherValue.add("ID", "y");
    Path noKeys("Device");
    Path a("Association");
    a.add("Part", base);
    for (Path* const other : {&otherClass, &otherKey, &otherValue, &noKeys}) {
        Path b("Association");
        b.add("Part", *other);
        for (const bool deep : {true, false})
            EXPECT_FALSE(areEqual(a, b, deep)) << deep;
    }
}

/// Whether associations with references to paths with these keys are equal.
bool areReferencesEqual(const Value& a, const Value& b, bool deep)
{
    Path left("Device");
    left.add("K", a.type, a.value);
    Path right("Device");
    right.add("K", b.type, b.value);
    Path leftAssociation("Association");
    leftAssociation.add("Part", left);
    Path rightAssociation("Association");
    rightAssociation.add("Part", right);
    return areEqual(leftAssociation, rightAssociation, deep);
}

TEST(ObjectPathReferences, areComparedByTypeWhenDeepAndByTextOtherwise)
{
    Fake::String seven("7");
    Fake::String minusOne("-1");
    Fake::String yes("TRUE");
    Fake::String no("FALSE");
    Fake::String half("0.500000");
    const auto text = [](Fake::String& string) {
        return Value{"text", CMPI_string, valueOf(&CMPIValue::string, &string.object)};
    };
    const std::vector<std::pair<Value, Value>> sameTexts = {
        {{"uint16", CMPI_uint16, valueOf(&CMPIValue::uint16, 7)}, text(seven)},
        {{"sint16", CMPI_sint16, valueOf(&CMPIValue::sint16, -1)}, text(minusOne)},
        {{"true", CMPI_boolean, valueOf(&CMPIValue::boolean, 1)}, text(yes)},
        {{"false", CMPI_boolean, valueOf(&CMPIValue::boolean, 0)}, text(no)},
        {{"char16", CMPI_char16, valueOf(&CMPIValue::char16, 7)}, text(seven)},
        {{"real64", CMPI_real64, valueOf(&CMPIValue::real64, 0.5)}, text(half)},
    };
    for (const auto& [a, b] : sameTexts) {
        EXPECT_FALSE(areReferencesEqual(a, b, true)) << a;
        EXPECT_TRUE(areReferencesEqual(a, b, false)) << a;
        EXPECT_FALSE(areValuesEqual(a, b)) << a;
    }
    for (const bool deep : {true, false}) {
        EXPECT_FALSE(areReferencesEqual(text(seven), text(minusOne), deep));
        EXPECT_TRUE(areReferencesEqual(sevens().front(), sevens().back(), deep));
    }
}

TEST(ObjectPathReferences, withNullKeysDifferFromThoseWithEmptyTexts)
{
    Path null("Device");
    null.add("K", CMPI_string, {}, CMPI_nullValue);
    Path empty("Device");
    empty.add("K", "");
    Path a("Association");
    a.add("Part", null);
    Path b("Association");
    b.add("Part", empty);
    for (const bool deep : {true, false}) {
        EXPECT_TRUE(areEqual(a, a, deep));
        EXPECT_FALSE(areEqual(a, b, deep));
    }
}

TEST(ObjectPathReferences, toNothingEqualNothing)
{
    // Without this only the first member of the union need be zero.
    CMPIValue null{};
    null.ref = nullptr;
    Path nullPointer("Association");
    nullPointer.add("Part", CMPI_ref, null);
    Path noHandle("Device");
    noHandle.object.hdl = nullptr;
    Path withoutHandle("Association");
    withoutHandle.add("Part", noHandle);
    for (const bool deep : {true, false}) {
        EXPECT_FALSE(areEqual(nullPointer, nullPointer, deep));
        EXPECT_FALSE(areEqual(withoutHandle, withoutHandle, deep));
    }
}

TEST(ObjectPathReferences, areFollowedEightDeep)
{
    std::list<Path> nested;
    nested.emplace_back("C");
    for (int depth = 0; depth < 8; ++depth) {
        Path& inner = nested.back();
        nested.emplace_back("C").add("R", inner);
    }
    EXPECT_TRUE(areEqual(nested.back(), nested.back(), true));
    EXPECT_TRUE(areEqual(nested.back(), nested.back(), false));
    Path& inner = nested.back();
    nested.emplace_back("C").add("R", inner);
    EXPECT_FALSE(areEqual(nested.back(), nested.back(), true));
    EXPECT_FALSE(areEqual(nested.back(), nested.back(), false));
}

TEST(ObjectPathReferences, toThemselvesComeToAnEnd)
{
    Path path("C");
    path.add("R", path);
    for (const bool deep : {true, false})
        EXPECT_FALSE(areEqual(path, path, deep));
}

// What is not there, and brokers whose calls fail.

TEST(UnreadableObjectPaths, nullPathsEqualNothing)
{
    const Path path("C");
    for (const bool deep : {true, false}) {
        EXPECT_FALSE(areEqual(nullptr, nullptr, deep));
        EXPECT_FALSE(areEqual(&path.object, nullptr, deep));
    }
}

TEST(UnreadableObjectPaths, pathsWithANullHandleEqualNothing)
{
    const Path path("C");
    Path noHandle("C");
    noHandle.object.hdl = nullptr;
    for (const bool deep : {true, false}) {
        EXPECT_FALSE(areEqual(noHandle, noHandle, deep));
        EXPECT_FALSE(areEqual(path, noHandle, deep));
    }
}

void fail(CMPIStatus* status)
{
    status->rc = CMPI_RC_ERR_FAILED;
}

CMPIString* failToNameTheClass(const CMPIObjectPath* path, CMPIStatus* status)
{
    fail(status);
    return &static_cast<Path*>(const_cast<void*>(static_cast<const void*>(path->hdl)))->className.object;
}

CMPICount failToCount(const CMPIObjectPath*, CMPIStatus* status)
{
    fail(status);
    return 0;
}

CMPIData failToGetTheKey(const CMPIObjectPath*, CMPICount, CMPIString**, CMPIStatus* status)
{
    fail(status);
    return {};
}

CMPIData getKeyWithoutName(const CMPIObjectPath*, CMPICount, CMPIString** name, CMPIStatus*)
{
    *name = nullptr;
    CMPIData data{};
    data.type = CMPI_uint16;
    return data;
}

const char* failToGetTheText(const CMPIString*, CMPIStatus* status)
{
    fail(status);
    return "text";
}

CMPIString* failToFormat(const CMPIDateTime* dateTime, CMPIStatus* status)
{
    fail(status);
    return &static_cast<Fake::DateTime*>(const_cast<void*>(static_cast<const void*>(dateTime->hdl)))
                ->text.object;
}

/// What can be wrong with a string of a broker's.
const std::vector<std::pair<const char*, std::function<void(Fake::String&)>>> stringFaults = {
    {"null handle", [](Fake::String& string) { string.object.hdl = nullptr; }},
    {"null table", [](Fake::String& string) { string.object.ft = nullptr; }},
    {"null slot", [](Fake::String& string) { string.functions.getCharPtr = nullptr; }},
    {"failing call", [](Fake::String& string) { string.functions.getCharPtr = failToGetTheText; }},
    {"null text",
     [](Fake::String& string) {
         string.functions.getCharPtr = [](const CMPIString*, CMPIStatus*) -> const char* { return nullptr; };
     }},
};

/// A path that equals itself unless something is wrong with it.
bool equalsItselfWith(const std::function<void(Path&)>& fault)
{
    Fake::DateTime dateTime("20200101000000.000000+000");
    Path path("C");
    path.add("Text", "x").add("Date", CMPI_dateTime, valueOf(&CMPIValue::dateTime, &dateTime.object));
    const auto equalsItself = [&] { return areEqual(path, path, true) && areEqual(path, path, false); };
    EXPECT_TRUE(equalsItself());
    fault(path);
    return equalsItself();
}

TEST(UnreadableObjectPaths, pathsWithoutTheirFunctionsEqualNothing)
{
    EXPECT_FALSE(equalsItselfWith([](Path& path) { path.object.ft = nullptr; }));
    EXPECT_FALSE(equalsItselfWith([](Path& path) { path.functions.getClassName = nullptr; }));
    EXPECT_FALSE(equalsItselfWith([](Path& path) { path.functions.getKeyCount = nullptr; }));
    EXPECT_FALSE(equalsItselfWith([](Path& path) { path.functions.getKeyAt = nullptr; }));
}

TEST(UnreadableObjectPaths, pathsWhoseCallsFailEqualNothing)
{
    EXPECT_FALSE(equalsItselfWith([](Path& path) { path.functions.getClassName = failToNameTheClass; }));
    EXPECT_FALSE(equalsItselfWith([](Path& path) { path.functions.getKeyCount = failToCount; }));
    EXPECT_FALSE(equalsItselfWith([](Path& path) { path.functions.getKeyAt = failToGetTheKey; }));
    EXPECT_FALSE(equalsItselfWith([](Path& path) { path.functions.getKeyAt = getKeyWithoutName; }));
}

TEST(UnreadableObjectPaths, pathsWithUnreadableNamesEqualNothing)
{
    for (const auto& [label, fault] : stringFaults) {
        EXPECT_FALSE(equalsItselfWith([&change = fault](Path& path) { change(path.className); })) << label;
        EXPECT_FALSE(equalsItselfWith([&change = fault](Path& path) { change(path.keys.back().name); }))
            << label;
    }
}

TEST(UnreadableObjectPaths, pathsWithANullClassNameEqualNothing)
{
    EXPECT_FALSE(equalsItselfWith([](Path& path) {
        path.functions.getClassName = [](const CMPIObjectPath*, CMPIStatus*) -> CMPIString* {
            return nullptr;
        };
    }));
}

TEST(UnreadableObjectPaths, pathsWithUnreadableValuesEqualNothing)
{
    for (const auto& [label, fault] : stringFaults) {
        Fake::String string("x");
        EXPECT_FALSE(equalsItselfWith([&string, &change = fault](Path& path) {
            change(string);
            path.keys.back().data.type = CMPI_string;
            path.keys.back().data.value.string = &string.object;
        })) << label;
    }
    for (const int type : {CMPI_string, CMPI_chars, CMPI_dateTime})
        EXPECT_FALSE(equalsItselfWith([type](Path& path) {
            path.keys.back().data.type = static_cast<CMPIType>(type);
            path.keys.back().data.value.string = nullptr;
        })) << type;
}

TEST(UnreadableObjectPaths, pathsWithUnreadableDatesEqualNothing)
{
    const std::vector<std::pair<const char*, std::function<void(Fake::DateTime&)>>> faults = {
        {"null handle", [](Fake::DateTime& dateTime) { dateTime.object.hdl = nullptr; }},
        {"null table", [](Fake::DateTime& dateTime) { dateTime.object.ft = nullptr; }},
        {"null slot", [](Fake::DateTime& dateTime) { dateTime.functions.getStringFormat = nullptr; }},
        {"failing call", [](Fake::DateTime& dateTime) { dateTime.functions.getStringFormat = failToFormat; }},
    };
    for (const auto& [label, fault] : faults) {
        Fake::DateTime dateTime("20200101000000.000000+000");
        fault(dateTime);
        EXPECT_FALSE(equalsItselfWith([&dateTime](Path& path) {
            path.keys.back().data.value.dateTime = &dateTime.object;
        })) << label;
    }
}

TEST(ObjectPathsAndNames, childrenForkedAmongThreadsAskToo)
{
    if (!Testing::childrenMayAllocate)
        GTEST_SKIP() << "the sanitizer's allocator is not made for it";
    constexpr int children = 300;
    const Path path("TAVRO_Class");
    const auto ask = [&path] {
        Tavro::stripSpaces(Tavro::getSystemName());
        Tavro::isObjPathsEqual(&path.object, &path.object, true);
    };
    EXPECT_EQ(Testing::childrenThatReturn(children, ask), children);
}

} // namespace
