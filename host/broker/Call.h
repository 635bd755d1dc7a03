/// \file
/// One call of a service by a provider: its arguments are resolved, misuse is reported, its status is
/// written. A service reads as
///
///     return serve("CMPIStringFT.getCharPtr", rc, nothing, [&](Call& call) {
///         return call.use<StringObject>(str, "the string").text.c_str();
///     });
#ifndef CIMHOST_BROKER_CALL_H
#define CIMHOST_BROKER_CALL_H

#include "broker/Core.h"
#include "broker/Objects.h"
#include "broker/Scope.h"

#include <exception>
#include <string>
#include <utility>
#include <vector>

namespace cimhost {

/// Leaves a service at once with a status code.
struct Refusal
{
    CMPIrc code;
};

class Call
{
public:
    /// \param service  a literal: table and slot
    explicit Call(const char* service) : service_(service) {}
    Call(const Call&) = delete;
    Call& operator=(const Call&) = delete;

    /// The broker that the call is made to.
    /// \throws Refusal  and reports when there is none
    Core& broker(const CMPIBroker* broker);

    /// The content of an object that the provider passed.
    /// \param role  what it is in this call, for the report
    /// \throws Refusal  and reports when it is null, foreign, dead or of another kind
    template <class Object>
    Object& use(const EnvelopeOf<Object>* object, const char* role)
    {
        return contentOf<Object>(resolve(object, role, Traits<Object>::kind));
    }

    /// The same for an object of any kind.
    Handle& resolve(const void* object, const char* role);
    Handle& resolve(const void* object, const char* role, Kind kind);

    /// A text that must be there.
    /// \throws Refusal  and reports when it is null
    const char* text(const char* text, const char* role);

    /// Reports a misuse.
    /// \throws Refusal  always
    [[noreturn]] void refuse(CMPIrc code, const std::string& why);

    /// Sets the code that the call answers with, without any misuse.
    void answerWith(CMPIrc code) { status_ = {code, nullptr}; }
    /// The same, and leaves the service.
    /// \throws Refusal  always
    [[noreturn]] static void leave(CMPIrc code) { throw Refusal{code}; }
    void answerWith(const CMPIStatus& status) { status_ = status; }
    [[nodiscard]] const CMPIStatus& status() const { return status_; }

    /// The broker of the objects in this call; for services that have resolved one.
    [[nodiscard]] Core& core() const { return *core_; }

    /// A new object for the provider.
    template <class Object, class... Arguments>
    EnvelopeOf<Object>* make(Arguments&&... arguments)
    {
        return cimhost::make<Object>(core(), std::forward<Arguments>(arguments)...);
    }
    CMPIString* makeString(std::string text) { return make<StringObject>(std::move(text)); }

private:
    const char* service_;
    Core* core_ = nullptr;
    CMPIStatus status_{CMPI_RC_OK, nullptr};
};

/// Runs a service that writes its status through `rc`, which may be null.
/// \param otherwise  what it answers with when it could not be served
/// \param body  called with the Call; its Refusal or want of memory becomes the status
template <class Result, class Body>
Result serve(const char* service, CMPIStatus* rc, Result otherwise, const Body& body)
{
    Call call(service);
    const auto writeStatus = [&] {
        if (rc != nullptr)
            *rc = call.status();
    };
    // The result of the body is a variable of its own: assigned to one that holds `otherwise`, the compiler
    // lets the body write into that one, and a body that throws leaves it half written.
    try {
        const Result result = body(call);
        writeStatus();
        return result;
    } catch (const Refusal& refusal) {
        call.answerWith(refusal.code);
    } catch (const std::exception&) {
        call.answerWith(CMPI_RC_ERR_FAILED);
    }
    writeStatus();
    return otherwise;
}

/// Runs a service that answers with its status.
template <class Body>
CMPIStatus perform(const char* service, const Body& body)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    serve(service, &status, false, [&](Call& call) {
        body(call);
        return true;
    });
    return status;
}

/// The names of a list that ends with a null pointer.
std::vector<std::string> takeNames(const char* const* names);

// The services that every kind of object has.

template <class Object>
CMPIStatus releaseObject(const char* service, const EnvelopeOf<Object>* object)
{
    return perform(service, [&](Call& call) {
        end(call.resolve(object, "the object", Traits<Object>::kind), State::released);
    });
}

/// A clone is its caller's: it outlives the request, until it is released or the broker goes.
template <class Object>
EnvelopeOf<Object>* cloneObject(const char* service, const EnvelopeOf<Object>* object, CMPIStatus* rc)
{
    using Envelope = EnvelopeOf<Object>;
    return serve(service, rc, static_cast<Envelope*>(nullptr), [&](Call& call) {
        const Object& original = call.use<Object>(object, "the object");
        return envelopeOf<Object>(makeLasting(call.core(), std::make_unique<Object>(original)));
    });
}

} // namespace cimhost

#endif
