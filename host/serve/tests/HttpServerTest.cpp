// The server with real connections. The broker serves nothing: an operation is answered by status 3.

#include "serve/HttpServer.h"

#include "cim/Descriptor.h"
#include "serve/tests/Messages.h"

#include <future>
#include <list>
#include <memory>
#include <string>
#include <system_error>
#include <thread>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <arpa/inet.h>
#include <netinet/in.h>
#include <sys/socket.h>

using namespace cimhost;
using namespace cimhost::serve;
using testing::AllOf;
using testing::EndsWith;
using testing::HasSubstr;
using testing::StartsWith;

namespace {

/// A client that speaks bytes.
class Connection
{
public:
    explicit Connection(const Endpoint& endpoint) : socket_(socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0))
    {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_port = htons(endpoint.port);
        inet_pton(AF_INET, endpoint.address.c_str(), &address.sin_addr);
        if (connect(socket_.number(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0)
            throw std::system_error(errno, std::generic_category(), "connect");
    }

    /// Once the server has closed the connection nothing is sent any more.
    void send(const std::string& bytes) const
    {
        for (std::size_t sent = 0; sent < bytes.size();) {
            const ssize_t now =
                ::send(socket_.number(), bytes.data() + sent, bytes.size() - sent, MSG_NOSIGNAL);
            if (now <= 0)
                return;
            sent += static_cast<std::size_t>(now);
        }
    }

    /// One response: its head, and as much of a body as it announces. Empty: the connection was closed.
    std::string receive()
    {
        while (received_.find("\r\n\r\n") == std::string::npos)
            if (!receiveMore())
                return std::exchange(received_, "");
        const std::size_t head = received_.find("\r\n\r\n") + 4;
        const std::string announced = "Content-Length: ";
        const std::size_t length = std::stoul(received_.substr(received_.find(announced) + announced.size()));
        while (received_.size() < head + length)
            if (!receiveMore())
                return std::exchange(received_, "");
        std::string response = received_.substr(0, head + length);
        received_.erase(0, head + length);
        return response;
    }

    /// Waits for the response that says that the body is waited for.
    void waitForContinue()
    {
        const std::string response = "HTTP/1.1 100 Continue\r\n\r\n";
        while (received_.size() < response.size() && receiveMore()) {
        }
        ASSERT_EQ(received_.substr(0, response.size()), response);
        received_.erase(0, response.size());
    }

    /// Waits until the server closes the connection.
    bool isClosed()
    {
        while (receiveMore()) {
        }
        return true;
    }

private:
    bool receiveMore()
    {
        char bytes[4096];
        const ssize_t count = recv(socket_.number(), bytes, sizeof bytes, 0);
        if (count > 0)
            received_.append(bytes, static_cast<std::size_t>(count));
        return count > 0;
    }

    cimhost::cim::Descriptor socket_;
    std::string received_;
};

const std::string body = callOf("EnumerateInstanceNames", parameter("ClassName", className()));
const std::string head =
    "POST /cimom HTTP/1.1\r\nHost: localhost\r\nContent-Type: text/xml\r\nCIMOperation: MethodCall\r\n"
    "CIMMethod: EnumerateInstanceNames\r\nCIMObject: root%2Fcimv2\r\n";

std::string httpRequest(const std::string& content)
{
    return head + "Content-Length: " + std::to_string(content.size()) + "\r\n\r\n" + content;
}

class Server : public testing::Test
{
protected:
    void start(const ServerLimits& limits = {})
    {
        server = std::make_unique<HttpServer>(Endpoint{"127.0.0.1", 0}, binding, limits);
    }

    std::string ask(const std::string& request)
    {
        Connection connection(server->endpoint());
        connection.send(request);
        return connection.receive();
    }

    void expectServes() { EXPECT_THAT(ask(httpRequest(body)), HasSubstr("<ERROR CODE=\"3\"")); }

    Broker broker{{}, {}};
    CimBinding binding{broker, "here", {4096, {}}};
    std::unique_ptr<HttpServer> server;
};

TEST_F(Server, answersOnAFreePort)
{
    start();
    EXPECT_NE(server->endpoint().port, 0);
    const std::string response = ask(httpRequest(body));
    EXPECT_THAT(response, StartsWith("HTTP/1.1 200 OK\r\n"));
    EXPECT_THAT(response, HasSubstr("CIMOperation: MethodResponse\r\n"));
    EXPECT_THAT(response, EndsWith("</MESSAGE></CIM>"));
}

TEST_F(Server, saysWhyItCannotListen)
{
    start();
    const auto reasonFor = [&](const Endpoint& endpoint) -> std::string {
        try {
            const HttpServer second(endpoint, binding);
            return "none";
        } catch (const ListenError& error) {
            return error.what();
        }
    };
    const Endpoint taken = server->endpoint();
    EXPECT_EQ(reasonFor(taken), "cannot listen on " + textOf(taken) + ": Address already in use");
    EXPECT_EQ(reasonFor({"localhost", 0}), "cannot listen on localhost:0: expected an IPv4 or IPv6 address");
    EXPECT_THAT(reasonFor({"192.0.2.1", 0}), HasSubstr("cannot listen on 192.0.2.1:0: "));
}

TEST_F(Server, writesAddressesAsUrlsDo)
{
    EXPECT_EQ(textOf(Endpoint{"127.0.0.1", 5988}), "127.0.0.1:5988");
    EXPECT_EQ(textOf(Endpoint{"::1", 5988}), "[::1]:5988");
}

TEST_F(Server, keepsConnections)
{
    start();
    Connection connection(server->endpoint());
    for (int i = 0; i < 3; ++i) {
        connection.send(httpRequest(body));
        EXPECT_THAT(connection.receive(), StartsWith("HTTP/1.1 200 OK\r\n")) << i;
    }
    connection.send(httpRequest("<CIM"));
    EXPECT_THAT(connection.receive(), HasSubstr("CIMError: request-not-well-formed\r\n"));
    connection.send(httpRequest(body) + httpRequest(body));
    EXPECT_THAT(connection.receive(), StartsWith("HTTP/1.1 200 OK\r\n")) << "after an error, and two at once";
    EXPECT_THAT(connection.receive(), StartsWith("HTTP/1.1 200 OK\r\n"));
}

TEST_F(Server, takesChunkedBodies)
{
    start();
    EXPECT_THAT(ask(head + "Transfer-Encoding: chunked\r\n\r\n1\r\n<\r\n0\r\n\r\n"),
                HasSubstr("request-not-well-formed"));
    std::string chunks;
    for (const char byte : body)
        chunks += std::string("1\r\n") + byte + "\r\n";
    EXPECT_THAT(ask(head + "Transfer-Encoding: chunked\r\n\r\n" + chunks + "0\r\n\r\n"),
                HasSubstr("<ERROR CODE=\"3\""));
    std::string many;
    for (int i = 0; i < 5; ++i)
        many += "400\r\n" + std::string(1024, ' ') + "\r\n";
    EXPECT_THAT(ask(head + "Transfer-Encoding: chunked\r\n\r\n" + many + "0\r\n\r\n"),
                StartsWith("HTTP/1.1 413 "));
    expectServes();
}

TEST_F(Server, refusesABodyBeforeItComes)
{
    start();
    EXPECT_THAT(ask(head + "Content-Length: 4097\r\n\r\n"), StartsWith("HTTP/1.1 413 "));
    EXPECT_THAT(ask(head + "Content-Length: 4097\r\nExpect: 100-continue\r\n\r\n"),
                StartsWith("HTTP/1.1 413 "));
    EXPECT_THAT(ask(head + "\r\n"), StartsWith("HTTP/1.1 411 "));
    expectServes();
}

TEST_F(Server, refusesByTheHeadAndCloses)
{
    start();
    const std::string smuggled = httpRequest(body);
    const std::string length = "Content-Length: " + std::to_string(smuggled.size()) + "\r\n";
    const auto with = [](const std::string& host, const std::string& headers) {
        return "POST /cimom HTTP/1.1\r\n" + host + headers + head.substr(head.find("Content-Type"));
    };
    const std::string local = "Host: localhost\r\n";
    struct Case
    {
        std::string head;
        const char* status;
    };
    const std::vector<Case> cases{
        {with("Host: evil.example\r\n", length), "421"},
        {with("", length), "400"},
        {with(local + local, length), "400"},
        {with(local, length + "Origin: http://evil.example\r\n"), "403"},
        {with(local, "Content-Length: 0\r\n" + length), "400"},
        {with(local, length + length), "400"},
        {with(local, length + "Transfer-Encoding: chunked\r\n"), "400"},
        {with(local, "Transfer-Encoding: chunked\r\n" + length), "400"},
        {with(local, "Transfer-Encoding: gzip\r\n"), "501"},
        {"M-" + with(local, "Content-Length: 0\r\n" + length), "400"},
        {"GET /cimom HTTP/1.1\r\nHost: evil.example\r\n", "421"},
        {"GET http://evil.example/cimom HTTP/1.1\r\nHost: localhost\r\n", "421"},
    };
    for (const Case& refused : cases) {
        Connection connection(server->endpoint());
        // What one reader takes for the body is another request for another.
        connection.send(refused.head + "\r\n" + smuggled);
        const std::string response = connection.receive();
        EXPECT_THAT(response, StartsWith(std::string("HTTP/1.1 ") + refused.status + ' ')) << refused.head;
        EXPECT_THAT(response, HasSubstr("Connection: close\r\n")) << refused.head;
        EXPECT_EQ(connection.receive(), "") << "one answer alone: " << refused.head;
    }
    EXPECT_THAT(ask("POST /cimom HTTP/1.0\r\n" + head.substr(head.find("Content-Type")) +
                    "Content-Length: " + std::to_string(body.size()) + "\r\n\r\n" + body),
                HasSubstr("<ERROR CODE=\"3\""))
        << "a client of HTTP/1.0 names no host";
    expectServes();
}

TEST_F(Server, listensOnAllAddresses)
{
    for (const char* address : {"*", "0.0.0.0"}) {
        server = std::make_unique<HttpServer>(Endpoint{address, 0}, binding);
        EXPECT_EQ(server->endpoint().address, "0.0.0.0");
        EXPECT_TRUE(isEverywhere(server->endpoint()));
        EXPECT_FALSE(isLoopback(server->endpoint()));
        std::string request = httpRequest(body);
        request.replace(request.find("localhost"), 9, "any.example");
        EXPECT_THAT(ask(request), HasSubstr("<ERROR CODE=\"3\"")) << "nobody knows what names lead here";
    }
    start();
    EXPECT_FALSE(isEverywhere(server->endpoint()));
    EXPECT_TRUE(isLoopback(server->endpoint()));
    EXPECT_TRUE(isEverywhere({"::", 1}));
    EXPECT_TRUE(isLoopback({"::1", 1}));
    EXPECT_FALSE(isLoopback({"192.0.2.1", 1}));
}

TEST_F(Server, survivesWhatIsNoHttp)
{
    start();
    const std::vector<std::string> requests{
        "\r\n\r\n\r\n\r\n",
        "x\r\n\r\n",
        "POST\r\n\r\n",
        "POST /cimom\r\n\r\n",
        "POST /cimom HTTP/9.9\r\n\r\n",
        "GET / HTTP/1.0\r\n\r\n",
        "POST / HTTP/1.1\r\nno colon\r\n\r\n",
        "POST / HTTP/1.1\r\nHost: localhost\r\nContent-Length: -1\r\n\r\n",
        "POST / HTTP/1.1\r\nHost: localhost\r\nContent-Length: 1\r\nContent-Length: 2\r\n\r\nab",
        "POST / HTTP/1.1\r\nHost: localhost\r\nTransfer-Encoding: chunked\r\n\r\nzz\r\n",
        "POST / HTTP/1.1\r\nHost: localhost\r\nTransfer-Encoding: gzip\r\n\r\nzz\r\n",
        "POST / HTTP/1.1\r\nHost: localhost\r\n" + std::string(100000, 'a') + ": b\r\n\r\n",
        "POST /" + std::string(100000, 'a') + " HTTP/1.1\r\n\r\n",
        std::string(5, '\0') + "\xff\xfe\r\n\r\n",
        "\x16\x03\x01\x02 the beginning of TLS\r\n\r\n",
    };
    for (const std::string& request : requests) {
        Connection connection(server->endpoint());
        connection.send(request);
        connection.send("\r\n\r\n");
    }
    EXPECT_THAT(ask("GET / HTTP/1.1\r\nHost: localhost\r\n\r\n"), StartsWith("HTTP/1.1 405 "));
    EXPECT_THAT(ask("POST / HTTP/1.1\r\nHost: localhost\r\n" + std::string(100000, 'a') + ": b\r\n\r\n"),
                StartsWith("HTTP/1.1 431 "));
    expectServes();
}

TEST_F(Server, answersOthersWhileARequestIsHalfThere)
{
    start();
    Connection slow(server->endpoint());
    const std::string request = httpRequest(body);
    slow.send(request.substr(0, request.size() / 2));
    expectServes();
    slow.send(request.substr(request.size() / 2));
    EXPECT_THAT(slow.receive(), HasSubstr("<ERROR CODE=\"3\""));
}

TEST_F(Server, servesAgainAfterTooManyConnections)
{
    ServerLimits limits;
    limits.connections = 2;
    start(limits);
    {
        Connection first(server->endpoint());
        Connection second(server->endpoint());
        for (Connection* connection : {&first, &second}) {
            connection->send(httpRequest(body));
            EXPECT_THAT(connection->receive(), HasSubstr("200 OK"));
        }
        for (int i = 0; i < 10; ++i)
            const Connection more(server->endpoint());
    }
    // Until the server has seen that those two are gone it may close further ones.
    std::string response;
    for (int tries = 0; response.empty() && tries < 100000; ++tries)
        response = ask(httpRequest(body));
    EXPECT_THAT(response, HasSubstr("200 OK"));
}

TEST_F(Server, endsConnectionsThatAreIdle)
{
    ServerLimits limits;
    limits.idle = std::chrono::seconds(1);
    start(limits);
    Connection connection(server->endpoint());
    EXPECT_TRUE(connection.isClosed());
    expectServes();
}

TEST_F(Server, endsConnectionsThatAreBusyForTooLong)
{
    ServerLimits limits;
    limits.transfer = std::chrono::milliseconds(300);
    start(limits);
    Connection connection(server->endpoint());
    std::thread drip([&] {
        // Never idle, and never done: more bytes than fit into the time.
        for (int i = 0; i < 100; ++i) {
            connection.send("X");
            std::this_thread::sleep_for(std::chrono::milliseconds(20));
        }
    });
    EXPECT_TRUE(connection.isClosed());
    drip.join();
    expectServes();
}

TEST_F(Server, answersWhatIsThereWhenItEnds)
{
    start();
    Connection idle(server->endpoint());
    Connection busy(server->endpoint());
    busy.send(httpRequest(body));
    EXPECT_THAT(busy.receive(), HasSubstr("200 OK"));
    server.reset();
    EXPECT_TRUE(idle.isClosed());
    EXPECT_TRUE(busy.isClosed());
}

TEST_F(Server, endsWhileItRefusesLinesThatAreTooLong)
{
    const std::string request = "POST /" + std::string(100000, 'a');
    for (int i = 0; i < 100; ++i) {
        start();
        std::list<Connection> connections;
        for (int client = 0; client < 8; ++client)
            connections.emplace_back(server->endpoint()).send(request);
        connections.front().receive(); // the others are being refused
        server.reset();
    }
}

TEST_F(Server, saysWhetherAProviderIsStillAsked)
{
    RequestLimits requests;
    requests.atOnce = 0; // all wait for others, as they do for a provider
    requests.waiting = std::chrono::seconds(3);
    const CimBinding waiting(broker, "here", requests);
    ServerLimits limits;
    limits.farewell = std::chrono::seconds(0);
    HttpServer busy({"127.0.0.1", 0}, waiting, limits);
    Connection connection(busy.endpoint());
    connection.send(head + "Expect: 100-continue\r\nContent-Length: " + std::to_string(body.size()) +
                    "\r\n\r\n");
    connection.waitForContinue();
    EXPECT_TRUE(busy.finish()) << "it is being read";
    connection.send(body);
    auto response = std::async(std::launch::async, [&] { return connection.receive(); });
    bool isAsked = false;
    while (!isAsked && response.wait_for(std::chrono::milliseconds(1)) == std::future_status::timeout)
        isAsked = !busy.finish();
    EXPECT_TRUE(isAsked);
    EXPECT_THAT(response.get(), StartsWith("HTTP/1.1 503 "));
}

TEST_F(Server, tellsBusyClientsThatItEnds)
{
    ServerLimits limits;
    limits.farewell = std::chrono::hours(1); // nothing but its clients' requests keeps it
    start(limits);
    Connection half(server->endpoint());
    const std::string request = httpRequest(body);
    half.send(head + "Expect: 100-continue\r\n" +
              request.substr(head.size(), request.size() - head.size() - 1));
    half.waitForContinue(); // from now on its request is counted
    std::vector<std::thread> clients;
    std::vector<std::string> last(4);
    std::vector<std::promise<void>> begun(last.size());
    clients.reserve(last.size());
    for (std::size_t client = 0; client < last.size(); ++client)
        clients.emplace_back([&, client] {
            Connection connection(server->endpoint());
            // Another request as soon as one is answered, for as long as the connection is kept.
            for (int i = 0;; ++i) {
                connection.send(request);
                const std::string response = connection.receive();
                if (i == 0)
                    begun[client].set_value();
                if (response.empty())
                    break;
                last[client] = response;
            }
        });
    for (std::promise<void>& each : begun)
        each.get_future().wait();
    std::thread ending([&] { server.reset(); });
    for (std::thread& client : clients)
        client.join();
    half.send(request.substr(request.size() - 1));
    EXPECT_THAT(half.receive(), AllOf(HasSubstr("200 OK"), HasSubstr("Connection: close\r\n")));
    ending.join();
    EXPECT_THAT(last, testing::Each(AllOf(HasSubstr("200 OK"), HasSubstr("Connection: close\r\n"))));
}

TEST_F(Server, answersManyClientsAtOnce)
{
    start();
    std::vector<std::thread> clients;
    std::vector<int> answered(8);
    clients.reserve(answered.size());
    for (int& count : answered)
        clients.emplace_back([&count, this] {
            Connection connection(server->endpoint());
            for (int i = 0; i < 20; ++i) {
                connection.send(httpRequest(body));
                count += connection.receive().find("<ERROR CODE=\"3\"") == std::string::npos ? 0 : 1;
            }
        });
    for (std::thread& client : clients)
        client.join();
    EXPECT_THAT(answered, testing::Each(20));
}

} // namespace
