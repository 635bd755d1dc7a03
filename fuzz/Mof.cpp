// Declarations in MOF: read, or refused in one line that may go to a terminal; what is read is made whole and
// written for clients.

#include "FuzzTarget.h"

#include "cim/Utf8.h"
#include "schema/Classes.h"
#include "schema/MofReader.h"
#include "serve/ClassWriter.h"
#include "serve/Dtd.h"
#include "serve/Xml.h"

using namespace cimhost;

namespace {

void checkClass(const schema::Class& declaration, const schema::Classes& classes)
{
    const schema::Class whole = classes.completed(declaration);
    Fuzz::require(whole.properties.size() >= declaration.properties.size(), "a class keeps what it declares");
    for (const schema::Property& property : whole.properties) {
        Fuzz::require(property.origin == classes.originOf(declaration.name, property.name),
                      "a property has an origin");
        Fuzz::require(classes.isA(declaration.name, property.origin), "an origin is a superclass");
    }
    serve::XmlWriter xml;
    serve::writeClass(xml, whole);
    serve::parseXml(xml.document(), {1000, 1000000}, &serve::isKnownElement);
}

} // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    try {
        const schema::Classes classes(schema::readMof(Fuzz::textOf(data, size), "input").classes);
        for (const schema::Class* const declaration : classes.subclassesOf("", true))
            checkClass(*declaration, classes);
    } catch (const schema::MofError& error) {
        Fuzz::require(cim::printable(error.what()) == error.what(), "a refusal may go to a terminal");
    }
    return 0;
}
