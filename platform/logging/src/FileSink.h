/// \file
/// Log lines in a file.
#ifndef MVLOG_FILESINK_H
#define MVLOG_FILESINK_H

#include "Descriptor.h"
#include "LineWriter.h"

#include <string>

#include <spdlog/details/null_mutex.h>
#include <spdlog/sinks/base_sink.h>

#include <sys/types.h>

namespace MVLog {

/// Appends lines to a file, and makes it anew once it was moved away or removed, as by a rotation of logs.
/// The caller sees to it that one thread at a time logs.
class FileSink : public spdlog::sinks::base_sink<spdlog::details::null_mutex>
{
public:
    /// \param path  relative to the process's folder of now
    /// \throw spdlog::spdlog_ex when it cannot be opened
    explicit FileSink(const std::string& path);

protected:
    /// \throw spdlog::spdlog_ex when the line cannot be written, or goes into the file that was moved away
    /// because there can be no other
    void sink_it_(const spdlog::details::log_msg& message) override;
    void flush_() override {}

private:
    /// Opens the file of that name. \return 0, or why it cannot be opened; what is open then stays open
    int open();
    [[nodiscard]] bool isMoved() const;

    std::string path_;
    Tavro::Descriptor file_;
    dev_t device_ = 0; ///< of the open file, as the next
    ino_t inode_ = 0;
    LineWriter writer_;
};

} // namespace MVLog

#endif
