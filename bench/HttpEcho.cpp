// SPDX-License-Identifier: Apache-2.0
// http_echo FILE: answers every request with the bytes of a file, by cimomd's own HTTP server: the least that serving
// them costs. Prints its port, and runs until it is ended.
#include <unistd.h>

#include <exception>
#include <fstream>
#include <iostream>
#include <iterator>

#include "cimom/http/Server.h"

int main(int argc, char** argv) {
  if (argc != 2) {
    std::cerr << "usage: http_echo FILE\n";
    return 2;
  }
  try {
    std::ifstream file(argv[1], std::ios::binary);
    const std::string answer{std::istreambuf_iterator<char>(file), {}};
    const Cimom::Http::Server server({}, [&](const Cimom::Http::Request&) {
      Cimom::Http::Response response;
      response.headers.add("Content-Type", "application/xml; charset=utf-8");
      response.body = answer;
      return response;
    });
    std::cout << server.port() << std::endl;
    while (true) {
      ::pause();
    }
  } catch (const std::exception& error) {
    std::cerr << "http_echo: " << error.what() << '\n';
    return 1;
  }
}
