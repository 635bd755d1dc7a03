/// \file
/// A reader of MOF: of class declarations (qualifiers, properties, arrays, references, pragmas, comments) and
/// of instances with plain values. It refuses all else that MOF has (qualifier declarations, methods,
/// flavors, aliases): the project's schema has none of it.
#ifndef SCHEMA_MOFREADER_H
#define SCHEMA_MOFREADER_H

#include <map>
#include <stdexcept>
#include <string>
#include <vector>

namespace schema {

/// Text that is not such MOF; what() names the file, the line and what was expected.
class MofError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

enum class Parameter
{
    None,   ///< as in `Key`
    Text,   ///< as in `Override ( "Name" )`
    Number, ///< an integer
    Flag,   ///< TRUE or FALSE
    Texts   ///< as in `Values { "OK", "Degraded" }`
};

struct Qualifier
{
    std::string name;
    Parameter kind = Parameter::None;
    /// As written, texts without quotes and escapes: none without a parameter, one, or a list.
    std::vector<std::string> values;
};

struct Property
{
    std::string name;
    /// An intrinsic type in lower case such as "uint16"; of a reference, the class it points to.
    std::string type;
    bool isReference = false;
    bool isArray = false;
    std::vector<Qualifier> qualifiers;
};

struct Class
{
    std::string name;
    std::string superclass; ///< empty: none
    std::vector<Qualifier> qualifiers;
    std::vector<Property> properties;
};

/// What an instance says of a property.
struct WrittenValue
{
    enum Kind
    {
        Null,
        Text,
        Number, ///< an integer
        Flag    ///< TRUE or FALSE
    };
    Kind kind = Null; ///< of every element of an array
    bool isArray = false;
    /// As in the text, texts without quotes and escapes: one, or an array's elements.
    std::vector<std::string> elements;
};

struct WrittenInstance
{
    std::string className;
    std::map<std::string, WrittenValue> values; ///< by the name of the property, as written
};

/// The classes in the order of the text. Pragmas are skipped. \param fileName  for error messages
/// \throws MofError  also for what no text may hold: a class, property or qualifier twice, ignoring letter
/// case
std::vector<Class> readMof(const std::string& text, const std::string& fileName);

/// \throws MofError  also when the file cannot be read
std::vector<Class> readMofFile(const std::string& fileName);

/// The same of a text that declares instances and no classes. An array has at least one element, and elements
/// of one kind. \throws MofError
std::vector<WrittenInstance> readMofInstances(const std::string& text, const std::string& fileName);
std::vector<WrittenInstance> readMofInstancesFile(const std::string& fileName);

} // namespace schema

#endif
