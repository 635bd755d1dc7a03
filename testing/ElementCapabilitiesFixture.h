/// \file
/// What the tests of the association TAVRO_GlimmarkElementCapabilities share.
#ifndef TESTING_ELEMENTCAPABILITIESFIXTURE_H
#define TESTING_ELEMENTCAPABILITIESFIXTURE_H

#include "EntryPoints.h"
#include "testing/AssociationFixture.h"

#include <Tavro/Common.h>

#include <cstddef>
#include <string>
#include <vector>

namespace ElementCapabilities {

inline constexpr auto association = "TAVRO_GlimmarkElementCapabilities";
inline constexpr auto module = "GlimmarkElementCapabilitiesProvider";
inline constexpr auto glimmark = "TAVRO_Glimmark";
inline constexpr auto capabilities = "TAVRO_GlimmarkCapabilities";

using Recorded::joined;
using Recorded::statusText;
using Recorded::Texts;

/// A run of blanks inside a text.
inline std::string blanks(std::size_t count)
{
    return std::string().append(count, ' ');
}

/// The broker's trace of a failure.
inline std::string warning(const std::string& text)
{
    return Recorded::warning(module, text);
}

/// The last of a list.
inline Texts lastOf(const Texts& list, std::size_t count)
{
    return list.size() < count ? list : Texts(list.end() - static_cast<std::ptrdiff_t>(count), list.end());
}

/// With one indicator unless a test makes others.
class Fixture : public AssociationFixture
{
protected:
    Fixture() { MadeInventory::set({{"a", "1"}}); }

    // Runs of calls and lines.

    const Texts collection{"ENTERING setVector", "EXITING setVector",
                           "ENTERING getGlimmarkCapabilitiesInstances",
                           "EXITING getGlimmarkCapabilitiesInstances"};

    /// The factory's answer with the path of the capabilities.
    Texts makingOfTheCapabilitiesPath(const std::string& path) const
    {
        return joined(Texts{"ENTERING getAllGlimmarkCapabilitiesCMPIObjPaths"},
                      makingOfAPath(capabilities, path),
                      Texts{"addKey(" + path + R"(, "InstanceID", "TAVRO:GlimmarkCapabilities1", chars))",
                            "EXITING getAllGlimmarkCapabilitiesCMPIObjPaths"});
    }

    // References as valueOf() writes them.

    static std::string deviceText(const std::string& deviceID)
    {
        return "root/test:TAVRO_Glimmark.CreationClassName=TAVRO_Glimmark,DeviceID=" + deviceID +
               ",SystemCreationClassName=TAVRO_ComputerSystem,SystemName=" + Tavro::getSystemName();
    }
    const std::string capabilitiesText =
        "root/test:TAVRO_GlimmarkCapabilities.InstanceID=TAVRO:GlimmarkCapabilities1";

    const Texts reports{"newString", "trace"};
};

} // namespace ElementCapabilities

#endif
