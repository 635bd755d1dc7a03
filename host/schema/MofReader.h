/// \file
/// A reader of MOF, the text format of CIM's schemas: of class declarations (qualifiers, properties, their
/// default values, arrays, references, pragmas, comments) and of instances with plain values. It refuses all
/// else that MOF has (qualifier declarations, methods, flavors, aliases).
#ifndef CIMHOST_SCHEMA_MOFREADER_H
#define CIMHOST_SCHEMA_MOFREADER_H

#include <cstddef>
#include <map>
#include <stdexcept>
#include <string>
#include <vector>

namespace cimhost::schema {

/// Text that is not such MOF; what() names the file, the line, the column and what was expected, and may
/// go to a terminal.
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
    bool isInherited = false; ///< never as read
};

/// A value as the text has it.
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

struct Property
{
    std::string name;
    /// An intrinsic type in lower case such as "uint16"; of a reference, the class it points to.
    std::string type;
    bool isReference = false;
    bool isArray = false;
    std::vector<Qualifier> qualifiers;
    WrittenValue defaultValue{}; ///< Null also where none is written
    bool isInherited = false;    ///< never as read
    std::string origin{};        ///< the class that declared it first; empty as read
};

struct Class
{
    std::string name;
    std::string superclass; ///< empty: none
    std::vector<Qualifier> qualifiers;
    std::vector<Property> properties;
};

struct WrittenInstance
{
    std::string className;
    std::map<std::string, WrittenValue> values; ///< by the name of the property, as written
};

/// What a text declares, in its order. Pragmas are skipped.
struct Declarations
{
    std::vector<Class> classes;
    std::vector<WrittenInstance> instances;
};

/// \param fileName  for error messages
/// \throws MofError  also for what no text may hold: a class, property, qualifier or value twice, ignoring
/// letter case; an array of values without elements, or with elements of different kinds
Declarations readMof(const std::string& text, const std::string& fileName);

/// The longest file read, in bytes.
constexpr std::size_t maxMofLength = 16777216;

/// \throws MofError  also when the file cannot be read, is no regular file or too long
Declarations readMofFile(const std::string& fileName);

} // namespace cimhost::schema

#endif
