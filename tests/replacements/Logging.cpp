// Another maker's logging library, which says that it was called.

#include <MVLog/MVLogger.h>
#include <MVLog/MVMessageBuffer.h>

#include <cstdio>

namespace MVLog {

void MVLogger::logLevelMessage(const char* function, const char*, int, const std::string&, int, const char*,
                               int, int, const std::string&)
{
    std::fprintf(stderr, "replaced log: %s\n", function);
}

void MVLogger::traceLevelMessage(const char* function, const char*, int, const std::string&, int, const char*,
                                 int, int, const std::string&)
{
    std::fprintf(stderr, "replaced trace: %s\n", function);
}

struct MVMessageBuffer::Implementation
{};

MVMessageBuffer::MVMessageBuffer() = default;
MVMessageBuffer::~MVMessageBuffer() = default;
MVMessageBuffer& MVMessageBuffer::operator<<(const char*)
{
    return *this;
}
MVMessageBuffer& MVMessageBuffer::operator<<(const std::string&)
{
    return *this;
}
MVMessageBuffer& MVMessageBuffer::operator<<(const void*)
{
    return *this;
}
MVMessageBuffer& MVMessageBuffer::operator<<(bool)
{
    return *this;
}
std::string MVMessageBuffer::str() const
{
    return {};
}

} // namespace MVLog
