/// \file
/// CMPI objects as a broker hands them out, each with function tables of its own, so that a test can
/// break one slot of one object.
#ifndef TAVRO_COMMON_TESTS_FAKEPATH_H
#define TAVRO_COMMON_TESTS_FAKEPATH_H

#include <iterator>
#include <list>
#include <string>
#include <utility>

#include <cmpift.h>

namespace Fake {

class String
{
public:
    explicit String(std::string text) : text_(std::move(text)) {}
    String(const String&) = delete;
    String& operator=(const String&) = delete;

    CMPIStringFT functions{200, nullptr, nullptr, getCharPtr};
    CMPIString object{this, &functions};

private:
    static const char* getCharPtr(const CMPIString* string, CMPIStatus*)
    {
        return static_cast<const String*>(string->hdl)->text_.c_str();
    }

    std::string text_;
};

class DateTime
{
public:
    explicit DateTime(std::string format) : text(std::move(format)) {}
    DateTime(const DateTime&) = delete;
    DateTime& operator=(const DateTime&) = delete;

    String text;
    CMPIDateTimeFT functions = table();
    CMPIDateTime object{this, &functions};

private:
    static CMPIDateTimeFT table()
    {
        CMPIDateTimeFT functions{};
        functions.getStringFormat = [](const CMPIDateTime* dateTime, CMPIStatus*) {
            return &static_cast<DateTime*>(const_cast<void*>(static_cast<const void*>(dateTime->hdl)))
                        ->text.object;
        };
        return functions;
    }
};

/// An object path. What its keys refer to must outlive it.
class Path
{
public:
    explicit Path(std::string name) : className(std::move(name)) {}
    Path(const Path&) = delete;
    Path& operator=(const Path&) = delete;

    Path& add(const std::string& name, CMPIType type, CMPIValue value, CMPIValueState state = CMPI_keyValue)
    {
        CMPIData data{};
        data.type = type;
        data.state = state;
        data.value = value;
        keys.emplace_back(name, data);
        return *this;
    }

    Path& add(const std::string& name, const std::string& text)
    {
        CMPIValue value{};
        value.string = &texts_.emplace_back(text).object;
        return add(name, CMPI_string, value);
    }

    Path& add(const std::string& name, Path& reference)
    {
        CMPIValue value{};
        value.ref = &reference.object;
        return add(name, CMPI_ref, value);
    }

    struct Key
    {
        String name;
        CMPIData data;

        Key(std::string keyName, const CMPIData& keyData) : name(std::move(keyName)), data(keyData) {}
    };

    String className;
    std::list<Key> keys;
    CMPIObjectPathFT functions = table();
    CMPIObjectPath object{this, &functions};

private:
    static Path& of(const CMPIObjectPath* path)
    {
        return *static_cast<Path*>(const_cast<void*>(static_cast<const void*>(path->hdl)));
    }

    static CMPIObjectPathFT table()
    {
        // Every slot that the comparison has no business with stays null.
        CMPIObjectPathFT functions{};
        functions.getClassName = [](const CMPIObjectPath* path, CMPIStatus*) {
            return &of(path).className.object;
        };
        functions.getKeyCount = [](const CMPIObjectPath* path, CMPIStatus*) {
            return static_cast<CMPICount>(of(path).keys.size());
        };
        functions.getKeyAt = [](const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus*) {
            Key& key = *std::next(of(path).keys.begin(), index);
            *name = &key.name.object;
            return key.data;
        };
        return functions;
    }

    std::list<String> texts_;
};

} // namespace Fake

#endif
