/// \file
/// The per-request owner of all records, which builds CMPI objects of them.
#ifndef TAVRO_GLIMMARK_GLIMMARKFACTORY_H
#define TAVRO_GLIMMARK_GLIMMARKFACTORY_H

#include "Glimmark.h"
#include "GlimmarkCapabilities.h"

#include <cmpidt.h>
#include <cmpift.h>

#include <map>
#include <string>
#include <vector>

namespace Tavro::GlimmarkProvider {

/// Collects records of the kinds asked for when it is made and answers from them until it ends: one
/// factory for each request, on its stack, of one thread.
///
/// Common to the builders:
/// - `broker` makes the objects; they belong to it and end with the request. Without a broker nothing
///   can be made, which is answered like any failure to make it.
/// - `ref` is the request's path: its namespace is that of everything made. Host name is this system's.
/// - `properties` is the broker's list of properties wanted, ended by a null pointer; null stands for all
///   of them. Keys are always set. Names are matched exactly, letter case included.
/// - `isObjPath` set asks for the keys only when there is no list.
/// - `rc` and `status` may be null. They are handed to the broker's calls, and set to code 1 with a
///   message for the failures that a builder reports itself.
/// - Lists are only ever appended to. All objects come in the order of their identifiers, byte by byte.
/// - A result of 0 is success, 1 that there is no such record, 2 that an object could not be made.
/// - Only exceptions of the standard library leave: std::bad_alloc.
class GlimmarkFactory
{
public:
    /// Collects nothing.
    GlimmarkFactory();

    /// Collects the indicators, the capabilities record, or both. A collection that fails leaves its
    /// kind without records: every look-up then finds nothing.
    GlimmarkFactory(bool collectDevices, bool collectCapabilities);

    ~GlimmarkFactory();
    GlimmarkFactory(const GlimmarkFactory&) = delete;
    GlimmarkFactory& operator=(const GlimmarkFactory&) = delete;

    /// Number of indicators with different identifiers.
    [[nodiscard]] int getNumberOfInstances() const;

    // Alarm devices: TAVRO_Glimmark.

    /// Makes one instance. \return null when the path or the instance could not be made
    CMPIInstance* makeGlimmarkInstance(const CMPIBroker* broker, const CMPIObjectPath* ref, Glimmark glimmark,
                                       const char** properties, bool isObjPath, CMPIStatus* rc) const;

    /// Appends what makeGlimmarkInstance returns for each indicator, null pointers included. \return 0
    int getAllGlimmarkCMPIInstances(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                    const char** properties, bool isObjPath,
                                    std::vector<CMPIInstance*>& instances, CMPIStatus* rc) const;

    /// Appends what makeGlimmarkInstance returns for the indicator with the identifier `key`, compared
    /// byte by byte. \return 0, or 1 when there is none
    int getOneGlimmarkCMPIInstance(const CMPIBroker* broker, const CMPIObjectPath* ref, CMPIString* key,
                                   const char** properties, std::vector<CMPIInstance*>& instances,
                                   CMPIStatus* rc) const;

    /// Appends the path of each indicator. \return 0; 1 when there is no indicator; 2 when a path could not
    /// be made, those before it being in the list
    int getAllGlimmarkCMPIObjPaths(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                   std::vector<CMPIObjectPath*>& objectPaths, CMPIStatus* status) const;

    // Capabilities: TAVRO_GlimmarkCapabilities.

    /// Makes one instance. \return null when the path or the instance could not be made
    CMPIInstance* makeGlimmarkCapabilitiesInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                   GlimmarkCapabilities glimmarkCap, const char** properties,
                                                   bool isObjPath, CMPIStatus* rc) const;

    /// Appends what makeGlimmarkCapabilitiesInstance returns for each record, null pointers included.
    /// \return 0
    int getAllGlimmarkCapabilitiesCMPIInstances(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                const char** properties, bool isObjPath,
                                                std::vector<CMPIInstance*>& instances, CMPIStatus* rc) const;

    /// Appends what makeGlimmarkCapabilitiesInstance returns for the record with the identifier `key`.
    /// \return 0, or 1 when there is none
    int getOneGlimmarkCapabilitiesCMPIInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                               CMPIString* key, const char** properties,
                                               std::vector<CMPIInstance*>& instances, CMPIStatus* rc) const;

    /// Appends the path of each record. \return 0; 1 when there is none; 2 when a path could not be made
    int getAllGlimmarkCapabilitiesCMPIObjPaths(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                               std::vector<CMPIObjectPath*>& objectPaths,
                                               CMPIStatus* status) const;

    // The far end of an association, decided by the class of `ref` and the association class alone, both
    // compared exactly. `resultClass` is only traced. Neither writes `rc` itself.

    /// \return one of the constants of Names.h; null when `assocClass` (which may be null) does not start
    ///     from the class of `ref`
    const char* get_assoc_targetClass_Name(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                           const char* assocClass, const char* resultClass,
                                           CMPIStatus* rc) const;

    /// \return a path without keys of the far end's class; null when there is none, or when the broker
    ///     could not make it
    CMPIObjectPath* get_assoc_targetClass_ObjectPath(const CMPIBroker* broker, const CMPIObjectPath* ref,
                                                     const char* assocClass, const char* resultClass,
                                                     CMPIStatus* rc) const;

private:
    void _createGlimmarkMap();
    void _createCapabilitiesMap();

    std::vector<Glimmark> glimmarks;
    std::vector<GlimmarkCapabilities> capabilities;
    std::map<std::string, Glimmark> glimmarkMap;                 // by DeviceID
    std::map<std::string, GlimmarkCapabilities> capabilitiesMap; // by InstanceID
};

} // namespace Tavro::GlimmarkProvider

#endif
