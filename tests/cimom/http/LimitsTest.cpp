// SPDX-License-Identifier: Apache-2.0
// No client takes the server from the others: how many connections and requests there may be, how long each may take,
// and what a handler that does not return costs.
#include <gtest/gtest.h>
#include <pthread.h>
#include <sys/resource.h>

#include <atomic>
#include <condition_variable>
#include <deque>
#include <mutex>

#include "cimom/http/Server.h"
#include "ground/Descriptor.h"
#include "tests/support/client/HttpClient.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Cimom::Http;
using namespace Testing;
using namespace std::chrono_literals;

Response echo(const Request& request) { return Response{200, {}, request.path}; }

// Requests for /slow wait until the gate is open.
class Gate {
 public:
  Handler handler() {
    return [this](const Request& request) {
      if (request.path == "/slow") {
        std::unique_lock lock(mutex_);
        ++waiting_;
        opened_.wait(lock, [this] { return open_; });
        --waiting_;
      }
      return echo(request);
    };
  }

  int waiting() {
    const std::lock_guard lock(mutex_);
    return waiting_;
  }

  void open() {
    const std::lock_guard lock(mutex_);
    open_ = true;
    opened_.notify_all();
  }

 private:
  std::mutex mutex_;
  std::condition_variable opened_;
  int waiting_ = 0;
  bool open_ = false;
};

void ask(HttpClient& client, const std::string& path) {
  client.send("POST " + path + " HTTP/1.1\r\nHost: localhost\r\nContent-Length: 0\r\n\r\n");
}

class LimitsTest : public testing::Test {
 protected:
  ~LimitsTest() override { gate_.open(); }

  Server& start(Handler handler = echo) { return *(server_ = std::make_unique<Server>(options_, std::move(handler))); }

  // Whether the server answers a new client now.
  bool answers() {
    try {
      return HttpClient(server_->port()).post("/", "").status == 200;
    } catch (const std::runtime_error&) {
      return false;
    }
  }

  // Clients that send the beginning of a request, and no more.
  void connectSlowClients(int count, const char* from) {
    for (int i = 0; i < count; ++i) {
      slow_.emplace_back(server_->port(), from).send("POST / HTTP/1.1\r\nHo");
    }
  }

  Gate gate_;
  ServerOptions options_;
  std::unique_ptr<Server> server_;
  std::deque<HttpClient> slow_;
};

TEST_F(LimitsTest, ServesOneAddressWhileAnotherHasTakenAllThatItMay) {
  start();
  connectSlowClients(64, "127.0.0.1");
  EXPECT_EQ(HttpClient(server_->port(), "127.0.0.2").post("/", "").status, 200u);
  const Response refused = HttpClient(server_->port(), "127.0.0.1").post("/", "");
  EXPECT_EQ(refused.status, 503u);
  EXPECT_EQ(refused.body, "too many connections\n");
  EXPECT_EQ(*refused.headers.find("Retry-After"), "1");
  slow_.pop_back();
  EXPECT_TRUE(poll([&] { return HttpClient(server_->port(), "127.0.0.1").post("/", "").status == 200; }));
}

TEST_F(LimitsTest, AnswersTheClientBeyondTheLimitOfConnections) {
  options_.maxConnections = 3;
  start();
  connectSlowClients(3, "127.0.0.1");
  EXPECT_EQ(HttpClient(server_->port(), "127.0.0.2").post("/", "").status, 503u);
  slow_.pop_back();
  EXPECT_TRUE(poll([&] { return HttpClient(server_->port(), "127.0.0.2").post("/", "").status == 200; }));
}

TEST_F(LimitsTest, OutlivesMoreConnectionsThanItTellsThatThereIsNoRoom) {
  options_.maxConnections = 1;
  start();
  connectSlowClients(100, "127.0.0.1");
  slow_.clear();
  EXPECT_TRUE(poll([this] { return answers(); }));
}

TEST_F(LimitsTest, CutsAClientThatSendsItsRequestTooSlowly) {
  options_.requestTimeout = 1s;
  start();
  HttpClient client(server_->port());
  // A byte now and then is traffic, and yet no request.
  const auto start = std::chrono::steady_clock::now();
  ASSERT_TRUE(poll([&] { return !client.send("P"); }, 20s));
  EXPECT_GE(std::chrono::steady_clock::now() - start, 900ms);
}

TEST_F(LimitsTest, CutsAClientWhoseSecondRequestIsTooSlow) {
  options_.requestTimeout = 3s;
  options_.idleTimeout = 3s;
  start();
  HttpClient client(server_->port());
  EXPECT_EQ(client.post("/", "").status, 200u);
  client.send("POST / HTTP/1.1\r\n");
  EXPECT_TRUE(poll([&] { return !client.send("a"); }, 20s));
}

