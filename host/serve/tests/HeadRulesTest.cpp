// What is refused by the head of a request alone.

#include "serve/HeadRules.h"

#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost::serve;
using testing::HasSubstr;

namespace {

class Head : public testing::Test
{
protected:
    /// The status of the refusal; 0: the body may be read.
    [[nodiscard]] unsigned int refusal(bool isLocal = true) const
    {
        const std::optional<HttpError> error = refusalOf(request, isLocal);
        return error ? error->status : 0;
    }

    /// The same with these headers, and one that names a host.
    unsigned int refusalWith(std::vector<HeaderField> headers)
    {
        request.headers = std::move(headers);
        request.headers.push_back({"Host", "127.0.0.1:5988"});
        return refusal();
    }

    unsigned int refusalOfHost(const std::string& host, bool isLocal = true)
    {
        request.headers = {{"Host", host}};
        return refusal(isLocal);
    }

    HttpRequest request{"POST", "/cimom", "HTTP/1.1", {}, ""};
};

TEST_F(Head, namesAHostOnce)
{
    EXPECT_EQ(refusal(), 400U);
    EXPECT_THAT(refusalOf(request, false)->message, HasSubstr("expected the header Host"));
    EXPECT_EQ(refusalWith({}), 0U);
    EXPECT_EQ(refusalWith({{"host", "127.0.0.1:5988"}}), 400U);
}

TEST_F(Head, needNotNameOneInHttp10)
{
    request.version = "HTTP/1.0";
    EXPECT_EQ(refusal(), 0U);
    EXPECT_EQ(refusalOfHost("evil.example"), 421U);
}

TEST_F(Head, namesALoopbackHostWhereOnlyThisMachineConnects)
{
    for (const char* host : {"localhost", "LocalHost:5988", "localhost.", "127.0.0.1", "127.0.0.1:5988",
                             "127.1.2.3:1", "[::1]", "[::1]:5988", "[::ffff:127.0.0.1]:5988", "localhost:"})
        EXPECT_EQ(refusalOfHost(host), 0U) << host;
    for (const char* host :
         {"evil.example", "evil.example:5988", "", "localhost.evil.example", "127.0.0.1.evil.example",
          "128.0.0.1", "0.0.0.0", "127.1", "2130706433", "[::2]", "[::]", "[::1", "::1", "localhost:a",
          "127.0.0.1:5988:1", "[::1]a", "[127.0.0.1]", "user@localhost", "localhost@evil.example"})
        EXPECT_NE(refusalOfHost(host), 0U) << host;
    EXPECT_EQ(refusalOfHost("evil.example"), 421U);
    EXPECT_EQ(refusalOfHost("evil.example:5988", false), 0U) << "an address that has names of its own";
    for (const char* host : {"a b", "a/b", "<a>", "a\"", "a@b"})
        EXPECT_EQ(refusalOfHost(host, false), 400U) << host;
}

TEST_F(Head, namesItInTheTargetToo)
{
    for (const char* target :
         {"http://evil.example/cimom", "HTTP://evil.example:5988", "http://a@evil.example/"}) {
        request.target = target;
        EXPECT_NE(refusalOfHost("localhost"), 0U) << target;
    }
    for (const char* target : {"http://localhost:5988/cimom", "/http://evil.example/", "*", "cimom", ""}) {
        request.target = target;
        EXPECT_EQ(refusalOfHost("localhost"), 0U) << target;
    }
}

TEST_F(Head, isOfNoPageInABrowser)
{
    EXPECT_EQ(refusalWith({{"Origin", "http://evil.example"}}), 403U);
    EXPECT_EQ(refusalWith({{"origin", "null"}}), 403U);
    EXPECT_EQ(refusalOf({"GET", "/", "HTTP/1.0", {{"Origin", "http://localhost"}}, ""}, false)->status, 403U);
}

TEST_F(Head, tellsTheLengthOnce)
{
    EXPECT_EQ(refusalWith({{"Content-Length", "1"}}), 0U);
    EXPECT_EQ(refusalWith({{"Content-Length", "99999999999999999999999"}}), 0U) << "too much, but a number";
    EXPECT_EQ(refusalWith({{"Content-Length", "1"}, {"content-length", "2"}}), 400U);
    EXPECT_EQ(refusalWith({{"Content-Length", "1"}, {"Content-Length", "1"}}), 400U);
    for (const char* length : {"", "x", "-1", "+1", "1x", "1, 1", " 1", "0x1"})
        EXPECT_EQ(refusalWith({{"Content-Length", length}}), 400U) << length;
}

TEST_F(Head, hasALengthOrChunks)
{
    EXPECT_EQ(refusalWith({{"Transfer-Encoding", "Chunked"}}), 0U);
    EXPECT_EQ(refusalWith({{"Transfer-Encoding", "chunked"}, {"Content-Length", "1"}}), 400U);
    EXPECT_EQ(refusalWith({{"Content-Length", "1"}, {"transfer-encoding", "identity"}}), 400U);
    for (const char* encoding : {"gzip", "gzip, chunked", "chunked, chunked", "identity", ""})
        EXPECT_EQ(refusalWith({{"Transfer-Encoding", encoding}}), 501U) << encoding;
    EXPECT_EQ(refusalWith({{"Transfer-Encoding", "chunked"}, {"Transfer-Encoding", "chunked"}}), 501U);
    request.version = "HTTP/1.0";
    EXPECT_EQ(refusalWith({{"Transfer-Encoding", "chunked"}}), 400U);
}

TEST_F(Head, hasNamesWithoutBlanks)
{
    EXPECT_EQ(refusalWith({{"Content-Length ", "1"}}), 400U);
    EXPECT_EQ(refusalWith({{"Transfer-Encoding\t", "chunked"}}), 400U);
}

} // namespace
