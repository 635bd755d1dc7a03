#include "serve/XmlLimits.h"

#include "serve/Fault.h"

#include <algorithm>
#include <iterator>
#include <string>
#include <vector>

namespace cimhost::serve {

namespace {

/// What of XML has no elements in it, and how it ends.
struct Opaque
{
    std::string_view begin;
    std::string_view end;
};

constexpr Opaque opaques[]{{"<!--", "-->"}, {"<![CDATA[", "]]>"}, {"<?", "?>"}};

class Counter
{
public:
    Counter(const XmlLimits& limits, std::string_view document) : limits_(limits), document_(document) {}

    void count()
    {
        for (position_ = document_.find('<'); position_ < document_.size();
             position_ = document_.find('<', position_))
            if (!skipOpaque())
                takeTag();
    }

private:
    [[nodiscard]] bool isAt(std::string_view text) const
    {
        return document_.compare(position_, text.size(), text) == 0;
    }

    void skipBehind(std::string_view text)
    {
        const std::size_t found = document_.find(text, position_);
        position_ = found == std::string_view::npos ? document_.size() : found + text.size();
    }

    bool skipOpaque()
    {
        const auto* const opaque =
            std::find_if(std::begin(opaques), std::end(opaques),
                         [&](const Opaque& candidate) { return isAt(candidate.begin); });
        if (opaque == std::end(opaques))
            return false;
        position_ += opaque->begin.size();
        skipBehind(opaque->end);
        return true;
    }

    void takeTag()
    {
        if (isAt("<!")) // a document type declaration, at which the parser stops
            position_ = document_.size();
        else if (isAt("</")) {
            closeElement();
            skipBehind(">");
        } else
            takeStart();
    }

    void openElement()
    {
        if (++elements_ > limits_.elements)
            fail("at most " + std::to_string(limits_.elements) + " elements");
        if (namespacesAround_.size() >= limits_.depth)
            fail("elements at most " + std::to_string(limits_.depth) + " deep in each other");
        namespacesAround_.push_back(namespaces_);
    }

    void closeElement()
    {
        if (namespacesAround_.empty())
            return;
        namespaces_ = namespacesAround_.back();
        namespacesAround_.pop_back();
    }

    void takeStart()
    {
        openElement();
        std::size_t ofElement = 0;
        for (++position_; position_ < document_.size() && document_[position_] != '>'; ++position_) {
            const char byte = document_[position_];
            if (byte == '"' || byte == '\'')
                position_ = std::min(document_.find(byte, position_ + 1), document_.size() - 1);
            else if (byte == '=')
                takeAttribute(++ofElement);
            else if (isAt("xmlns") && ++namespaces_ > limits_.namespaces)
                fail("at most " + std::to_string(limits_.namespaces) + " namespaces declared at a time");
        }
        if (document_[position_ - 1] == '/')
            closeElement();
    }

    /// \param ofElement  how many the element has up to this one
    void takeAttribute(std::size_t ofElement)
    {
        if (ofElement > limits_.attributesOfElement)
            fail("at most " + std::to_string(limits_.attributesOfElement) + " attributes of an element");
        if (++attributes_ > limits_.attributes)
            fail("at most " + std::to_string(limits_.attributes) + " attributes");
    }

    [[noreturn]] void fail(const std::string& expected) const
    {
        throw RequestError(Fault::tooLarge, placeAt(document_, position_) + "expected " + expected);
    }

    const XmlLimits& limits_;
    std::string_view document_;
    std::size_t position_ = 0; ///< of the byte looked at
    std::size_t elements_ = 0;
    std::size_t attributes_ = 0;
    std::size_t namespaces_ = 0;                ///< declared here and around
    std::vector<std::size_t> namespacesAround_; ///< for each element around: declared around that one
};

} // namespace

void requireWithin(const XmlLimits& limits, std::string_view document)
{
    Counter(limits, document).count();
}

std::string placeAt(std::string_view document, std::size_t position)
{
    const std::string_view before = document.substr(0, position);
    const auto line = 1 + std::count(before.begin(), before.end(), '\n');
    const std::size_t lineStart = before.rfind('\n') + 1; // 0 in the first line
    const auto isCharacter = [](char byte) { return (static_cast<unsigned char>(byte) & 0xC0) != 0x80; };
    const auto column =
        1 + std::count_if(before.begin() + static_cast<std::ptrdiff_t>(lineStart), before.end(), isCharacter);
    return "line " + std::to_string(line) + ", column " + std::to_string(column) + ": ";
}

} // namespace cimhost::serve
