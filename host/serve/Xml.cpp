#include "serve/Xml.h"

#include "cim/Utf8.h"
#include "cim/Values.h"
#include "serve/Fault.h"

#include <exception>
#include <limits>
#include <memory>
#include <new>
#include <optional>

#include <libxml/SAX2.h>
#include <libxml/parser.h>
#include <libxml/parserInternals.h>

namespace cimhost::serve {

namespace {

const char* bytesOf(const xmlChar* text)
{
    return reinterpret_cast<const char*>(text);
}

std::string place(int line, int column)
{
    return "line " + std::to_string(line) + ", column " + std::to_string(column) + ": ";
}

/// Text in UTF-8 without null characters is all that XML can be; the library would guess at anything else.
void requireText(std::string_view document)
{
    for (std::string_view rest = document; !rest.empty();) {
        const std::size_t position = document.size() - rest.size();
        const std::optional<char32_t> character = cim::takeCharacter(rest);
        if (!character || *character == 0)
            throw RequestError(Fault::notWellFormed,
                               placeAt(document, position) + "found " +
                                   (character ? "a null character" : "a byte that is not UTF-8") +
                                   ", expected text in UTF-8");
    }
}

/// Builds the tree while the library reads. Its functions are called by the library, which knows no
/// exceptions: the first one is kept until it has returned.
class Builder
{
public:
    Builder(std::string_view document, bool (*isKnown)(std::string_view))
        : isKnown_(isKnown),
          parser_(newParser(document), &xmlFreeParserCtxt)
    {}

    Element build()
    {
        xmlParseDocument(parser_.get());
        if (failure_)
            std::rethrow_exception(failure_);
        if (parser_->wellFormed == 0)
            throw RequestError(Fault::notWellFormed, "expected an XML document");
        if (root_.children.empty())
            throw RequestError(Fault::notLooselyValid, "expected the element CIM");
        return std::move(root_.children.front());
    }

private:
    xmlParserCtxtPtr newParser(std::string_view document);

    /// Runs a step of the building; what it throws ends the reading.
    template <class Step>
    static void guard(void* context, const Step& step)
    {
        auto& builder = *static_cast<Builder*>(static_cast<xmlParserCtxtPtr>(context)->_private);
        if (builder.failure_)
            return;
        try {
            step(builder);
        } catch (...) {
            builder.failure_ = std::current_exception();
            xmlStopParser(builder.parser_.get());
        }
    }

    static void onStartDocument(void* context)
    {
        guard(context, [](Builder& builder) { builder.checkEncoding(); });
    }

    static void onDocumentType(void* context, const xmlChar* /*name*/, const xmlChar* /*publicId*/,
                               const xmlChar* /*systemId*/)
    {
        guard(context, [](Builder& builder) {
            builder.fail(Fault::notValid, "found a document type declaration, expected none");
        });
    }

    static void onStart(void* context, const xmlChar* name, const xmlChar* prefix, const xmlChar* /*uri*/,
                        int /*namespaceCount*/, const xmlChar** /*namespaces*/, int attributeCount,
                        int /*defaultedCount*/, const xmlChar** attributes)
    {
        guard(context, [&](Builder& builder) {
            const std::string before = prefix == nullptr ? "" : std::string(bytesOf(prefix)) + ':';
            builder.start(before + bytesOf(name), attributeCount, attributes);
        });
    }

    static void onEnd(void* context, const xmlChar* /*name*/, const xmlChar* /*prefix*/,
                      const xmlChar* /*uri*/)
    {
        guard(context, [](Builder& builder) { builder.end(); });
    }

    static void onText(void* context, const xmlChar* text, int length)
    {
        guard(context, [&](Builder& builder) {
            if (builder.ignoredDepth_ == 0)
                builder.open_.back()->text.append(bytesOf(text), static_cast<std::size_t>(length));
        });
    }

    static void onError(void* context, xmlErrorPtr error)
    {
        guard(context, [&](Builder& builder) { builder.stopAt(*error); });
    }

    void checkEncoding() const;
    void start(std::string name, int attributeCount, const xmlChar** attributes);
    void end();
    void stopAt(const xmlError& error) const;
    [[noreturn]] void fail(Fault fault, const std::string& what) const;

