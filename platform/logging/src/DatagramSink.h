/// \file
/// Log lines to a log daemon of this machine.
#ifndef MVLOG_DATAGRAMSINK_H
#define MVLOG_DATAGRAMSINK_H

#include "Descriptor.h"

#include <memory>
#include <string>

#include <spdlog/details/null_mutex.h>
#include <spdlog/formatter.h>
#include <spdlog/sinks/base_sink.h>

namespace MVLog {

/// Sends each line as a datagram to a socket of the file system, and connects anew when the daemon was
/// started anew. A daemon that does not read is waited for once, shortly; until it reads again, lines that
/// find its queue full are lost. The caller sees to it that one thread at a time logs.
class DatagramSink : public spdlog::sinks::base_sink<spdlog::details::null_mutex>
{
public:
    /// \param formatter  makes the datagrams
    /// \throw spdlog::spdlog_ex when nobody listens there
    DatagramSink(std::string path, std::unique_ptr<spdlog::formatter> formatter);

protected:
    /// \throw spdlog::spdlog_ex when the line cannot be sent
    void sink_it_(const spdlog::details::log_msg& message) override;
    void flush_() override {}

private:
    /// Each: \return 0, or why it failed
    int connect();
    int send(const spdlog::memory_buf_t& datagram);

    std::string path_;
    Tavro::Descriptor socket_;
    bool isStuck_ = false; ///< the last wait for the daemon was in vain
};

} // namespace MVLog

#endif
