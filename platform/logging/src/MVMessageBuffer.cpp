#include "MVLog/MVMessageBuffer.h"

#include <array>
#include <charconv>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <iterator>
#include <string_view>

namespace MVLog {

// No stream, which takes longer to be made than a line to be put together; and one piece of memory for a usual line.
struct MVMessageBuffer::Implementation
{
    void append(std::string_view piece)
    {
        if (failed)
            return;
        if (!rest.empty() || piece.size() > place.size() - length) {
            rest += piece;
            return;
        }
        std::memcpy(&place[length], piece.data(), piece.size());
        length += piece.size();
    }

    std::array<char, 448> place; ///< of the text's beginning
    std::size_t length = 0;      ///< of that beginning
    std::string rest;            ///< of the text
    bool failed = false;         ///< from the first null text on
};

MVMessageBuffer::MVMessageBuffer() : implementation_(new Implementation) {} // `place` is left as it is

MVMessageBuffer::~MVMessageBuffer() = default;

MVMessageBuffer& MVMessageBuffer::operator<<(const char* text)
{
    if (text == nullptr)
        implementation_->failed = true;
    else
        implementation_->append(text);
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(const std::string& text)
{
    implementation_->append(text);
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(const void* address)
{
    if (address == nullptr)
        return *this << "0";
    constexpr int hexadecimal = 16;
    const auto number = reinterpret_cast<std::uintptr_t>(address);
    char text[2 + 2 * sizeof number] = {'0', 'x'};
    const auto* const end = std::to_chars(std::begin(text) + 2, std::end(text), number, hexadecimal).ptr;
    implementation_->append({std::begin(text), static_cast<std::size_t>(end - std::begin(text))});
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(bool flag)
{
    implementation_->append(flag ? "1" : "0");
    return *this;
}

std::string MVMessageBuffer::str() const
{
    std::string text(implementation_->place.data(), implementation_->length);
    if (!implementation_->rest.empty())
        text += implementation_->rest;
    return text;
}

} // namespace MVLog
