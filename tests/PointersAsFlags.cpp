// Compiled by two tests only, which expect the compiler to refuse it: a pointer is no flag.

#include "Cmpi.h"

void setWithoutType(const CMPIInstance* instance, const CMPIObjectPath* path, const void* pointer)
{
#ifdef OF_A_KEY
    Tavro::GlimmarkProvider::Cmpi::addKey(path, "Key", pointer);
#else
    Tavro::GlimmarkProvider::Cmpi::setProperty(instance, "Property", pointer);
#endif
}
