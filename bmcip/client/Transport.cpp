// SPDX-License-Identifier: Apache-2.0
#include "bmcip/client/Transport.h"

#include <curl/curl.h>

#include <algorithm>
#include <array>
#include <list>
#include <utility>
#include <vector>

#include "ground/Names.h"

namespace Bmcip {
namespace {

constexpr std::size_t maxHeaders = 1 << 16;
constexpr int tickMilliseconds = 200;

using Easy = std::unique_ptr<CURL, decltype(&curl_easy_cleanup)>;
using Headers = std::unique_ptr<curl_slist, decltype(&curl_slist_free_all)>;

struct Exchange {
  explicit Exchange(Easy handle) : easy(std::move(handle)) {}

  Easy easy;
  Headers headers{nullptr, &curl_slist_free_all};
  std::string message;
  Server server;
  std::function<void(Reply)> done;
  Reply reply;
  std::string cimError;
  std::size_t headerBytes = 0;
  bool tooLarge = false;
  std::array<char, CURL_ERROR_SIZE> error{};
};

void addHeader(Headers& headers, const std::string& line) {
  curl_slist* longer = curl_slist_append(headers.get(), line.c_str());
  if (!longer) {
    throw std::bad_alloc();
  }
  static_cast<void>(headers.release());
  headers.reset(longer);
}

std::string escaped(const std::string& text) {
  const std::unique_ptr<char, decltype(&curl_free)> escape(
      curl_easy_escape(nullptr, text.data(), static_cast<int>(text.size())), &curl_free);
  return escape ? escape.get() : "";
}

std::size_t takeBody(char* data, std::size_t, std::size_t size, void* user) {
  auto& exchange = *static_cast<Exchange*>(user);
  if (exchange.reply.message.size() + size > Transport::maxReply) {
    exchange.tooLarge = true;
    return 0;
  }
  exchange.reply.message.append(data, size);
  return size;
}

std::size_t takeHeader(char* data, std::size_t, std::size_t size, void* user) {
  auto& exchange = *static_cast<Exchange*>(user);
  exchange.headerBytes += size;
  if (exchange.headerBytes > maxHeaders) {
    exchange.tooLarge = true;
    return 0;
  }
  constexpr std::string_view name = "CIMError:";
  const std::string_view line(data, size);
  if (line.size() > name.size() && Ground::sameName(line.substr(0, name.size()), name)) {
    const auto begin = line.find_first_not_of(' ', name.size());
    exchange.cimError = begin == std::string_view::npos ? "" : line.substr(begin, line.find_first_of("\r\n") - begin);
  }
  return size;
}

std::string seconds(std::chrono::milliseconds time) {
  const std::string text = std::to_string(static_cast<double>(time.count()) / 1000);
  return text.substr(0, text.find('.') + 2) + " s";
}

// What libcurl says of a transfer that failed.
Failure transferFailure(const Exchange& exchange, CURLcode code, const Access& access) {
  const std::string detail = exchange.error[0] ? exchange.error.data() : curl_easy_strerror(code);
  if (exchange.tooLarge) {
    return {FailureKind::Malformed, "the reply is larger than " + std::to_string(Transport::maxReply) +
                                        " bytes: no object manager with these classes answers so"};
  }
  switch (code) {
    case CURLE_COULDNT_RESOLVE_HOST:
      return {FailureKind::Unreachable, "not reachable: there is no host of that name (" + detail + ")"};
    case CURLE_COULDNT_CONNECT:
      return {FailureKind::Unreachable,
              "not reachable: " + detail + "; does the object manager run there, and listen on this port?"};
    case CURLE_OPERATION_TIMEDOUT:
      return {FailureKind::TimedOut, "no answer within " + seconds(access.timeout) + " (connection: " +
                                         seconds(access.connectTimeout) + "): " + detail + "; --timeout changes that"};
    case CURLE_PEER_FAILED_VERIFICATION:
    case CURLE_SSL_ISSUER_ERROR:
      return {FailureKind::Certificate, "the server's certificate is not accepted: " + detail +
                                            "; name the authority that signed it with --cacert FILE"};
    case CURLE_SSL_CACERT_BADFILE:
      return {FailureKind::Certificate, "the file for --cacert cannot be used: " + detail};
    case CURLE_SSL_CONNECT_ERROR:
      return {FailureKind::Certificate, "no TLS connection: " + detail + "; does the server speak https on this port?"};
    case CURLE_GOT_NOTHING:
    case CURLE_RECV_ERROR:
    case CURLE_SEND_ERROR:
      return {FailureKind::Unreachable,
              "the server broke the connection off: " + detail + "; does it expect https on this port?"};
    case CURLE_PARTIAL_FILE:
      return {FailureKind::Unreachable, "the server broke the connection off in the middle of its reply: " + detail};
    default:
      return {FailureKind::Malformed, "the reply cannot be read: " + detail};
  }
}

// What an HTTP status other than 200 means.
Failure statusFailure(const Exchange& exchange, long status, const Access& access) {
  const std::string http = "HTTP status " + std::to_string(status);
  switch (status) {
    case 401:
    case 403:
      return {FailureKind::Login, access.user.empty() && !access.netrc
                                      ? "the server asks for a login: give --credentials FILE, --netrc or --user NAME"
                                      : "the server does not accept this login (" + http + ")"};
    case 404:
      return {FailureKind::Malformed, "no object manager answers there (" + http + " for /cimom)"};
    case 503:
      return {FailureKind::Unreachable, "the object manager takes no more requests now (" + http + ")"};
    default:
      return {FailureKind::Error, "the object manager does not take the request: " + http +
                                      (exchange.cimError.empty() ? "" : ", " + exchange.cimError)};
  }
}

}  // namespace

struct Transport::State {
  Access access;
  std::unique_ptr<CURLM, decltype(&curl_multi_cleanup)> multi{curl_multi_init(), &curl_multi_cleanup};
  std::list<Exchange> active;
  std::vector<Easy> idle;  // for reuse: a handle brings its buffers

