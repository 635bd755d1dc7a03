#include "Tavro/Common.h"

#include <sys/utsname.h>

std::string Tavro::getSystemName()
{
    // The kernel ends the name with a null character, however long it is.
    utsname kernel;
    kernel.nodename[0] = '\0';
    uname(&kernel);
    return static_cast<const char*>(kernel.nodename);
}
