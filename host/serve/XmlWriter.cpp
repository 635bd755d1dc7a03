#include "serve/XmlWriter.h"

#include "cim/Utf8.h"

#include <new>
#include <optional>
#include <utility>

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

} // namespace

XmlWriter::XmlWriter(Text text) : text_(std::move(text)), writer_(nullptr, &xmlFreeTextWriter)
{
    xmlOutputBuffer* const output = xmlOutputBufferCreateIO(&append, nullptr, this, nullptr);
    if (output == nullptr)
        throw std::bad_alloc();
    writer_.reset(xmlNewTextWriter(output));
    if (writer_)
        return;
    xmlOutputBufferClose(output);
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

Text XmlWriter::take()
{
    require(xmlTextWriterFlush(writer_.get()));
    return std::move(text_);
}

/// A failure is told to the caller of the next function: the library would write about it to standard error.
int XmlWriter::append(void* self, const char* bytes, int count)
{
    auto& writer = *static_cast<XmlWriter*>(self);
    if (writer.failure_)
        return count;
    try {
        writer.text_.append({bytes, static_cast<std::size_t>(count)});
    } catch (...) {
        writer.failure_ = std::current_exception();
    }
    return count;
}

/// The library itself fails for want of memory only.
void XmlWriter::require(int written) const
{
    if (failure_)
        std::rethrow_exception(failure_);
    if (written < 0)
        throw std::bad_alloc();
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
