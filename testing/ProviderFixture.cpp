#include "testing/ProviderFixture.h"

#include <cstdlib>
#include <strings.h>
#include <utility>

namespace cim = cimhost::cim;

namespace Logged {

namespace {

/// Replaces the one "Line: NUMBER]" of a text by "Line]".
std::string withoutNumber(std::string text, int number)
{
    const std::string numbered = "Line: " + std::to_string(number) + "]";
    const auto position = text.find(numbered);
    EXPECT_NE(position, std::string::npos) << "no " << numbered << " in " << text;
    if (position != std::string::npos)
        text.replace(position, numbered.size(), "Line]");
    return text;
}

void expectPair(const RecordedLog::Line& log, const RecordedLog::Line& trace)
{
    EXPECT_EQ(log.channel, RecordedLog::Channel::log) << log.text;
    EXPECT_EQ(trace.channel, RecordedLog::Channel::trace) << log.text;
    EXPECT_EQ(log.text, trace.text);
    EXPECT_EQ(log.function, trace.function);
    EXPECT_EQ(log.file, trace.file);
    EXPECT_EQ(log.line, trace.line);
    EXPECT_EQ(log.category, trace.category);
    EXPECT_EQ(log.level, trace.level);
    EXPECT_NE(log.text.find(log.file), std::string::npos) << log.text;
    EXPECT_EQ("Mavrel." + log.file, log.category + ".cpp");
    for (const RecordedLog::Line& line : {log, trace}) {
        EXPECT_TRUE(line.reservedIsNull);
        EXPECT_EQ(line.first, 0);
        EXPECT_EQ(line.second, 0);
    }
}

/// One of each pair.
std::vector<RecordedLog::Line> pairs()
{
    const std::vector<RecordedLog::Line> all = RecordedLog::lines();
    EXPECT_EQ(all.size() % 2, 0U);
    std::vector<RecordedLog::Line> firsts;
    for (std::size_t i = 0; i + 1 < all.size(); i += 2) {
        expectPair(all[i], all[i + 1]);
        firsts.push_back(all[i]);
    }
    return firsts;
}

std::string asText(const RecordedLog::Line& line)
{
    return std::to_string(line.level) + " " + line.category + " " + withoutLineNumber(line);
}

bool beginsWith(const std::string& text, const std::string& beginning)
{
    return text.compare(0, beginning.size(), beginning) == 0;
}

} // namespace

std::string withoutLineNumber(const RecordedLog::Line& line)
{
    return withoutNumber(line.text, line.line);
}

std::vector<std::string> lines()
{
    std::vector<std::string> texts;
    for (const RecordedLog::Line& line : pairs())
        texts.push_back(asText(line));
    return texts;
}

std::vector<std::string> flow()
{
    std::vector<std::string> texts;
    for (const RecordedLog::Line& line : pairs()) {
        if (beginsWith(line.text, "ENTERING: " + line.function + "()"))
            texts.push_back("ENTERING " + line.function);
        else if (beginsWith(line.text, "EXITING: " + line.function + "()"))
            texts.push_back("EXITING " + line.function);
        else
            texts.push_back(asText(line));
    }
    return texts;
}

std::vector<std::string> linesOf(const std::string& function)
{
    std::vector<std::string> texts;
    for (const RecordedLog::Line& line : pairs()) {
        if (line.function == function)
            texts.push_back(asText(line));
    }
    return texts;
}

std::string line(const std::string& module, const std::string& kind, const std::string& function,
                 const std::string& parameters)
{
    const std::string text =
        kind + ": " + function + "() in " + module + ".cpp [Line],Parameters List: " + parameters;
    return "3000 Mavrel." + module + " " + text;
}

} // namespace Logged

namespace {

cimhost::Registration computerSystemOnly()
{
    auto registration = computerSystemRegistration();
    // One besides the usual, so that a test sees where a namespace comes from.
    registration.classes.at(0).nameSpaces.emplace_back("root/test");
    return registration;
}

std::string textOf(const cim::Value& value);

std::string textOf(const cim::ObjectPath& path)
{
    std::string text = path.nameSpace + ":" + path.className;
    char separator = '.';
    for (const cim::Key& key : path.keys) {
        text += separator + key.name + "=" + textOf(key.value);
        separator = ',';
    }
    return text;
}

struct ScalarText
{
    std::string operator()(std::monostate) const { return "<null>"; }
    std::string operator()(bool flag) const { return flag ? "true" : "false"; }
    std::string operator()(const std::string& text) const { return text; }
    std::string operator()(const std::shared_ptr<const cim::ObjectPath>& path) const
    {
        return path ? textOf(*path) : "<null>";
    }
    std::string operator()(const std::shared_ptr<const cim::Instance>& instance) const
    {
        return instance ? textOf(instance->path) : "<null>";
    }
    template <class Number>
    std::string operator()(Number number) const
    {
        return std::to_string(number);
    }
};

std::string textOf(const cim::Value& value)
{
    if (value.isNull)
        return "<null>";
    if ((value.type & CMPI_ARRAY) == 0)
        return std::visit(ScalarText(), value.items.at(0));
    std::string text;
    for (const cim::Value::Scalar& item : value.items)
        text += (text.empty() ? "" : ", ") + std::visit(ScalarText(), item);
    return "[" + text + "]";
}

template <class Items>
std::string find(const Items& items, const std::string& name)
{
    for (const auto& item : items) {
        if (strcasecmp(item.name.c_str(), name.c_str()) == 0)
            return textOf(item.value);
    }
    return "<none>";
}

cim::Value textValue(const std::string& text)
{
    return {CMPI_string, false, {text}};
}

} // namespace

