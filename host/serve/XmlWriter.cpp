#include "serve/XmlWriter.h"

#include "cim/Utf8.h"

#include <new>
#include <optional>

#include <libxml/xmlwriter.h>

namespace cimhost::serve {

namespace {

/// Whether a document of XML 1.0 may have the character.
bool isAllowed(char32_t character)
{
    if (character < 0x20)
        return character == '\t' || character == '\n' || character == '\r';
    return (character < 0xD800 || character > 0xDFFF) && character != 0xFFFE && character != 0xFFFF;
}

std::string allowed(std::string_view text)
{
    std::string result;
    result.reserve(text.size());
    while (!text.empty()) {
        const std::string_view before = text;
        const std::optional<char32_t> character = cim::takeCharacter(text);
        if (character && isAllowed(*character))
            result += before.substr(0, before.size() - text.size());
        else
            cim::appendCharacter(result, 0xFFFD);
    }
    return result;
}

const xmlChar* xmlOf(const char* text)
{
    return reinterpret_cast<const xmlChar*>(text);
}

/// The library fails for want of memory only.
void require(int written)
{
    if (written < 0)
        throw std::bad_alloc();
}

} // namespace

XmlWriter::XmlWriter() : buffer_(xmlBufferCreate(), &xmlBufferFree), writer_(nullptr, &xmlFreeTextWriter)
{
    if (!buffer_)
        throw std::bad_alloc();
    xmlBufferSetAllocationScheme(buffer_.get(), XML_BUFFER_ALLOC_DOUBLEIT);
    writer_.reset(xmlNewTextWriterMemory(buffer_.get(), 0));
    if (!writer_)
        throw std::bad_alloc();
}

XmlWriter::~XmlWriter() = default;

void XmlWriter::declaration()
{
    require(xmlTextWriterStartDocument(writer_.get(), nullptr, "utf-8", nullptr));
}

void XmlWriter::attribute(const char* name, std::string_view value)
{
    require(xmlTextWriterWriteAttribute(writer_.get(), xmlOf(name), xmlOf(allowed(value).c_str())));
}

void XmlWriter::text(std::string_view text)
{
    require(xmlTextWriterWriteString(writer_.get(), xmlOf(allowed(text).c_str())));
}

std::string XmlWriter::document()
{
    require(xmlTextWriterFlush(writer_.get()));
    return {reinterpret_cast<const char*>(xmlBufferContent(buffer_.get())),
            static_cast<std::size_t>(xmlBufferLength(buffer_.get()))};
}

void XmlWriter::start(const char* name)
{
    require(xmlTextWriterStartElement(writer_.get(), xmlOf(name)));
}

void XmlWriter::end()
{
    require(xmlTextWriterFullEndElement(writer_.get()));
}

} // namespace cimhost::serve
