/// \file
/// The CMPI services that the stand-in uses, as functions that either do what they say or throw. The only
/// place that touches a broker's function tables; no null pointer is followed.
#ifndef TAVRO_COMPUTERSYSTEM_CMPI_H
#define TAVRO_COMPUTERSYSTEM_CMPI_H

#include <cmpidt.h>
#include <cmpift.h>

#include <initializer_list>
#include <stdexcept>
#include <string>

namespace Tavro::ComputerSystem::Cmpi {

/// Ends an operation; becomes the status that it answers with.
class Failure : public std::runtime_error
{
public:
    Failure(CMPIrc code, const std::string& message) : std::runtime_error(message), code_(code) {}
    [[nodiscard]] CMPIrc code() const { return code_; }

private:
    CMPIrc code_;
};

// All of these throw a Failure when the object is null, when its broker does not have the service, and
// when the service fails, with the service's code. What is made belongs to the broker and ends with the
// request.

/// The namespace of a path.
std::string nameSpaceOf(const CMPIObjectPath* path);

CMPIObjectPath* newObjectPath(const CMPIBroker* broker, const std::string& nameSpace, const char* className);
CMPIInstance* newInstance(const CMPIBroker* broker, const CMPIObjectPath* path);

void setHostname(const CMPIObjectPath* path, const std::string& host);
void addKey(const CMPIObjectPath* path, const char* name, const std::string& value);

/// \param properties  ended by a null pointer, or null for all
/// \param keys        ended by a null pointer
void setPropertyFilter(const CMPIInstance* instance, const char** properties, const char** keys);
void setProperty(const CMPIInstance* instance, const char* name, const std::string& value);
void setProperty(const CMPIInstance* instance, const char* name, CMPIUint16 value);
/// \param array  of uint16
void setProperty(const CMPIInstance* instance, const char* name, CMPIArray* array);
CMPIArray* newArray(const CMPIBroker* broker, std::initializer_list<CMPIUint16> elements);

void returnInstance(const CMPIResult* result, const CMPIInstance* instance);
void returnObjectPath(const CMPIResult* result, const CMPIObjectPath* path);
void returnDone(const CMPIResult* result);

/// The status of an operation that failed. Its message is null where the broker does not make one.
CMPIStatus failed(const CMPIBroker* broker, CMPIrc code, const char* message) noexcept;

} // namespace Tavro::ComputerSystem::Cmpi

#endif