std::string providerDirectory()
{
    return TEST_PROVIDER_DIRECTORY;
}

cimhost::Registration computerSystemRegistration()
{
    return cimhost::readRegistrationFile(TEST_COMPUTER_SYSTEM_REGISTRATION);
}

ProviderFixture::ProviderFixture() : ProviderFixture(computerSystemOnly()) {}

ProviderFixture::ProviderFixture(const cimhost::Habits* habits)
    : ProviderFixture(computerSystemOnly(), habits)
{}

ProviderFixture::ProviderFixture(cimhost::Registration registration, const cimhost::Habits* habits)
    : host(std::move(registration), {providerDirectory()}, {}, habits),
      request(std::make_unique<cimhost::Request>(host))
{
    setComputerSystems({"alpha"});
    MadeInventory::set({});
    broker.name(request->context(), "ctx");
    RecordedLog::clear();
}

void ProviderFixture::newRequest()
{
    request.reset(); // requests nest: the old one ends before the new one begins
    request = std::make_unique<cimhost::Request>(host);
    broker.forget();
    RecordedLog::clear();
    broker.name(request->context(), "ctx");
}

ProviderFixture::~ProviderFixture()
{
    request.reset();
    EXPECT_EQ(MadeInventory::openCursors(), 0) << "a cursor was left open";
}

void ProviderFixture::setComputerSystems(const std::vector<std::string>& names)
{
    std::string list;
    for (const std::string& name : names)
        list += (list.empty() ? "" : ",") + name;
    ::setenv("TAVRO_COMPUTER_SYSTEMS", list.c_str(), 1);
}

CMPIObjectPath* ProviderFixture::ref(const std::string& className,
                                     const std::vector<std::pair<std::string, std::string>>& keys,
                                     const std::string& nameSpace)
{
    cim::ObjectPath path{"", nameSpace, className, {}};
    for (const auto& [name, value] : keys)
        path.keys.push_back({name, textValue(value)});
    return ref(path);
}

CMPIObjectPath* ProviderFixture::ref(cim::ObjectPath path)
{
    if (path.nameSpace.empty())
        path.nameSpace = "root/test";
    CMPIObjectPath* const handle = request->path(path);
    broker.name(handle, "ref");
    return handle;
}

std::optional<std::string> ProviderFixture::message(const CMPIStatus& status)
{
    return cimhost::read(status.msg);
}

std::vector<std::string> ProviderFixture::timeline() const
{
    const std::vector<std::string> flow = Logged::flow();
    const std::vector<std::string> calls = broker.calls();
    const std::vector<std::size_t> linesBefore = broker.othersBeforeCalls();
    std::vector<std::string> all;
    std::size_t line = 0;
    for (std::size_t call = 0; call < calls.size(); ++call) {
        // Each flow line stands for two: one in the log, one in the trace.
        for (; line < linesBefore[call] / 2; ++line)
            all.push_back(flow.at(line));
        all.push_back(calls[call]);
    }
    for (; line < flow.size(); ++line)
        all.push_back(flow[line]);
    return all;
}

void ProviderFixture::clearRecords()
{
    broker.clear();
    RecordedLog::clear();
}

std::string valueOf(const cim::ObjectPath& path, const std::string& key)
{
    return find(path.keys, key);
}

std::string valueOf(const cim::Instance& instance, const std::string& property)
{
    return find(instance.properties, property);
}

std::vector<std::string> namesOf(const cim::Instance& instance)
{
    std::vector<std::string> names;
    for (const cim::Property& property : instance.properties)
        names.push_back(property.name);
    return names;
}

std::vector<std::string> valuesOf(const cim::ObjectPaths& paths, const std::string& key)
{
    std::vector<std::string> values;
    values.reserve(paths.size());
    for (const cim::ObjectPath& path : paths)
        values.push_back(valueOf(path, key));
    return values;
}

std::vector<std::string> valuesOf(const cim::Instances& instances, const std::string& property)
{
    std::vector<std::string> values;
    values.reserve(instances.size());
    for (const cim::Instance& instance : instances)
        values.push_back(valueOf(instance, property));
    return values;
}
