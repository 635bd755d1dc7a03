/// \file
/// The provider's comparisons of object paths. The test executable defines Tavro::isObjPathsEqual itself,
/// ahead of the support library's: each call is written down and handed on to the library.
#ifndef TESTING_RECORDEDCOMPARISONS_H
#define TESTING_RECORDEDCOMPARISONS_H

#include <vector>

#include <cmpift.h>

namespace RecordedComparisons {

struct Comparison
{
    const CMPIObjectPath* first;
    const CMPIObjectPath* second;
    bool deep;
    bool equal; ///< what the library answered
};

/// Those of all threads since the last clear(), in order.
std::vector<Comparison> all();
void clear();

} // namespace RecordedComparisons

#endif
