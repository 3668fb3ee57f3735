// SPDX-License-Identifier: Apache-2.0
#include "cimom/providers/ProviderRegistration.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fstream>
#include <iterator>
#include <sstream>
#include <string_view>
#include <system_error>

#include "cimom/model/Errors.h"

namespace Cimom {
namespace {

namespace fs = std::filesystem;

std::string_view trimmed(std::string_view text) {
  constexpr std::string_view blanks = " \t\r\v\f";
  const std::size_t first = text.find_first_not_of(blanks);
  if (first == std::string_view::npos) {
    return {};
  }
  return text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

std::vector<std::string> words(std::string_view text) {
  std::istringstream stream{std::string(text)};
  std::vector<std::string> result;
  for (std::string word; stream >> word;) {
    result.push_back(word);
  }
  return result;
}

// Reads the stanzas line by line.
class StanzaReader {
 public:
  explicit StanzaReader(std::string file) : file_(std::move(file)) {}

  void line(std::string_view text) {
    ++line_;
    text = trimmed(text.substr(0, text.find('#')));
    if (text.empty()) {
      return;
    }
    if (text.front() == '[') {
      return open(text);
    }
    const std::size_t colon = text.find(':');
    if (colon == std::string_view::npos) {
      fail("expected \"[ClassName]\" or \"key: value\", not \"" + std::string(text) + "\"");
    }
    if (!stanza_) {
      fail("expected \"[ClassName]\" before the first key");
    }
    assign(trimmed(text.substr(0, colon)), trimmed(text.substr(colon + 1)));
  }

  std::vector<ProviderRegistration> finish() {
    close();
    return std::move(done_);
  }

 private:
  [[noreturn]] void fail(const std::string& what) const { throw ConfigurationError(place() + ": " + what); }

  std::string place() const { return file_ + ":" + std::to_string(line_); }

  void open(std::string_view text) {
    close();
    const std::string_view name = text.back() == ']' ? trimmed(text.substr(1, text.size() - 2)) : std::string_view();
    if (name.empty()) {
      fail("expected \"[ClassName]\", not \"" + std::string(text) + "\"");
    }
    stanza_ = true;
    current_ = {};
    current_.className = name;
    current_.registeredAt = place();
  }

  void assign(std::string_view key, std::string_view value) {
    if (value.empty()) {
      fail("\"" + std::string(key) + "\" has no value");
    }
    if (key == "provider") {
      return assignOnce(current_.provider, key, value);
    }
    if (key == "location") {
      return assignOnce(current_.location, key, value);
    }
    if (key == "namespace") {
      for (std::string& name : words(value)) {
        current_.namespaces.push_back(std::move(name));
      }
    } else if (key == "type") {
      for (const std::string& type : words(value)) {
        assignType(type);
      }
    } else if (key != "group") {
      fail("unknown key \"" + std::string(key) + "\": must be provider, location, type, namespace or group");
    }
  }

  void assignOnce(std::string& member, std::string_view key, std::string_view value) {
    if (!member.empty()) {
      fail("duplicate \"" + std::string(key) + "\"");
    }
    member = value;
  }

  void assignType(const std::string& type) {
    if (type == "instance") {
      current_.instance = true;
    } else if (type == "association") {
      current_.association = true;
    } else if (type == "method") {
      current_.method = true;
    } else {
      fail("unknown type \"" + type + "\": must be instance, association or method");
    }
  }

  void close() {
    if (!stanza_) {
      return;
    }
    const auto require = [&](bool there, const char* key) {
      if (!there) {
        throw ConfigurationError(current_.registeredAt + ": [" + current_.className + "]: \"" + key + "\" is missing");
      }
    };
    require(!current_.provider.empty(), "provider");
    require(!current_.location.empty(), "location");
    require(current_.instance || current_.association || current_.method, "type");
    require(!current_.namespaces.empty(), "namespace");
    done_.push_back(std::move(current_));
    stanza_ = false;
  }

  std::string file_;
  unsigned line_ = 0;
  bool stanza_ = false;
  ProviderRegistration current_;
  std::vector<ProviderRegistration> done_;
};

std::vector<ProviderRegistration> readFile(const fs::path& file) {
  std::ifstream stream(file);
  StanzaReader reader(file.string());
  if (!stream || fs::is_directory(file)) {
    throw ConfigurationError(file.string() + ": " + (stream ? "is a directory" : std::strerror(errno)));
  }
  for (std::string line; std::getline(stream, line);) {
    reader.line(line);
  }
  return reader.finish();
}

std::vector<fs::path> registrationsIn(const fs::path& directory) {
  std::vector<fs::path> files;
  std::error_code unreadable;
  for (fs::directory_iterator entry(directory, unreadable), end; !unreadable && entry != end;
       entry.increment(unreadable)) {
    if (entry->path().extension() == ".reg") {
      files.push_back(entry->path());
    }
  }
  if (unreadable) {
    throw ConfigurationError(directory.string() + ": cannot be read: " + unreadable.message());
  }
  if (files.empty()) {
    throw ConfigurationError(directory.string() + ": contains no *.reg file");
  }
  std::ranges::sort(files);
  return files;
}

}  // namespace

std::vector<ProviderRegistration> readRegistration(const fs::path& fileOrDirectory) {
  std::error_code unreadable;
  if (!fs::is_directory(fileOrDirectory, unreadable)) {
    return readFile(fileOrDirectory);
  }
  std::vector<ProviderRegistration> all;
  for (const fs::path& file : registrationsIn(fileOrDirectory)) {
    std::ranges::move(readFile(file), std::back_inserter(all));
  }
  return all;
}

}  // namespace Cimom
