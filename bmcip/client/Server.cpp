// SPDX-License-Identifier: Apache-2.0
#include "bmcip/client/Server.h"

#include <curl/curl.h>

#include <memory>
#include <stdexcept>

namespace Bmcip {
namespace {

using Url = std::unique_ptr<CURLU, decltype(&curl_url_cleanup)>;

std::string part(const Url& url, CURLUPart which) {
  char* text = nullptr;
  if (curl_url_get(url.get(), which, &text, 0) != CURLUE_OK) {
    return {};
  }
  const std::unique_ptr<char, decltype(&curl_free)> owner(text, &curl_free);
  return text;
}

const char* usualPort(const std::string& scheme) { return scheme == "https" ? "5989" : "5988"; }

}  // namespace

bool Server::isThisMachine() const { return host == "localhost" || host == "[::1]" || host.starts_with("127."); }

Server parseServer(const std::string& text, const Server& defaults) {
  const bool hasScheme = text.find("://") != std::string::npos;
  const Url url(curl_url(), &curl_url_cleanup);
  const std::string whole = hasScheme ? text : defaults.scheme + "://" + text;
  const CURLUcode code = curl_url_set(url.get(), CURLUPART_URL, whole.c_str(), CURLU_NON_SUPPORT_SCHEME);
  if (code != CURLUE_OK || text.find_first_of(" \t\r\n") != std::string::npos) {
    throw std::invalid_argument("\"" + text + "\" must be a host, or a URL such as https://host:5989");
  }
  Server server = defaults;
  server.given = text;
  server.scheme = part(url, CURLUPART_SCHEME);
  if (server.scheme != "http" && server.scheme != "https") {
    throw std::invalid_argument("\"" + text + "\" must begin with http:// or https://");
  }
  if (!part(url, CURLUPART_USER).empty() || !part(url, CURLUPART_PASSWORD).empty()) {
    throw std::invalid_argument("a URL must hold no user and password: put them into a file for --credentials");
  }
  if (!part(url, CURLUPART_QUERY).empty() || !part(url, CURLUPART_FRAGMENT).empty()) {
    throw std::invalid_argument("\"" + text + "\" must end with the namespace: no ? and no # are taken");
  }
  server.host = part(url, CURLUPART_HOST);
  server.port = part(url, CURLUPART_PORT);
  if (server.port.empty()) {
    server.port = server.scheme == defaults.scheme ? defaults.port : usualPort(server.scheme);
  }
  std::string path = part(url, CURLUPART_PATH);
  while (path.starts_with('/')) {
    path.erase(0, 1);
  }
  while (path.ends_with('/')) {
    path.pop_back();
  }
  if (!path.empty()) {
    server.nameSpace = path;
  }
  return server;
}

}  // namespace Bmcip
