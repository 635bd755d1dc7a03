/// \file
/// What the providers of the sample library have in common.
#ifndef CIMHOST_TESTING_PROVIDERPARTS_H
#define CIMHOST_TESTING_PROVIDERPARTS_H

#include <string>

#include <cmpift.h>

namespace sample {

constexpr CMPIStatus ok{CMPI_RC_OK, nullptr};

/// The broker that loaded the library; every factory function sets it.
extern const CMPIBroker* broker;

CMPIStatus failure(CMPIrc code, const char* message);

/// Text goes to a broker as the character pointer itself, in the place of the value's.
const CMPIValue* chars(const char* text);

/// Empty also for null.
std::string textOf(const CMPIString* string);

/// A path in the namespace of the request's.
CMPIObjectPath* newPath(const CMPIObjectPath* request, const char* className);

/// Tells the tests what a call came with: a trace of the component "Sample".
void say(const std::string& text, CMPILevel level = CMPI_LEV_INFO);

/// A table whose operations all answer CMPI_RC_ERR_NOT_SUPPORTED; a provider replaces those that it has.
CMPIInstanceMIFT notSupported(const char* name);

} // namespace sample

#endif
