/// \file
/// What the tests of both associations share: calls and lines as the recording writes them, and runs of them
/// of which the operations consist.
#ifndef TESTING_ASSOCIATIONFIXTURE_H
#define TESTING_ASSOCIATIONFIXTURE_H

#include "testing/ProviderFixture.h"

#include <Tavro/Common.h>

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

namespace Recorded {

using Texts = std::vector<std::string>;

/// The broker's trace of a failure. \param provider  who reports it
inline std::string warning(const std::string& provider, const std::string& text)
{
    return "trace(2, \"" + provider + "\", \"" + text + "\", null)";
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

} // namespace Recorded

/// In the runs of calls and lines, `path` is the recording's name of a path.
class AssociationFixture : public ProviderFixture
{
protected:
    using Texts = Recorded::Texts;

    AssociationFixture() = default;
    explicit AssociationFixture(cimhost::Registration registration) : ProviderFixture(std::move(registration))
    {}

    const Texts readingOfTheNamespace{"getNameSpace(ref, rc)", R"(getCharPtr("root/test", rc))"};

    /// Gives a path the namespace of the request.
    Texts settingOfTheNamespace(const std::string& path) const
    {
        return Recorded::joined(readingOfTheNamespace, Texts{"setNameSpace(" + path + R"(, "root/test"))"});
    }

    /// A new path of the request's.
    Texts makingOfAPath(const std::string& className, const std::string& path) const
    {
        return Recorded::joined(
            readingOfTheNamespace, Texts{R"(newObjectPath("root/test", ")" + className + R"(", rc))"},
            settingOfTheNamespace(path), Texts{"setHostname(" + path + ", " + quotedHost + ")"});
    }

    /// The factory's answer with the path of the only indicator, which is "a:/1".
    Texts makingOfTheDevicePath(const std::string& path) const
    {
        const std::string addKey = "addKey(" + path;
        return Recorded::joined(
            Texts{"ENTERING getAllGlimmarkCMPIObjPaths"}, makingOfAPath("TAVRO_Glimmark", path),
            Texts{addKey + R"(, "CreationClassName", "TAVRO_Glimmark", chars))",
                  addKey + R"(, "DeviceID", "a:/1", chars))",
                  addKey + R"(, "SystemCreationClassName", "TAVRO_ComputerSystem", chars))",
                  addKey + R"(, "SystemName", )" + quotedHost + ", chars)",
                  "EXITING getAllGlimmarkCMPIObjPaths"});
    }

    static Texts readingOfTheClass(const std::string& path, const std::string& className)
    {
        return {"getClassName(" + path + ", rc)", "getCharPtr(\"" + className + "\", rc)"};
    }

    /// Finding the far end's class: that of the request's path is read once for each way tried, and the
    /// target's path, the first one made, is made of what was found.
    /// \param trace  the broker's trace of what was found
    Texts findingOfTheTarget(const std::string& nearClass, std::size_t ways, const std::string& farClass,
                             const std::string& trace) const
    {
        Texts reading;
        for (std::size_t way = 0; way < ways; ++way)
            reading = Recorded::joined(reading, readingOfTheClass("ref", nearClass));
        return Recorded::joined(
            Texts{"ENTERING get_assoc_targetClass_ObjectPath", "ENTERING get_assoc_targetClass_Name"},
            reading, Texts{trace, "EXITING get_assoc_targetClass_Name"}, makingOfAPath(farClass, "path1"),
            Texts{"EXITING get_assoc_targetClass_ObjectPath"});
    }

    const std::string quotedHost = '"' + Tavro::getSystemName() + '"';
    const Texts resultServices{"returnObjectPath", "returnInstance", "returnDone"};
};

#endif
