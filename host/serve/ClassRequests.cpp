#include "serve/ClassRequests.h"

#include "cim/Utf8.h"
#include "cim/Values.h"
#include "serve/ValueReader.h"

#include <algorithm>
#include <utility>

namespace cimhost::serve {

namespace {

bool isNameSpaceOf(const RegisteredClass& entry, const std::string& nameSpace)
{
    return std::any_of(entry.nameSpaces.begin(), entry.nameSpaces.end(),
                       [&](const std::string& name) { return cim::sameName(name, nameSpace); });
}

void requireNameSpace(const Registration& registration, const std::string& nameSpace)
{
    if (std::none_of(registration.classes.begin(), registration.classes.end(),
                     [&](const RegisteredClass& entry) { return isNameSpaceOf(entry, nameSpace); }))
        throw ValueError(CMPI_RC_ERR_INVALID_NAMESPACE, "no registration names the namespace " + nameSpace);
}

bool isThere(const schema::Class& declaration, const Registration& registration, const std::string& nameSpace)
{
    bool isRegistered = false;
    for (const RegisteredClass& entry : registration.classes) {
        if (!cim::sameName(entry.className, declaration.name))
            continue;
        isRegistered = true;
        if (isNameSpaceOf(entry, nameSpace))
            return true;
    }
    return !isRegistered;
}

/// Takes away all items for which it is true.
template <class Item, class Predicate>
void drop(std::vector<Item>& items, const Predicate& isUnwanted)
{
    items.erase(std::remove_if(items.begin(), items.end(), isUnwanted), items.end());
}

template <class Item>
void dropInherited(std::vector<Item>& items)
{
    drop(items, [](const Item& item) { return item.isInherited; });
}

/// As much of the class as is asked for.
schema::Class told(schema::Class whole, const Question& question)
{
    if (const cim::PropertyList& wanted = question.request.properties)
        drop(whole.properties, [&](const schema::Property& property) {
            return std::none_of(wanted->begin(), wanted->end(),
                                [&](const std::string& name) { return cim::sameName(name, property.name); });
        });
    const bool localOnly = question.localOnly.value_or(true);
    if (localOnly) {
        dropInherited(whole.properties);
        dropInherited(whole.qualifiers);
    }
    const bool withQualifiers = question.includeQualifiers.value_or(true);
    if (!withQualifiers)
        whole.qualifiers.clear();
    for (schema::Property& property : whole.properties) {
        if (localOnly)
            dropInherited(property.qualifiers);
        if (!withQualifiers)
            property.qualifiers.clear();
        if (!question.includeClassOrigin.value_or(false))
            property.origin.clear();
    }
    return whole;
}

Reply find(const Question& question, const Broker& broker)
{
    const schema::Classes& classes = broker.classes();
    const std::string& nameSpace = question.request.target.nameSpace;
    const std::string& name = question.request.target.className;
    requireNameSpace(broker.registration(), nameSpace);
    const schema::Class* const asked = classes.find(name);
    const bool isKnown = asked != nullptr && isThere(*asked, broker.registration(), nameSpace);
    const bool isGet = question.step == Step::getClass;
    if (!isKnown && (isGet || !name.empty()))
        throw ValueError(isGet ? CMPI_RC_ERR_NOT_FOUND : CMPI_RC_ERR_INVALID_CLASS,
                         "no class " + cim::excerpt(name) + " is known in " + nameSpace);
    Reply reply;
    if (isGet) {
        reply.classes.push_back(told(classes.completed(*asked), question));
        return reply;
    }
    for (const schema::Class* const found :
         classes.subclassesOf(name, question.deepInheritance.value_or(false))) {
        if (!isThere(*found, broker.registration(), nameSpace))
            continue;
        if (question.step == Step::enumerateClassNames)
            reply.classes.push_back({found->name, {}, {}, {}});
        else
            reply.classes.push_back(told(classes.completed(*found), question));
    }
    return reply;
}

} // namespace

Reply findClasses(const Question& question, const Broker& broker)
{
    try {
        return find(question, broker);
    } catch (const ValueError& error) {
        return {{{error.code(), error.what()}, {}, {}}};
    }
}

} // namespace cimhost::serve
