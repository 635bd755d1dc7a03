/// \file
/// An XML document, written element by element.
#ifndef CIMHOST_SERVE_XMLWRITER_H
#define CIMHOST_SERVE_XMLWRITER_H

#include "serve/Text.h"

#include <exception>
#include <memory>
#include <string>
#include <string_view>

struct _xmlTextWriter;

namespace cimhost::serve {

/// Writes in UTF-8, without blanks between elements. An empty element has an end tag of its own, since
/// clients of the field do not know `<VALUE/>`. What XML cannot hold (most control characters,
/// bytes that are not UTF-8) becomes U+FFFD.
/// All functions: \throws std::bad_alloc, TextTooLong
class XmlWriter
{
public:
    /// \param text  what it is written to
    explicit XmlWriter(Text text = Text());
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

    /// What has been written, the last call.
    [[nodiscard]] Text take();
    /// The same as one string.
    [[nodiscard]] std::string document() { return take().whole(); }

private:
    static int append(void* self, const char* bytes, int count);
    void require(int written) const;
    void start(const char* name);
    void end();

    Text text_;
    std::exception_ptr failure_; ///< of the text; the library knows no exceptions
    std::unique_ptr<_xmlTextWriter, void (*)(_xmlTextWriter*)> writer_;
};

} // namespace cimhost::serve

#endif
