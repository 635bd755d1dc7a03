/// \file
/// The broker's services and those of its objects. A call on a null object is left out, wherever an operation
/// may come to one.
///
/// `ref` is the path of a request. `rc` is what each call leaves its status in, the last one's remains.
#ifndef TESTS_FAILURES_DESCRIBED_SERVICES_H
#define TESTS_FAILURES_DESCRIBED_SERVICES_H

#include <cstdint>
#include <string>
#include <vector>

#include <cmpift.h>

namespace described {

using Path = CMPIObjectPath;
using Instance = CMPIInstance;
using Result = CMPIResult;
using Status = CMPIStatus;
using Paths = std::vector<Path*>;
using Instances = std::vector<Instance*>;

constexpr Status ok{CMPI_RC_OK, nullptr};

/// The broker of all calls from now on: the one that a provider was made for last.
void setBroker(const CMPIBroker* of);
const CMPIBroker* broker();

/// No object, or one without a handle, which an object can lose at any call.
template <class Object>
bool missing(const Object* object)
{
    return object == nullptr || object->hdl == nullptr;
}

// Reports.

/// A line of the broker's trace.
void tell(CMPILevel level, const char* provider, const std::string& text);

/// A failure: the status becomes CMPI_RC_ERR_FAILED with the message, a warning goes to the broker's trace.
void report(const char* provider, Status& status, const std::string& message, const std::string& traceText);

/// The same where message and trace have one text.
void report(const char* provider, Status& status, const std::string& text);

// Texts and paths.

/// Null for a null string.
const char* characters(const CMPIString* string, Status& rc);

/// Empty where it cannot be read.
std::string className(const Path* path, Status& rc);

/// A path of a class in the namespace of the request.
Path* newPath(const Path* ref, const char* ofClass, Status& rc);

/// The same where the making itself leaves its status nowhere.
Path* newPathUnchecked(const Path* ref, const char* ofClass, Status& rc);

/// Gives a path the namespace of the request; a null path is left alone.
void place(const Path* path, const Path* ref, Status& rc);

/// Gives a path the namespace of the request and the name of the host; a null path is left alone.
void placeOnHost(const Path* path, const Path* ref, Status& rc);

void addKey(const Path* path, const char* name, const std::string& text);
void addKey(const Path* path, const char* name, const Path* value);

// Instances.

/// Null for a null path. \param rc  may be null
Instance* newInstance(const Path* path, Status* rc);

/// The path of an instance; null for a null instance.
Path* pathOf(const Instance* instance, Status& rc);

/// \param keys  of what the filter lets pass besides the properties asked for
void setFilter(const Instance* instance, std::vector<const char*> keys);

void setText(const Instance* instance, const char* name, const std::string& text);
void setNumber(const Instance* instance, const char* name, unsigned int number);
void setFlag(const Instance* instance, const char* name, bool flag);
void setReference(const Instance* instance, const char* name, const Path* path);

/// \return whether the array could be made
bool setNumbers(const Instance* instance, const char* name, const std::vector<std::uint16_t>& numbers,
                Status& rc);

} // namespace described

#endif
