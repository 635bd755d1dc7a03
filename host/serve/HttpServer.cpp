#include "serve/HttpServer.h"

#include "serve/Deadlines.h"
#include "serve/HeadRules.h"

#include <atomic>
#include <condition_variable>
#include <mutex>
#include <string_view>
#include <utility>

#include <malloc.h>
#include <microhttpd.h>
#include <unistd.h>

namespace cimhost::serve {

namespace {

/// A request while it comes in.
struct Exchange
{
    HttpRequest request;
    bool isTooLarge = false;
};

using ResponsePointer = std::unique_ptr<MHD_Response, decltype(&MHD_destroy_response)>;

MHD_Result takeHeader(void* context, MHD_ValueKind /*kind*/, const char* name, const char* value)
{
    auto& request = *static_cast<HttpRequest*>(context);
    request.headers.push_back({name, value == nullptr ? "" : value});
    return MHD_YES;
}

/// A response while it goes out; the library asks for one piece after another.
ssize_t readBody(void* body, std::uint64_t /*position*/, char* bytes, std::size_t most)
{
    const std::size_t count = static_cast<Text*>(body)->read(bytes, most);
    return count > 0 ? static_cast<ssize_t>(count) : MHD_CONTENT_READER_END_OF_STREAM;
}

/// What a long answer took goes back to the system: the C library would keep it for a next one.
void freeBody(void* owner)
{
    constexpr std::size_t isLong = 8388608;
    const std::unique_ptr<Text> body(static_cast<Text*>(owner));
    if (body->size() < isLong)
        return;
    *body = Text();
    malloc_trim(0);
}

/// The library's response, which takes the body over.
ResponsePointer makeResponse(HttpResponse response)
{
    constexpr std::size_t blockSize = 65536;
    auto body = std::make_unique<Text>(std::move(response.body));
    ResponsePointer result(
        MHD_create_response_from_callback(body->size(), blockSize, &readBody, body.get(), &freeBody),
        &MHD_destroy_response);
    if (!result)
        return result;
    static_cast<void>(body.release()); // the callback's
    for (const HeaderField& field : response.headers)
        MHD_add_response_header(result.get(), field.name.c_str(), field.value.c_str());
    return result;
}

int socketOf(MHD_Connection* connection)
{
    return MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CONNECTION_FD)->connect_fd;
}

} // namespace

class HttpServer::Implementation
{
public:
    Implementation(const Endpoint& endpoint, const CimBinding& binding, const ServerLimits& limits)
        : binding_(binding),
          limits_(limits),
          socket_(listenAt(endpoint)),
          deadlines_(limits.transfer),
          daemon_(start())
    {}

    ~Implementation()
    {
        finish();
        waitForConnections();
        MHD_stop_daemon(daemon_);
    }

    Implementation(const Implementation&) = delete;
    Implementation& operator=(const Implementation&) = delete;

    bool finish()
    {
        if (!isEnding_.exchange(true))
            close(MHD_quiesce_daemon(daemon_));
        std::unique_lock<std::mutex> lock(mutex_);
        allEnded_.wait_for(lock, limits_.farewell, [&] { return requests_ == 0; });
        return asked_ == 0;
    }

    [[nodiscard]] const Endpoint& endpoint() const { return socket_.endpoint; }

private:
    MHD_Daemon* start()
    {
        MHD_Daemon* const daemon = MHD_start_daemon(
            MHD_USE_AUTO | MHD_USE_INTERNAL_POLLING_THREAD | MHD_USE_THREAD_PER_CONNECTION | MHD_USE_ITC, 0,
            nullptr, nullptr, &onRequest, this, MHD_OPTION_LISTEN_SOCKET, socket_.descriptor,
            MHD_OPTION_CONNECTION_LIMIT, limits_.connections, MHD_OPTION_CONNECTION_TIMEOUT,
            static_cast<unsigned int>(limits_.idle.count()), MHD_OPTION_NOTIFY_COMPLETED, &onCompleted, this,
            MHD_OPTION_NOTIFY_CONNECTION, &onConnection, this, MHD_OPTION_END);
        if (daemon == nullptr) {
            close(socket_.descriptor);
            throw ListenError("cannot start a server on " + textOf(socket_.endpoint));
        }
        return daemon;
    }

    /// Called with the headers, then with each piece of the body, then once more.
    static MHD_Result onRequest(void* self, MHD_Connection* connection, const char* target,
                                const char* method, const char* version, const char* piece,
                                std::size_t* pieceSize, void** state)
    {
        auto& server = *static_cast<Implementation*>(self);
        try {
            if (*state == nullptr) {
                auto& exchange = *server.begin(state);
                exchange.request.method = method;
                exchange.request.target = target;
                exchange.request.version = version;
                return server.takeHeaders(connection, exchange);
            }
            auto& exchange = *static_cast<Exchange*>(*state);
            if (*pieceSize == 0)
                return server.answer(connection, exchange);
            server.takePiece(exchange, {piece, std::exchange(*pieceSize, 0)});
            return MHD_YES;
        } catch (...) {
            return MHD_NO; // out of memory: the connection is closed
        }
    }

