/// \file
/// A request message of CIM-XML, as far as it is understood, and what is found for it.
#ifndef CIMHOST_SERVE_MESSAGE_H
#define CIMHOST_SERVE_MESSAGE_H

#include "broker/OperationRequest.h"
#include "cim/Model.h"
#include "schema/MofReader.h"

#include <cstdint>
#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace cimhost::serve {

// The statuses of DMTF DSP0200 that CMPI has no name for.
constexpr auto invalidEnumerationContext = static_cast<CMPIrc>(21);
constexpr auto invalidOperationTimeout = static_cast<CMPIrc>(22);
constexpr auto filteredEnumerationNotSupported = static_cast<CMPIrc>(25);
constexpr auto continuationOnErrorNotSupported = static_cast<CMPIrc>(26);
constexpr auto serverLimitsExceeded = static_cast<CMPIrc>(27);

/// Who answers a question, and how.
enum class Step
{
    ask, ///< the provider, at once
    // The provider, in pieces.
    open,
    pull,
    close,
    count,
    // The declarations of classes.
    getClass,
    enumerateClasses,
    enumerateClassNames,
};

/// What an enumeration consists of.
enum class Items
{
    instancesWithPaths,
    paths,
    instances, ///< of queries, which are not opened
};

/// What an operation has no use for is left as it is here.
struct Question
{
    Step step = Step::ask;
    /// What a provider is asked. Of the other questions the class, the namespace and the properties.
    OperationRequest request{};
    // Nothing: the default that the operation has.
    std::optional<bool> localOnly{};
    std::optional<bool> deepInheritance{};
    std::optional<bool> includeQualifiers{};
    std::optional<bool> includeClassOrigin{};
    // Of enumerations in pieces.
    Items items = Items::instancesWithPaths;
    std::string context{};
    std::uint32_t mostItems = 0;
    std::optional<std::uint32_t> timeout{}; ///< in seconds
};

struct RequestMessage
{
    std::string id;              ///< the client's own; the response bears the same
    std::string protocolVersion; ///< such as "1.0"
    std::string method;          ///< as the client wrote it
    bool isIntrinsic = true;     ///< one of CIM's own operations; otherwise a method of a class
    std::string nameSpace;       ///< such as root/cimv2
    /// What is asked, or what is wrong with the question.
    std::variant<Question, cim::Status> content;
};

/// What is found for a question.
struct Reply
{
    cim::Answer answer{};
    std::vector<schema::Class>
        classes{}; ///< with all that is to be told of them; for names their names alone
    // Of enumerations in pieces.
    std::string context{}; ///< empty: the answer is the last piece
    std::uint64_t count = 0;
};

} // namespace cimhost::serve

#endif
