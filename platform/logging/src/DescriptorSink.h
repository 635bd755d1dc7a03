/// \file
/// Where log lines go: an open file, one system call a line.
#ifndef MVLOG_DESCRIPTORSINK_H
#define MVLOG_DESCRIPTORSINK_H

#include <string>

#include <spdlog/details/null_mutex.h>
#include <spdlog/sinks/base_sink.h>

namespace MVLog {

/// Writes each line with one call, so that lines stay whole even where several processes append to
/// one file. The caller sees to it that one thread at a time logs.
class DescriptorSink : public spdlog::sinks::base_sink<spdlog::details::null_mutex>
{
public:
    /// Standard error.
    DescriptorSink();
    /// Opens a file to append to. \throw spdlog::spdlog_ex when it cannot be opened
    explicit DescriptorSink(const std::string& file);
    ~DescriptorSink() override;

    DescriptorSink(const DescriptorSink&) = delete;
    DescriptorSink& operator=(const DescriptorSink&) = delete;

protected:
    /// \throw spdlog::spdlog_ex when the line cannot be written
    void sink_it_(const spdlog::details::log_msg& message) override;
    void flush_() override {}

private:
    int descriptor_;
    bool isOwned_;
};

} // namespace MVLog

#endif
