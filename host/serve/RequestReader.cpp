#include "serve/RequestReader.h"

#include "cim/Utf8.h"
#include "cim/Values.h"
#include "serve/Dtd.h"
#include "serve/ValueReader.h"

#include <algorithm>
#include <array>
#include <set>
#include <string>
#include <utility>
#include <vector>

namespace cimhost::serve {

namespace {

/// The value of a parameter, and what it is to be put into.
struct Parameter
{
    const Element& value;
    Question& question;
    const XmlLimits& limits;
};

void require(const Parameter& parameter, std::string_view name)
{
    if (parameter.value.name != name)
        throw ValueError(parameter.value, "this element", std::string(name));
}

const std::string& readClassName(const Parameter& parameter)
{
    require(parameter, "CLASSNAME");
    return attribute(parameter.value, "NAME");
}

const std::string& readText(const Parameter& parameter)
{
    require(parameter, "VALUE");
    return textOf(parameter.value);
}

void takeClassName(const Parameter& parameter)
{
    parameter.question.request.target.className = readClassName(parameter);
}

void takeInstanceName(const Parameter& parameter)
{
    require(parameter, "INSTANCENAME");
    parameter.question.request.target = readInstanceName(parameter.value);
}

/// A traversal from a class leads to classes.
void takeObjectName(const Parameter& parameter)
{
    if (parameter.value.name == "CLASSNAME")
        throw ValueError(CMPI_RC_ERR_NOT_SUPPORTED,
                         placeOf(parameter.value) + ": traversals from a class are not served");
    takeInstanceName(parameter);
}

void takePropertyList(const Parameter& parameter)
{
    require(parameter, "VALUE.ARRAY");
    std::vector<std::string>& names = parameter.question.request.properties.emplace();
    for (const Element& name : childrenAmong(parameter.value, {"VALUE", "VALUE.NULL"})) {
        if (name.name == "VALUE.NULL")
            throw ValueError(name, "no name", "the name of a property");
        names.push_back(textOf(name));
    }
}

bool readFlag(const Parameter& parameter)
{
    require(parameter, "VALUE");
    return readBoolean(parameter.value);
}

void takeLocalOnly(const Parameter& parameter)
{
    parameter.question.localOnly = readFlag(parameter);
}

void takeDeepInheritance(const Parameter& parameter)
{
    parameter.question.deepInheritance = readFlag(parameter);
}

void takeIncludeQualifiers(const Parameter& parameter)
{
    parameter.question.includeQualifiers = readFlag(parameter);
}

void takeIncludeClassOrigin(const Parameter& parameter)
{
    parameter.question.includeClassOrigin = readFlag(parameter);
}

void takeContext(const Parameter& parameter)
{
    parameter.question.context = readText(parameter);
}

void takeMostItems(const Parameter& parameter)
{
    require(parameter, "VALUE");
    parameter.question.mostItems = readUnsigned(parameter.value);
}

void takeTimeout(const Parameter& parameter)
{
    require(parameter, "VALUE");
    parameter.question.timeout = readUnsigned(parameter.value);
}

void takeContinueOnError(const Parameter& parameter)
{
    if (readFlag(parameter))
        throw ValueError(continuationOnErrorNotSupported,
                         placeOf(parameter.value) + ": an enumeration ends with its first error");
}

void refuseFilter(const Parameter& parameter)
{
    throw ValueError(filteredEnumerationNotSupported, placeOf(parameter.value) + ": filters are not served");
}

void takeAssocClass(const Parameter& parameter)
{
    parameter.question.request.traversal.assocClass = readClassName(parameter);
}

void takeResultClass(const Parameter& parameter)
{
    parameter.question.request.traversal.resultClass = readClassName(parameter);
}

void takeRole(const Parameter& parameter)
{
    parameter.question.request.traversal.role = readText(parameter);
}

void takeResultRole(const Parameter& parameter)
{
    parameter.question.request.traversal.resultRole = readText(parameter);
}

void takeNewInstance(const Parameter& parameter)
{
    require(parameter, "INSTANCE");
    parameter.question.request.instance = readInstance(parameter.value, parameter.limits);
    parameter.question.request.target.className = parameter.question.request.instance.path.className;
}

void takeModifiedInstance(const Parameter& parameter)
{
    require(parameter, "VALUE.NAMEDINSTANCE");
    const std::vector<Element>& parts = childrenInOrder(parameter.value, {"INSTANCENAME", "INSTANCE"});
    parameter.question.request.target = readInstanceName(parts[0]);
    parameter.question.request.instance = readInstance(parts[1], parameter.limits);
}

void takeQueryLanguage(const Parameter& parameter)
{
    parameter.question.request.queryLanguage = readText(parameter);
}

void takeQuery(const Parameter& parameter)
{
    parameter.question.request.query = readText(parameter);
}

struct ParameterEntry
{
    const char* name;
    bool isRequired;
    void (*take)(const Parameter&);
};

constexpr ParameterEntry className{"ClassName", true, &takeClassName};
constexpr ParameterEntry superclassName{"ClassName", false, &takeClassName};
constexpr ParameterEntry instanceName{"InstanceName", true, &takeInstanceName};
constexpr ParameterEntry objectName{"ObjectName", true, &takeObjectName};
constexpr ParameterEntry localOnly{"LocalOnly", false, &takeLocalOnly};
constexpr ParameterEntry deepInheritance{"DeepInheritance", false, &takeDeepInheritance};
constexpr ParameterEntry includeQualifiers{"IncludeQualifiers", false, &takeIncludeQualifiers};
constexpr ParameterEntry includeClassOrigin{"IncludeClassOrigin", false, &takeIncludeClassOrigin};
constexpr ParameterEntry propertyList{"PropertyList", false, &takePropertyList};
constexpr ParameterEntry assocClass{"AssocClass", false, &takeAssocClass};
constexpr ParameterEntry resultClass{"ResultClass", false, &takeResultClass};
constexpr ParameterEntry role{"Role", false, &takeRole};
constexpr ParameterEntry resultRole{"ResultRole", false, &takeResultRole};
constexpr ParameterEntry newInstance{"NewInstance", true, &takeNewInstance};
constexpr ParameterEntry modifiedInstance{"ModifiedInstance", true, &takeModifiedInstance};
constexpr ParameterEntry queryLanguage{"QueryLanguage", true, &takeQueryLanguage};
constexpr ParameterEntry query{"Query", true, &takeQuery};

constexpr ParameterEntry filterQueryLanguage{"FilterQueryLanguage", false, &refuseFilter};
constexpr ParameterEntry filterQuery{"FilterQuery", false, &refuseFilter};
constexpr ParameterEntry operationTimeout{"OperationTimeout", false, &takeTimeout};
constexpr ParameterEntry continueOnError{"ContinueOnError", false, &takeContinueOnError};
constexpr ParameterEntry maxObjectCount{"MaxObjectCount", false, &takeMostItems};
constexpr ParameterEntry maxObjectCountOfPull{"MaxObjectCount", true, &takeMostItems};
constexpr ParameterEntry enumerationContext{"EnumerationContext", true, &takeContext};

struct MethodEntry
{
    const char* name;
    Step step;
    Operation operation; ///< of the steps ask and open
    Items items;         ///< of the steps open and pull
    std::vector<ParameterEntry> parameters;
};

MethodEntry asking(const char* name, Operation operation, std::vector<ParameterEntry> parameters)
{
    return {name, Step::ask, operation, {}, std::move(parameters)};
}

MethodEntry opening(const char* name, Operation operation, std::vector<ParameterEntry> parameters)
{
    const Items items = answersPaths(operation) ? Items::paths : Items::instancesWithPaths;
    if (items != Items::paths)
        parameters.insert(parameters.end(), {includeClassOrigin, propertyList});
    parameters.insert(parameters.end(),
                      {filterQueryLanguage, filterQuery, operationTimeout, continueOnError, maxObjectCount});
    return {name, Step::open, operation, items, std::move(parameters)};
}

MethodEntry pulling(const char* name, Items items)
{
    return {name, Step::pull, {}, items, {enumerationContext, maxObjectCountOfPull}};
}

MethodEntry answering(const char* name, Step step, std::vector<ParameterEntry> parameters)
{
    return {name, step, {}, {}, std::move(parameters)};
}

/// The operations served, with their parameters (DMTF DSP0200, 5.4).
const std::vector<MethodEntry>& methods()
{
    static const std::vector<MethodEntry> entries{
        asking("EnumerateInstanceNames", Operation::enumerateInstanceNames, {className}),
        asking("EnumerateInstances", Operation::enumerateInstances,
               {className, localOnly, deepInheritance, includeQualifiers, includeClassOrigin, propertyList}),
        asking("GetInstance", Operation::getInstance,
               {instanceName, localOnly, includeQualifiers, includeClassOrigin, propertyList}),
        asking("CreateInstance", Operation::createInstance, {newInstance}),
        asking("ModifyInstance", Operation::modifyInstance,
               {modifiedInstance, includeQualifiers, propertyList}),
        asking("DeleteInstance", Operation::deleteInstance, {instanceName}),
        asking("ExecQuery", Operation::execQuery, {queryLanguage, query}),
        asking("Associators", Operation::associators,
               {objectName, assocClass, resultClass, role, resultRole, includeQualifiers, includeClassOrigin,
                propertyList}),
        asking("AssociatorNames", Operation::associatorNames,
               {objectName, assocClass, resultClass, role, resultRole}),
        asking("References", Operation::references,
               {objectName, resultClass, role, includeQualifiers, includeClassOrigin, propertyList}),
        asking("ReferenceNames", Operation::referenceNames, {objectName, resultClass, role}),
        opening("OpenEnumerateInstances", Operation::enumerateInstances, {className, deepInheritance}),
        opening("OpenEnumerateInstancePaths", Operation::enumerateInstanceNames, {className}),
        opening("OpenAssociatorInstances", Operation::associators,
                {instanceName, assocClass, resultClass, role, resultRole}),
        opening("OpenAssociatorInstancePaths", Operation::associatorNames,
                {instanceName, assocClass, resultClass, role, resultRole}),
        opening("OpenReferenceInstances", Operation::references, {instanceName, resultClass, role}),
        opening("OpenReferenceInstancePaths", Operation::referenceNames, {instanceName, resultClass, role}),
        pulling("PullInstancesWithPath", Items::instancesWithPaths),
        pulling("PullInstancePaths", Items::paths),
        pulling("PullInstances", Items::instances),
        answering("CloseEnumeration", Step::close, {enumerationContext}),
        answering("EnumerationCount", Step::count, {enumerationContext}),
        answering("GetClass", Step::getClass,
                  {className, localOnly, includeQualifiers, includeClassOrigin, propertyList}),
        answering("EnumerateClasses", Step::enumerateClasses,
                  {superclassName, deepInheritance, localOnly, includeQualifiers, includeClassOrigin}),
        answering("EnumerateClassNames", Step::enumerateClassNames, {superclassName, deepInheritance}),
    };
    return entries;
}

const MethodEntry* findMethod(const std::string& name)
{
    const auto found = std::find_if(methods().begin(), methods().end(), [&](const MethodEntry& entry) {
        return cim::sameName(entry.name, name);
    });
    return found == methods().end() ? nullptr : &*found;
}

std::string namesOf(const std::vector<ParameterEntry>& parameters)
{
    std::string names;
    for (const ParameterEntry& entry : parameters)
        names += (names.empty() ? "" : ", ") + std::string(entry.name);
    return names;
}

/// Reads the parameters of one operation.
class ParameterReader
{
public:
    ParameterReader(const MethodEntry& method, Question& question, const XmlLimits& limits)
        : method_(method),
          question_(question),
          limits_(limits)
    {}

