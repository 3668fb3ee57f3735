// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <chrono>
#include <future>
#include <list>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "cimom/http/Server.h"
#include "tests/support/client/HttpClient.h"

namespace {

using namespace Cimom::Http;
using namespace Testing;
using namespace std::chrono_literals;

// Replies with what arrived.
Response echo(const Request& request) {
  Response response{200, {}, request.method + " " + request.path + " [" + request.body + "]" + request.user};
  response.headers.add("X-Echo", request.headers.find("X-Given") ? *request.headers.find("x-given") : "none");
  return response;
}

ServerOptions limitedTo(std::size_t bytes) {
  ServerOptions options;
  options.maxRequestSize = bytes;
  return options;
}

// A handler that waits until it is let go, and says when it has been reached.
struct Gate {
  std::promise<void> reached;
  std::promise<void> opened;
  std::shared_future<void> open = opened.get_future().share();

  Handler handler() {
    return [this](const Request&) {
      reached.set_value();
      open.wait();
      return Response{200, {}, "late"};
    };
  }
};

TEST(ServerTest, PassesMethodPathHeadersAndBodyToTheHandler) {
  Server server({}, echo);
  HttpClient client(server.port());
  const Response response = client.post("/cimom?x=1", "hello", "X-Given: value\r\n");
  EXPECT_EQ(response.status, 200u);
  EXPECT_EQ(response.body, "POST /cimom [hello]");
  EXPECT_EQ(*response.headers.find("X-Echo"), "value");
}

TEST(ServerTest, TakesAnyMethod) {
  Server server({}, echo);
  HttpClient client(server.port());
  client.send("M-POST /cimom HTTP/1.1\r\nHost: localhost\r\nContent-Length: 2\r\n\r\nab");
  EXPECT_EQ(client.receive().body, "M-POST /cimom [ab]");
}

TEST(ServerTest, AnswersSeveralRequestsOnOneConnection) {
  Server server({}, echo);
  HttpClient client(server.port());
  EXPECT_EQ(client.post("/a", "1").body, "POST /a [1]");
  EXPECT_EQ(client.post("/b", "2").body, "POST /b [2]");
}

TEST(ServerTest, AssemblesAChunkedBody) {
  Server server({}, echo);
  HttpClient client(server.port());
  client.send(
      "POST / HTTP/1.1\r\nHost: localhost\r\nTransfer-Encoding: chunked\r\n\r\n3\r\nabc\r\n2\r\nde\r\n0\r\n\r\n");
  EXPECT_EQ(client.receive().body, "POST / [abcde]");
}

TEST(ServerTest, AsksForTheBodyOfAClientThatExpectsIt) {
  Server server({}, echo);
  HttpClient client(server.port());
  client.send("POST / HTTP/1.1\r\nHost: localhost\r\nExpect: 100-continue\r\nContent-Length: 3\r\n\r\n");
  EXPECT_EQ(client.receive().status, 100u);
  client.send("abc");
  EXPECT_EQ(client.receive().body, "POST / [abc]");
}

TEST(ServerTest, TakesABodyAsLargeAsItsLimit) {
  Server server(limitedTo(100), echo);
  HttpClient client(server.port());
  EXPECT_EQ(client.post("/", std::string(100, 'x')).status, 200u);
}

TEST(ServerTest, RefusesALargerBodyBeforeItIsSent) {
  Server server(limitedTo(100), echo);
  HttpClient client(server.port());
  client.send("POST / HTTP/1.1\r\nHost: localhost\r\nExpect: 100-continue\r\nContent-Length: 101\r\n\r\n");
  EXPECT_EQ(client.receive().status, 413u);
}

TEST(ServerTest, RefusesALargerBodyThatIsSentAtOnce) {
  Server server(limitedTo(100), echo);
  HttpClient client(server.port());
  EXPECT_EQ(client.post("/", std::string(101, 'x')).status, 413u);
}

TEST(ServerTest, RefusesALengthThatNoNumberHolds) {
  Server server(limitedTo(100), echo);
  HttpClient client(server.port());
  client.send("POST / HTTP/1.1\r\nHost: localhost\r\nContent-Length: 99999999999999999999999\r\n\r\n");
  const unsigned status = client.receive().status;
  EXPECT_TRUE(status == 400 || status == 413) << status;
}

TEST(ServerTest, RefusesAChunkedBodyThatGrowsBeyondTheLimit) {
  Server server(limitedTo(100), echo);
  HttpClient client(server.port());
  client.send("POST / HTTP/1.1\r\nHost: localhost\r\nTransfer-Encoding: chunked\r\n\r\n");
  client.send("40\r\n" + std::string(64, 'x') + "\r\n40\r\n" + std::string(64, 'x') + "\r\n0\r\n\r\n");
  EXPECT_EQ(client.receive().status, 413u);
}

TEST(ServerTest, CutsOffAChunkedBodyThatNeverEnds) {
  Server server(limitedTo(100), echo);
  HttpClient client(server.port());
  client.send("POST / HTTP/1.1\r\nHost: localhost\r\nTransfer-Encoding: chunked\r\n\r\n");
  const std::string chunk = "400\r\n" + std::string(1024, 'x') + "\r\n";
  int sent = 0;
  while (sent < 100000 && client.send(chunk)) {
    ++sent;
  }
  EXPECT_LT(sent, 100000);
}

TEST(ServerTest, AnswersAnExceptionOfTheHandlerWithItsText) {
  Server server({}, [](const Request&) -> Response { throw std::runtime_error("out of order"); });
  HttpClient client(server.port());
  const Response response = client.post("/", "");
  EXPECT_EQ(response.status, 500u);
  EXPECT_EQ(response.body, "out of order\n");
}

TEST(ServerTest, ServesOthersWhileOneRequestWaits) {
  Gate gate;
  const Handler slow = gate.handler();
  Server server({}, [&](const Request& request) { return request.path == "/slow" ? slow(request) : echo(request); });
  HttpClient waiting(server.port());
  waiting.send("POST /slow HTTP/1.1\r\nHost: localhost\r\nContent-Length: 0\r\n\r\n");
  gate.reached.get_future().wait();
  for (int i = 0; i < 8; ++i) {
    EXPECT_EQ(HttpClient(server.port()).post("/fast", "").status, 200u);
  }
  gate.opened.set_value();
  EXPECT_EQ(waiting.receive().body, "late");
}

TEST(ServerTest, ClosesAnIdleConnection) {
  ServerOptions options;
  options.idleTimeout = 1s;
  Server server(options, echo);
  HttpClient client(server.port());
  EXPECT_TRUE(client.isClosed());
}

TEST(ServerTest, RepliesWithoutWaitingForAnAcknowledgement) {
  Server server({}, [](const Request&) { return Response{200, {}, std::string(20000, 'x')}; });
  HttpClient client(server.port());
  client.post("/", "");
  // A delayed acknowledgement costs 40 ms each time, a machine that stalls some of the times.
  int prompt = 0;
  for (int i = 0; i < 20; ++i) {
    const auto start = std::chrono::steady_clock::now();
    client.post("/", "body");
    prompt += std::chrono::steady_clock::now() - start < 30ms ? 1 : 0;
  }
  EXPECT_GE(prompt, 10);
}

TEST(ServerTest, WaitsForRequestsInProgressWhenShuttingDown) {
  Gate gate;
  Server server({}, gate.handler());
  HttpClient client(server.port());
  client.send("POST / HTTP/1.1\r\nHost: localhost\r\nContent-Length: 0\r\n\r\n");
  gate.reached.get_future().wait();
  EXPECT_FALSE(server.drain(1ms));
  EXPECT_THROW(HttpClient refused(server.port()), std::runtime_error);
  gate.opened.set_value();
  EXPECT_EQ(client.receive().body, "late");
  EXPECT_TRUE(server.drain(10s));
}

TEST(ServerTest, RefusesNewRequestsWhileShuttingDown) {
  Server server({}, echo);
  HttpClient client(server.port());
  client.post("/", "");
  EXPECT_TRUE(server.drain(10s));
  EXPECT_EQ(client.post("/", "").status, 503u);
}

TEST(ServerTest, NamesThePortThatIsTaken) {
  Server first({}, echo);
  ServerOptions options;
  options.port = first.port();
  try {
    Server second(options, echo);
    FAIL() << "two servers on one port";
  } catch (const ServerError& error) {
    EXPECT_EQ(std::string(error.what()),
              "cannot listen on 127.0.0.1 port " + std::to_string(first.port()) + ": Address already in use");
  }
}

TEST(ServerTest, RefusesAHostNameAsAddress) {
  ServerOptions options;
  options.address = "localhost";
  EXPECT_THROW(Server(options, echo), ServerError);
}

TEST(ServerTest, RefusesAMalformedTlsKey) {
  ServerOptions options;
  options.tlsCertificate = "no PEM";
  options.tlsKey = "no PEM";
  EXPECT_THROW(Server(options, echo), ServerError);
}

TEST(ServerTest, NamesAnIpv6EndpointInBrackets) {
  ServerOptions options;
  options.address = "::1";
  try {
    Server server(options, echo);
    EXPECT_EQ(server.endpoint(), "http://[::1]:" + std::to_string(server.port()));
  } catch (const ServerError& error) {
    GTEST_SKIP() << error.what();  // a machine without IPv6
  }
}

class AuthenticatedServerTest : public testing::Test {
 protected:
  static ServerOptions options() {
    ServerOptions options;
    options.authenticator = [](const std::string& user, const std::string& password) {
      return user == "admin" && password == "secret";
    };
    return options;
  }

