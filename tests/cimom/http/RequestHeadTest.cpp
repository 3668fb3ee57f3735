// SPDX-License-Identifier: Apache-2.0
// Requests whose end is in doubt, or that are meant for another host, are refused, and the connection ends.
#include <gtest/gtest.h>

#include "cimom/http/Server.h"
#include "tests/support/client/HttpClient.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Cimom::Http;
using namespace Testing;

class RequestHeadTest : public testing::Test {
 protected:
  static ServerOptions options() {
    ServerOptions options;
    options.hostNames = {"managed.example"};
    return options;
  }

  // The status of a POST with these headers, and of HTTP/1.1 where nothing else is said.
  Response ask(const std::string& headers, const std::string& body = {}, const std::string& version = "1.1") const {
    HttpClient client(server_.port());
    client.send("POST / HTTP/" + version + "\r\n" + headers + "\r\n" + body);
    Response response = client.receive();
    if (response.status != 200) {
      EXPECT_TRUE(poll([&] { return client.receiveSome().empty(); })) << headers;
    }
    return response;
  }

  unsigned statusFor(const std::string& host) const {
    return ask("Host: " + host + "\r\nContent-Length: 0\r\n").status;
  }

  Server server_{options(), [](const Request&) { return Response{200, {}, "reached"}; }};
};

TEST_F(RequestHeadTest, RefusesTwoLengths) {
  EXPECT_EQ(ask("Host: localhost\r\nContent-Length: 3\r\nContent-Length: 4\r\n", "abcd").status, 400u);
  EXPECT_EQ(ask("Host: localhost\r\nContent-Length: 3\r\nContent-Length: 3\r\n", "abc").status, 400u);
  EXPECT_EQ(ask("Host: localhost\r\nContent-Length: 3, 3\r\n", "abc").status, 400u);
}

TEST_F(RequestHeadTest, RefusesALengthThatIsNone) {
  for (const char* length : {"-1", "+3", "3x", "0x3", ""}) {
    EXPECT_EQ(ask("Host: localhost\r\nContent-Length: " + std::string(length) + "\r\n", "abc").status, 400u) << length;
  }
}

TEST_F(RequestHeadTest, RefusesALengthWithChunking) {
  const Response response = ask("Host: localhost\r\nContent-Length: 5\r\nTransfer-Encoding: chunked\r\n", "0\r\n\r\n");
  EXPECT_EQ(response.status, 400u);
  EXPECT_EQ(response.body, "the request has both Content-Length and Transfer-Encoding\n");
}

TEST_F(RequestHeadTest, RefusesOtherCodingsThanChunked) {
  for (const char* coding : {"gzip", "gzip, chunked", "identity", "chunked, identity", "xchunked"}) {
    EXPECT_EQ(ask("Host: localhost\r\nTransfer-Encoding: " + std::string(coding) + "\r\n", "0\r\n\r\n").status, 501u)
        << coding;
  }
  EXPECT_EQ(ask("Host: localhost\r\nTransfer-Encoding: chunked\r\nTransfer-Encoding: identity\r\n", "0\r\n\r\n").status,
            501u);
  EXPECT_EQ(ask("Host: localhost\r\nTransfer-Encoding: Chunked\r\n", "0\r\n\r\n").status, 200u);
}

TEST_F(RequestHeadTest, RefusesChunkingOfHttp10) {
  EXPECT_EQ(ask("Host: localhost\r\nTransfer-Encoding: chunked\r\n", "0\r\n\r\n", "1.0").status, 400u);
}

TEST_F(RequestHeadTest, RefusesAFieldWhoseNameIsNone) {
  for (const char* field : {"Content-Length : 0", "Content-\tLength: 0", "X(Y): 0", "X\"Y: 0"}) {
    EXPECT_EQ(ask("Host: localhost\r\n" + std::string(field) + "\r\n").status, 400u) << field;
  }
}

TEST_F(RequestHeadTest, WantsOneHost) {
  EXPECT_EQ(ask("Content-Length: 0\r\n").body, "the request has no Host\n");
  EXPECT_EQ(ask("Host: localhost\r\nHost: localhost\r\nContent-Length: 0\r\n").status, 400u);
  EXPECT_EQ(ask("Content-Length: 0\r\n", "", "1.0").status, 200u);
}

TEST_F(RequestHeadTest, AnswersToItsOwnNamesAndAddresses) {
  for (const char* host : {"localhost", "LOCALHOST:5988", "localhost.", "127.0.0.1", "127.0.0.1:5988", "[::1]:5988",
                           "[::1]", "managed.example", "Managed.Example:80"}) {
    EXPECT_EQ(statusFor(host), 200u) << host;
  }
}

TEST_F(RequestHeadTest, RefusesAForeignHost) {
  for (const char* host : {"evil.example", "evil.example:5988", "localhost.evil.example", "127.0.0.1.evil.example",
                           "192.0.2.1", "[2001:db8::1]", "[::1", "[::1]x", "", ":5988", "localhost:80@evil.example"}) {
    EXPECT_EQ(statusFor(host), 421u) << host;
  }
  EXPECT_NE(ask("Host: evil.example\r\nContent-Length: 0\r\n").body.find("server-name"), std::string::npos);
}

TEST_F(RequestHeadTest, IsAnsweredInChunksWhereTheReplyIsLarge) {
  const Server server({}, [](const Request& request) {
    return Response{200, {}, std::string(request.path.size() > 1 ? 1 << 20 : 100, 'x')};
  });
  HttpClient client(server.port());
  const Response large = client.post("/large", "");
  EXPECT_EQ(*large.headers.find("Transfer-Encoding"), "chunked");
  EXPECT_EQ(large.headers.find("Content-Length"), nullptr);
  EXPECT_EQ(large.body, std::string(1 << 20, 'x'));
  const Response small = client.post("/", "");
  EXPECT_EQ(small.headers.find("Transfer-Encoding"), nullptr);
  EXPECT_EQ(*small.headers.find("Content-Length"), "100");
  client.send("POST /large HTTP/1.0\r\nContent-Length: 0\r\n\r\n");
  const Response old = client.receive();
  EXPECT_EQ(old.headers.find("Transfer-Encoding"), nullptr);
  EXPECT_EQ(*old.headers.find("Content-Length"), std::to_string(1 << 20));
}

TEST_F(RequestHeadTest, IsAnsweredWithTheWholeOfAReplyInPieces) {
  const std::vector<std::string> pieces = {std::string(70'000, 'b'), "", "c", std::string(100'000, 'd')};
  const Server server({}, [&](const Request& request) {
    return request.path == "/large" ? Response{200, {}, "a", {}, pieces} : Response{200, {}, "a", {}, {"b", "c"}};
  });
  const std::string whole = "a" + pieces[0] + pieces[1] + pieces[2] + pieces[3];
  HttpClient client(server.port());
  const Response large = client.post("/large", "");
  EXPECT_EQ(*large.headers.find("Transfer-Encoding"), "chunked");
  EXPECT_EQ(large.body, whole);
  const Response small = client.post("/", "");
  EXPECT_EQ(*small.headers.find("Content-Length"), "3");
  EXPECT_EQ(small.body, "abc");
  client.send("POST /large HTTP/1.0\r\nContent-Length: 0\r\n\r\n");
  const Response old = client.receive();
  EXPECT_EQ(*old.headers.find("Content-Length"), std::to_string(whole.size()));
  EXPECT_EQ(old.body, whole);
}

}  // namespace