TEST_F(LimitsTest, CutsAClientThatDoesNotTakeItsReply) {
  options_.idleTimeout = 1s;
  options_.maxConnections = 1;
  start([](const Request&) { return Response{200, {}, std::string(64 << 20, 'x')}; });
  HttpClient client(server_->port());
  ask(client, "/");
  EXPECT_FALSE(client.receiveSome().empty());
  EXPECT_TRUE(poll([&] {
    HttpClient other(server_->port());
    ask(other, "/");
    return other.receiveSome().starts_with("HTTP/1.1 200");
  }));
}

TEST_F(LimitsTest, RefusesRequestsBeyondThoseThatItAnswersAtOnce) {
  options_.maxRequests = 2;
  start(gate_.handler());
  HttpClient first(server_->port());
  HttpClient second(server_->port());
  ask(first, "/slow");
  ask(second, "/slow");
  ASSERT_TRUE(poll([&] { return gate_.waiting() == 2; }));
  const Response refused = HttpClient(server_->port()).post("/", "");
  EXPECT_EQ(refused.status, 503u);
  EXPECT_EQ(refused.body, "too many requests at once\n");
  gate_.open();
  EXPECT_EQ(first.receive().body, "/slow");
  EXPECT_EQ(second.receive().body, "/slow");
  EXPECT_EQ(HttpClient(server_->port()).post("/", "").status, 200u);
}

TEST_F(LimitsTest, AnswersInThePlaceOfAHandlerThatDoesNot) {
  options_.operationTimeout = 3s;
  options_.maxRequests = 1;
  std::string asked;
  options_.failureHandler = [&](const Request& request, const std::string& why) {
    asked = request.body;
    return Response{200, {}, why};
  };
  start(gate_.handler());
  HttpClient client(server_->port());
  const Response late = client.post("/slow", "body");
  EXPECT_EQ(late.body, "the provider did not answer within 3 s");
  EXPECT_EQ(asked, "body");
  // Another thread is in the place of the one that waits; one more such handler, and there is none.
  EXPECT_EQ(client.post("/", "").status, 200u);
  EXPECT_EQ(client.post("/slow", "").status, 200u);
  EXPECT_EQ(gate_.waiting(), 2);
  EXPECT_EQ(client.post("/", "").status, 503u);
  EXPECT_FALSE(server_->drain(1ms));
  gate_.open();
  EXPECT_TRUE(server_->drain(10s));
}

TEST_F(LimitsTest, HoldsNoPlaceForAClientThatHasGone) {
  options_.operationTimeout = 3s;
  options_.maxRequests = 1;
  start(gate_.handler());
  {
    HttpClient gone(server_->port());
    ask(gone, "/slow");
    ASSERT_TRUE(poll([&] { return gate_.waiting() == 1; }));
  }
  EXPECT_TRUE(poll([&] { return HttpClient(server_->port()).post("/", "").status == 200; }));
  EXPECT_EQ(gate_.waiting(), 1);
}

TEST_F(LimitsTest, PassesTheTimeOfItsAnswerToTheHandler) {
  options_.operationTimeout = 60s;
  std::chrono::steady_clock::duration left{};
  start([&](const Request& request) {
    left = request.deadline - std::chrono::steady_clock::now();
    return echo(request);
  });
  HttpClient(server_->port()).post("/", "");
  EXPECT_GT(left, 30s);
  EXPECT_LE(left, 60s);
}

TEST_F(LimitsTest, OutlivesAHandlerThatEndsItsThread) {
  if (sanitized()) {
    GTEST_SKIP() << "the sanitizers do not follow the unwinding of a thread";
  }
  options_.maxRequests = 1;
  start([](const Request& request) {
    if (request.path == "/exit") {
      pthread_exit(nullptr);
    }
    return echo(request);
  });
  HttpClient client(server_->port());
  for (int i = 0; i < 3; ++i) {
    const Response ended = HttpClient(server_->port()).post("/exit", "");
    EXPECT_EQ(ended.status, 500u);
    EXPECT_EQ(ended.body, "a provider ended the thread of its request\n");
    EXPECT_TRUE(poll([&] { return client.post("/", "").status == 200; }));
  }
  EXPECT_TRUE(server_->drain(10s));
}

thread_local std::string culprit;

TEST_F(LimitsTest, SaysWhoEndedTheThreadOfTheRequest) {
  if (sanitized()) {
    GTEST_SKIP() << "the sanitizers do not follow the unwinding of a thread";
  }
  options_.threadEnd = []() -> const std::string& { return culprit; };
  start([](const Request& request) -> Response {
    culprit = request.path == "/unknown" ? "" : "provider TST_Other did";
    pthread_exit(nullptr);
  });
  EXPECT_EQ(HttpClient(server_->port()).post("/", "").body, "provider TST_Other did\n");
  EXPECT_EQ(HttpClient(server_->port()).post("/unknown", "").body, "a provider ended the thread of its request\n");
}

