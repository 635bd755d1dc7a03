// Two tests have the compiler refuse parts of this: a pointer is no flag.

#include "Cmpi.h"

void setWithoutType([[maybe_unused]] const CMPIInstance* instance,
                    [[maybe_unused]] const CMPIObjectPath* path, [[maybe_unused]] const void* pointer)
{
#if defined OF_A_KEY
    Tavro::GlimmarkProvider::Cmpi::addKey(path, "Key", pointer);
#elif defined OF_A_PROPERTY
    Tavro::GlimmarkProvider::Cmpi::setProperty(instance, "Property", pointer);
#endif
}