  static constexpr const char* wrong_ = "Authorization: Basic YWRtaW46d3Jvbmc=\r\n";

  Server server_{options(), echo};
  HttpClient client_{server_.port()};
};

TEST_F(AuthenticatedServerTest, ChallengesAClientWithoutCredentials) {
  const Response response = client_.post("/", "body");
  EXPECT_EQ(response.status, 401u);
  EXPECT_EQ(*response.headers.find("WWW-Authenticate"), "Basic realm=\"cimom\"");
}

TEST_F(AuthenticatedServerTest, RefusesAWrongPassword) { EXPECT_EQ(client_.post("/", "", wrong_).status, 401u); }

TEST_F(AuthenticatedServerTest, TurnsAwayWhoGuessesManyAtOnceAndEndsWhileTheOthersWait) {
  ServerOptions many = options();
  many.maxConnectionsPerAddress = 200;
  std::vector<std::string> lines;
  std::mutex mutex;
  many.log = [&](const std::string& line) {
    const std::lock_guard lock(mutex);
    lines.push_back(line);
  };
  std::list<HttpClient> waiting;
  {
    Server server(many, echo);
    for (int i = 0; i < 3; ++i) {
      EXPECT_EQ(HttpClient(server.port()).post("/", "", wrong_).status, 401u);
    }
    for (int i = 0; i < 100; ++i) {
      waiting.emplace_back(server.port())
          .send("POST / HTTP/1.1\r\nHost: localhost\r\nContent-Length: 0\r\n" + std::string(wrong_) + "\r\n");
    }
    const Response refused = HttpClient(server.port()).post("/", "", wrong_);
    EXPECT_EQ(refused.status, 429u);
    EXPECT_EQ(*refused.headers.find("Retry-After"), "10");
    // Others may log in meanwhile.
    EXPECT_EQ(HttpClient(server.port(), "127.0.0.2").post("/", "", "Authorization: Basic YWRtaW46c2VjcmV0\r\n").status,
              200u);
  }
  EXPECT_EQ(waiting.back().receive().status, 429u);
  EXPECT_EQ(lines.front(), "login failed: user \"admin\" from 127.0.0.1");
}

TEST_F(AuthenticatedServerTest, RefusesMalformedCredentials) {
  EXPECT_EQ(client_.post("/", "", "Authorization: Basic !!!\r\n").status, 401u);
}

TEST_F(AuthenticatedServerTest, PassesTheUserToTheHandler) {
  EXPECT_EQ(client_.post("/", "b", "Authorization: Basic YWRtaW46c2VjcmV0\r\n").body, "POST / [b]admin");
}

}  // namespace
