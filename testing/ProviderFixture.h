/// \file
/// What a test of a provider stands on: a broker that records, an inventory that the test makes, and the
/// lines that the logging library got.
#ifndef TESTING_PROVIDERFIXTURE_H
#define TESTING_PROVIDERFIXTURE_H

#include "testing/MadeInventory.h"
#include "testing/RecordedLog.h"
#include "testing/RecordingBroker.h"

#include "broker/Broker.h"

#include <memory>
#include <optional>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

/// Flow lines, error lines and other texts of the logging library, in a form that is easy to compare.
namespace Logged {

/// A line's text with the line number left out: "[Line: 12]" becomes "[Line]", "Line: 12]" becomes "Line]".
std::string withoutLineNumber(const RecordedLog::Line& line);

/// All lines as "LEVEL CATEGORY TEXT" without line numbers. Each must have been given to the log and then to
/// the trace, alike in every argument, with its file, function and line number in its text and the reserved
/// arguments null, 0 and 0; a line that was not fails the test.
std::vector<std::string> lines();

/// The flow alone, each function's lines as "ENTERING name" and "EXITING name"; an error line as its text.
std::vector<std::string> flow();

/// The flow lines of one function, as lines() gives them.
std::vector<std::string> linesOf(const std::string& function);

/// What the library's parameter list of these labels and values is: pointers as addresses, texts as texts, a
/// null text ends it.
template <class... LabelsAndValues>
std::string parameters(const LabelsAndValues&... labelsAndValues)
{
    std::ostringstream stream;
    const auto insert = [&](const auto& value) {
        using Value = std::decay_t<decltype(value)>;
        if constexpr (std::is_same_v<Value, const char*> || std::is_same_v<Value, char*>) {
            const char* const text = value;
            if (text == nullptr)
                stream.setstate(std::ios_base::badbit);
            else
                stream << text;
        } else if constexpr (std::is_pointer_v<Value>) {
            stream << static_cast<const void*>(value);
        } else {
            stream << value;
        }
    };
    (insert(labelsAndValues), ...);
    return stream.str();
}

/// A flow line of level 3000 as lines() gives it. \param kind  "ENTERING" or "EXITING"
std::string line(const std::string& module, const std::string& kind, const std::string& function,
                 const std::string& parameters);

} // namespace Logged

/// Where the built provider libraries lie, for a host's broker.
std::string providerDirectory();

/// The registration of the stand-in that serves TAVRO_ComputerSystem in root/cimv2.
cimhost::Registration computerSystemRegistration();

/// A test with a broker and one open request.
class ProviderFixture : public ::testing::Test
{
protected:
    /// A broker that serves TAVRO_ComputerSystem in root/cimv2 and root/test from a stand-in.
    ProviderFixture();
    /// The same with the habits of a real broker; null: with none.
    explicit ProviderFixture(const cimhost::Habits* habits);
    /// A broker that serves what a registration names.
    explicit ProviderFixture(cimhost::Registration registration, const cimhost::Habits* habits = nullptr);
    ~ProviderFixture() override;

    /// The computer systems that the broker knows, by their names.
    static void setComputerSystems(const std::vector<std::string>& names);

    /// A path of the request's, without host: a class path or, with keys of text, that of an instance. The
    /// recording calls it "ref".
    CMPIObjectPath* ref(const std::string& className,
                        const std::vector<std::pair<std::string, std::string>>& keys = {},
                        const std::string& nameSpace = "root/test");
    /// The same for keys of any type. A path without a namespace is put into "root/test".
    CMPIObjectPath* ref(cimhost::cim::ObjectPath path);

    /// Ends the open request with all of its objects, and opens another, with nothing recorded so far.
    void newRequest();

    /// What the operation answered. \param status  what it returned
    cimhost::cim::Answer answer(const CMPIStatus& status) const { return request->answer(status); }

    /// The text of a status's message; nothing: there is none.
    static std::optional<std::string> message(const CMPIStatus& status);

    /// The broker's calls and the flow lines, as Logged::flow() gives them, in the order in which they came
    /// about. Both since the last clearRecords().
    std::vector<std::string> timeline() const;
    /// Forgets the calls and the lines so far.
    void clearRecords();

    const CMPIContext* ctx() { return request->context(); }
    const CMPIResult* rslt() { return request->result(); }

    cimhost::Broker host;
    RecordingBroker broker{host, RecordedLog::count};
    std::unique_ptr<cimhost::Request> request;
};

/// The value of a key or property as text: texts as they are, numbers in decimal, flags as true or false,
/// arrays in brackets, references as CLASS.KEY=VALUE,…; "<null>", or "<none>" where there is none of that
/// name.
std::string valueOf(const cimhost::cim::ObjectPath& path, const std::string& key);
std::string valueOf(const cimhost::cim::Instance& instance, const std::string& property);

/// The names of an instance's properties, in order.
std::vector<std::string> namesOf(const cimhost::cim::Instance& instance);

/// The values of one key of several paths.
std::vector<std::string> valuesOf(const cimhost::cim::ObjectPaths& paths, const std::string& key);
std::vector<std::string> valuesOf(const cimhost::cim::Instances& instances, const std::string& property);

/// A property list as a broker hands it over, ended by a null pointer.
class PropertyNames
{
public:
    PropertyNames(std::initializer_list<const char*> names) : list(names) { list.push_back(nullptr); }
    operator const char**() { return list.data(); }

private:
    std::vector<const char*> list;
};

#endif