    bool (*isKnown_)(std::string_view);
    Element root_; ///< the document's element is its child
    /// From the root inwards. An element's children stay where they are while it is the innermost.
    std::vector<Element*> open_{&root_};
    std::size_t ignoredDepth_ = 0; ///< how many elements inwards of an unknown one, itself included
    std::exception_ptr failure_;
    std::unique_ptr<xmlParserCtxt, decltype(&xmlFreeParserCtxt)> parser_;
};

xmlParserCtxtPtr Builder::newParser(std::string_view document)
{
    xmlParserCtxt* const parser =
        xmlCreateMemoryParserCtxt(document.data(), static_cast<int>(document.size()));
    if (parser == nullptr)
        throw std::bad_alloc();
    xmlSAXHandler handler{};
    handler.initialized = XML_SAX2_MAGIC;
    handler.startDocument = &onStartDocument;
    handler.internalSubset = &onDocumentType;
    handler.startElementNs = &onStart;
    handler.endElementNs = &onEnd;
    handler.characters = &onText;
    handler.ignorableWhitespace = &onText;
    handler.serror = &onError;
    *parser->sax = handler;
    parser->_private = this;
    // CDATA sections come as text.
    xmlCtxtUseOptions(parser, XML_PARSE_NONET | XML_PARSE_NOCDATA);
    return parser;
}

void Builder::checkEncoding() const
{
    const xmlChar* const declared =
        parser_->encoding != nullptr ? parser_->encoding : parser_->input->encoding;
    if (declared != nullptr && !cim::sameName(bytesOf(declared), "UTF-8"))
        fail(Fault::notWellFormed,
             "found the encoding " + cim::excerpt(bytesOf(declared)) + " declared, expected UTF-8");
}

void Builder::start(std::string name, int attributeCount, const xmlChar** attributes)
{
    if (ignoredDepth_ > 0 || !isKnown_(name)) {
        ++ignoredDepth_;
        return;
    }
    Element element;
    element.name = std::move(name);
    element.line = xmlSAX2GetLineNumber(parser_.get());
    for (int index = 0; index < attributeCount; ++index) {
        // Local name, prefix, namespace, first byte of the value and the one behind its last.
        const xmlChar** const attribute = attributes + static_cast<std::ptrdiff_t>(index) * 5;
        if (attribute[1] == nullptr)
            element.attributes.push_back(
                {bytesOf(attribute[0]), std::string(bytesOf(attribute[3]), bytesOf(attribute[4]))});
    }
    Element& parent = *open_.back();
    parent.children.push_back(std::move(element));
    open_.push_back(&parent.children.back());
}

void Builder::end()
{
    if (ignoredDepth_ > 0)
        --ignoredDepth_;
    else
        open_.pop_back();
}

void Builder::stopAt(const xmlError& error) const
{
    if (error.level < XML_ERR_ERROR)
        return;
    if (error.code == XML_ERR_NO_MEMORY)
        throw std::bad_alloc();
    std::string_view message = error.message == nullptr ? "not well-formed" : error.message;
    while (!message.empty() && message.back() == '\n')
        message.remove_suffix(1);
    throw RequestError(Fault::notWellFormed, place(error.line, error.int2) +
                                                 "expected well-formed XML: " + cim::excerpt(message, 200));
}

void Builder::fail(Fault fault, const std::string& what) const
{
    throw RequestError(
        fault, place(xmlSAX2GetLineNumber(parser_.get()), xmlSAX2GetColumnNumber(parser_.get())) + what);
}

} // namespace

Element parseXml(std::string_view document, const XmlLimits& limits, bool (*isKnown)(std::string_view name))
{
    // The library sets itself up once; several threads may be the first.
    static const bool isSetUp = [] {
        xmlInitParser();
        return true;
    }();
    static_cast<void>(isSetUp);
    if (document.empty())
        throw RequestError(Fault::notWellFormed, "found nothing, expected an XML document");
    if (document.size() > std::numeric_limits<int>::max())
        throw RequestError(Fault::tooLarge, "expected a document of less than 2 GiB");
    requireText(document);
    requireWithin(limits, document);
    return Builder(document, isKnown).build();
}

} // namespace cimhost::serve