TEST_F(LimitsTest, AnswersAHandlerWithoutMemoryAndOneThatThrowsNoException) {
  start([](const Request& request) -> Response {
    if (request.path == "/memory") {
      throw std::bad_alloc();
    }
    throw 1;
  });
  EXPECT_EQ(HttpClient(server_->port()).post("/memory", "").status, 503u);
  EXPECT_EQ(HttpClient(server_->port()).post("/", "").status, 500u);
}

TEST_F(LimitsTest, TakesOnlySoManyLargeBodiesTogether) {
  options_.maxRequestMemory = 200000;
  start();
  const std::string head = "POST / HTTP/1.1\r\nHost: localhost\r\nContent-Length: 200000\r\n\r\n";
  // Whichever body arrives first, the other has no room; here it is to be the second, and a small one has room.
  EXPECT_TRUE(poll([&] {
    HttpClient first(server_->port());
    first.send(head + std::string(199999, 'x'));
    HttpClient second(server_->port());
    second.send(head + std::string(200000, 'x'));
    if (second.receive().status != 503) {
      return false;
    }
    EXPECT_EQ(HttpClient(server_->port()).post("/", std::string(60000, 'x')).status, 200u);
    first.send("x");
    EXPECT_EQ(first.receive().status, 200u);
    return true;
  }));
  EXPECT_EQ(HttpClient(server_->port()).post("/", std::string(200000, 'x')).status, 200u);
}

TEST_F(LimitsTest, DoesNotWaitForAClientThatDoesNotTakeItsReplyWhenShuttingDown) {
  start([](const Request&) { return Response{200, {}, std::string(64 << 20, 'x')}; });
  HttpClient client(server_->port());
  ask(client, "/");
  EXPECT_FALSE(client.receiveSome().empty());
  const auto start = std::chrono::steady_clock::now();
  EXPECT_TRUE(server_->drain(60s));
  EXPECT_LT(std::chrono::steady_clock::now() - start, 20s);
}

// Leaves the process as many descriptors as a test needs, and the limit as it was.
class DescriptorLimitTest : public LimitsTest {
 protected:
  DescriptorLimitTest() { getrlimit(RLIMIT_NOFILE, &before_); }
  ~DescriptorLimitTest() override { setrlimit(RLIMIT_NOFILE, &before_); }

  void leave(rlim_t descriptors) const {
    const rlimit limit{descriptors, before_.rlim_max};
    setrlimit(RLIMIT_NOFILE, &limit);
  }

  rlimit before_{};
};

TEST_F(DescriptorLimitTest, ShedsClientsWithoutSpinningWhereThereAreNoDescriptors) {
  if (sanitized()) {
    GTEST_SKIP() << "the sanitizers look at memory through descriptors of their own";
  }
  start();
  // The clients share the process, so that the descriptors are gone before the server has its own.
  const Ground::Descriptor last("/dev/null", O_RDONLY);
  leave(static_cast<rlim_t>(last.number()) + 10);
  timespec before{};
  int refused = 0;
  for (int i = 0; i < 20; ++i) {
    try {
      slow_.emplace_back(server_->port()).send("POST");
    } catch (const std::runtime_error&) {
      ++refused;
    }
  }
  EXPECT_GT(refused, 0);
  clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &before);
  std::this_thread::sleep_for(300ms);
  timespec after{};
  clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &after);
  EXPECT_LT((after.tv_sec - before.tv_sec) * 1000 + (after.tv_nsec - before.tv_nsec) / 1000000, 100);
  slow_.clear();
  EXPECT_TRUE(poll([this] { return answers(); }));
}

TEST_F(DescriptorLimitTest, RefusesConnectionsThatItsDescriptorsDoNotAllow) {
  const rlimit limit{200, before_.rlim_max};
  setrlimit(RLIMIT_NOFILE, &limit);
  options_.maxConnections = 200;
  start();  // raises the limit
  rlimit raised{};
  getrlimit(RLIMIT_NOFILE, &raised);
  EXPECT_GE(raised.rlim_cur, 200U);
  options_.maxConnections = 4000000;
  try {
    start();
    FAIL() << "there cannot be so many";
  } catch (const ServerError& error) {
    EXPECT_NE(std::string(error.what()).find("max-connections 4000000 needs"), std::string::npos) << error.what();
    EXPECT_NE(std::string(error.what()).find("lower max-connections, or raise"), std::string::npos) << error.what();
  }
}

}  // namespace
