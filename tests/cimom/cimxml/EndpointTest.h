// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "cimom/ObjectManager.h"
#include "cimom/cimxml/Endpoint.h"
#include "tests/cimom/cimxml/Messages.h"

namespace Testing {

// The endpoint before an object manager with the probe provider, in root/test.
class EndpointTest : public testing::Test {
 protected:
  EndpointTest();

  Cimom::Http::Response post(const std::string& method, const std::string& body) const;

  // What the operation returns: the content of IMETHODRESPONSE.
  std::string returned(const std::string& method, const std::string& parameters) const;

  // The status code and the description of a failed operation: "5: …".
  std::string failed(const std::string& method, const std::string& parameters) const;

  // The content of a response message that answers the method; a failure otherwise.
  static std::string contentOf(const Cimom::Http::Response& response, const std::string& method);

  static Cimom::Http::Request request(const std::string& method, const std::string& body);

  Cimom::ObjectManager manager_;
  Cimom::CimXml::Endpoint endpoint_;
};

// The name of the first TEST_Thing.
std::string thingName(const std::string& number = "1");

}  // namespace Testing
