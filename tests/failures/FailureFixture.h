/// \file
/// What the tests of failures share: operations in requests of their own.
#ifndef TESTS_FAILURES_FAILUREFIXTURE_H
#define TESTS_FAILURES_FAILUREFIXTURE_H

#include "testing/Allocations.h"
#include "testing/Operations.h"
#include "testing/ProviderFixture.h"

#include <string>
#include <vector>

class FailureFixture : public ProviderFixture
{
protected:
    FailureFixture() = default;
    /// With the habits of a real broker; null: with none.
    explicit FailureFixture(const cimhost::Habits* habits) : ProviderFixture(habits) {}

    /// Runs an operation in the open request.
    CMPIStatus run(const Operation& operation) { return run(operation, host.cmpiBroker()); }

    /// The same with another broker to serve the provider.
    CMPIStatus run(const Operation& operation, const CMPIBroker* servingBroker)
    {
        const auto path = [this](const cimhost::cim::ObjectPath& wanted) {
            const Allocations::Pause pause;
            return ref(wanted);
        };
        return operation.run({servingBroker, ctx(), rslt(), path});
    }

    /// The calls of one whole request of its own.
    std::vector<std::string> wholeRequest(const Operation& operation)
    {
        newRequest();
        run(operation);
        return broker.calls();
    }
};

#endif
