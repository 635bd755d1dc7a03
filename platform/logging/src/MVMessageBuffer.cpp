#include "MVLog/MVMessageBuffer.h"

#include <charconv>
#include <cstdint>
#include <iterator>
#include <string_view>

namespace MVLog {

// A text and not a stream: a stream takes longer to be made than a line to be put together.
struct MVMessageBuffer::Implementation
{
    Implementation() { text.reserve(usualLength); }

    void append(std::string_view piece)
    {
        if (!failed)
            text += piece;
    }

    static constexpr std::size_t usualLength = 255; ///< that of a line with its parameter list

    std::string text;
    bool failed = false; ///< from the first null text on
};

MVMessageBuffer::MVMessageBuffer() : implementation_(std::make_unique<Implementation>()) {}

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
    constexpr int hexadecimal = 16;
    const auto number = reinterpret_cast<std::uintptr_t>(address);
    char digits[2 * sizeof number];
    const auto* const end = std::to_chars(std::begin(digits), std::end(digits), number, hexadecimal).ptr;
    if (address != nullptr)
        implementation_->append("0x");
    implementation_->append({digits, static_cast<std::size_t>(end - digits)});
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(bool flag)
{
    implementation_->append(flag ? "1" : "0");
    return *this;
}

std::string MVMessageBuffer::str() const
{
    return implementation_->text;
}

} // namespace MVLog