  Easy handle() {
    if (idle.empty()) {
      return {curl_easy_init(), &curl_easy_cleanup};
    }
    Easy reused = std::move(idle.back());
    idle.pop_back();
    curl_easy_reset(reused.get());
    return reused;
  }

  void prepare(Exchange& exchange, const Call& call);
  void finish(CURL* easy, CURLcode code);
};

void Transport::State::prepare(Exchange& exchange, const Call& call) {
  for (const std::string& line :
       {std::string("Content-Type: application/xml; charset=\"utf-8\""),
        std::string("Accept: application/xml, text/xml"), std::string("CIMOperation: MethodCall"),
        std::string("CIMProtocolVersion: 1.0"), "CIMMethod: " + call.method,
        "CIMObject: " + escaped(exchange.server.nameSpace), std::string("Expect:")}) {
    addHeader(exchange.headers, line);
  }
  exchange.message = call.message;
  CURL* easy = exchange.easy.get();
  const auto set = [easy](CURLoption option, auto value) { curl_easy_setopt(easy, option, value); };
  const std::string url = exchange.server.url() + "/cimom";
  set(CURLOPT_URL, url.c_str());
  set(CURLOPT_PROTOCOLS_STR, "http,https");
  set(CURLOPT_PROXY, "");
  set(CURLOPT_NOSIGNAL, 1L);
  set(CURLOPT_BUFFERSIZE, 16384L);
  set(CURLOPT_UPLOAD_BUFFERSIZE, 16384L);
  set(CURLOPT_HTTP_VERSION, static_cast<long>(CURL_HTTP_VERSION_1_1));
  set(CURLOPT_POST, 1L);
  set(CURLOPT_POSTFIELDS, exchange.message.c_str());
  set(CURLOPT_POSTFIELDSIZE, static_cast<long>(exchange.message.size()));
  set(CURLOPT_HTTPHEADER, exchange.headers.get());
  set(CURLOPT_USERAGENT, "bmcip");
  set(CURLOPT_WRITEFUNCTION, &takeBody);
  set(CURLOPT_WRITEDATA, static_cast<void*>(&exchange));
  set(CURLOPT_HEADERFUNCTION, &takeHeader);
  set(CURLOPT_HEADERDATA, static_cast<void*>(&exchange));
  set(CURLOPT_ERRORBUFFER, exchange.error.data());
  set(CURLOPT_PRIVATE, static_cast<void*>(&exchange));
  set(CURLOPT_CONNECTTIMEOUT_MS, static_cast<long>(std::min(access.connectTimeout, access.timeout).count()));
  set(CURLOPT_TIMEOUT_MS, static_cast<long>(access.timeout.count()));
  if (!access.cacert.empty()) {
    set(CURLOPT_CAINFO, access.cacert.c_str());
  }
  set(CURLOPT_HTTPAUTH, static_cast<long>(CURLAUTH_BASIC));
  if (!access.user.empty()) {
    set(CURLOPT_USERNAME, access.user.c_str());
    set(CURLOPT_PASSWORD, access.password.c_str());
  } else if (access.netrc) {
    set(CURLOPT_NETRC, static_cast<long>(CURL_NETRC_REQUIRED));
  }
}

void Transport::State::finish(CURL* easy, CURLcode code) {
  Exchange* finished = nullptr;
  curl_easy_getinfo(easy, CURLINFO_PRIVATE, &finished);
  const auto place =
      std::ranges::find_if(active, [finished](const Exchange& exchange) { return &exchange == finished; });
  std::list<Exchange> taken;
  taken.splice(taken.begin(), active, place);
  Exchange& exchange = taken.front();
  curl_multi_remove_handle(multi.get(), easy);
  long status = 0;
  curl_easy_getinfo(easy, CURLINFO_RESPONSE_CODE, &status);
  if (code != CURLE_OK) {
    exchange.reply.failure = transferFailure(exchange, code, access);
  } else if (status != 200) {
    exchange.reply.failure = statusFailure(exchange, status, access);
  }
  if (char* peer = nullptr; curl_easy_getinfo(easy, CURLINFO_PRIMARY_IP, &peer) == CURLE_OK && peer) {
    exchange.reply.peer = peer;
  }
  idle.push_back(std::move(exchange.easy));
  exchange.done(std::move(exchange.reply));
}

Transport::Transport(Access access) : state_(std::make_unique<State>()) {
  static const CURLcode initialized = curl_global_init(CURL_GLOBAL_DEFAULT);
  if (initialized != CURLE_OK || !state_->multi) {
    throw std::runtime_error("libcurl cannot be used");
  }
  state_->access = std::move(access);
}

Transport::~Transport() {
  for (const Exchange& exchange : state_->active) {
    curl_multi_remove_handle(state_->multi.get(), exchange.easy.get());
  }
}

void Transport::send(const Server& server, const Call& call, std::function<void(Reply)> done) {
  Easy easy = state_->handle();
  if (!easy) {
    throw std::bad_alloc();
  }
  Exchange& exchange = state_->active.emplace_back(std::move(easy));
  exchange.server = server;
  exchange.done = std::move(done);
  state_->prepare(exchange, call);
  curl_multi_add_handle(state_->multi.get(), exchange.easy.get());
}

void Transport::run(const std::function<void()>& tick) {
  while (!state_->active.empty()) {
    int running = 0;
    if (const CURLMcode code = curl_multi_perform(state_->multi.get(), &running); code != CURLM_OK) {
      throw std::runtime_error(curl_multi_strerror(code));
    }
    int left = 0;
    bool finished = false;
    while (const CURLMsg* message = curl_multi_info_read(state_->multi.get(), &left)) {
      if (message->msg == CURLMSG_DONE) {
        state_->finish(message->easy_handle, message->data.result);
        finished = true;
      }
    }
    if (tick) {
      tick();
    }
    if (!finished && !state_->active.empty()) {
      curl_multi_poll(state_->multi.get(), nullptr, 0, tickMilliseconds, nullptr);
    }
  }
}

Reply Transport::ask(const Server& server, const Call& call) {
  Reply answer;
  send(server, call, [&answer](Reply reply) { answer = std::move(reply); });
  run();
  if (answer.failure) {
    throw Failure(*answer.failure);
  }
  return answer;
}

}  // namespace Bmcip
