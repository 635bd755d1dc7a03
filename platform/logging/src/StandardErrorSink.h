/// \file
/// Log lines on standard error.
#ifndef MVLOG_STANDARDERRORSINK_H
#define MVLOG_STANDARDERRORSINK_H

#include <spdlog/details/null_mutex.h>
#include <spdlog/sinks/base_sink.h>

namespace MVLog {

/// Nobody waits longer for whoever reads standard error than for another destination, although it is the
/// process's and may block. The caller sees to it that one thread at a time logs.
class StandardErrorSink : public spdlog::sinks::base_sink<spdlog::details::null_mutex>
{
protected:
    /// \throw spdlog::spdlog_ex when the line cannot be written
    void sink_it_(const spdlog::details::log_msg& message) override;
    void flush_() override {}
};

} // namespace MVLog

#endif
