/// \file
/// A thin layer over the host's broker that writes down every call a provider makes and can let single
/// calls fail. It stands in the broker's function tables, so that nothing passes by it.
#ifndef TESTING_RECORDINGBROKER_H
#define TESTING_RECORDINGBROKER_H

#include "broker/Broker.h"

#include <cstddef>
#include <map>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include <cmpift.h>

/// How a call fails.
enum class Failure
{
    nullResult,  ///< a null pointer or a zero; a status argument is left alone
    noHandle,    ///< an object with a null handle
    errorStatus, ///< a null pointer or a zero, and code 1 with the message "injected" in the status argument
    noMessage,   ///< as errorStatus, but the status has no message
    servedError, ///< the call is served, and its status is that of errorStatus all the same
    wrongValue,  ///< getNext: an item that is no reference; hasNext: false
    nullState,   ///< data that is served but says that it is null
    lostHandle   ///< the call is served, but the object it is made on has a null handle from then on
};

/// One at a time may exist. Calls are written as the service's name with its arguments in parentheses:
/// the broker, the object's own table and out-parameters are left out, texts are quoted, objects have
/// the names given by name() or else "path1", "instance1" and so on in the order in which they were made;
/// a status pointer is "rc", a null pointer "null", a value is followed by its type. What other providers
/// call while they answer an up-call is neither written down nor counted.
class RecordingBroker
{
public:
    /// \param countOfOthers  the number of other things that were recorded so far, asked at each call; may be
    /// null
    explicit RecordingBroker(cimhost::Broker& recordedBroker, std::size_t (*countOfOthers)() = nullptr);
    ~RecordingBroker();
    RecordingBroker(const RecordingBroker&) = delete;
    RecordingBroker& operator=(const RecordingBroker&) = delete;

    /// What to call an object of the test's own.
    void name(const void* object, const std::string& name);

    /// Forgets the calls so far, and the names of objects that calls made.
    void clear();

    /// Forgets the test's own objects too, whose request has ended, and the failures still to come.
    void forget();

    std::vector<std::string> calls() const;

    /// For each of calls(), how many other things had been recorded before it.
    std::vector<std::size_t> othersBeforeCalls() const;

    /// Those calls that begin with one of the services' names.
    std::vector<std::string> calls(const std::vector<std::string>& services) const;

    /// The ways in which a call can fail, each with an effect of its own. \param call  one of calls()
    static std::vector<Failure> failuresOf(const std::string& call);

    /// Lets the nth call (from 1, counted from now on) of a service fail; without a name, that of any
    /// service. May be said for several.
    void fail(const std::string& service, int nth, Failure failure);

    // What the layer's functions in the tables use.

    static RecordingBroker* current();
    /// Writes a call down. \return how it is to fail; nothing: it is not
    std::optional<Failure> record(const std::string& service, const std::vector<std::string>& arguments);
    /// The name of an object; a new one of that kind if it has none.
    std::string nameOf(const void* object, const std::string& kind);
    /// The status of a call that fails. \param failure  errorStatus, noMessage or servedError
    CMPIStatus injectedStatus(Failure failure);

private:
    struct Plan
    {
        std::string service;
        int remaining;
        Failure failure;
    };

    cimhost::Broker& broker;
    cimhost::FunctionTables originalTables;
    std::size_t (*othersSoFar)();
    mutable std::mutex mutex;
    std::vector<std::string> recorded;
    std::vector<std::size_t> othersBefore;
    std::map<const void*, std::string> names;
    std::map<const void*, std::string> givenNames;
    std::map<std::string, int> counters;
    std::vector<Plan> plans;
};

#endif
