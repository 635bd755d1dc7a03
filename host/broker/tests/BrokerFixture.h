/// \file
/// A broker with everything that it tells, and short forms of what the tests do over and over.
#ifndef CIMHOST_BROKER_TESTS_BROKERFIXTURE_H
#define CIMHOST_BROKER_TESTS_BROKERFIXTURE_H

#include "broker/Broker.h"
#include "cim/Values.h"

#include <mutex>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

/// Equal to a code is a status with that code and no message. In the status's own namespace, where the
/// test macros look for it.
inline bool operator==(const CMPIStatus& status, CMPIrc code)
{
    return status.rc == code && status.msg == nullptr;
}

namespace cimhost {

constexpr const char* testNameSpace = "root/test";

/// A registration of one class TEST_NAME for each provider NAME of the sample library, all in root/test.
inline Registration sampleRegistration(const std::vector<std::string>& names)
{
    Registration registration;
    for (const std::string& name : names)
        registration.classes.push_back({"TEST_" + name, name, "CimhostSample", true, false, {testNameSpace}});
    return registration;
}

inline cim::ObjectPath classPath(const std::string& className)
{
    return {"", testNameSpace, className, {}};
}

inline cim::ObjectPath thingPath(const std::string& name)
{
    return {"", testNameSpace, "TEST_Thing", {{"Name", cim::textValue(name)}}};
}

/// A text as CMPI_chars are passed.
inline const CMPIValue* chars(const char* text)
{
    return reinterpret_cast<const CMPIValue*>(text);
}

/// A status that no call leaves as it is.
inline CMPIStatus untouched()
{
    static CMPIString nobody{};
    return {static_cast<CMPIrc>(99), &nobody};
}

class BrokerFixture : public testing::Test
{
protected:
    explicit BrokerFixture(Registration registration = {},
                           std::vector<std::string> directories = {SAMPLE_DIRECTORY},
                           const Habits* habits = nullptr, schema::Classes classes = {})
        : broker_(std::move(registration), std::move(directories), listeners(), habits, std::move(classes))
    {}

    [[nodiscard]] const CMPIBroker* mb() const { return broker_.cmpiBroker(); }

    CMPIObjectPath* newPath(const char* className = "TEST_Thing", const char* nameSpace = testNameSpace)
    {
        return mb()->eft->newObjectPath(mb(), nameSpace, className, nullptr);
    }
    CMPIString* newString(const char* text) { return mb()->eft->newString(mb(), text, nullptr); }

    static std::string textOf(const CMPIString* string) { return read(string).value_or("(no string)"); }

    /// Fails unless every call since the last time kept to the interface.
    void expectNoMisuse() const { EXPECT_THAT(misuses_, testing::IsEmpty()); }
    /// Fails unless there was that one misuse since the last time.
    void expectMisuse(const std::string& line)
    {
        EXPECT_THAT(misuses_, testing::ElementsAre(line));
        misuses_.clear();
    }

    std::vector<std::string> traces_;
    std::vector<std::string> logs_;
    std::vector<std::string> misuses_;
    Broker broker_;

private:
    Listeners listeners()
    {
        return {[this](const TraceRecord& record) {
                    traces_.push_back(std::to_string(record.level) + " " + record.component + ": " +
                                      record.text);
                },
                [this](const LogRecord& record) {
                    logs_.push_back(std::to_string(record.severity) + " " + record.id + ": " + record.text);
                },
                [this](const std::string& line) { misuses_.push_back(line); }};
    }
};

/// A fixture whose tests run inside a request.
class RequestFixture : public BrokerFixture
{
protected:
    Request request_{broker_};
    CMPIStatus rc_ = untouched();

    /// The code that the last call wrote; fails when it wrote none, or a message.
    CMPIrc code()
    {
        EXPECT_EQ(rc_.msg, nullptr);
        const CMPIrc written = rc_.rc;
        rc_ = untouched();
        return written;
    }
};

} // namespace cimhost

#endif
