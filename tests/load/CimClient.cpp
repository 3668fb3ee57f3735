// SPDX-License-Identifier: Apache-2.0
#include "tests/load/CimClient.h"

#include <chrono>
#include <stdexcept>

#include "tests/cimom/cimxml/Messages.h"

namespace Testing {
namespace {

constexpr unsigned httpOk = 200;

// The object manager gives up on a provider before.
constexpr std::chrono::seconds replyPatience{90};

// The value of an attribute of the first element of that name; empty if there is none.
std::string attributeOf(const std::string& xml, const std::string& element, const std::string& name) {
  const auto begin = xml.find('<' + element + ' ');
  const auto end = xml.find('>', begin);
  const auto at = xml.find(name + "=\"", begin);
  if (begin == std::string::npos || at >= end) {
    return {};
  }
  const auto value = at + name.size() + 2;
  return xml.substr(value, xml.find('"', value) - value);
}

Answer judge(unsigned status, std::string body) {
  if (status != httpOk) {
    const bool isTold = body.size() > 1;
    return {isTold ? Answer::Kind::ErrorTold : Answer::Kind::Untold, "HTTP " + std::to_string(status), std::move(body)};
  }
  if (!body.ends_with("</CIM>") && !body.ends_with("</CIM>\n")) {
    return {Answer::Kind::Untold, "an answer without its end", std::move(body)};
  }
  if (body.find("<ERROR ") == std::string::npos) {
    return {Answer::Kind::Fine, "", std::move(body)};
  }
  const std::string code = attributeOf(body, "ERROR", "CODE");
  const bool isTold = !code.empty() && !attributeOf(body, "ERROR", "DESCRIPTION").empty();
  return {isTold ? Answer::Kind::ErrorTold : Answer::Kind::Untold, code, std::move(body)};
}

}  // namespace

Answer CimClient::ask(const std::string& method, const std::string& parameters, const std::string& nameSpace) {
  return send(
      method, "root%2F" + nameSpace,
      messageOf("<IMETHODCALL NAME=\"" + method + "\">" + nameSpacePath(nameSpace) + parameters + "</IMETHODCALL>"));
}

Answer CimClient::send(const std::string& method, const std::string& object, const std::string& body) {
  try {
    if (!connection_) {
      connection_.emplace(port_, "127.0.0.1", replyPatience);
    }
    auto response = connection_->post("/cimom", body,
                                      "Content-Type: application/xml; charset=\"utf-8\"\r\n"
                                      "CIMOperation: MethodCall\r\nCIMMethod: " +
                                          method + "\r\nCIMObject: " + object + "\r\n");
    const std::string* connection = response.headers.find("Connection");
    if (connection && *connection == "close") {
      connection_.reset();
    }
    return judge(response.status, std::move(response.body));
  } catch (const std::runtime_error& error) {
    connection_.reset();
    return {Answer::Kind::Untold, "no answer", error.what()};
  }
}

Answer CimClient::sendRaw(const std::string& bytes) const {
  try {
    HttpClient connection(port_);
    connection.send(bytes);
    connection.finish();
    std::string all;
    for (std::string some = connection.receiveSome(); !some.empty(); some = connection.receiveSome()) {
      all += some;
    }
    const bool isHttp = all.empty() || all.starts_with("HTTP/1.");
    return {isHttp ? Answer::Kind::Fine : Answer::Kind::Untold, "", std::move(all)};
  } catch (const std::runtime_error& error) {
    return {Answer::Kind::Untold, "no answer", error.what()};
  }
}

void Tally::add(const std::string& what, const Answer& answer) {
  ++requests_;
  ++byStatus_[answer.status.empty() ? "fine" : answer.status];
  if (answer.kind == Answer::Kind::ErrorTold) {
    ++errorsTold_;
  } else if (answer.kind == Answer::Kind::Untold) {
    ++untold_[what + ": " + answer.status + ": " + answer.body.substr(0, 1000)];
  }
}

void Tally::add(const Tally& other) {
  requests_ += other.requests_;
  errorsTold_ += other.errorsTold_;
  for (const auto& [status, count] : other.byStatus_) {
    byStatus_[status] += count;
  }
  for (const auto& [what, count] : other.untold_) {
    untold_[what] += count;
  }
}

std::string Tally::summary() const {
  std::string text = std::to_string(requests_) + " requests";
  for (const auto& [status, count] : byStatus_) {
    text += ", " + status + ": " + std::to_string(count);
  }
  return text;
}

}  // namespace Testing
