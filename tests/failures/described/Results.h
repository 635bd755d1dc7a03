/// \file
/// What the operations return to the broker.
#ifndef TESTS_FAILURES_DESCRIBED_RESULTS_H
#define TESTS_FAILURES_DESCRIBED_RESULTS_H

#include "Services.h"

namespace described {

void returnPath(const Result* result, const Path* path);

/// Each of them in the namespace of the request.
void returnPaths(const Result* result, const Paths& paths, const Path* ref, Status& status);

/// Null instances too.
void returnInstance(const Result* result, const Instance* instance);
void returnInstances(const Result* result, const Instances& instances);

/// The first of them whose path is equal to that of the request, if any.
void returnFirstEqual(const Result* result, const Instances& instances, const Path* cop, bool deep,
                      Status& status);

/// The path of an instance, in the namespace of the request; nothing where it has none or is null.
void returnPathOf(const Result* result, const Instance* instance, const Path* ref, Status& status);

void returnDone(const Result* result);

} // namespace described

#endif
