/// \file
/// Log lines on standard error.
#ifndef MVLOG_STANDARDERRORSINK_H
#define MVLOG_STANDARDERRORSINK_H

#include "LineWriter.h"

#include <spdlog/details/null_mutex.h>
#include <spdlog/sinks/base_sink.h>

#include <unistd.h>

namespace MVLog {

/// The caller sees to it that one thread at a time logs.
class StandardErrorSink : public spdlog::sinks::base_sink<spdlog::details::null_mutex>
{
protected:
    /// \throw spdlog::spdlog_ex when the line cannot be written
    void sink_it_(const spdlog::details::log_msg& message) override
    {
        spdlog::memory_buf_t line;
        formatter_->format(message, line);
        writer_.write({line.data(), line.size()});
    }
    void flush_() override {}

private:
    LineWriter writer_{STDERR_FILENO, "standard error"};
};

} // namespace MVLog

#endif
