/// \file
/// CIM operations over HTTP (DMTF DSP0200): what a request of HTTP has to be, and what is responded.
#ifndef CIMHOST_SERVE_CIMBINDING_H
#define CIMHOST_SERVE_CIMBINDING_H

#include "broker/Broker.h"
#include "serve/Enumerations.h"
#include "serve/Http.h"
#include "serve/Page.h"
#include "serve/PropertyLists.h"
#include "serve/Slots.h"
#include "serve/Xml.h"

#include <chrono>
#include <cstddef>
#include <memory>
#include <optional>
#include <string>

namespace cimhost::serve {

/// What a request may have at most, and what is kept for its answer.
struct RequestLimits
{
    std::size_t bytes = 1048576; ///< of the body
    XmlLimits xml;
    unsigned int atOnce = 8;                  ///< requests that providers are asked for
    std::chrono::milliseconds waiting{60000}; ///< for others to be answered
    std::size_t answers = 536870912; ///< bytes of all answers that their clients have not received yet
};

/// Answers requests by asking a broker. Safe to use from several threads at once.
class CimBinding
{
public:
    /// \param broker    outlives this object
    /// \param hostName  of this machine, for paths that name no host but have to
    /// \param page      what is answered besides CIM; without a text, nothing
    CimBinding(Broker& broker, std::string hostName, const RequestLimits& limits = {}, Page page = {});

    /// The refusal of a request whose body need not be waited for; nothing: read on.
    /// \param request  without its body, with a head that is not refused by itself
    [[nodiscard]] std::optional<HttpResponse> refuse(const HttpRequest& request) const;

    /// The response to a whole request. Never fails: an error has its status. An error of HTTP has a
    /// body of plain text that says what is wrong, one of CIM is an ERROR in the response message.
    [[nodiscard]] HttpResponse answer(const HttpRequest& request) const;

    /// The response to what HTTP alone refuses.
    [[nodiscard]] static HttpResponse refused(const HttpError& error);

    /// The response to a body that turned out longer than the limit.
    [[nodiscard]] HttpResponse tooLarge() const;

    [[nodiscard]] const RequestLimits& limits() const { return limits_; }

private:
    [[nodiscard]] HttpResponse respond(const HttpRequest& request) const;
    /// \throws HttpError  none became free in time
    [[nodiscard]] Slots::Taken takeSlot() const;

    Broker& broker_;
    std::string hostName_;
    RequestLimits limits_;
    Page page_;
    PropertyLists lists_;
    std::shared_ptr<TextBudget> budget_;
    std::unique_ptr<Slots> slots_;
    std::unique_ptr<Enumerations> enumerations_ = std::make_unique<Enumerations>();
};

} // namespace cimhost::serve

#endif
