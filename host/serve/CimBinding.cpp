#include "serve/CimBinding.h"

#include "cim/Utf8.h"
#include "cim/Values.h"
#include "serve/Executor.h"
#include "serve/Fault.h"
#include "serve/RequestReader.h"
#include "serve/ResponseWriter.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <exception>
#include <utility>

namespace cimhost::serve {

namespace {

/// The names under which extensions of HTTP are declared (RFC 2774) for CIM operations.
constexpr std::string_view extensionName = "http://www.dmtf.org/cim/mapping/http/v1.0";

struct FaultEntry
{
    Fault fault;
    unsigned int status;
    const char* cimError; ///< null: DSP0200 has no name for it
};

constexpr std::array faultEntries{
    FaultEntry{Fault::notWellFormed, 400, "request-not-well-formed"},
    FaultEntry{Fault::notValid, 400, "request-not-valid"},
    FaultEntry{Fault::notLooselyValid, 400, "request-not-loosely-valid"},
    FaultEntry{Fault::tooLarge, 413, nullptr},
    FaultEntry{Fault::unsupportedProtocolVersion, 501, "unsupported-protocol-version"},
    FaultEntry{Fault::unsupportedCimVersion, 501, "unsupported-cim-version"},
    FaultEntry{Fault::unsupportedDtdVersion, 501, "unsupported-dtd-version"},
    FaultEntry{Fault::multipleRequests, 501, "multiple-requests-unsupported"},
    FaultEntry{Fault::unsupportedOperation, 501, "unsupported-operation"},
    FaultEntry{Fault::headerMismatch, 400, "header-mismatch"},
};

HttpError httpErrorOf(const RequestError& error)
{
    const auto* const entry =
        std::find_if(faultEntries.begin(), faultEntries.end(),
                     [&](const FaultEntry& candidate) { return candidate.fault == error.fault(); });
    HttpError result{entry->status, error.what(), {}};
    if (entry->cimError != nullptr)
        result.headers.push_back({"CIMError", entry->cimError});
    return result;
}

HttpResponse responseTo(const HttpError& error)
{
    HttpResponse response{error.status, error.headers, Text(error.message + '\n')};
    response.headers.push_back({"Content-Type", "text/plain; charset=utf-8"});
    return response;
}

bool isXml(std::string_view type)
{
    return cim::sameName(type, "application/xml") || cim::sameName(type, "text/xml");
}

/// The request was made by POST, or by M-POST with a declaration of CIM's headers.
/// \return what stands before the names of CIM's headers: nothing, or such as "73-"
std::string checkMethod(const HttpRequest& request)
{
    if (request.method == "POST")
        return "";
    if (request.method != "M-POST")
        throw HttpError{405,
                        "found the method " + cim::excerpt(request.method) + ", expected POST or M-POST",
                        {{"Allow", "POST, M-POST"}}};
    const std::string* const declaration = findHeader(request, "Man");
    if (declaration == nullptr)
        throw HttpError{400, "found M-POST without a header Man, expected one", {}};
    std::string_view name = withoutParameters(*declaration);
    if (name.size() >= 2 && name.front() == '"' && name.back() == '"')
        name = name.substr(1, name.size() - 2);
    const std::string_view prefix = parameterOf(*declaration, "ns");
    if (name != extensionName || prefix.size() != 2 ||
        prefix.find_first_not_of("0123456789") != std::string_view::npos)
        throw HttpError{510, "Man: expected " + std::string(extensionName) + "; ns= and two digits", {}};
    return std::string(prefix) + '-';
}

void checkContent(const HttpRequest& request)
{
    const std::string* const type = findHeader(request, "Content-Type");
    if (type == nullptr || !isXml(withoutParameters(*type)))
        throw HttpError{415, "Content-Type: expected application/xml or text/xml", {}};
    const std::string_view charset = parameterOf(*type, "charset");
    if (!charset.empty() && !cim::sameName(charset, "utf-8"))
        throw HttpError{415, "Content-Type: expected the charset utf-8", {}};
    const std::string* const encoding = findHeader(request, "Content-Encoding");
    if (encoding != nullptr && !cim::sameName(*encoding, "identity"))
        throw HttpError{415, "Content-Encoding: expected none", {}};
}

void checkAccept(const HttpRequest& request)
{
    if (!accepts(request, "Accept", {"application/xml", "text/xml"}))
        throw HttpError{406, "Accept: expected application/xml or text/xml", {}};
    if (!accepts(request, "Accept-Charset", {"utf-8"}))
        throw HttpError{406, "Accept-Charset: expected utf-8", {}};
}

/// A header of CIM's, which may be there once. Null: it is not there.
const std::string* findCimHeader(const HttpRequest& request, const std::string& prefix, const char* name)
{
    const std::string whole = prefix + name;
    const auto isSame = [&](const HeaderField& field) { return cim::sameName(field.name, whole); };
    if (std::count_if(request.headers.begin(), request.headers.end(), isSame) > 1)
        throw RequestError(Fault::headerMismatch, whole + ": found it several times, expected it once");
    return findHeader(request, whole);
}

/// Such a header's value without the escapes of URIs.
std::string requireCimHeader(const HttpRequest& request, const std::string& prefix, const char* name)
{
    const std::string* const value = findCimHeader(request, prefix, name);
    if (value == nullptr)
        throw RequestError(Fault::headerMismatch, "expected the header " + prefix + name);
    std::string decoded;
    for (std::size_t index = 0; index < value->size(); ++index) {
        if ((*value)[index] != '%') {
            decoded += (*value)[index];
            continue;
        }
        const char* const digits = value->data() + index + 1;
        unsigned int byte = 0;
        if (index + 2 >= value->size() || std::from_chars(digits, digits + 2, byte, 16).ptr != digits + 2)
            throw RequestError(Fault::headerMismatch,
                               prefix + name + ": expected two hexadecimal digits behind %");
        decoded += static_cast<char>(byte);
        index += 2;
    }
    return decoded;
}

void checkOperation(const HttpRequest& request, const std::string& prefix)
{
    if (findCimHeader(request, prefix, "CIMExport") != nullptr)
        throw RequestError(Fault::unsupportedOperation, prefix + "CIMExport: exports are not served");
    const std::string* const operation = findCimHeader(request, prefix, "CIMOperation");
    if (operation == nullptr)
        throw HttpError{400, "expected the header " + prefix + "CIMOperation: MethodCall", {}};
    if (!cim::sameName(*operation, "MethodCall"))
        throw RequestError(Fault::unsupportedOperation, prefix + "CIMOperation: found \"" +
                                                            cim::excerpt(*operation) +
                                                            "\", expected MethodCall");
    if (findCimHeader(request, prefix, "CIMBatch") != nullptr)
        throw RequestError(Fault::multipleRequests, prefix + "CIMBatch: expected a single request");
    const std::string* const version = findCimHeader(request, prefix, "CIMProtocolVersion");
    if (version != nullptr && version->substr(0, 2) != "1.")
        throw RequestError(Fault::unsupportedProtocolVersion, prefix + "CIMProtocolVersion: found \"" +
                                                                  cim::excerpt(*version) +
                                                                  "\", expected 1.x");
}

void requireSame(const char* header, const std::string& value, const std::string& inMessage)
{
    if (!cim::sameName(value, inMessage))
        throw RequestError(Fault::headerMismatch, std::string(header) + ": found \"" + cim::excerpt(value) +
                                                      "\", expected \"" + cim::excerpt(inMessage) +
                                                      "\" as in the message");
}

/// Headers and message say the same.
void checkMatch(const HttpRequest& request, const std::string& prefix, const RequestMessage& message)
{
    requireSame("CIMMethod", requireCimHeader(request, prefix, "CIMMethod"), message.method);
    const std::string object = requireCimHeader(request, prefix, "CIMObject");
    if (message.isIntrinsic)
        requireSame("CIMObject", object, message.nameSpace);
    if (const std::string* const version = findCimHeader(request, prefix, "CIMProtocolVersion"))
        requireSame("CIMProtocolVersion", *version, message.protocolVersion);
}

/// The headers of a good response; those of M-POST tell that its demand was met.
std::vector<HeaderField> responseHeaders(const std::string& prefix)
{
    std::vector<HeaderField> headers{{"Content-Type", "application/xml; charset=\"utf-8\""},
                                     {prefix + "CIMOperation", "MethodResponse"}};
    if (!prefix.empty()) {
        headers.push_back({"Ext", ""});
        headers.push_back({"Cache-Control", "no-cache"});
        headers.push_back({"Man", std::string(extensionName) + "; ns=" + prefix.substr(0, 2)});
    }
    return headers;
}

} // namespace

CimBinding::CimBinding(Broker& broker, std::string hostName, const RequestLimits& limits, Page page)
    : broker_(broker),
      hostName_(std::move(hostName)),
      limits_(limits),
      page_(std::move(page)),
      lists_(broker.classes(), broker.registration()),
      budget_(std::make_shared<TextBudget>(limits.answers)),
      slots_(std::make_unique<Slots>(limits.atOnce))
{}

std::optional<HttpResponse> CimBinding::refuse(const HttpRequest& request) const
{
    const std::string* const length = findHeader(request, "Content-Length");
    if (length == nullptr) {
        const bool hasBody = request.method == "POST" || request.method == "M-POST";
        if (hasBody && findHeader(request, "Transfer-Encoding") == nullptr)
            return responseTo({411, "expected the header Content-Length", {}});
        return std::nullopt;
    }
    std::size_t bytes = 0;
    const auto [end, error] = std::from_chars(length->data(), length->data() + length->size(), bytes);
    if (error != std::errc() || bytes > limits_.bytes) // it is a number, if not of 64 bits
        return tooLarge();
    return std::nullopt;
}

HttpResponse CimBinding::refused(const HttpError& error)
{
    return responseTo(error);
}

HttpResponse CimBinding::answer(const HttpRequest& request) const
{
    try {
        return respond(request);
    } catch (const HttpError& error) {
        return responseTo(error);
    } catch (const RequestError& error) {
        return responseTo(httpErrorOf(error));
    } catch (const std::exception& error) {
        return responseTo({500, std::string("the server failed: ") + cim::excerpt(error.what()), {}});
    }
}

HttpResponse CimBinding::tooLarge() const
{
    return responseTo({413, "expected a body of at most " + std::to_string(limits_.bytes) + " bytes", {}});
}

Slots::Taken CimBinding::takeSlot() const
{
    std::optional<Slots::Taken> slot = slots_->take(limits_.waiting);
    if (!slot)
        throw HttpError{503, "too many requests are being answered, try again", {{"Retry-After", "10"}}};
    return std::move(*slot);
}

HttpResponse CimBinding::respond(const HttpRequest& request) const
{
    if (request.method == "GET" && page_.text && request.target == page_.target) {
        const Slots::Taken slot = takeSlot();
        return {200, {{"Content-Type", page_.type}}, Text(page_.text())};
    }
    const std::string prefix = checkMethod(request);
    checkOperation(request, prefix);
    checkContent(request);
    checkAccept(request);
    RequestMessage message = readRequest(request.body, limits_.xml);
    checkMatch(request, prefix, message);
    if (auto* const question = std::get_if<Question>(&message.content))
        lists_.shorten(question->request.properties);
    const Slots::Taken slot = takeSlot();
    Reply reply = execute(message, broker_, *enumerations_);
    return {200, responseHeaders(prefix),
            writeResponse(message, std::move(reply), hostName_, broker_.classes(), budget_)};
}

} // namespace cimhost::serve
