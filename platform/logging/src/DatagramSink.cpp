#include "DatagramSink.h"

#include <cerrno>
#include <cstring>
#include <utility>

#include <sys/socket.h>
#include <sys/time.h>
#include <sys/un.h>

namespace MVLog {
namespace {

constexpr timeval longestWait{0, 100000}; ///< a tenth of a second

} // namespace

DatagramSink::DatagramSink(std::string path, std::unique_ptr<spdlog::formatter> formatter)
    : path_(std::move(path))
{
    set_formatter_(std::move(formatter));
    if (const int error = connect(); error != 0)
        throw spdlog::spdlog_ex("cannot connect to " + path_, error);
}

int DatagramSink::connect()
{
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    if (path_.size() >= sizeof address.sun_path)
        return ENAMETOOLONG;
    std::memcpy(&address.sun_path, path_.c_str(), path_.size());

    if (!socket_.isOpen())
        socket_ = Tavro::Descriptor(socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0));
    if (!socket_.isOpen())
        return errno;
    setsockopt(socket_.number(), SOL_SOCKET, SO_SNDTIMEO, &longestWait, sizeof longestWait);
    return ::connect(socket_.number(), reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0
               ? 0
               : errno;
}

int DatagramSink::send(const spdlog::memory_buf_t& datagram)
{
    const int flags = MSG_NOSIGNAL | (isStuck_ ? MSG_DONTWAIT : 0);
    ssize_t sent = 0;
    do
        sent = ::send(socket_.number(), datagram.data(), datagram.size(), flags);
    while (sent < 0 && errno == EINTR);
    const int error = sent < 0 ? errno : 0;
    isStuck_ = error == EAGAIN;
    return error;
}

void DatagramSink::sink_it_(const spdlog::details::log_msg& message)
{
    spdlog::memory_buf_t datagram;
    formatter_->format(message, datagram);

    int error = send(datagram);
    if (error == ECONNREFUSED || error == ECONNRESET || error == ENOTCONN) {
        error = connect();
        if (error == 0)
            error = send(datagram);
    }
    if (error != 0)
        throw spdlog::spdlog_ex("a log line is lost: cannot send to " + path_, error);
}

} // namespace MVLog
