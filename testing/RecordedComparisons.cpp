#include "testing/RecordedComparisons.h"

#include <Tavro/Common.h>

#include <mutex>

#include <dlfcn.h>

namespace RecordedComparisons {

namespace {

std::mutex mutex;
std::vector<Comparison> comparisons;

using Compare = bool (*)(const CMPIObjectPath*, const CMPIObjectPath*, bool);

Compare libraryFunction()
{
    return reinterpret_cast<Compare>(dlsym(RTLD_NEXT, "_ZN5Tavro15isObjPathsEqualEPK15_CMPIObjectPathS2_b"));
}

bool record(const Comparison& comparison)
{
    const std::lock_guard lock(mutex);
    comparisons.push_back(comparison);
    return comparison.equal;
}

} // namespace

std::vector<Comparison> all()
{
    const std::lock_guard lock(mutex);
    return comparisons;
}

void clear()
{
    const std::lock_guard lock(mutex);
    comparisons.clear();
}

} // namespace RecordedComparisons

namespace Tavro {

bool isObjPathsEqual(const CMPIObjectPath* a, const CMPIObjectPath* b, bool deep)
{
    static const auto original = RecordedComparisons::libraryFunction();
    return RecordedComparisons::record({a, b, deep, original(a, b, deep)});
}

} // namespace Tavro