    /// \param element  IPARAMVALUE
    void take(const Element& element)
    {
        const ParameterEntry& entry = find(element);
        if (!given_.insert(&entry).second)
            throw ValueError(element, std::string("the parameter ") + entry.name + " again",
                             "each parameter once");
        const Element* const value =
            optionalChild(element, {"VALUE", "VALUE.ARRAY", "VALUE.REFERENCE", "INSTANCENAME", "CLASSNAME",
                                    "QUALIFIER.DECLARATION", "CLASS", "INSTANCE", "VALUE.NAMEDINSTANCE"});
        if (value == nullptr)
            return; // null, as if it were not there
        take(entry, *value);
        withValue_.insert(&entry);
    }

    /// \param element  IMETHODCALL
    void requireAll(const Element& element) const
    {
        for (const ParameterEntry& entry : method_.parameters)
            if (entry.isRequired && withValue_.count(&entry) == 0)
                throw ValueError(element, std::string(method_.name) + " without a value of " + entry.name,
                                 "one");
    }

private:
    [[nodiscard]] const ParameterEntry& find(const Element& element) const
    {
        const std::string& name = attribute(element, "NAME");
        for (const ParameterEntry& entry : method_.parameters)
            if (cim::sameName(entry.name, name))
                return entry;
        throw ValueError(element, "the parameter \"" + cim::excerpt(name) + '"',
                         "those of " + std::string(method_.name) + ": " + namesOf(method_.parameters));
    }

