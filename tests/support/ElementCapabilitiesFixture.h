/// \file
/// What the tests of the association TAVRO_GlimmarkElementCapabilities share.
#ifndef TESTS_SUPPORT_ELEMENTCAPABILITIESFIXTURE_H
#define TESTS_SUPPORT_ELEMENTCAPABILITIESFIXTURE_H

#include "EntryPoints.h"
#include "ProviderFixture.h"

#include <Tavro/Common.h>

#include <cstddef>
#include <string>
#include <vector>

namespace ElementCapabilities {

inline constexpr auto association = "TAVRO_GlimmarkElementCapabilities";
inline constexpr auto module = "GlimmarkElementCapabilitiesProvider";
inline constexpr auto glimmark = "TAVRO_Glimmark";
inline constexpr auto capabilities = "TAVRO_GlimmarkCapabilities";

using Texts = std::vector<std::string>;

/// A run of blanks inside a text.
inline std::string blanks(std::size_t count)
{
    return std::string().append(count, ' ');
}

/// The broker's trace of a failure, as the recording writes it.
inline std::string warning(const std::string& text)
{
    return R"(trace(2, "GlimmarkElementCapabilitiesProvider", ")" + text + "\", null)";
}

/// The making of a status message.
inline std::string statusText(const std::string& text)
{
    return "newString(\"" + text + "\", null)";
}

/// Lists of calls and lines, one after the other.
template <class... Lists>
Texts joined(Texts first, const Lists&... others)
{
    (first.insert(first.end(), others.begin(), others.end()), ...);
    return first;
}

/// The last of a list.
inline Texts lastOf(const Texts& list, std::size_t count)
{
    return list.size() < count ? list : Texts(list.end() - static_cast<std::ptrdiff_t>(count), list.end());
}

/// With one indicator unless a test makes others.
class Fixture : public ProviderFixture
{
protected:
    Fixture() { MadeInventory::set({{"a", "1"}}); }

    // Runs of calls and lines, of which the operations consist. `path` is the recording's name of a path.

    const Texts collection{"ENTERING setVector", "EXITING setVector",
                           "ENTERING getGlimmarkCapabilitiesInstances",
                           "EXITING getGlimmarkCapabilitiesInstances"};
    const Texts readingOfTheNamespace{"getNameSpace(ref, rc)", R"(getCharPtr("root/test", rc))"};

    Texts settingOfTheNamespace(const std::string& path) const
    {
        return joined(readingOfTheNamespace, Texts{"setNameSpace(" + path + R"(, "root/test"))"});
    }

    /// A new path of the request's.
    Texts makingOfAPath(const std::string& className, const std::string& path) const
    {
        return joined(readingOfTheNamespace,
                      Texts{R"(newObjectPath("root/test", ")" + className + R"(", rc))"},
                      settingOfTheNamespace(path), Texts{"setHostname(" + path + ", " + quotedHost + ")"});
    }

    /// The factory's answer with the only indicator's path.
    Texts makingOfTheDevicePath(const std::string& path) const
    {
        const std::string addKey = "addKey(" + path;
        return joined(Texts{"ENTERING getAllGlimmarkCMPIObjPaths"}, makingOfAPath(glimmark, path),
                      Texts{addKey + R"(, "CreationClassName", "TAVRO_Glimmark", chars))",
                            addKey + R"(, "DeviceID", "a:/1", chars))",
                            addKey + R"(, "SystemCreationClassName", "TAVRO_ComputerSystem", chars))",
                            addKey + R"(, "SystemName", )" + quotedHost + ", chars)",
                            "EXITING getAllGlimmarkCMPIObjPaths"});
    }

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

    const std::string quotedHost = '"' + Tavro::getSystemName() + '"';
    const Texts resultServices{"returnObjectPath", "returnInstance", "returnDone"};
    const Texts reports{"newString", "trace"};
};

} // namespace ElementCapabilities

#endif
