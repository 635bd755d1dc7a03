/// \file
/// Calling into a provider.
#ifndef CIMHOST_BROKER_PROVIDERCALL_H
#define CIMHOST_BROKER_PROVIDERCALL_H

#include "broker/Core.h"

#include <exception>
#include <string>

#include <cxxabi.h>

namespace cimhost {

/// Runs a call into a provider. No exception may leave a function of the interface; one that does is
/// reported as misuse and does not get further than this.
/// \param operation  what is called, for the report
/// \param failed  called with a message when an exception came; its result is the call's
template <class Body, class Failed>
auto callProvider(Core& core, const std::string& operation, const Body& body, const Failed& failed)
{
    const auto report = [&](const std::string& what) {
        core.tellMisuse(operation + ": the provider threw " + what);
        return failed("the provider threw " + what);
    };
    try {
        return body();
#ifdef __GLIBCXX__ // elsewhere the end of a thread is nothing to catch
    } catch (const abi::__forced_unwind&) {
        throw; // the thread ends
#endif
    } catch (const std::exception& error) {
        return report(std::string("an exception: ") + error.what());
    } catch (...) {
        return report("something that is not an exception");
    }
}

} // namespace cimhost

#endif
