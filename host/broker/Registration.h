/// \file
/// The registration of providers, in the format of the small-footprint CIM broker:
///
///     # a comment
///     [CIM_Example]
///        provider: ExampleProvider
///        location: ExampleLibrary
///        type: instance association
///        namespace: root/cimv2
///     #
///
/// One section for each class; `type` and `namespace` are lists separated by blanks.
#ifndef CIMHOST_BROKER_REGISTRATION_H
#define CIMHOST_BROKER_REGISTRATION_H

#include <cstddef>
#include <stdexcept>
#include <string>
#include <vector>

namespace cimhost {

/// A registration file that cannot be used; what() names the file, the line and what was
/// expected, and may go to a terminal.
class RegistrationError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// What serves one class.
struct RegisteredClass
{
    std::string className;
    std::string provider; ///< prefix of the entry points: PROVIDER_Create_InstanceMI
    std::string location; ///< the library is libLOCATION.so
    bool instance = false;
    bool association = false;
    std::vector<std::string> nameSpaces;
};

/// Whether the class is registered for that namespace; letter case is ignored.
bool isRegisteredIn(const RegisteredClass& entry, const std::string& nameSpace);

/// The classes in the order of the file.
struct Registration
{
    std::vector<RegisteredClass> classes;
};

/// Reads registration text.
/// \param name  what to call it in error messages
/// \throws RegistrationError  on anything that the format does not have: a line outside a section, an
/// unknown or repeated entry, a missing one, an unknown type, the same class and provider twice
Registration parseRegistration(const std::string& text, const std::string& name);

/// The longest file read, in bytes.
constexpr std::size_t maxRegistrationLength = 1048576;

/// Reads a registration file.
/// \throws RegistrationError  also when the file cannot be read, is no regular file or too long
Registration readRegistrationFile(const std::string& fileName);

} // namespace cimhost

#endif