    static void onCompleted(void* self, MHD_Connection* connection, void** state,
                            MHD_RequestTerminationCode /*why*/)
    {
        auto& server = *static_cast<Implementation*>(self);
        server.end(state);
        server.deadlines_.begin(socketOf(connection));
    }

    static void onConnection(void* self, MHD_Connection* connection, void** /*state*/,
                             MHD_ConnectionNotificationCode what)
    {
        auto& server = *static_cast<Implementation*>(self);
        Deadlines& deadlines = server.deadlines_;
        if (what == MHD_CONNECTION_NOTIFY_STARTED)
            deadlines.begin(socketOf(connection));
        else
            deadlines.end(socketOf(connection));
        server.countConnection(what);
    }

    void countConnection(MHD_ConnectionNotificationCode what)
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        connections_ += what == MHD_CONNECTION_NOTIFY_STARTED ? 1 : -1;
        if (connections_ == 0)
            allEnded_.notify_all();
    }

    /// The library follows a null pointer when it is stopped while it refuses a request line that is too long.
    void waitForConnections()
    {
        constexpr std::chrono::seconds longest(1);
        deadlines_.endAll();
        std::unique_lock<std::mutex> lock(mutex_);
        allEnded_.wait_for(lock, longest, [&] { return connections_ == 0; });
    }

    Exchange* begin(void** state)
    {
        auto exchange = std::make_unique<Exchange>();
        {
            const std::lock_guard<std::mutex> lock(mutex_);
            ++requests_;
        }
        *state = exchange.get();
        return exchange.release();
    }

    void end(void** state)
    {
        if (*state == nullptr)
            return;
        delete static_cast<Exchange*>(std::exchange(*state, nullptr));
        const std::lock_guard<std::mutex> lock(mutex_);
        if (--requests_ == 0)
            allEnded_.notify_all();
    }

    /// Where a request is refused, what follows it cannot be told from its body: the connection is closed.
    MHD_Result takeHeaders(MHD_Connection* connection, Exchange& exchange) const
    {
        MHD_get_connection_values(connection, MHD_HEADER_KIND, &takeHeader, &exchange.request);
        std::optional<HttpResponse> refusal = refuse(exchange.request);
        return refusal ? send(connection, std::move(*refusal), true) : MHD_YES;
    }

    [[nodiscard]] std::optional<HttpResponse> refuse(const HttpRequest& request) const
    {
        const std::optional<HttpError> refusal = refusalOf(request, isLoopback(endpoint()));
        return refusal ? CimBinding::refused(*refusal) : binding_.refuse(request);
    }

    /// The last response of a connection says so, and those are that are sent while the server ends.
    MHD_Result send(MHD_Connection* connection, HttpResponse response, bool isLast) const
    {
        if (isLast || isEnding_)
            response.headers.push_back({"Connection", "close"});
        const unsigned int status = response.status;
        const ResponsePointer made = makeResponse(std::move(response));
        return made ? MHD_queue_response(connection, status, made.get()) : MHD_NO;
    }

    /// What goes beyond the limit is not kept.
    void takePiece(Exchange& exchange, std::string_view piece) const
    {
        std::string& body = exchange.request.body;
        exchange.isTooLarge = exchange.isTooLarge || body.size() + piece.size() > binding_.limits().bytes;
        if (exchange.isTooLarge)
            body.clear();
        else
            body += piece;
    }

    MHD_Result answer(MHD_Connection* connection, const Exchange& exchange)
    {
        const int socket = socketOf(connection);
        deadlines_.end(socket); // the broker may take its time
        ++asked_;
        HttpResponse response = exchange.isTooLarge ? binding_.tooLarge() : binding_.answer(exchange.request);
        --asked_;
        deadlines_.begin(socket);
        return send(connection, std::move(response), false);
    }

    const CimBinding& binding_;
    ServerLimits limits_;
    ListeningSocket socket_;
    std::mutex mutex_;
    std::condition_variable allEnded_;
    std::atomic<bool> isEnding_ = false;
    std::atomic<int> asked_ = 0; ///< requests that the binding is asked for
    int requests_ = 0;           ///< those that are being read, answered or sent
    int connections_ = 0;
    Deadlines deadlines_;
    MHD_Daemon* daemon_;
};

HttpServer::HttpServer(const Endpoint& endpoint, const CimBinding& binding, const ServerLimits& limits)
    : implementation_(std::make_unique<Implementation>(endpoint, binding, limits))
{}

HttpServer::~HttpServer() = default;

bool HttpServer::finish()
{
    return implementation_->finish();
}

const Endpoint& HttpServer::endpoint() const
{
    return implementation_->endpoint();
}

} // namespace cimhost::serve
