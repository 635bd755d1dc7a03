#include "MVLog/MVMessageBuffer.h"

#include <sstream>

namespace MVLog {

struct MVMessageBuffer::Implementation
{
    std::ostringstream stream;
};

MVMessageBuffer::MVMessageBuffer() : implementation_(std::make_unique<Implementation>()) {}

MVMessageBuffer::~MVMessageBuffer() = default;

MVMessageBuffer& MVMessageBuffer::operator<<(const char* text)
{
    implementation_->stream << text;
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(const std::string& text)
{
    implementation_->stream << text;
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(const void* address)
{
    implementation_->stream << address;
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(bool flag)
{
    implementation_->stream << flag;
    return *this;
}

std::string MVMessageBuffer::str() const
{
    return implementation_->stream.str();
}

} // namespace MVLog