    void take(const ParameterEntry& entry, const Element& value)
    {
        try {
            entry.take({value, question_, limits_});
        } catch (const ValueError& error) {
            throw ValueError(error.code(), std::string(error.what()) + ", in the parameter " + entry.name);
        }
    }

    const MethodEntry& method_;
    Question& question_;
    const XmlLimits& limits_;
    std::set<const ParameterEntry*> given_;
    std::set<const ParameterEntry*> withValue_;
};

cim::Status status(CMPIrc code, const std::string& message)
{
    return {code, message};
}

bool isNameByte(char byte)
{
    return (byte >= 'A' && byte <= 'Z') || (byte >= 'a' && byte <= 'z') || (byte >= '0' && byte <= '9') ||
           byte == '_';
}

/// The words of a query outside of its quoted texts.
std::vector<std::string> wordsOf(const std::string& text)
{
    std::vector<std::string> words(1);
    char quote = '\0';
    for (const char byte : text) {
        if (quote != '\0')
            quote = byte == quote ? '\0' : quote;
        else if (isNameByte(byte)) {
            words.back() += byte;
            continue;
        } else if (byte == '"' || byte == '\'')
            quote = byte;
        if (!words.back().empty())
            words.emplace_back();
    }
    return words;
}

/// The class that a query selects from, which tells the provider to ask; empty: it names none.
std::string classOf(const std::string& text)
{
    const std::vector<std::string> words = wordsOf(text);
    const auto from = std::find_if(words.begin(), words.end(),
                                   [](const std::string& word) { return cim::sameName(word, "FROM"); });
    return from == words.end() || from + 1 == words.end() ? std::string() : *(from + 1);
}

using Content = std::variant<Question, cim::Status>;

/// The parts of the question that follow from others.
Content completed(Question question, const std::string& nameSpace)
{
    OperationRequest& request = question.request;
    if (request.operation == Operation::execQuery) {
        request.target.className = classOf(request.query);
        if (request.target.className.empty())
            return status(CMPI_RC_ERR_INVALID_QUERY, "the query names no class after FROM");
    }
    request.target.nameSpace = nameSpace;
    request.instance.path.nameSpace = nameSpace;
    if (request.operation == Operation::modifyInstance) {
        if (!cim::sameName(request.instance.path.className, request.target.className))
            return status(CMPI_RC_ERR_INVALID_PARAMETER,
                          "ModifiedInstance: the instance is not of the class of its name");
        request.instance.path = request.target;
    }
    return question;
}

/// \param call  IMETHODCALL
Content readContent(const Element& call, const RequestMessage& message, const XmlLimits& limits)
{
    const MethodEntry* const method = findMethod(message.method);
    if (method == nullptr)
        return status(CMPI_RC_ERR_NOT_SUPPORTED,
                      "the operation " + cim::excerpt(message.method) + " is not served");
    try {
        Question question;
        question.step = method->step;
        question.items = method->items;
        question.request.operation = method->operation;
        ParameterReader reader(*method, question, limits);
        for (const Element& child : call.children)
            if (child.name == "IPARAMVALUE")
                reader.take(child);
        reader.requireAll(call);
        return completed(std::move(question), message.nameSpace);
    } catch (const ValueError& error) {
        return status(error.code(), error.what());
    }
}

void requireVersion(const Element& element, std::string_view name, char major, Fault fault)
{
    const std::string& version = attribute(element, name);
    if (version.size() < 3 || version[0] != major || version[1] != '.')
        throw RequestError(fault, placeOf(element) + ": found " + std::string(name) + " \"" +
                                      cim::excerpt(version) + "\", expected " + major + ".x");
}

/// The element with the one operation. \param message  MESSAGE
const Element& findCall(const Element& message)
{
    const Element& request = onlyChild(message, {"SIMPLEREQ", "MULTIREQ", "SIMPLEEXPREQ", "MULTIEXPREQ"});
    if (request.name == "MULTIREQ")
        throw RequestError(Fault::multipleRequests, placeOf(request) + ": expected a single request");
    if (request.name != "SIMPLEREQ")
        throw RequestError(Fault::unsupportedOperation,
                           placeOf(request) + ": expected an operation, SIMPLEREQ");
    const Element* call = nullptr;
    for (const Element& child : childrenAmong(request, {"CORRELATOR", "IMETHODCALL", "METHODCALL"})) {
        if (child.name == "CORRELATOR")
            continue;
        if (call != nullptr)
            failAt(child, "a second call", "one");
        call = &child;
    }
    if (call == nullptr)
        failAt(request, "no call", "IMETHODCALL or METHODCALL");
    return *call;
}

/// \param call  IMETHODCALL
void readIntrinsic(const Element& call, const XmlLimits& limits, RequestMessage& message)
{
    childrenAmong(call, {"LOCALNAMESPACEPATH", "IPARAMVALUE"});
    if (call.children.empty() || call.children.front().name != "LOCALNAMESPACEPATH")
        failAt(call, "no namespace", "LOCALNAMESPACEPATH as its first element");
    const auto isNameSpace = [](const Element& child) { return child.name == "LOCALNAMESPACEPATH"; };
    if (std::count_if(call.children.begin(), call.children.end(), isNameSpace) > 1)
        failAt(call, "a second LOCALNAMESPACEPATH", "one");
    message.nameSpace = readNameSpace(call.children.front());
    message.content = readContent(call, message, limits);
}

/// Methods of a class: the broker calls none.
/// \param call  METHODCALL
void readExtrinsic(const Element& call, RequestMessage& message)
{
    message.isIntrinsic = false;
    const std::vector<Element>& parts =
        childrenAmong(call, {"LOCALCLASSPATH", "LOCALINSTANCEPATH", "PARAMVALUE"});
    if (parts.empty() || parts.front().name == "PARAMVALUE" || parts.front().children.empty())
        failAt(call, "no object", "LOCALCLASSPATH or LOCALINSTANCEPATH as its first element");
    message.nameSpace = readNameSpace(parts.front().children.front());
    message.content = status(CMPI_RC_ERR_NOT_SUPPORTED, "methods of classes are not served");
}

} // namespace

RequestMessage readRequest(std::string_view bytes, const XmlLimits& limits)
{
    const Element document = parseXml(bytes, limits, &isKnownElement);
    if (document.name != "CIM")
        failAt(document, "this element", "CIM");
    requireVersion(document, "CIMVERSION", '2', Fault::unsupportedCimVersion);
    requireVersion(document, "DTDVERSION", '2', Fault::unsupportedDtdVersion);
    const Element& element = onlyChild(document, {"MESSAGE"});
    requireVersion(element, "PROTOCOLVERSION", '1', Fault::unsupportedProtocolVersion);
    const Element& call = findCall(element);

    RequestMessage message;
    message.id = attribute(element, "ID");
    message.protocolVersion = attribute(element, "PROTOCOLVERSION");
    message.method = attribute(call, "NAME");
    if (call.name == "IMETHODCALL")
        readIntrinsic(call, limits, message);
    else
        readExtrinsic(call, message);
    return message;
}

} // namespace cimhost::serve
