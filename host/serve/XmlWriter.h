/// \file
/// An XML document, written element by element.
#ifndef CIMHOST_SERVE_XMLWRITER_H
#define CIMHOST_SERVE_XMLWRITER_H

#include <memory>
#include <string>
#include <string_view>

struct _xmlBuffer;
struct _xmlTextWriter;

namespace cimhost::serve {

/// Writes in UTF-8, without blanks between elements. An empty element has an end tag of its own, since
/// clients of the field do not know `<VALUE/>`. What XML cannot hold (most control characters,
/// bytes that are not UTF-8) becomes U+FFFD.
/// All functions: \throws std::bad_alloc
class XmlWriter
{
public:
    XmlWriter();
    ~XmlWriter();
    XmlWriter(const XmlWriter&) = delete;
    XmlWriter& operator=(const XmlWriter&) = delete;

    void declaration();
    void attribute(const char* name, std::string_view value);
    void text(std::string_view text);

    /// An element around what `content` writes; attributes come first.
    template <class Content>
    void element(const char* name, const Content& content)
    {
        start(name);
        content();
        end();
    }

    /// What has been written.
    [[nodiscard]] std::string document();

private:
    void start(const char* name);
    void end();

    std::unique_ptr<_xmlBuffer, void (*)(_xmlBuffer*)> buffer_;
    std::unique_ptr<_xmlTextWriter, void (*)(_xmlTextWriter*)> writer_;
};

} // namespace cimhost::serve

#endif
