/// \file
/// The text of a log line, put together piece by piece.
#ifndef MVLOG_MVMESSAGEBUFFER_H
#define MVLOG_MVMESSAGEBUFFER_H

#include <memory>
#include <string>

namespace MVLog {

/// Takes what is inserted as a standard output stream does. One thread at a time may use a buffer.
class MVMessageBuffer
{
public:
    MVMessageBuffer();
    ~MVMessageBuffer();

    MVMessageBuffer(const MVMessageBuffer&) = delete;
    MVMessageBuffer& operator=(const MVMessageBuffer&) = delete;

    /// A null text puts the buffer into its failed state: what it holds stays, nothing more is added.
    MVMessageBuffer& operator<<(const char* text);
    MVMessageBuffer& operator<<(const std::string& text);
    /// In the stream's format of an untyped pointer; null is an address like any other, 0.
    MVMessageBuffer& operator<<(const void* address);
    /// As 1 or 0.
    MVMessageBuffer& operator<<(bool flag);

    /// All that was inserted so far.
    [[nodiscard]] std::string str() const;

private:
    struct Implementation;
    std::unique_ptr<Implementation> implementation_;
};

} // namespace MVLog

#endif
